#include "core/readings/LogTransfer.h"

#include "core/link/CommandExchange.h"
#include "core/readings/LineLayout.h"
#include "core/readings/LogLineFormat.h"
#include "core/readings/ReplyWords.h"
#include "core/settings/AppState.h"

LogTransfer::LogTransfer(CommandExchange& exchange, AppState& state, Listener& listener)
    : exchange_(exchange), s_(state), listener_(listener) {}

LogTransfer::End LogTransfer::run() {
    CommandExchange::Scope busy(exchange_);
    return LineLayout::fromState(s_).qr32 ? qr32Protocol() : generalProtocol();
}

bool LogTransfer::sendRequest(const QString& command) {
    exchange_.FlushInput();
    if (s_.abortRequested)
        return false;
    s_.commandText = command;
    exchange_.SerialWrite(s_.commandText);
    return !s_.abortRequested;
}

std::optional<LogTransfer::End> LogTransfer::readRecord(long long progressCount) {
    listener_.progress(progressCount);
    exchange_.SendCommand();
    if (s_.abortRequested)
        return End::LinkFailed;
    if (replywords::unusable(s_.responseText))
        return End::ReplyFailed;
    s_.dataLine = s_.responseText;
    return std::nullopt;
}

LogTransfer::End LogTransfer::generalProtocol() {
    const LineLayout layout = LineLayout::fromState(s_);
    if (!sendRequest(QStringLiteral("?L\r")))
        return End::LinkFailed;
    for (long long count = 0;; ++count) {
        if (const auto failed = readRecord(count))
            return *failed;
        // Every record is acknowledged, the "ENDS" line too.
        exchange_.SerialWrite(QStringLiteral("A"));
        if (s_.abortRequested)
            return End::LinkFailed;
        if (replywords::has(s_.dataLine, "ENDS"))
            return End::Complete;
        const auto line = LogLineFormat::reformat(s_.dataLine, layout);
        if (!line)
            return End::LinkFailed;
        s_.dataLine = *line;
        s_.workspaceText += *line;
        s_.workspaceText += QLatin1Char('\n');
        if (listener_.stopRequested())
            return End::Stopped;
    }
}

LogTransfer::End LogTransfer::qr32Protocol() {
    if (!sendRequest(QStringLiteral("?R\r")))
        return End::LinkFailed;
    // Exactly numLogged records, no acknowledgement and no end marker.
    const long long total = s_.numLogged;
    for (long long i = 1; i <= total; ++i) {
        if (const auto failed = readRecord(i))
            return *failed;
        const auto line = LogLineFormat::qr32Record(s_.dataLine);
        if (!line)
            return End::LinkFailed;
        s_.dataLine = *line;
        s_.workspaceText += *line;
    }
    return End::Complete;
}
