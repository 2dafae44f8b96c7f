#pragma once

#include <QObject>
#include <memory>

class ControlCommands;
class MainWindow;
struct AppState;
struct StatusReply;

// The status query: asks the meter who it is ("?S", and "?W" for QR32-layout meters), shows its
// identity and offers exactly the commands it supports. The control commands (stirrer, logging,
// power, erase, voltage) live in ControlCommands, which this class creates.
class InstrumentCommands : public QObject {
    Q_OBJECT
public:
    explicit InstrumentCommands(MainWindow& window);
    ~InstrumentCommands() override;

    // Exchanges "?S", parses the reply and shows identity and commands. Afterwards the caller
    // tests abortRequested (then shows frmCommError) and replyText for "BUSY", "EXIT", "ERROR".
    void QueryStatus();

private:
    void DisplayPlainStatus(const StatusReply& reply);
    void DisplayK5Status(const StatusReply& reply);
    void DisplayPercentStatus(const StatusReply& reply);
    void ResetStatusDisplay();

    // Capability routines, run in this order after every successful parse.
    void ShowLoggingButtons();
    void ShowStirringButtons();
    void ShowPowerButtons();
    void ShowGLPCommands();
    void ShowLogCommands();
    void ShowMaxMinCommands();
    void PlaceHelpButton();
    void ArrangeControlButtons();
    void runCapabilityRoutines(bool arrangeControls);

    // Takes the fields the reply delivered; the others keep their values.
    void takeIdentity(const StatusReply& reply);
    // Workspace top edge, and its height as the window height less `margin` (twips).
    void placeWorkspace(int topTwips, int marginTwips);
    // Labels the K5 display blanks, put back for other meters.
    void restoreIdentityCaptions();
    void finishDisplay();
    void warnIfBatteryLow();

    MainWindow& w_;
    AppState& s_;
    std::unique_ptr<ControlCommands> control_;
};
