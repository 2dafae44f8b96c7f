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
        state.replyText = state.responseText;
        parseVersionReply(state.replyText, reply);
    }
    return reply;
}

void headerAndPositions(CommandExchange& exchange, AppState& state, bool& logColumnKnown) {
    auto forgetHeader = [&] {
        state.headerText.clear();
        state.positionText.clear();
        logColumnKnown = false;
    };
    if (!exchange.ExchangeCommand(QStringLiteral("?H")))
        return;
    if (replywords::unusable(state.responseText))
        return forgetHeader();
    state.headerText = HeaderPosition::headerFor(state.responseText, state.hasLog);
    if (!exchange.ExchangeCommand(QStringLiteral("?P")))
        return;
    if (replywords::unusable(state.responseText))
        return forgetHeader();
    state.positionText = state.responseText;
    if (!state.hasLog) {
        state.logColumnWidth = 4;
        logColumnKnown = false;
        return;
    }
    const HeaderPosition::LogColumn column =
        HeaderPosition::findLogColumn(state.headerText, state.positionText);
    logColumnKnown = column.found;
    if (column.found) {
        state.logColumnStart = column.start;
        state.logColumnWidth = column.width;
    }
}

} // namespace StatusQuery
