#include "instrument/InstrumentCommands.h"

#include "shell/MainWindow.h"

InstrumentCommands::InstrumentCommands(MainWindow& window) : QObject(&window), w_(window) {}

void InstrumentCommands::QueryStatus() {}
