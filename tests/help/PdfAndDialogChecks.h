#pragma once

// Helpers for the help tests: a check that no dialog appears, and readers for printed PDF files.

#include "support/DialogDriver.h"

#include <QProcess>
#include <QStringList>
#include <QTest>
#include <QWidget>
#include <functional>

// Runs `call` with a driver armed that closes any modal dialog; true when none appeared.
inline bool noModalDuring(const std::function<void()>& call) {
    DialogDriver::whenModal(
        QString(), [](QWidget* modal) { modal->close(); }, 300);
    call();
    QTest::qWait(400);
    const QStringList failures = DialogDriver::takeFailures();
    return failures.size() == 1 && failures.at(0).startsWith(QLatin1String("no modal dialog"));
}

// The text of a printed PDF, page by page, with the page number that closes each page removed and
// all white space collapsed (the layout of a printout is not the point).
inline QString printedText(const QString& pdf) {
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

// The fonts a PDF uses, as pdffonts lists them.
inline QString pdfFonts(const QString& pdf) {
    QProcess run;
    run.start(QStringLiteral("pdffonts"), {pdf});
    if (!run.waitForFinished(20000))
        return QString();
    return QString::fromUtf8(run.readAllStandardOutput());
}
