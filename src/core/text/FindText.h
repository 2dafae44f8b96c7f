#pragma once

#include <QString>

// The find dialog's search. Positions count from 1. Case is ignored, one character at a time,
// so positions in the text never shift. The search runs from findStart to the end; when
// nothing is found there and findStart is 2 or more, it runs again over the matches that begin
// at positions 1 to findStart. Returns the 1-based position of the match, or 0.
class FindText {
public:
    static qsizetype find(const QString& text, const QString& search, qsizetype findStart);

    // The workspace control turns each CR LF of the text into one line break, so positions
    // after it are one less there. These map a 0-based index between the two.
    static qsizetype documentPosition(const QString& text, qsizetype textIndex);
    static qsizetype textIndex(const QString& text, qsizetype documentPosition);
};
