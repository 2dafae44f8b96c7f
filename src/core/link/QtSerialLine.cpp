#include "core/link/QtSerialLine.h"

#include "core/link/PortNames.h"

#include <QTimer>

QtSerialLine::QtSerialLine(QObject* parent) : SerialLine(parent) {
    connect(&port_, &QSerialPort::readyRead, this, &SerialLine::bytesArrived);
    connect(&port_, &QSerialPort::errorOccurred, this, [this](QSerialPort::SerialPortError e) {
        if (e != QSerialPort::ResourceError && e != QSerialPort::ReadError &&
            e != QSerialPort::WriteError)
            return;
        // A vanished device keeps its read notifier firing: close the port once control is back
        // in the event loop, so nothing spins; the next operation then reports the loss.
        QTimer::singleShot(0, this, [this] {
            if (port_.isOpen() && port_.error() != QSerialPort::NoError)
                port_.close();
        });
        emit failed();
    });
}

QtSerialLine::~QtSerialLine() {
    port_.close();
}

qint32 QtSerialLine::open(const QString& devicePath, const QString& mode) {
    port_.close();
    const PortNames::Mode m = PortNames::parseMode(mode);
    if (!m.valid) {
        lastOpenError_ = QSerialPort::UnsupportedOperationError;
        return 1;
    }
    port_.setPortName(PortNames::platformPath(devicePath));
    if (!port_.open(QIODevice::ReadWrite)) {
        lastOpenError_ = port_.error();
        port_.clearError();
        return static_cast<qint32>(lastOpenError_) + 100;
    }
    const auto parity = m.parity == 'E'   ? QSerialPort::EvenParity
                        : m.parity == 'O' ? QSerialPort::OddParity
                        : m.parity == 'M' ? QSerialPort::MarkParity
                        : m.parity == 'S' ? QSerialPort::SpaceParity
                                          : QSerialPort::NoParity;
    // A port that cannot take a setting is a failed open, not a silent one.
    const bool ok =
        port_.setBaudRate(m.baud) &&
        port_.setDataBits(static_cast<QSerialPort::DataBits>(m.dataBits)) &&
        port_.setParity(parity) &&
        port_.setStopBits(m.stopBits == 2 ? QSerialPort::TwoStop : QSerialPort::OneStop) &&
        port_.setFlowControl(QSerialPort::NoFlowControl);
    if (!ok) {
        lastOpenError_ = port_.error();
        port_.close();
        port_.clearError();
        return static_cast<qint32>(lastOpenError_) + 100;
    }
    baud_ = m.baud;
    lastOpenError_ = QSerialPort::NoError;
    return 0;
}

qint32 QtSerialLine::close() {
    if (port_.isOpen())
        port_.close();
    port_.clearError();
    return 0;
}

void QtSerialLine::requireOpen(const char* what) {
    if (!port_.isOpen())
        throw SerialError(std::string(what) + ": the serial port is not open");
}

// Time-outs are not failures; a vanished device or a failed read or write is.
void QtSerialLine::checkPortError(const char* what) {
    const auto e = port_.error();
    if (e == QSerialPort::NoError)
        return;
    if (e == QSerialPort::TimeoutError) {
        port_.clearError();
        return;
    }
    // The error stays set: a port that failed keeps failing until it is closed.
    const QString text = port_.errorString();
    throw SerialError(std::string(what) + ": " + text.toStdString());
}

qint32 QtSerialLine::write(const QByteArray& bytes) {
    requireOpen("write");
    if (port_.write(bytes) != bytes.size())
        checkPortError("write");
    // No event loop runs during an exchange: push the bytes out now. The limit allows for the
    // slowest line speed.
    const int limitMs =
        1000 + static_cast<int>(qint64(bytes.size()) * 10 * 1000 / qMax(baud_, 300));
    while (port_.bytesToWrite() > 0) {
        if (!port_.waitForBytesWritten(limitMs)) {
            checkPortError("write");
            if (port_.bytesToWrite() > 0)
                throw SerialError("write: the serial port does not take data");
        }
    }
    return 0;
}

int QtSerialLine::readByte() {
    requireOpen("read");
    if (port_.bytesAvailable() == 0) {
        port_.waitForReadyRead(0); // collect what the operating system holds, without waiting
        checkPortError("read");
        if (!port_.isOpen())
            throw SerialError("read: the serial port has gone");
    }
    char c = 0;
    if (!port_.getChar(&c))
        return 0;
    return static_cast<unsigned char>(c);
}

qint32 QtSerialLine::setOption(int operation, qint32 value) {
    switch (operation) {
    case kOptionBufferSetup:
    case kOptionReadBuffer:
        // Buffer set-up of the line: QSerialPort sizes its own buffers, so there is nothing to do.
        Q_UNUSED(value);
        return 0;
    case kOptionPurge:
        // Before "Z": drop whatever the meter had queued, so the next exchange starts clean.
        if (port_.isOpen())
            port_.clear(QSerialPort::AllDirections);
        return 0;
    default:
        return 1;
    }
}

bool QtSerialLine::waitForByte(int msecs) {
    requireOpen("read");
    if (port_.bytesAvailable() > 0)
        return true;
    port_.waitForReadyRead(qMax(0, msecs));
    checkPortError("read");
    if (!port_.isOpen())
        throw SerialError("read: the serial port has gone");
    return port_.bytesAvailable() > 0;
}

bool QtSerialLine::isOpen() const {
    return port_.isOpen();
}
