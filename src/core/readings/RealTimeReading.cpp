#include "core/readings/RealTimeReading.h"

#include "core/link/CommandExchange.h"
#include "core/readings/ReplyWords.h"
#include "core/settings/AppState.h"

RealTimeReading::Outcome RealTimeReading::request(CommandExchange& exchange, AppState& s) {
    {
        CommandExchange::Scope busy(exchange);
        exchange.FlushInput();
        if (!s.abortRequested) {
            s.commandText = QStringLiteral("?D\r");
            exchange.SerialWrite(s.commandText);
            s.commandResent = false;
            if (!s.abortRequested)
                exchange.SendCommand();
        }
    }
    if (s.abortRequested)
        return Outcome::LinkFailed;
    s.dataLine = s.responseText;
    const QString& reply = s.responseText;
    if (replywords::has(reply, "ERROR"))
        return Outcome::MeterError;
    if (!replywords::unusable(reply) && !s.commandResent)
        return Outcome::Reading;
    if (!replywords::has(reply, "BUSY") && s.commandResent) {
        s.commandResent = false;
        return Outcome::Restart;
    }
    return Outcome::MeterLost;
}
