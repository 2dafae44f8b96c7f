#pragma once

#include <QString>

class MainWindow;
class ReadingCommands;
struct AppState;

// Real-time readings: one "?D" reading per interval, appended as one line, until Stop, an
// unusable reply or the 10,000-line limit. Every reading is due at runStartTime + n x interval
// on the monotonic clock, so a late reading never delays the ones after it and the schedule
// runs on across midnight.
class RealTimeRun {
public:
    static constexpr int kLineLimit = 10000;

    RealTimeRun(MainWindow& window, ReadingCommands& owner);

    // cmdCurrentData and mnuRealTime: the interval dialog, then the run.
    void cmdCurrentData_Click();
    // (Re)starts a run: continues the table when the workspace holds one, takes the first
    // reading at once.
    void StartRealTimeRun();
    void GetCurrentDataReading();
    // Arms tmrRealTime (under 60 s) or tmrLong (58 s). False when the reading is already
    // overdue.
    bool ScheduleNextReading();
    void ShowCountdown();
    // An unusable reply: the run ends, the port closes and the meter must be detected again.
    void RealTimeMeterLost();

    void tmrRealTime_Timer();
    void tmrLong_Timer();
    void tmrDisplayInterval_Timer();

    static QString countdownText(double seconds);

private:
    // Steps of StartRealTimeRun before the first reading; false when the run cannot start.
    bool beginRun();
    void acceptReading();
    // The run cannot keep up (overdue, or a reply too short for its layout).
    void cannotKeepUp();
    double runClock() const;

    MainWindow& w_;
    AppState& s_;
    ReadingCommands& owner_;
    // Set by a reading whose reply needed a re-send: the run starts again from now. The
    // caller loops instead of recursing, so repeated re-sends cannot deepen the stack.
    bool restartRequested_ = false;
};
