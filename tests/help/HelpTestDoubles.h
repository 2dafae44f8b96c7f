#pragma once

// Helpers for the help tests: a message seam that keeps every text it showed, a driver for modal
// dialogs, and readers for printed PDF files. File and print dialogs come from ScriptedDialogs.

#include "shell/Prompts.h"
#include "support/ScriptedDialogs.h"

#include <QApplication>
#include <QList>
#include <QProcess>
#include <QRegularExpression>
#include <QStringList>
#include <QTimer>
#include <QWidget>

class RecordingPrompts : public Prompts {
public:
    QStringList texts;
    QList<Icon> icons;
    Answer answer = Answer::Ok;

    Answer show(const QString& text, Icon icon, Buttons, bool) override {
        texts.append(text);
        icons.append(icon);
        return answer;
    }
};

// Runs `action` on the modal dialog that the code under test is about to show. A watchdog closes
// a dialog still open after a few seconds and records it, so a fault cannot hang the suite. The
// timers die with the driver, so nothing fires into a later test.
class ModalDriver {
public:
    bool watchdogFired = false;
    QString seen; // object name of the modal dialog the action found

    template <typename Action> void whenShown(Action action) {
        step_.setSingleShot(true);
        step_.setInterval(0);
        QObject::disconnect(&step_, nullptr, nullptr, nullptr);
        QObject::connect(&step_, &QTimer::timeout, [this, action] {
            QWidget* modal = QApplication::activeModalWidget();
            seen = modal ? modal->objectName() : QString();
            if (modal)
                action(modal);
        });
        step_.start();
        watchdog_.setSingleShot(true);
        watchdog_.setInterval(5000);
        QObject::disconnect(&watchdog_, nullptr, nullptr, nullptr);
        QObject::connect(&watchdog_, &QTimer::timeout, [this] {
            if (QWidget* modal = QApplication::activeModalWidget()) {
                watchdogFired = true;
                modal->close();
            }
        });
        watchdog_.start();
    }

private:
    QTimer step_;
    QTimer watchdog_;
};

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
