#pragma once

#include <QObject>
#include <QString>

class MainWindow;
struct AppState;

// Opening the configured port, the detection polls and the port dialogs.
class Connection : public QObject {
    Q_OBJECT
public:
    explicit Connection(MainWindow& window);

    // Closes and reopens the port at baudRate and starts the detection polls; on failure shows
    // frmSerialPortInUse or frmSerialPortUnavailable.
    void ConnectMeter();
    // The port dialog frmCommsPort, modal over the main window.
    void ShowCommsPortDialog();

private:
    void tmrDetectMeter_Timer();

    MainWindow& w_;
    AppState& s_;
};
