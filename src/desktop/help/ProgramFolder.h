#pragma once

#include <QString>

// The folder that holds the help files and the splash picture: the folder of the executable.
QString programFolder();
