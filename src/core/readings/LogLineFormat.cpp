#include "core/readings/LogLineFormat.h"

#include <algorithm>

namespace {

bool isDigit(QChar c) {
    return c >= QLatin1Char('0') && c <= QLatin1Char('9');
}

// The number a two-character year field holds: leading blanks skipped, then its digits (" 4"
// and "4 " are 4). A field with no number in it gives nullopt.
std::optional<int> yearNumber(QStringView field) {
    qsizetype i = 0;
    while (i < field.size() && field[i] == QLatin1Char(' '))
        ++i;
    int value = 0;
    int digits = 0;
    for (; i < field.size() && isDigit(field[i]); ++i, ++digits)
        value = value * 10 + (field[i].unicode() - u'0');
    return digits > 0 ? std::optional<int>(value) : std::nullopt;
}

} // namespace

std::optional<QString> LogLineFormat::reformat(const QString& record, const LineLayout& layout) {
    if (layout.percentFormat)
        return record;

    const qsizetype n = record.size();
    qsizetype fieldLength = 19;
    if (layout.marinLago)
        fieldLength = 16;
    if (layout.isK5Family)
        fieldLength = 11;

    // The date/time field stands just before the final character (the CR).
    const qsizetype body = std::max<qsizetype>(0, n - 1);
    const qsizetype start = std::max<qsizetype>(0, body - fieldLength);
    QString field = record.mid(start, body - start);

    // A "/" twelve characters from the end of the field marks a two-digit year: dd/mm/yy.
    const QString tail = field.right(12);
    const bool shortYear = tail.startsWith(QLatin1Char('/'));

    qsizetype minimum = shortYear ? kMinGeneralShortYear : kMinGeneral;
    if (layout.marinLago)
        minimum = kMinMarinLago;
    if (layout.isK5Family)
        minimum = kMinK5;
    if (n < minimum)
        return std::nullopt;

    if (shortYear) {
        const std::optional<int> y = yearNumber(QStringView(tail).mid(1, 2));
        if (!y)
            return std::nullopt;
        const int year = *y < 76 ? *y + 2000 : *y + 1900;
        const QString g = field.right(17);
        field = g.left(6) + QString::number(year) + QLatin1String("  ") + g.right(8);
    }

    QString reading = record.left(shortYear ? n - 18 : n - 20);
    if (layout.marinLago) {
        field = field.right(16);
        reading = record.left(n - 19);
    }
    if (layout.isK5Family)
        reading = record.left(n - 12);

    if (reading.endsWith(QLatin1Char(' ')))
        reading.chop(1);
    return field + QLatin1Char(' ') + reading;
}

std::optional<QString> LogLineFormat::qr32Record(const QString& record) {
    return qr32Fixed(record, std::max<qsizetype>(0, record.size() - 37));
}

std::optional<QString> LogLineFormat::qr32Fixed(const QString& record, qsizetype extra) {
    if (extra < 0 || record.size() < kMinQr32 + extra)
        return std::nullopt;
    QString line = record;
    line[11 + extra] = QLatin1Char(':');
    line[14 + extra] = QLatin1Char(':');
    line.insert(6 + extra, QLatin1String("20"));
    return line;
}
