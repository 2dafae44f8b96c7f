#pragma once

#include "core/instrument/ModelTable.h"
#include "core/settings/AppState.h"

#include <QString>

// Which line layout the connected meter uses. Taken from the identity the status query left in
// AppState; the pure line rules take it as a parameter so they can be tested without a window.
struct LineLayout {
    bool percentFormat = false; // lines are passed through (the meter's own columns)
    bool hasLog = false;        // percent format only: reading lines carry a Log# column
    bool isK5Family = false;    // 11-character date/time field
    bool marinLago = false;     // 16-character date/time field, two characters dropped
    bool qr32 = false;          // fixed 36-character records, own download protocol

    static LineLayout fromState(const AppState& s) {
        LineLayout l;
        l.percentFormat = s.percentFormat;
        l.hasLog = s.hasLog;
        l.isK5Family = s.isK5Family;
        l.marinLago = modeltable::usesShortDateTime(s.modelCode);
        l.qr32 = modeltable::usesQr32Layout(s.modelCode);
        return l;
    }
};
