#pragma once

#include <QString>

// Validation of the real-time interval typed into frmRealTimeInterval.
class IntervalRule {
public:
    static constexpr int kMaximumSeconds = 3600;

    struct Result {
        bool accepted = false;
        int seconds = 0;
        QString message; // shown when not accepted
    };

    // Slow lines cannot carry a reading every second.
    static int minimumForBaud(qint32 baudRate);
    // The baud-rate minimum, raised to what the model itself needs (two seconds for the "LXT"
    // models and K50V3, which cannot answer every second).
    static int minimumSeconds(qint32 baudRate, const QString& modelCode);

    static Result check(const QString& entry, qint32 baudRate, const QString& modelCode);
};
