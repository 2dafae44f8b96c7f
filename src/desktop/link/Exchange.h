#pragma once

#include <QByteArray>
#include <QString>

class MainWindow;
struct AppState;

// The command/reply exchange with the meter: drain, write, wait for one CR-ended reply line,
// re-send while the meter is busy, and the prompts and dialogs the exchange raises.
// Every wait blocks in the operating system through SerialLine::waitForByte.
class Exchange {
public:
    explicit Exchange(MainWindow& window);

    // Longest reply line kept; a meter that never ends its line cannot grow it further.
    static constexpr int kMaxReplyLength = 4096;
    static QString wakeUpCommand(); // 24 x "{@", then "?S" and CR

    // How a drain ended. A meter that never went quiet and a failed link both set
    // abortRequested; a caller that can live with a meter still sending tells them apart here.
    enum class Drain { Quiet, KeptSending, Failed };
    Drain FlushInput();
    void SendCommand();
    void ReadReply();
    void ResetLink();

    // FlushInput; commandText = command + CR; write it; SendCommand.
    // Returns false when abortRequested is set afterwards (the caller shows ShowCommError()).
    bool ExchangeCommand(const QString& command);
    // Writes text (Latin-1) to the line; a failure sets abortRequested. Stores ioResult.
    void SerialWrite(const QString& text);
    // The communication-error dialog frmCommError, modal over the main window. Does nothing
    // when one is already open (a timer tick inside its event loop must not stack another).
    void ShowCommError();
    // The processor-overuse dialog frmCPUOverUse, modal over the main window.
    void ShowCpuOverUse();

    // True while an exchange or a link dialog runs; timer ticks that find it set do nothing.
    bool inProgress() const { return depth_ > 0 || commErrorOpen_; }

    // Guard for callers that run several exchanges in one operation.
    class Scope {
    public:
        explicit Scope(Exchange& e) : e_(e) { ++e_.depth_; }
        ~Scope() { --e_.depth_; }
        Scope(const Scope&) = delete;
        Scope& operator=(const Scope&) = delete;

    private:
        Exchange& e_;
    };

private:
    void ShowBusyMessage();
    void ShowNoResponseMessage();
    double replyWindowSeconds() const;
    static bool isBusyReply(const QString& reply);

    MainWindow& w_;
    AppState& s_;
    int depth_ = 0;
    bool commErrorOpen_ = false;
};
