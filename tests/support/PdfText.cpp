#include "PdfText.h"

#include <QProcess>
#include <QStringList>

QString printedText(const QString& pdf) {
    QProcess run;
    run.start(QStringLiteral("pdftotext"), {QStringLiteral("-layout"), pdf, QStringLiteral("-")});
    if (!run.waitForFinished(20000) || run.exitCode() != 0)
        return QStringLiteral("<pdftotext failed>");
    const QStringList pages =
        QString::fromUtf8(run.readAllStandardOutput()).split(QLatin1Char('\f'));
    QStringList kept;
    for (int i = 0; i < pages.size(); ++i) {
        QStringList lines = pages.at(i).split(QLatin1Char('\n'));
        while (!lines.isEmpty() && lines.constLast().trimmed().isEmpty())
            lines.removeLast();
        if (!lines.isEmpty() && lines.constLast().trimmed() == QString::number(i + 1))
            lines.removeLast();
        kept.append(lines.join(QLatin1Char('\n')));
    }
    return kept.join(QLatin1Char(' ')).simplified();
}

QString pdfFonts(const QString& pdf) {
    QProcess run;
    run.start(QStringLiteral("pdffonts"), {pdf});
    if (!run.waitForFinished(20000))
        return QString();
    return QString::fromUtf8(run.readAllStandardOutput());
}
