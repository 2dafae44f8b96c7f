#pragma once

#include <QDialog>
#include <QString>

struct AppState;
class Prompts;
class PlatformDialogs;
class QLabel;

// frmAboutKVO: the maker's about box. Its e-mail and web labels open the default mail program
// and browser; the catalogue label opens the drive chooser. "Splash.jpg" beside the program is
// shown when it is there.
class AboutKvoDialog : public QDialog {
    Q_OBJECT
public:
    AboutKvoDialog(AppState& state, Prompts& prompts, PlatformDialogs& dialogs,
                   const QString& folder, QWidget* parent = nullptr);

    QLabel* label(const char* name) const;

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    QLabel* addLink(const QString& name, const QString& text);
    void loadSplash(const QString& folder);
    void lblCatalogue_Click();

    AppState& state_;
    Prompts& prompts_;
    PlatformDialogs& dialogs_;
    QLabel* splash_ = nullptr;
    QLabel* email_ = nullptr;
    QLabel* web_ = nullptr;
    QLabel* catalogue_ = nullptr;
};
