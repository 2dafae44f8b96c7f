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

    virtual ~PlatformDialogs() = default;
    // filters: e.g. {"Text File   (*.txt)", "Comma Delimited    (*.csv)"}. nullopt = cancelled.
    virtual std::optional<SaveChoice> askSaveFile(QWidget* parent, const QString& folder,
                                                  const QString& proposedName,
                                                  const QStringList& filters) = 0;
    virtual std::optional<QString> askOpenFile(QWidget* parent, const QString& folder,
                                               const QStringList& filters) = 0;
    // The print dialog without page range, selection-only or print-to-file choices.
    // Returns false when cancelled.
    virtual bool askPrinter(QWidget* parent, QPrinter& printer) = 0;
    // Opens a file, web address or mailto: address with its default application.
    virtual bool openWithDefaultApplication(const QUrl& url) = 0;
};
