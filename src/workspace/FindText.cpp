#include "workspace/FindText.h"

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
        const qsizetype p = text.indexOf(search, 0, Qt::CaseInsensitive);
        if (p >= 0 && p + 1 <= findStart)
            return p + 1;
    }
    return 0;
}
