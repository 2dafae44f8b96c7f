#pragma once

#include "core/readings/LineLayout.h"

#include <QDateTime>
#include <QString>
#include <optional>

// Builds the workspace line of one real-time reading from the meter's reply to "?D".
class RealTimeLine {
public:
    struct Context {
        LineLayout layout;
        bool logColumnKnown = false; // percent format with log: where the Log# field stands
        int logColumnStart = 0;      // 1-based
        int logColumnWidth = 0;
        QDateTime now; // wall clock, printed into lines of percent meters without a log
    };

    // The reading number right-aligned in four characters; longer numbers unpadded.
    static QString numberText(int readingNumber);

    // The line without its final LF, or nullopt when the reply is too short for its layout.
    static std::optional<QString> build(const QString& reply, int readingNumber,
                                        const Context& context);
};
