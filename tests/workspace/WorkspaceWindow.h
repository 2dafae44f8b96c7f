#pragma once

// The real main window offscreen with scripted file and print dialogs, for the workspace's
// window tests. Not started: no meter is needed to fill, save, open, find or print.
#include "ScriptedDialogs.h"
#include "WindowFixture.h"

#include <QAction>
#include <QFile>
#include <QLabel>
#include <QPlainTextEdit>
#include <QProcess>
#include <QRegularExpression>
#include <memory>

struct WorkspaceWindow {
    ScriptedDialogs dialogs;
    std::unique_ptr<WindowFixture> f;
    MainWindow* w = nullptr;

    WorkspaceWindow() {
        f = std::make_unique<WindowFixture>(&dialogs);
        w = &f->createWindow();
        w->resize(900, 700);
        w->show();
    }

    AppState& state() { return f->state(); }
    const MainControls& c() { return f->c(); }
    QPlainTextEdit* edit() { return c().RichTextBox1; }

    // The workspace as a filling operation leaves it: text, display kind, header, saved flag.
    void fill(const QString& text, QAction* mark = nullptr, const QString& header = QString(),
              bool saved = false) {
        w->UncheckDisplayMenus();
        if (mark)
            mark->setChecked(true);
        state().headerText = header;
        c().lblHeader->setText(header);
        state().workspaceText = text;
        edit()->setPlainText(text);
        state().workspaceSaved = saved;
    }
};

inline QByteArray readBytes(const QString& path) {
    QFile f(path);
    return f.open(QIODevice::ReadOnly) ? f.readAll() : QByteArray("<unreadable>");
}

inline bool writeBytes(const QString& path, const QByteArray& bytes) {
    QFile f(path);
    return f.open(QIODevice::WriteOnly) && f.write(bytes) == bytes.size();
}

inline QString collapsed(const QString& text) {
    return text.simplified();
}

// The text of a printed PDF, white space collapsed (pdftotext changes runs of spaces).
inline QString printedText(const QString& pdf) {
    QProcess run;
    run.start(QStringLiteral("pdftotext"), {QStringLiteral("-layout"), pdf, QStringLiteral("-")});
    if (!run.waitForFinished(20000) || run.exitCode() != 0)
        return QStringLiteral("<pdftotext failed>");
    return collapsed(QString::fromUtf8(run.readAllStandardOutput()));
}
