#pragma once

#include <QObject>
#include <QString>

class MainWindow;

// The Help menu and the Help button: the two help windows, the two about boxes and the
// catalogue. Each window is created for one showing, modal over the main window.
class HelpCommands : public QObject {
    Q_OBJECT
public:
    explicit HelpCommands(MainWindow& window);

    // The folder the help files and the splash picture are read from; the program's own folder
    // unless set otherwise.
    const QString& folder() const { return folder_; }
    void setFolder(const QString& folder) { folder_ = folder; }

    void mnuHelpGeneral_Click();
    void mnuK5help_Click();
    void mnuAboutKVO_Click();
    void mnuAboutTelvio_Click();
    void mnuCatalog_Click();

private:
    MainWindow& w_;
    QString folder_;
};
