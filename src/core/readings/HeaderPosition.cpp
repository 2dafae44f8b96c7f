#include "core/readings/HeaderPosition.h"

#include <QStringList>

namespace {

// A whole number field of the position reply (blanks, CR and LF around it ignored).
bool numberField(const QString& text, int& value) {
    const QString t = text.trimmed();
    if (t.isEmpty() || t.size() > 6)
        return false;
    for (QChar c : t)
        if (c < QLatin1Char('0') || c > QLatin1Char('9'))
            return false;
    value = t.toInt();
    return true;
}

} // namespace

HeaderPosition::LogColumn HeaderPosition::findLogColumn(const QString& header,
                                                        const QString& position) {
    LogColumn column;
    const qsizetype j = header.indexOf(QLatin1String("Log"));
    if (j < 0)
        return column;

    int k = 0;
    for (qsizetype q = 0; q <= j; ++q) {
        const bool space = header[q] == QLatin1Char(' ');
        const bool nextIsSpace = q + 1 < header.size() && header[q + 1] == QLatin1Char(' ');
        if (space && !nextIsSpace)
            ++k;
    }
    if (k < 1)
        return column;

    const QStringList fields = position.split(QLatin1Char(','));
    const qsizetype startField = 2 * qsizetype(k) - 1;
    if (fields.size() <= startField + 1)
        return column;
    int start = 0;
    int width = 0;
    if (!numberField(fields[startField], start) || !numberField(fields[startField + 1], width) ||
        start < 1 || width < 1)
        return column;
    column.found = true;
    column.start = start;
    column.width = width;
    return column;
}
