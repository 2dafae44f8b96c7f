#include "core/text/CommaDelimited.h"

namespace {
constexpr char16_t kComma = u',';
constexpr char16_t kSpace = u' ';
constexpr char16_t kLineFeed = u'\n';

bool isFieldCharacter(char16_t c) {
    return (c >= u'0' && c <= u'9') || c == u'.' || c == u'+' || c == u'-' || c == u'E' ||
           c == kComma;
}
} // namespace

// Pass 1: the first space of every run of spaces becomes a comma, unless a comma precedes it.
void CommaDelimited::commaForFirstSpaceOfRun(QString& d) {
    char16_t* p = reinterpret_cast<char16_t*>(d.data());
    for (qsizetype i = 1; i < d.size(); ++i) {
        if (p[i] == kSpace && p[i - 1] != kComma && p[i - 1] != kSpace)
            p[i] = kComma;
    }
}

// Pass 2: every remaining space is dropped.
QString CommaDelimited::withoutSpaces(const QString& d) {
    QString out;
    out.reserve(d.size());
    for (const QChar c : d) {
        if (c.unicode() != kSpace)
            out.append(c);
    }
    return out;
}

// Pass 3: a comma that ends a line becomes a space.
void CommaDelimited::spaceForCommaBeforeLineFeed(QString& d) {
    char16_t* p = reinterpret_cast<char16_t*>(d.data());
    for (qsizetype i = 1; i < d.size(); ++i) {
        if (p[i] == kLineFeed && p[i - 1] == kComma)
            p[i - 1] = kSpace;
    }
}

// Pass 4: the first comma of each line turns back into a space (the very first character of
// the text is never looked at). With no line feed after it, the scan ends.
void CommaDelimited::spaceForFirstCommaOfLine(QString& d) {
    char16_t* p = reinterpret_cast<char16_t*>(d.data());
    const qsizetype n = d.size();
    for (qsizetype i = 1; i < n; ++i) {
        if (p[i] != kComma)
            continue;
        p[i] = kSpace;
        while (i < n && p[i] != kLineFeed)
            ++i;
    }
}

// Pass 5: the first field is copied as it is; from its comma to the end of the line only the
// characters of numbers, commas and "OVR" are kept. A sign right before "OVR" becomes a space.
QString CommaDelimited::keepFieldCharacters(const QString& d) {
    const char16_t* p = reinterpret_cast<const char16_t*>(d.constData());
    const qsizetype n = d.size();
    QString out;
    out.reserve(n);
    qsizetype i = 0;
    while (i < n) {
        while (i < n && p[i] != kComma)
            out.append(QChar(p[i++]));
        if (i >= n)
            break;
        for (; i < n && p[i] != kLineFeed; ++i) {
            if (isFieldCharacter(p[i])) {
                out.append(QChar(p[i]));
            } else if (p[i] == u'O' && i + 2 < n && p[i + 1] == u'V' && p[i + 2] == u'R') {
                out.append(QStringLiteral("OVR"));
                if (i > 0 && (p[i - 1] == u'-' || p[i - 1] == u'+') && out.size() >= 4)
                    out[out.size() - 4] = QChar(kSpace);
            }
        }
        if (i >= n)
            break;
        out.append(QChar(kLineFeed));
        ++i;
    }
    return out;
}

QString CommaDelimited::convert(const QString& text) {
    QString d = text;
    commaForFirstSpaceOfRun(d);
    d = withoutSpaces(d);
    spaceForCommaBeforeLineFeed(d);
    spaceForFirstCommaOfLine(d);
    return keepFieldCharacters(d);
}
