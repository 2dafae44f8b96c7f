#pragma once

#include "core/instrument/StatusReply.h"

#include <optional>

class CommandExchange;
struct AppState;

// The meter's side of detection and of the status query, for every front end.
namespace StatusQuery {

// One detection poll: the wake-up command, then whatever comes back within the short poll
// time-out. True when anything came back; a failed link sets abortRequested instead.
bool poll(CommandExchange& exchange, AppState& state);
// "?S", and "?W" for a meter whose reply leaves version and serial number to it. nullopt when
// the link failed (abortRequested is set).
std::optional<StatusReply> query(CommandExchange& exchange, AppState& state);

// "?H" and "?P" of a percent-format meter: the column header (as the log table and its saved
// file show it) and the Log# column that real-time lines number, into the state. logColumnKnown
// tells whether that column was found; a link failure leaves it alone, an unusable reply forgets
// header and positions. A header without "Log" or positions with too few fields leave the
// previous column alone, and real-time lines then keep the meter's own log number.
void headerAndPositions(CommandExchange& exchange, AppState& state, bool& logColumnKnown);

} // namespace StatusQuery
