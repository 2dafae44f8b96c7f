#include "core/text/DelimitedFieldReader.h"

namespace {
bool isLineEnd(QChar c) {
    return c == u'\n' || c == u'\r';
}
bool isBlank(QChar c) {
    return c == u' ' || c == u'\t';
}
} // namespace

QString DelimitedFieldReader::toWorkspaceText(QStringView text) {
    QString out;
    // The items and their line feeds never take more room than the text (one more at most).
    out.reserve(text.size() + 2);
    const qsizetype n = text.size();
    qsizetype i = 0;
    // True right after a comma: an item follows even when the text or the line ends there.
    bool itemPending = false;
    while (i < n || itemPending) {
        while (i < n && isBlank(text[i]))
            ++i;
        QStringView item;
        if (i < n && text[i] == u'"') {
            const qsizetype start = i + 1;
            qsizetype close = text.indexOf(u'"', start);
            if (close < 0)
                close = n;
            item = text.mid(start, close - start);
            i = close + 1;
            while (i < n && text[i] != u',' && !isLineEnd(text[i]))
                ++i;
        } else {
            const qsizetype start = i;
            while (i < n && text[i] != u',' && !isLineEnd(text[i]))
                ++i;
            item = text.mid(start, i - start);
        }
        out.append(item);
        if (!item.endsWith(u'\n'))
            out.append(u'\n');
        itemPending = false;
        if (i < n && text[i] == u',') {
            ++i;
            itemPending = true;
        } else if (i < n) {
            // Line end: CR LF counts once.
            if (text[i] == u'\r' && i + 1 < n && text[i + 1] == u'\n')
                ++i;
            ++i;
        }
    }
    return out;
}
