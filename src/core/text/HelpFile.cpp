#include "core/text/HelpFile.h"

#include <QDir>
#include <QFile>
#include <QStringDecoder>

namespace HelpFile {

int topicCount(HelpKind kind) {
    return kind == HelpKind::General ? 13 : 8;
}
int printIndex(HelpKind kind) {
    return topicCount(kind) - 2;
}
int exitIndex(HelpKind kind) {
    return topicCount(kind) - 1;
}

QStringList topicCaptions(HelpKind kind) {
    if (kind == HelpKind::General)
        return {QStringLiteral("Introduction"),
                QStringLiteral("Commands"),
                QStringLiteral("Current  Data"),
                QStringLiteral("Logged  Data"),
                QStringLiteral("Erase  Data"),
                QStringLiteral("What  is  GLP ?"),
                QStringLiteral("GLP  Data"),
                QStringLiteral("Save"),
                QStringLiteral("Print"),
                QStringLiteral("Setup  Wizard"),
                QStringLiteral("Importing  Data to Microsoft  Excel"),
                QStringLiteral("Print  help  file"),
                QStringLiteral("Exit  help")};
    return {QStringLiteral("Enable  Logging"),  QStringLiteral("Disable  Logging"),
            QStringLiteral("Start  Stirring"),  QStringLiteral("Stop  Stirring"),
            QStringLiteral("Power  On"),        QStringLiteral("Power  Off"),
            QStringLiteral("Print  help file"), QStringLiteral("Exit  help")};
}

QString fileName(HelpKind kind) {
    return kind == HelpKind::General ? QStringLiteral("help.txt") : QStringLiteral("HelpOther.txt");
}

QStringList parseBlocks(const QString& text, int count) {
    QStringList topics;
    if (count <= 0)
        return topics;
    QString normal = text;
    normal.replace(QLatin1String("\r\n"), QLatin1String("\n"));
    normal.replace(QLatin1Char('\r'), QLatin1Char('\n'));
    QStringList lines = normal.split(QLatin1Char('\n'));
    // A line break at the end of the file ends the last line; it does not start another one.
    if (!lines.isEmpty() && lines.constLast().isEmpty())
        lines.removeLast();

    QString current;
    bool pending = false; // lines read since the last "#"
    for (const QString& line : std::as_const(lines)) {
        if (topics.size() == count)
            break;
        if (line == QLatin1String("#")) {
            topics.append(current);
            current.clear();
            pending = false;
        } else {
            current += line + QLatin1String("\r\n");
            pending = true;
        }
    }
    if (pending && topics.size() < count)
        topics.append(current);
    while (topics.size() < count)
        topics.append(QString());
    return topics;
}

QString decode(const QByteArray& bytes) {
    QByteArray body = bytes;
    if (body.startsWith("\xEF\xBB\xBF"))
        body.remove(0, 3);
    QStringDecoder utf8(QStringDecoder::Utf8);
    QString text = utf8.decode(body);
    if (utf8.hasError())
        return QString::fromLatin1(body);
    return text;
}

QStringList load(const QString& folder, HelpKind kind) {
    QFile file(QDir(folder).filePath(fileName(kind)));
    QString text;
    if (file.open(QIODevice::ReadOnly))
        text = decode(file.readAll());
    return parseBlocks(text, topicCount(kind));
}

QString composePrintText(const QStringList& topics, int count) {
    QString text;
    for (int i = 0; i < count; ++i)
        text += topics.value(i) + QLatin1String("\r\n\r\n\r\n");
    return text;
}

} // namespace HelpFile
