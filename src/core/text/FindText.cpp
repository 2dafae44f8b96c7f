#include "core/text/FindText.h"

qsizetype FindText::find(const QString& text, const QString& search, qsizetype findStart) {
    if (search.isEmpty())
        return 0;
    const qsizetype from = qMax<qsizetype>(1, findStart);
    if (from <= text.size()) {
        const qsizetype p = text.indexOf(search, from - 1, Qt::CaseInsensitive);
        if (p >= 0)
            return p + 1;
    }
    if (findStart >= 2) {
        // Only matches that begin at positions 1 to findStart count: search no further.
        const QStringView head = QStringView(text).left(findStart - 1 + search.size());
        const qsizetype p = head.indexOf(search, 0, Qt::CaseInsensitive);
        if (p >= 0 && p + 1 <= findStart)
            return p + 1;
    }
    return 0;
}

qsizetype FindText::documentPosition(const QString& text, qsizetype textIndex) {
    const qsizetype end = qBound<qsizetype>(0, textIndex, text.size());
    qsizetype pairs = 0;
    for (qsizetype k = text.indexOf(u'\r'); k >= 0 && k + 1 < end; k = text.indexOf(u'\r', k + 1)) {
        if (text[k + 1] == u'\n')
            ++pairs;
    }
    return end - pairs;
}

qsizetype FindText::textIndex(const QString& text, qsizetype documentPosition) {
    qsizetype index = 0;
    for (qsizetype doc = 0; doc < documentPosition && index < text.size(); ++doc) {
        if (text[index] == u'\r' && index + 1 < text.size() && text[index + 1] == u'\n')
            ++index;
        ++index;
    }
    return index;
}
