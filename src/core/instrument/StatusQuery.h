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

// The meter's column header ("?H") as the log table and its saved file show it; nullopt when the
// link failed or the meter gave no usable header.
std::optional<QString> columnHeader(CommandExchange& exchange, AppState& state);

} // namespace StatusQuery
