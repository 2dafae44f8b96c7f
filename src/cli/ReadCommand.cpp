#include "cli/CliLink.h"
#include "cli/Commands.h"
#include "core/instrument/StatusQuery.h"
#include "core/readings/IntervalRule.h"
#include "core/readings/LineLayout.h"
#include "core/readings/ReadingSchedule.h"
#include "core/readings/RealTimeLine.h"
#include "core/readings/RealTimeReading.h"
#include "core/settings/SystemClock.h"

#include <QThread>
#include <cstdio>

namespace {

// Sleeps until the monotonic time due, a fifth of a second at most at a time, so an interrupt
// is seen at once. False when interrupted.
bool sleepUntil(const Clock& clock, double due) {
    for (double rest = due - clock.nowSeconds(); rest > 0; rest = due - clock.nowSeconds()) {
        if (interrupted())
            return false;
        QThread::usleep(static_cast<unsigned long>(qMin(rest, 0.2) * 1e6));
    }
    return !interrupted();
}

void print(const QString& line) {
    std::fputs((line + u'\n').toLocal8Bit().constData(), stdout);
    std::fflush(stdout);
}
} // namespace

// Timed real-time readings as the window takes them: the same minimum intervals, the schedule
// counted from the start of the run, one line per reading written and flushed as it arrives.
// Ctrl+C or SIGTERM ends the run between readings, as Stop does.
int Commands::read(CliLink& link, int intervalSeconds, int count) {
    const auto reply = link.queryStatus();
    if (!reply)
        return link.failure();
    AppState& s = link.state();
    link.adopt(*reply);
    const IntervalRule::Result rule =
        IntervalRule::check(QString::number(intervalSeconds), s.baudRate, s.modelCode);
    if (!rule.accepted) {
        complain(rule.message);
        return ExitCode::kUsage;
    }
    bool logColumnKnown = false;
    if (s.percentFormat) {
        StatusQuery::headerAndPositions(link.exchange(), s, logColumnKnown);
        if (s.abortRequested)
            return link.failure();
        if (!s.headerText.isEmpty())
            print(QString(s.headerText).remove(u'\r'));
    }
    catchInterrupts();
    SystemClock clock;
    double start = clock.nowSeconds();
    int lines = 0;
    for (int taken = 0; count <= 0 || taken < count;) {
        if (!sleepUntil(clock, ReadingSchedule::dueTime(start, lines, rule.seconds)))
            return ExitCode::kDone;
        switch (RealTimeReading::request(link.exchange(), s)) {
        case RealTimeReading::Outcome::Reading:
            break;
        case RealTimeReading::Outcome::Restart:
            start = clock.nowSeconds();
            lines = 0;
            continue;
        case RealTimeReading::Outcome::MeterError:
            complain(QStringLiteral("the meter answered \"ERROR\""));
            return ExitCode::kMeterError;
        case RealTimeReading::Outcome::MeterLost:
            complain(QStringLiteral("the meter stopped answering"));
            return ExitCode::kLinkFailed;
        case RealTimeReading::Outcome::LinkFailed:
            complain(QStringLiteral("the link to %1 failed").arg(s.portName));
            return ExitCode::kLinkFailed;
        }
        const RealTimeLine::Context context{LineLayout::fromState(s), logColumnKnown,
                                            s.logColumnStart, s.logColumnWidth, clock.wallNow()};
        const auto line = RealTimeLine::build(s.responseText, ++taken, context);
        if (!line) {
            complain(QStringLiteral("the meter's reply cannot be laid out as a reading"));
            return ExitCode::kLinkFailed;
        }
        print(QString(*line).remove(u'\r'));
        ++lines;
    }
    return ExitCode::kDone;
}
