#include "core/link/PortNames.h"

#include <QRegularExpression>

namespace PortNames {

namespace {
QString stripDevicePrefix(const QString& text) {
    static const QString prefix = QStringLiteral("\\\\.\\");
    return text.startsWith(prefix) ? text.mid(prefix.size()) : text;
}
} // namespace

QString platformPath(const QString& devicePathOrName) {
    const QString name = stripDevicePrefix(devicePathOrName);
#ifdef Q_OS_WIN
    return name;
#else
    static const QRegularExpression com(QStringLiteral("^COM([0-9]{1,5})$"),
                                        QRegularExpression::CaseInsensitiveOption);
    const auto m = com.match(name);
    if (m.hasMatch()) {
        const int n = m.captured(1).toInt();
        if (n >= 1) // stored "COMn" settings keep working: COM1 is the first serial device
            return QStringLiteral("/dev/ttyS%1").arg(n - 1);
    }
    if (name.startsWith(QLatin1Char('/')))
        return name;
    return QStringLiteral("/dev/") + name;
#endif
}

int PortNumberOf(const QString& name) {
    const QString rest = name.mid(3).trimmed();
    int digits = 0;
    while (digits < rest.size() && rest.at(digits).isDigit() && digits < 9)
        ++digits;
    return digits == 0 ? 0 : rest.left(digits).toInt();
}

bool isUsableName(const QString& name) {
    if (name.isEmpty() || name.size() > 255)
        return false;
    for (const QChar ch : name) {
        if (ch.isSpace() || ch.unicode() < 32 || ch.unicode() == 127)
            return false;
    }
    static const QRegularExpression com(QStringLiteral("^COM([0-9]+)$"),
                                        QRegularExpression::CaseInsensitiveOption);
    const auto m = com.match(name);
    if (m.hasMatch()) {
        bool ok = false;
        const int n = m.captured(1).toInt(&ok);
        return ok && n >= 1 && n <= 32767;
    }
    return true;
}

Mode parseMode(const QString& text) {
    Mode mode;
    bool haveBaud = false;
    for (const QString& part : text.split(QLatin1Char(' '), Qt::SkipEmptyParts)) {
        const int eq = part.indexOf(QLatin1Char('='));
        if (eq <= 0)
            return {};
        const QString key = part.left(eq).toLower();
        const QString value = part.mid(eq + 1);
        bool ok = true;
        if (key == QLatin1String("baud")) {
            mode.baud = value.toInt(&ok);
            haveBaud = ok && mode.baud > 0;
        } else if (key == QLatin1String("parity")) {
            if (value.size() != 1 || !QStringLiteral("NEOMS").contains(value.toUpper()))
                return {};
            mode.parity = value.toUpper().at(0).toLatin1();
        } else if (key == QLatin1String("data")) {
            mode.dataBits = value.toInt(&ok);
            ok = ok && mode.dataBits >= 5 && mode.dataBits <= 8;
        } else if (key == QLatin1String("stop")) {
            mode.stopBits = value.toInt(&ok);
            ok = ok && (mode.stopBits == 1 || mode.stopBits == 2);
        }
        if (!ok)
            return {};
    }
    mode.valid = haveBaud;
    return mode;
}

} // namespace PortNames
