#pragma once

class CommandExchange;
struct AppState;

// One real-time reading on the wire: a drain, then "?D" and its reply into responseText.
namespace RealTimeReading {

enum class Outcome {
    Reading,    // a usable reply at the first try: lay it out as a line
    MeterError, // the meter answered "ERROR": the run ends as Stop ends it
    Restart,    // the meter needed the command twice: its timing is unknown, start again now
    MeterLost,  // busy or no usable reply: the meter is gone from the run
    LinkFailed, // abortRequested is set
};

Outcome request(CommandExchange& exchange, AppState& state);

} // namespace RealTimeReading
