#include "core/readings/RealTimeLine.h"

#include "core/readings/LogLineFormat.h"

#include <algorithm>

QString RealTimeLine::numberText(int readingNumber) {
    return QString::number(readingNumber).rightJustified(4, QLatin1Char(' '));
}

std::optional<QString> RealTimeLine::build(const QString& reply, int readingNumber,
                                           const Context& context) {
    const QString num = numberText(readingNumber);
    const LineLayout& layout = context.layout;

    if (layout.percentFormat && layout.hasLog) {
        // The meter numbers its own log; overwrite that field with the run's number.
        if (!context.logColumnKnown || context.logColumnStart < 1)
            return reply;
        const qsizetype at = context.logColumnStart - 1;
        if (reply.size() < context.logColumnStart)
            return std::nullopt;
        const qsizetype count = std::min<qsizetype>(
            {qsizetype(std::max(context.logColumnWidth, 0)), num.size(), reply.size() - at});
        QString line = reply;
        line.replace(at, count, num.left(count));
        return line;
    }

    if (layout.percentFormat) {
        // 25 characters in front, under the header prefix "   Date      Time   Log# ".
        return context.now.toString(QStringLiteral("dd/MM/yyyy")) + QLatin1Char(' ') +
               context.now.toString(QStringLiteral("HH:mm:ss")) + QLatin1Char(' ') + num +
               QLatin1Char(' ') + reply;
    }

    if (layout.qr32) {
        const auto fixed = LogLineFormat::qr32Fixed(reply, 0);
        if (!fixed)
            return std::nullopt;
        // The middle of the fixed record makes room for the number; first and last parts are
        // taken without overlap so a short reply never repeats characters.
        const QString head = fixed->left(20);
        const QString rest = fixed->mid(20);
        return head + num + rest.right(std::min<qsizetype>(16, rest.size()));
    }

    if (reply.size() < 4)
        return std::nullopt;
    return LogLineFormat::reformat(num + reply.mid(4), layout);
}
