#pragma once

#include "core/Prompts.h"
#include "core/instrument/StatusReply.h"
#include "core/link/CommandExchange.h"
#include "core/link/QtSerialLine.h"
#include "core/settings/AppState.h"
#include "core/settings/SystemClock.h"

#include <QStringList>

// Exit codes of telvio-cli.
namespace ExitCode {
inline constexpr int kDone = 0;
inline constexpr int kUsage = 2;
inline constexpr int kNoMeter = 3;
inline constexpr int kPort = 4;
inline constexpr int kLinkFailed = 5;
inline constexpr int kMeterError = 6;
} // namespace ExitCode

// The meter link of the command-line tool: the core exchange on the real serial line, with no
// person to ask. Every question is answered as giving up (Cancel, No); every message goes to
// standard error as one line.
class CliLink : private Prompts, private LinkHost {
public:
    CliLink();

    AppState& state() { return state_; }
    CommandExchange& exchange() { return exchange_; }
    SerialLine& line() { return line_; }
    Prompts& prompts() { return *this; }

    // Opens the state's port at its speed. 0, or ExitCode::kPort after saying why.
    int open();
    // Wake-up polls every 0.6 s until the meter answers, for at most waitSeconds. 0, or the exit
    // code after saying why.
    int detect(double waitSeconds);
    // The status query after detection (with the longer reply window a woken meter needs).
    // nullopt after saying why; failure() then gives the exit code.
    std::optional<StatusReply> queryStatus();
    // Takes the meter's identity and layout from a status reply, as the window's status display
    // does.
    void adopt(const StatusReply& reply);
    // The exit code for a failed operation: the meter's own error, or a failed link.
    int failure() const { return meterError_ ? ExitCode::kMeterError : ExitCode::kLinkFailed; }

private:
    Answer show(const QString& text, Icon icon, Buttons buttons, bool systemModal) override;
    double replyWindowSeconds() const override { return detecting_ ? 12.0 : 2.0; }
    void endProgress() override {}
    void linkReset() override {}

    AppState state_;
    QtSerialLine line_;
    SystemClock clock_;
    CommandExchange exchange_;
    bool detecting_ = false;
    bool meterError_ = false;
};

// One line on standard error, prefixed with the program's name.
void complain(const QString& text);
// Ctrl+C and SIGTERM are noted from then on, so a run can end between lines as Stop ends it.
void catchInterrupts();
bool interrupted();
