#include "readings/ReadingCommands.h"

#include "shell/MainWindow.h"

ReadingCommands::ReadingCommands(MainWindow& window) : QObject(&window), w_(window) {}

void ReadingCommands::GetHeaderAndPosition() {}

void ReadingCommands::cmdStopCurrentData_Click() {}
