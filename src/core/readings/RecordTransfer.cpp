#include "core/readings/RecordTransfer.h"

#include "core/link/CommandExchange.h"
#include "core/readings/ReplyWords.h"
#include "core/settings/AppState.h"

RecordTransfer::Result RecordTransfer::run(CommandExchange& exchange, AppState& s, Kind kind) {
    CommandExchange::Scope busy(exchange);
    Result result;
    int lines = 0;
    exchange.FlushInput();
    if (!s.abortRequested) {
        s.commandText = kind == Kind::Glp ? QStringLiteral("?G\r") : QStringLiteral("?M\r");
        exchange.SerialWrite(s.commandText);
    }
    // The block ends with a line beginning "END" (exactly, in capitals), "ENDS" included.
    while (!s.abortRequested && s.responseText.left(3) != QLatin1String("END")) {
        exchange.SendCommand();
        if (s.abortRequested)
            break;
        if (replywords::unusable(s.responseText)) {
            result.end = End::ReplyFailed;
            return result;
        }
        exchange.SerialWrite(QStringLiteral("\n"));
        if (s.responseText.left(3) != QLatin1String("END")) {
            QString line = s.responseText;
            if (line.endsWith(QLatin1Char('\r')))
                line.chop(1);
            if (kind == Kind::MaxMin)
                result.text += QLatin1Char(' ');
            result.text += line;
            result.text += QLatin1Char('\n');
            if (++lines >= kMaxLines)
                s.abortRequested = true;
        }
    }
    if (s.abortRequested)
        result.end = End::LinkFailed;
    return result;
}
