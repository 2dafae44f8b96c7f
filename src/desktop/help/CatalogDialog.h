#pragma once

#include <QDialog>
#include <QStringList>

struct AppState;
class Prompts;
class PlatformDialogs;
class QComboBox;

// frmCatalog: asks for the drive that holds the catalogue CD. OK remembers the chosen drive in
// catalogDrive and opens the page when it is there; otherwise it says so and stays open.
// Cancel and closing change nothing.
class CatalogDialog : public QDialog {
    Q_OBJECT
public:
    // drives: what the list offers (normally Catalogue::availableDrives()).
    CatalogDialog(AppState& state, Prompts& prompts, PlatformDialogs& dialogs,
                  const QStringList& drives, QWidget* parent = nullptr);

    QComboBox* driveList() const { return drives_; }

private:
    void selectInitialDrive(const QStringList& drives);
    void cmdOK_Click();

    AppState& state_;
    Prompts& prompts_;
    PlatformDialogs& dialogs_;
    QComboBox* drives_ = nullptr;
};
