#pragma once

#include <QDialog>

// frmSerialPortInUse and frmSerialPortUnavailable: the port could not be opened.
class PortErrorDialog : public QDialog {
    Q_OBJECT
public:
    enum class Kind { InUse, Unavailable };
    enum class Choice { Retry, Setup, Cancel };
    PortErrorDialog(Kind kind, const QString& portName, QWidget* parent);
    Choice choice() const { return choice_; }
    static QString messageText(Kind kind, const QString& portName);

private:
    Choice choice_ = Choice::Cancel;
};
