#include "core/readings/ReadingConversions.h"

#include <algorithm>
#include <charconv>

namespace {

constexpr int kFieldWidth = 6;
constexpr float kFactor = 1000.0f;
constexpr float kLimit = 999999.0f;

// Turns to_chars' scientific form ("-1.234e+03") into plain positional text ("-1234").
QString positional(const char* first, const char* last) {
    char out[64];
    int n = 0;
    if (first < last && *first == '-') {
        out[n++] = '-';
        ++first;
    }
    char digits[16];
    int count = 0;
    int exponent = 0;
    for (const char* p = first; p < last; ++p) {
        if (*p >= '0' && *p <= '9' && count < 16) {
            digits[count++] = *p;
        } else if (*p == 'e') {
            std::from_chars(p[1] == '+' ? p + 2 : p + 1, last, exponent);
            break;
        }
    }
    while (count > 1 && digits[count - 1] == '0')
        --count;
    if (exponent < -40 || exponent > 40)
        return QStringLiteral("0");
    if (exponent < 0) {
        out[n++] = '0';
        out[n++] = '.';
        for (int k = 0; k < -exponent - 1; ++k)
            out[n++] = '0';
        for (int k = 0; k < count; ++k)
            out[n++] = digits[k];
    } else {
        for (int k = 0; k <= exponent || k < count; ++k) {
            if (k == exponent + 1)
                out[n++] = '.';
            out[n++] = k < count ? digits[k] : '0';
        }
    }
    return QString::fromLatin1(out, n);
}

bool isLineBreak(QChar c) {
    return c == u'\n' || c == u'\r';
}

bool isDigit(QChar c) {
    return c >= u'0' && c <= u'9';
}

// The field with "*" read as ".", trimmed, as Latin-1 bytes for from_chars; empty when the
// field is not a number (a number may have leading or trailing spaces and a sign).
int numericText(QStringView field, char (&buf)[16]) {
    qsizetype i = 0;
    qsizetype end = field.size();
    while (i < end && field[i] == u' ')
        ++i;
    while (end > i && field[end - 1] == u' ')
        --end;
    int n = 0;
    if (i < end && (field[i] == u'+' || field[i] == u'-')) {
        if (field[i] == u'-')
            buf[n++] = '-';
        ++i;
    }
    int digits = 0;
    int points = 0;
    for (; i < end && n < 15; ++i) {
        const QChar c = field[i];
        if (isDigit(c)) {
            ++digits;
            buf[n++] = static_cast<char>(c.unicode());
        } else if ((c == u'.' || c == u'*') && points == 0) {
            ++points;
            buf[n++] = '.';
        } else {
            return 0;
        }
    }
    return (digits > 0 && i == end) ? n : 0;
}

} // namespace

QString ReadingConversions::renderSingle(float value) {
    if (value == 0.0f || value != value)
        return QStringLiteral("0");
    char buf[64];
    // The fewest significant digits (up to seven) that still name the same single value.
    for (int precision = 1; precision <= 7; ++precision) {
        const auto res = std::to_chars(buf, buf + sizeof buf, static_cast<double>(value),
                                       std::chars_format::scientific, precision - 1);
        float back = 0;
        std::from_chars(buf, res.ptr, back);
        if (back == value || precision == 7)
            return positional(buf, res.ptr);
    }
    return QStringLiteral("0");
}

std::optional<QString> ReadingConversions::convertValueField(QStringView field) {
    char buf[16];
    const int n = numericText(field, buf);
    if (n == 0)
        return std::nullopt;
    float x = 0;
    std::from_chars(buf, buf + n, x);
    const float f = x * kFactor;
    if (f > kLimit)
        return QStringLiteral("+OVR");
    QString t = renderSingle(f);
    if (field.contains(u'*'))
        t.replace(u'.', u'*');
    return t;
}

void ReadingConversions::convertUnit(QString& s, const QString& unit, const QString& replacement) {
    // Units are looked for from the fifth character on; a unit at the fifth or sixth character
    // takes the four or five characters before it as its value field.
    for (qsizetype i = s.indexOf(unit, 4); i >= 0; i = s.indexOf(unit, i + unit.size())) {
        s.replace(i, unit.size(), replacement);
        qsizetype fieldStart = qMax<qsizetype>(0, i - kFieldWidth);
        // The value field ends at a line break: it is what follows the last CR or LF.
        for (qsizetype k = i - 1; k >= fieldStart; --k) {
            if (isLineBreak(s[k])) {
                fieldStart = k + 1;
                break;
            }
        }
        const auto t = convertValueField(QStringView(s).mid(fieldStart, i - fieldStart));
        if (!t)
            continue;
        // A rendering longer than the field overwrites what stands before it, but never
        // reaches past the start of the text or over a line break.
        const qsizetype writeStart = i - t->size();
        if (writeStart < 0 ||
            (writeStart < fieldStart &&
             std::any_of(s.cbegin() + writeStart, s.cbegin() + fieldStart, isLineBreak)))
            continue;
        for (qsizetype k = fieldStart; k < i; ++k)
            s[k] = QLatin1Char(' ');
        s.replace(writeStart, t->size(), *t);
    }
}

QString ReadingConversions::apply(const QString& text) const {
    QString s = text;
    if (msToUs)
        convertUnit(s, QStringLiteral("mS"), QStringLiteral("uS"));
    if (ppkToPpm)
        convertUnit(s, QStringLiteral("ppK"), QStringLiteral("ppM"));
    if (asterisks)
        s.replace(QLatin1Char('*'), QLatin1Char('.'));
    return s;
}
