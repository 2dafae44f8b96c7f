#pragma once

#include <QString>
#include <QStringList>

// What the workspace holds, as the check marks of the Display menu tell it.
struct DisplayKind {
    bool realTime = false;
    bool log = false;
    bool glp = false;
    bool voltage = false;
    bool maxMin = false;
    bool listen = false;
};

// The names and file types the save dialog offers for a display kind.
class SaveNames {
public:
    static QString defaultName(const DisplayKind& kind);
    // Plain text always; comma-delimited too for log, real-time and listen data.
    static QStringList saveFilters(const DisplayKind& kind);
    static QStringList openFilters();
    // A name without any dot (in the file or a folder name) gets ".txt" for the first filter
    // and ".csv" otherwise; a name with a dot anywhere is kept as typed.
    static QString withDefaultExtension(const QString& path, int filterIndex);
};
