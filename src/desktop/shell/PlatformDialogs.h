#pragma once

#include <QString>
#include <QStringList>
#include <QUrl>
#include <optional>

class QPrinter;
class QWidget;

// The seam for the platform's file, print and "open with default application" services.
// The real one shows Qt's dialogs and uses QDesktopServices; tests pick names and filters,
// print to a PDF file and record what would have been opened.
class PlatformDialogs {
public:
    struct SaveChoice {
        QString path;
        int filterIndex = 0; // 0 = the first filter offered
    };

    // What a file dialog starts from. The program keeps name and filter index from one use to
    // the next, as one dialog component would.
    struct FileRequest {
        QString folder;
        QString fileName; // proposed name, or the full path last used
        // e.g. {"Text File   (*.txt)", "Comma Delimited    (*.csv)"}
        QStringList filters;
        int filterIndex = 0; // the filter selected when the dialog opens
    };

    virtual ~PlatformDialogs() = default;
    // nullopt = cancelled.
    virtual std::optional<SaveChoice> askSaveFile(QWidget* parent, const FileRequest& request) = 0;
    virtual std::optional<QString> askOpenFile(QWidget* parent, const FileRequest& request) = 0;
    // The print dialog without page range, selection-only or print-to-file choices.
    // Returns false when cancelled.
    virtual bool askPrinter(QWidget* parent, QPrinter& printer) = 0;
    // Opens a file, web address or mailto: address with its default application.
    virtual bool openWithDefaultApplication(const QUrl& url) = 0;
};
