#pragma once

#include <QString>

// Turns workspace text into comma-delimited lines for spreadsheets. The first field of each
// line keeps its first separator as a space, so a date and a time stay together; later fields
// keep only the characters of numbers, so units leave empty fields behind.
//
// At the end of the text the passes simply stop: a last line without a line feed is converted
// like any other line but gets no line feed added, and text after the last comma is copied as
// it stands (a line without a comma passes through whole anyway).
class CommaDelimited {
public:
    static QString convert(const QString& text);

private:
    static void commaForFirstSpaceOfRun(QString& d);
    static QString withoutSpaces(const QString& d);
    static void spaceForCommaBeforeLineFeed(QString& d);
    static void spaceForFirstCommaOfLine(QString& d);
    static QString keepFieldCharacters(const QString& d);
};
