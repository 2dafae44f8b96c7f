#include "core/instrument/MeterControl.h"

#include "core/link/CommandExchange.h"
#include "core/readings/ReplyWords.h"
#include "core/settings/AppState.h"

#include <QThread>

namespace MeterControl {

bool isUsable(const QString& reply) {
    return !reply.isEmpty() && !replywords::hasAny(reply, {"BUSY", "EXIT", "ERROR"});
}

bool stirrerStarted(const QString& reply) {
    return reply.startsWith(u"SON");
}
bool batteryTooLow(const QString& reply) {
    return reply.startsWith(u"BLOW");
}
bool stirrerStopped(const QString& reply) {
    return reply.startsWith(u"SOFF");
}
bool loggingStarted(const QString& reply) {
    return replywords::has(reply, "LOG START");
}
bool loggingStopped(const QString& reply) {
    return replywords::has(reply, "LOG STOP");
}
bool poweredOff(const QString& reply) {
    return reply.startsWith(u"SSD");
}
bool logErased(const QString& reply) {
    return isUsable(reply) && reply.startsWith(u"ERASED");
}

bool powerOff(CommandExchange& exchange, AppState& s) {
    CommandExchange::Scope busy(exchange);
    // Wake the meter; its status reply is drained rather than awaited.
    s.commandText = CommandExchange::wakeUpCommand();
    exchange.SerialWrite(s.commandText);
    if (!s.abortRequested)
        exchange.FlushInput();
    if (!s.abortRequested) {
        QThread::msleep(500);
        exchange.FlushInput();
    }
    if (!s.abortRequested) {
        s.commandText = QStringLiteral("?K\r");
        exchange.SerialWrite(s.commandText);
    }
    if (!s.abortRequested)
        exchange.SendCommand();
    return !s.abortRequested;
}

QString voltageLine(const QString& reply) {
    qsizetype first = 0;
    qsizetype last = reply.size();
    while (first < last && reply[first] == u' ')
        ++first;
    while (last > first && reply[last - 1] == u' ')
        --last;
    return QStringLiteral("Meter Battery Voltage = ") + reply.mid(first, last - first);
}

} // namespace MeterControl
