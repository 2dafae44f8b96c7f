#include "core/link/PortProbe.h"

#include "core/link/PortNames.h"

#include <QFileInfo>
#include <QSerialPort>
#include <QSerialPortInfo>
#include <algorithm>

namespace PortProbe {

Outcome probe(const QString& portName) {
    if (portName.isEmpty())
        return Outcome::Missing;
#ifndef Q_OS_WIN
    // A name with no device behind it is missing. QSerialPort would first try to create its lock
    // file, which fails for names too long for a file name, and report that as a permission
    // error: the port would be called "in use".
    if (!QFileInfo::exists(PortNames::platformPath(portName)))
        return Outcome::Missing;
#endif
    QSerialPort port;
    port.setPortName(PortNames::platformPath(portName));
    if (port.open(QIODevice::ReadWrite)) {
        port.close();
        return Outcome::Opened;
    }
    switch (port.error()) {
    case QSerialPort::PermissionError: // held by another program (lock), or no permission
    case QSerialPort::OpenError:       // already open
        return Outcome::InUse;
    case QSerialPort::DeviceNotFoundError:
        return Outcome::Missing;
    case QSerialPort::ResourceError: // the device is there but would not open now
        return Outcome::Present;
    default:
        return Outcome::Failed;
    }
}

bool comPortExists(const QString& portName) {
    const Outcome o = probe(portName);
    return o == Outcome::Opened || o == Outcome::InUse || o == Outcome::Present;
}

QStringList existingPorts() {
    QStringList names;
    for (const QSerialPortInfo& info : QSerialPortInfo::availablePorts()) {
        if (comPortExists(info.portName()))
            names << info.portName();
    }
    // Natural order: COM2 before COM10, ttyS2 before ttyS10.
    std::sort(names.begin(), names.end(), [](const QString& a, const QString& b) {
        auto split = [](const QString& s) {
            int i = int(s.size());
            while (i > 0 && s.at(i - 1).isDigit())
                --i;
            return std::make_pair(s.left(i), s.mid(i).toLongLong());
        };
        return split(a) < split(b);
    });
    return names;
}

} // namespace PortProbe
