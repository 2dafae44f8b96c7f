#include "help/HelpCommands.h"

#include "shell/MainWindow.h"

HelpCommands::HelpCommands(MainWindow& window) : QObject(&window), w_(window) {}
