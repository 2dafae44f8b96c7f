#include "cli/CliLink.h"
#include "cli/Commands.h"

#include <QDir>
#include <QFileInfo>
#include <QSerialPortInfo>
#include <QTextStream>

// Every serial port the system lists: its path, its stable name where the system keeps one (on
// Linux the links in /dev/serial/by-id, which survive re-plugging), and what the adapter says of
// itself.
int Commands::ports(const QString& byIdFolder) {
    QHash<QString, QString> stableNames;
    const QDir byId(byIdFolder);
    for (const QFileInfo& link :
         byId.entryInfoList(QDir::System | QDir::Files | QDir::NoDotAndDotDot))
        if (link.isSymLink())
            stableNames.insert(QFileInfo(link.symLinkTarget()).canonicalFilePath(),
                               link.absoluteFilePath());
    QTextStream out(stdout);
    for (const QSerialPortInfo& port : QSerialPortInfo::availablePorts()) {
        const QString path = port.systemLocation();
        QStringList about;
        for (const QString& part : {port.manufacturer(), port.description(), port.serialNumber()})
            if (!part.isEmpty() && !about.contains(part))
                about << part;
        out << path << '\t'
            << stableNames.value(QFileInfo(path).canonicalFilePath(), QStringLiteral("-")) << '\t'
            << (about.isEmpty() ? QStringLiteral("-") : about.join(u' ')) << '\n';
    }
    return ExitCode::kDone;
}
