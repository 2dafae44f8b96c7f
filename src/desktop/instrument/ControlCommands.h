#pragma once

#include <QObject>
#include <QString>

class LogEraseCheckDialog;
class MainWindow;
struct AppState;

// Commands that change the meter's state: stirrer, automatic logging, power off and on, erase
// the log, and the battery-voltage display refreshed every two seconds.
class ControlCommands : public QObject {
    Q_OBJECT
public:
    explicit ControlCommands(MainWindow& window);

    void cmdStartStirring_Click();
    void cmdStopStirring_Click();
    void cmdEnableLogging_Click();
    void cmdDisableLogging_Click();
    void cmdK5Off_Click();
    void cmdK5On_Click();
    void cmdEraseLog_Click();
    void mnuVoltage_Click();
    void tmrDisplayVoltage_Timer();

private:
    // StopVoltageDisplay, then exchanges `command`. False (after frmCommError) when it failed.
    bool runCommand(const QString& command);
    void eraseConfirmed(LogEraseCheckDialog& dialog);
    void enterShutdownState();
    // Stops the voltage timer and shows frmCommError; the last voltage line stays shown.
    void voltageLinkFailed();

    MainWindow& w_;
    AppState& s_;
};
