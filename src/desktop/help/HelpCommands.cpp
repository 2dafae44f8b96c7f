#include "desktop/help/HelpCommands.h"

#include "desktop/help/AboutKvoDialog.h"
#include "desktop/help/AboutTelvioDialog.h"
#include "desktop/help/Catalogue.h"
#include "desktop/help/HelpWindow.h"
#include "desktop/help/ProgramFolder.h"
#include "desktop/shell/MainWindow.h"

#include <QAction>
#include <QPushButton>

HelpCommands::HelpCommands(MainWindow& window)
    : QObject(&window), w_(window), folder_(programFolder()) {
    const MainControls& c = w_.controls();
    connect(c.mnuHelpGeneral, &QAction::triggered, this, &HelpCommands::mnuHelpGeneral_Click);
    connect(c.cmdHelp, &QPushButton::clicked, this, &HelpCommands::mnuHelpGeneral_Click);
    connect(c.mnuK5help, &QAction::triggered, this, &HelpCommands::mnuK5help_Click);
    connect(c.mnuAboutKVO, &QAction::triggered, this, &HelpCommands::mnuAboutKVO_Click);
    connect(c.mnuAboutTelvio, &QAction::triggered, this, &HelpCommands::mnuAboutTelvio_Click);
    connect(c.mnuCatalog, &QAction::triggered, this, &HelpCommands::mnuCatalog_Click);
}

void HelpCommands::mnuHelpGeneral_Click() {
    w_.StopVoltageDisplay();
    HelpWindow help(HelpKind::General, w_.state(), w_.prompts(), w_.dialogs(), folder_, &w_);
    help.usePrinter(&w_.printer());
    help.exec();
}

void HelpCommands::mnuK5help_Click() {
    w_.StopVoltageDisplay();
    HelpWindow help(HelpKind::Other, w_.state(), w_.prompts(), w_.dialogs(), folder_, &w_);
    help.usePrinter(&w_.printer());
    help.exec();
}

void HelpCommands::mnuAboutKVO_Click() {
    w_.StopVoltageDisplay();
    AboutKvoDialog about(w_.state(), w_.prompts(), w_.dialogs(), folder_, &w_);
    about.exec();
}

void HelpCommands::mnuAboutTelvio_Click() {
    // The only Help item that leaves a running voltage display alone.
    AboutTelvioDialog about(&w_);
    about.exec();
}

void HelpCommands::mnuCatalog_Click() {
    w_.StopVoltageDisplay();
    Catalogue::browse(w_.state(), w_.prompts(), w_.dialogs(), &w_);
}

#include "moc_HelpCommands.cpp"
