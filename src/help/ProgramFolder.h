#pragma once

#include <QString>

// The folder that holds the help files and the splash picture: the folder of the executable,
// or the folder named by TELVIO_DATA_DIR when that is set (the build folder, for tests).
QString programFolder();
