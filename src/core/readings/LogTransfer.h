#pragma once

#include <QString>
#include <optional>

class CommandExchange;
struct AppState;

// The log download on the wire, for every front end: "?L" with an acknowledgement per record
// until "ENDS", or, for QR32-layout meters, "?R" and exactly numLogged records. Each record is
// laid out by the line rules and appended to the state's workspaceText.
class LogTransfer {
public:
    // What the front end sees of a running transfer.
    class Listener {
    public:
        virtual ~Listener() = default;
        // count records are in (called before each record is read).
        virtual void progress(long long count) = 0;
        // Between records of the general protocol: true ends the transfer (Stop).
        virtual bool stopRequested() = 0;
    };

    enum class End {
        Complete,    // every record taken
        Stopped,     // the listener asked to stop
        ReplyFailed, // empty, busy or exit reply
        LinkFailed,  // the link failed or a record could not be laid out
    };

    LogTransfer(CommandExchange& exchange, AppState& state, Listener& listener);
    // Uses the identity and layout the last status query left in the state.
    End run();

private:
    // Drains the line and writes the request; false when the link failed.
    bool sendRequest(const QString& command);
    // Reads one record into dataLine; the way the transfer ends when it could not.
    std::optional<End> readRecord(long long progressCount);
    End generalProtocol();
    End qr32Protocol();

    CommandExchange& exchange_;
    AppState& s_;
    Listener& listener_;
};
