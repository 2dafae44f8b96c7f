#pragma once

#include <QDialog>

class QComboBox;
class Prompts;

// frmCommsPort: which port and which speed. Typed text that is not usable keeps it open.
class CommsPortDialog : public QDialog {
    Q_OBJECT
public:
    CommsPortDialog(const QString& portName, qint32 baudRate, Prompts& prompts, QWidget* parent);

    QString chosenPort() const { return port_; }
    qint32 chosenBaud() const { return baud_; }

    static QStringList speeds();

private:
    void FillPortList(const QString& portName);
    void cmdOK_Click();

    Prompts& prompts_;
    QComboBox* cboCom_ = nullptr;
    QComboBox* cboBaud_ = nullptr;
    QString port_;
    qint32 baud_ = 0;
};
