#pragma once

// Timing of real-time readings. Every due time is counted from the start of the run
// (never from the previous reading), so late readings do not push the later ones back.
// Times are seconds of the monotonic clock, which keeps counting across midnight.
class ReadingSchedule {
public:
    static constexpr int kShortLimitMs = 60000; // tmrRealTime covers less than this
    static constexpr int kLongWaitMs = 58000;   // tmrLong's coarse step

    static double dueTime(double runStart, int lineCount, double interval) {
        return lineCount * interval + runStart;
    }

    struct Next {
        enum class Kind {
            Now,     // due this very moment: take the reading at once
            Short,   // arm tmrRealTime for ms
            Long,    // arm tmrLong (58 s), then schedule again
            Overdue, // already late: the run cannot keep up
        };
        Kind kind = Kind::Now;
        int ms = 0;
    };
    static Next next(double due, double now);

    struct Countdown {
        int secs = 0;      // shown in lblMessage
        bool tick = false; // arm tmrDisplayInterval for tickMs
        int tickMs = 0;
    };
    // Seconds left, rounded (halves to even); the next tick comes when that number drops by one.
    // At 1 the countdown rests until the reading restarts it.
    static Countdown countdown(double due, double now);

    // Progress of a download in twentieths, rounded halves to even.
    static int twentieths(long long count, long long total);
};
