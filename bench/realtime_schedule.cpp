// Real-time readings every second for 120 readings, timed by when the simulated meter received
// each "?D". Reading n must come n seconds after the first (each reading's drain before "?D"
// takes the same time), within 20 ms, and the last no further off than the first.
// Takes two minutes.
#include "ReadingsBench.h"

#include "desktop/readings/ReadingCommands.h"
#include "desktop/readings/RealTimeRun.h"

#include <QApplication>
#include <algorithm>
#include <cmath>

using namespace readingsbench;

int main(int argc, char** argv) {
    QApplication app(argc, argv);
    const int readings = argc > 1 ? std::max(2, atoi(argv[1])) : 120;
    BenchWindow b;
    if (!b.start(QStringLiteral("plain")))
        return 2;
    AppState& s = b.window->state();
    s.logInterval = 1;
    s.runActive = true;
    b.window->readings().realTime().StartRealTimeRun();
    if (!waitFor([&] { return s.lineCount >= readings || !s.runActive; }, (readings + 10) * 1000)) {
        std::fprintf(stderr, "run did not finish\n");
        return 2;
    }
    b.window->readings().cmdStopCurrentData_Click();

    const QList<double> times = b.meter->commandTimes("?D\r");
    if (times.size() < readings) {
        std::fprintf(stderr, "only %lld readings\n", static_cast<long long>(times.size()));
        return 2;
    }
    double worst = 0;
    double sum = 0;
    for (int n = 0; n < readings; ++n) {
        const double off = (times[n] - times[0] - n * 1.0) * 1000.0;
        worst = std::max(worst, std::fabs(off));
        sum += off;
    }
    const double second = (times[1] - times[0] - 1.0) * 1000.0;
    const double last = (times[readings - 1] - times[0] - (readings - 1)) * 1000.0;
    std::printf("real-time, %d readings every 1 s: worst offset %.2f ms, mean %.2f ms, "
                "second reading %+.2f ms, last %+.2f ms (target: every one within 20 ms, "
                "no drift)\n",
                readings, worst, sum / readings, second, last);
    std::printf("RESULT realtime_worst_offset_ms %.2f ms 20\n", worst);
    std::printf("RESULT realtime_last_offset_ms %.2f ms 20\n", std::fabs(last));
    return worst <= 20.0 ? 0 : 1;
}
