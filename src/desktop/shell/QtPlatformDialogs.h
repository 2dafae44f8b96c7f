#pragma once

#include "desktop/shell/PlatformDialogs.h"

// The platform's own dialogs through Qt, and QDesktopServices for default applications
// (never a shell command line, so no text handed over can run a command).
class QtPlatformDialogs : public PlatformDialogs {
public:
    std::optional<SaveChoice> askSaveFile(QWidget* parent, const FileRequest& request) override;
    std::optional<QString> askOpenFile(QWidget* parent, const FileRequest& request) override;
    bool askPrinter(QWidget* parent, QPrinter& printer) override;
    bool openWithDefaultApplication(const QUrl& url) override;
};
