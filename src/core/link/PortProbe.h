#pragma once

#include <QString>
#include <QStringList>

// Tries a port for a moment to tell whether it is there: opened, held by another program,
// missing, or failed otherwise. Never holds the port.
namespace PortProbe {

enum class Outcome { Opened, InUse, Present, Missing, Failed };

Outcome probe(const QString& portName);
// True when the port can be opened or is held elsewhere (so it exists).
bool comPortExists(const QString& portName);
// The ports of this machine that exist, by their names ("COM3" on Windows, "ttyUSB0" elsewhere).
QStringList existingPorts();

} // namespace PortProbe
