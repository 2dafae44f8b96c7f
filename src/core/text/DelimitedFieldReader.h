#pragma once

#include <QString>

// Reads text the way a delimited-field input does and lays it out for the workspace: one item
// per line, each followed by a line feed (unless it already ends with one).
//
// Items end at a comma or at the end of a line (LF, CR LF or CR). Leading blanks (spaces,
// tabs) are skipped. An item that begins with a double quote runs to the closing quote, line
// ends included, and loses its quotes; whatever follows the closing quote up to the next comma
// or line end is ignored. A comma is always followed by an item, empty if the line ends there;
// an empty line is one empty item. An unclosed quote runs to the end of the text.
class DelimitedFieldReader {
public:
    static QString toWorkspaceText(QStringView text);
};
