#pragma once

#include <QString>

class Clock;
class Prompts;
class SerialLine;
struct AppState;

// What the exchange needs from the program around it, beyond message boxes.
class LinkHost {
public:
    virtual ~LinkHost() = default;
    // How long a busy meter is re-sent to: 12 s right after detection or while the meter shuts
    // down (it is slow then), 2 s otherwise.
    virtual double replyWindowSeconds() const = 0;
    // A message about the exchange is about to be shown: end any progress display first.
    virtual void endProgress() = 0;
    // The link was reset (port closed, identity forgotten): show the unconnected state.
    virtual void linkReset() = 0;
};

// The command/reply exchange with the meter: drain, write, wait for one CR-ended reply line,
// re-send while the meter is busy, and the prompts the exchange raises. Every wait blocks in the
// operating system through SerialLine::waitForByte. Results go to the state's exchange fields
// (responseText, abortRequested, ...), which every caller reads.
class CommandExchange {
public:
    CommandExchange(AppState& state, SerialLine& line, Clock& clock, Prompts& prompts,
                    LinkHost& host);
    virtual ~CommandExchange() = default;

    // Longest reply line kept; a meter that never ends its line cannot grow it further.
    static constexpr int kMaxReplyLength = 4096;
    static QString wakeUpCommand(); // 24 x "{@", then "?S" and CR

    // How a drain ended. A meter that never went quiet and a failed link both set
    // abortRequested; a caller that can live with a meter still sending tells them apart here.
    enum class Drain { Quiet, KeptSending, Failed };
    Drain FlushInput();
    void SendCommand();
    void ReadReply();
    // Closes the port and forgets the meter's identity, then tells the host.
    void ResetLink();

    // FlushInput; commandText = command + CR; write it; SendCommand.
    // Returns false when abortRequested is set afterwards.
    bool ExchangeCommand(const QString& command);
    // Writes text (Latin-1) to the line; a failure sets abortRequested. Stores ioResult.
    void SerialWrite(const QString& text);

    // True while an exchange runs; timer ticks that find it set do nothing.
    bool inProgress() const { return depth_ > 0; }

    // Guard for callers that run several exchanges in one operation.
    class Scope {
    public:
        explicit Scope(CommandExchange& e) : e_(e) { ++e_.depth_; }
        ~Scope() { --e_.depth_; }
        Scope(const Scope&) = delete;
        Scope& operator=(const Scope&) = delete;

    private:
        CommandExchange& e_;
    };

protected:
    AppState& s_;
    SerialLine& line_;
    Clock& clock_;
    Prompts& prompts_;

private:
    void ShowBusyMessage();
    void ShowNoResponseMessage();
    static bool isBusyReply(const QString& reply);

    LinkHost& host_;
    int depth_ = 0;
};
