#pragma once

#include <QDialog>

// frmCPUOverUse: readings could not be kept up; the run has already been stopped.
class CpuOverUseDialog : public QDialog {
    Q_OBJECT
public:
    explicit CpuOverUseDialog(QWidget* parent);
};
