#pragma once

#include "desktop/shell/PlatformDialogs.h"

#include <QList>
#include <QQueue>

// File and print dialogs for tests: each call takes the next scripted answer (a call with no
// answer left cancels and is counted in `unanswered`), and every call is recorded.
class ScriptedDialogs : public PlatformDialogs {
public:
    struct SaveCall {
        QString folder;
        QString proposedName;
        QStringList filters;
        int filterIndex;
    };
    struct OpenCall {
        QString folder;
        QString fileName;
        QStringList filters;
    };

    // Scripting.
    void answerSave(const QString& path, int filterIndex = 0);
    void cancelSave();
    void answerOpen(const QString& path);
    void cancelOpen();
    // The next print dialog chooses PDF output to this file.
    void printToPdf(const QString& pdfPath);
    void cancelPrint();
    // The next print dialog is accepted as it opens, on the printer it was given.
    void acceptPrinter() { prints_.enqueue(QString()); }
    void setOpenWithResult(bool ok) { openWithResult_ = ok; }

    // What was asked.
    QList<SaveCall> saveCalls;
    QList<OpenCall> openCalls;
    int printDialogs = 0;
    QList<QUrl> openedWithDefault;
    int unanswered = 0;

    std::optional<SaveChoice> askSaveFile(QWidget* parent, const FileRequest& request) override;
    std::optional<QString> askOpenFile(QWidget* parent, const FileRequest& request) override;
    bool askPrinter(QWidget* parent, QPrinter& printer) override;
    bool openWithDefaultApplication(const QUrl& url) override;

private:
    QQueue<std::optional<SaveChoice>> saves_;
    QQueue<std::optional<QString>> opens_;
    QQueue<std::optional<QString>> prints_;
    bool openWithResult_ = true;
};
