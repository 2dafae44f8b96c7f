#include "core/instrument/StatusQuery.h"

#include "core/link/CommandExchange.h"
#include "core/readings/HeaderPosition.h"
#include "core/readings/ReplyWords.h"
#include "core/settings/AppState.h"

namespace StatusQuery {

bool poll(CommandExchange& exchange, AppState& state) {
    state.commandText = CommandExchange::wakeUpCommand();
    state.readTimeoutSec = 0.1;
    exchange.SerialWrite(state.commandText);
    if (!state.abortRequested)
        exchange.ReadReply();
    return !state.abortRequested && !state.responseText.isEmpty();
}

std::optional<StatusReply> query(CommandExchange& exchange, AppState& state) {
    CommandExchange::Scope busy(exchange);
    if (!exchange.ExchangeCommand(QStringLiteral("?S")))
        return std::nullopt;
    state.replyText = state.responseText;
    StatusReply reply = parseStatusReply(state.replyText, state.modelCode);
    if (reply.needsVersionQuery) {
        if (!exchange.ExchangeCommand(QStringLiteral("?W")))
            return std::nullopt;
        parseVersionReply(state.responseText, reply);
    }
    return reply;
}

std::optional<QString> columnHeader(CommandExchange& exchange, AppState& state) {
    if (!exchange.ExchangeCommand(QStringLiteral("?H")) || replywords::unusable(state.responseText))
        return std::nullopt;
    return HeaderPosition::headerFor(state.responseText, state.hasLog);
}

} // namespace StatusQuery
