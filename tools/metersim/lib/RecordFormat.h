#pragma once

#include "Profile.h"

#include <QByteArray>
#include <QList>

namespace metersim {

// Generates the text the simulated meter sends as logged records and readings: deterministic,
// so a test can compute what the program must show, with a mix of "mS" and "ppK" readings and
// asterisk decimal marks.
class RecordFormat {
public:
    // Record number index (0-based) in the profile's log layout, ended by CR. For a profile
    // without a log this is a real-time reading without date (the "?D" layout).
    static QByteArray record(const Profile& p, int index);
    static QList<QByteArray> records(const Profile& p, int n);

    // Column header and position replies of percent-format meters, CR included.
    static QByteArray percentHeader(bool withLog);
    static QByteArray percentPositions(bool withLog);

private:
    // Six-character value field followed by its unit, e.g. " 1.413mS" or " 0*707ppK".
    static QByteArray conductivity(int index);
};

} // namespace metersim
