#pragma once

#include <QString>

class CommandExchange;
struct AppState;

// GLP ("?G") and max/min ("?M") records on the wire: a block of lines, each acknowledged with
// LF, ended by a line beginning "END".
namespace RecordTransfer {

enum class Kind { Glp, MaxMin };
// A block is a handful of lines; a meter that keeps answering without ever sending "END" must
// not hold the program, so a block this long ends as a failed link (its lines kept).
inline constexpr int kMaxLines = 1000;
enum class End {
    Complete,
    ReplyFailed, // empty, busy or exit reply
    LinkFailed,
};
struct Result {
    End end = End::Complete;
    // The lines received, each ended by LF without its CR; max/min lines start with a space.
    QString text;
};

Result run(CommandExchange& exchange, AppState& state, Kind kind);

} // namespace RecordTransfer
