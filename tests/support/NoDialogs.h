#pragma once

#include "shell/PlatformDialogs.h"

#include <QList>

// Platform dialogs that are always cancelled; URLs handed over are only recorded.
class NoDialogs : public PlatformDialogs {
public:
    std::optional<SaveChoice> askSaveFile(QWidget*, const FileRequest&) override {
        return std::nullopt;
    }
    std::optional<QString> askOpenFile(QWidget*, const FileRequest&) override {
        return std::nullopt;
    }
    bool askPrinter(QWidget*, QPrinter&) override { return false; }
    bool openWithDefaultApplication(const QUrl& url) override {
        opened << url;
        return true;
    }
    QList<QUrl> opened;
};
