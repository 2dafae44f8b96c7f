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
    // Models that need two seconds per reading whatever the line speed ("LXT" models, K50V3).
    static bool needsTwoSeconds(const QString& modelCode);
    static int minimumSeconds(qint32 baudRate, const QString& modelCode);

    static Result check(const QString& entry, qint32 baudRate, const QString& modelCode);
};
