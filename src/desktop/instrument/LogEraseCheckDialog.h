#pragma once

#include <QDialog>

class QLabel;
class QPushButton;

// frmLogEraseCheck: asks before the meter's log is erased. "&Yes" emits yesClicked() and leaves
// closing to whoever erases (the dialog stays open when the meter does not confirm); "&No",
// Escape and the title bar close it.
class LogEraseCheckDialog : public QDialog {
    Q_OBJECT
public:
    explicit LogEraseCheckDialog(QWidget* parent);

signals:
    void yesClicked();

private:
    QLabel* Label1 = nullptr;
    QPushButton* cmdOK = nullptr;
    QPushButton* cmdCancel = nullptr;
};
