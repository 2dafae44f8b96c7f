#pragma once

#include <QPixmap>

// Small pictures of the help windows, drawn in code so that no image file has to ship.
namespace HelpIcons {
// The arrow beside the topic that is shown.
QPixmap arrow();
// The printer that prints the help file when clicked.
QPixmap printer();
} // namespace HelpIcons
