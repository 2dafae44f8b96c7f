#pragma once

#include <QObject>

class MainWindow;

// The Help menu and the Help button: the two help windows, the two about boxes and the
// catalogue. Each window is created for one showing, modal over the main window.
class HelpCommands : public QObject {
    Q_OBJECT
public:
    explicit HelpCommands(MainWindow& window);

    void mnuHelpGeneral_Click();
    void mnuK5help_Click();
    void mnuAboutKVO_Click();
    void mnuAboutTelvio_Click();
    void mnuCatalog_Click();

private:
    MainWindow& w_;
};
