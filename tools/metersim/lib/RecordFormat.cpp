#include "RecordFormat.h"

#include <QDateTime>

namespace metersim {

namespace {

struct Column {
    const char* title;
    int width;
};

// Percent-format columns, one space before each.
const Column kLogColumns[] = {{"Date", 10}, {"Time", 8}, {"Log#", 4}, {"pH", 5}, {"Cond", 9}};
const Column kReadingColumns[] = {{"pH", 5}, {"Cond", 9}};

QDateTime stamp(int index) {
    // One record a minute from a fixed start, so long logs cross days and months.
    const QDateTime start(QDate(2004, 3, 1), QTime(8, 0, 0), Qt::UTC);
    return start.addSecs(qint64(index) * 60);
}

QByteArray latin(const QString& s) {
    return s.toLatin1();
}

// The low digits of value in a field of fixed width: record numbers wrap as on the meter's
// display, so a 10,000-record log keeps every column in place.
QByteArray number(int value, int width) {
    int modulus = 1;
    for (int i = 0; i < width; ++i)
        modulus *= 10;
    return QByteArray::number(value % modulus).rightJustified(width, '0');
}

QByteArray ph(int index) {
    return QByteArray::number(4.0 + (index * 13 % 600) / 100.0, 'f', 2).rightJustified(5, ' ');
}

template <size_t N> QByteArray headerOf(const Column (&columns)[N]) {
    QByteArray h;
    for (const Column& c : columns)
        h += ' ' + QByteArray(c.title).leftJustified(c.width, ' ');
    return h + '\r';
}

template <size_t N> QByteArray positionsOf(const Column (&columns)[N]) {
    QByteArray out = QByteArray::number(int(N));
    int start = 1;
    for (const Column& c : columns) {
        start += 1; // the space before the column
        out += ',' + QByteArray::number(start) + ',' + QByteArray::number(c.width);
        start += c.width;
    }
    return out + '\r';
}

} // namespace

QByteArray RecordFormat::conductivity(int index) {
    const bool ppk = index % 2 == 1;
    const double value = 0.1 + (index * 37 % 1900) / 1000.0;
    QByteArray field = QByteArray::number(value, 'f', 3).rightJustified(6, ' ');
    if (index % 3 == 2)
        field.replace('.', '*');
    return field + (ppk ? "ppK" : "mS");
}

QByteArray RecordFormat::record(const Profile& p, int index) {
    const QDateTime t = stamp(index);
    const QByteArray cond = conductivity(index);
    const QByteArray num = number(index + 1, 4);
    switch (p.layout) {
    case LogLayout::FourDigitYear:
        return num + ' ' + cond + " 25.0C " + latin(t.toString("dd/MM/yyyy hh:mm:ss")) + '\r';
    case LogLayout::TwoDigitYear:
        return num + ' ' + cond + " 25.0C " + latin(t.toString("dd/MM/yy hh:mm:ss")) + '\r';
    case LogLayout::K5:
        return num + ' ' + cond + " 25.0C " + latin(t.toString("dd/MM hh:mm")) + '\r';
    case LogLayout::Qr32: {
        QByteArray reading = ' ' + number(index + 1, 3) + ' ' + cond + " 25.0";
        reading = reading.leftJustified(19, ' ', true);
        return latin(t.toString("dd/MM/yy hh.mm.ss")) + reading + '\r';
    }
    case LogLayout::Percent:
        return ' ' + latin(t.toString("dd/MM/yyyy")) + ' ' + latin(t.toString("hh:mm:ss")) + ' ' +
               num + ' ' + ph(index) + ' ' + cond.leftJustified(9, ' ') + '\r';
    case LogLayout::None:
        break;
    }
    return ' ' + ph(index) + ' ' + cond.leftJustified(9, ' ') + '\r';
}

QList<QByteArray> RecordFormat::records(const Profile& p, int n) {
    QList<QByteArray> out;
    out.reserve(qMax(0, n));
    for (int i = 0; i < n; ++i)
        out.append(record(p, i));
    return out;
}

QByteArray RecordFormat::percentHeader(bool withLog) {
    return withLog ? headerOf(kLogColumns) : headerOf(kReadingColumns);
}

QByteArray RecordFormat::percentPositions(bool withLog) {
    return withLog ? positionsOf(kLogColumns) : positionsOf(kReadingColumns);
}

} // namespace metersim
