#pragma once

#include "core/text/SaveNames.h"

#include <QString>

class MainWindow;

// Saving the workspace as plain or comma-delimited text, and opening a file for display.
class WorkspaceFiles {
public:
    explicit WorkspaceFiles(MainWindow& window);

    void SaveWorkspace();
    void OpenFileIntoWorkspace();
    QString DefaultSaveName() const;
    DisplayKind displayKind() const;

private:
    struct Chosen {
        QString path;
        bool commaDelimited = false;
    };
    // Sets saveCancelled when the dialog is cancelled.
    Chosen AskSaveFileName();
    QString fileContents(bool commaDelimited) const;
    QString folder() const;
    void rememberFolder(const QString& path);

    MainWindow& w_;
    QString lastFolder_;
    // Kept between uses, as one dialog component keeps them: the name last used for saving or
    // opening (the open dialog starts with it) and the filter last chosen for saving.
    QString fileName_;
    int filterIndex_ = 0;
};
