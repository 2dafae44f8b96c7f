#pragma once

#include <QString>

// Port names as the user and the settings see them ("COM3", "ttyUSB0", "/dev/pts/4"), and the
// device path the platform opens.
namespace PortNames {

// "\\.\COM3" or "COM3" -> "COM3" (Windows) or "/dev/ttyS2" (elsewhere); "ttyUSB0" ->
// "/dev/ttyUSB0"; a path stays as it is.
QString platformPath(const QString& devicePathOrName);
// The number of a "COMn" name: the numeric value of the text from its fourth character on
// (0 when there is none).
int PortNumberOf(const QString& name);
// A name the port dialog may accept: not empty, no blanks or control characters, and a "COMn"
// name's number within 1..32767.
bool isUsableName(const QString& name);

struct Mode {
    qint32 baud = 0;
    char parity = 'N';
    int dataBits = 8;
    int stopBits = 1;
    bool valid = false;
};
// Parses "baud=9600 parity=N data=8 stop=1".
Mode parseMode(const QString& text);

} // namespace PortNames
