#pragma once

#include <QString>

// What a save writes of the workspace text. Asterisk decimal marks become points in a
// comma-delimited file, or when the settings ask for it, but never in GLP data (whose asterisks
// are not decimal marks); a plain-text file starts with the column header when one is shown.
namespace SavedText {

QString contents(QString text, bool commaDelimited, bool asteriskSetting, bool glpData,
                 const QString& shownHeader);

} // namespace SavedText
