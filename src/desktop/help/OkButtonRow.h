#pragma once

#include <QString>

class QDialog;
class QHBoxLayout;

// The about boxes' closing row: one default button "cmdOK" at the right that accepts the dialog.
QHBoxLayout* okButtonRow(QDialog* dialog, const QString& caption);
