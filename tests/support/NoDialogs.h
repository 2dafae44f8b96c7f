#pragma once

#include "desktop/shell/PlatformDialogs.h"

// Platform dialogs that are always cancelled; nothing is ever opened.
class NoDialogs : public PlatformDialogs {
public:
    std::optional<SaveChoice> askSaveFile(QWidget*, const FileRequest&) override {
        return std::nullopt;
    }
    std::optional<QString> askOpenFile(QWidget*, const FileRequest&) override {
        return std::nullopt;
    }
    bool askPrinter(QWidget*, QPrinter&) override { return false; }
    bool openWithDefaultApplication(const QUrl&) override { return false; }
};
