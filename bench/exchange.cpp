// 10,000 "?S" exchanges with the simulated meter through the real exchange, and the processor
// time of a 2-second wait for a reply that never comes.
#include "desktop/link/Exchange.h"
#include "core/Prompts.h"
#include "core/link/QtSerialLine.h"
#include "core/settings/SystemClock.h"
#include "desktop/shell/MainWindow.h"

#include <Meter.h>
#include <QApplication>
#include <QElapsedTimer>
#include <QLabel>
#include <QTimer>
#include <algorithm>
#include <cstdio>
#include <sys/resource.h>

namespace {
class SilentPrompts : public Prompts {
public:
    Answer show(const QString&, Icon, Buttons, bool) override { return Answer::Cancel; }
};

double cpuSeconds() {
    rusage u{};
    getrusage(RUSAGE_SELF, &u);
    return double(u.ru_utime.tv_sec + u.ru_stime.tv_sec) +
           double(u.ru_utime.tv_usec + u.ru_stime.tv_usec) / 1e6;
}

// Round trip of the bare line (write, wait for the CR): the meter's own reply time.
double bareRoundTripUs(QtSerialLine& line, int n) {
    std::vector<double> times;
    QElapsedTimer t;
    for (int i = 0; i < n; ++i) {
        t.start();
        line.write("?S\r");
        for (;;) {
            int c = line.readByte();
            if (c == 13)
                break;
            if (c <= 0)
                line.waitForByte(2000);
        }
        times.push_back(double(t.nsecsElapsed()) / 1000.0);
    }
    std::sort(times.begin(), times.end());
    std::printf("bare line round trip 99th pct %.1f us\n", times[times.size() * 99 / 100]);
    return times[times.size() / 2];
}
} // namespace

int main(int argc, char** argv) {
    qputenv("QT_QPA_PLATFORM", "offscreen");
    QApplication app(argc, argv);
    const int n = 10000;
    metersim::Meter meter(metersim::profile(QStringLiteral("plain")));
    if (!meter.start()) {
        std::fprintf(stderr, "meter: %s\n", qPrintable(meter.errorString()));
        return 1;
    }
    SilentPrompts prompts;
    SystemClock clock;
    QtSerialLine line;
    MainWindow window({&prompts, &clock, &line, nullptr});
    AppState& s = window.state();
    if (line.open(meter.portPath(), QStringLiteral("baud=9600 parity=N data=8 stop=1")) != 0)
        return 1;

    const double bareUs = bareRoundTripUs(line, 2000);

    // The exchange of every command: send, then wait for the one reply line.
    std::vector<double> times;
    times.reserve(n);
    QElapsedTimer t;
    const double cpu0 = cpuSeconds();
    for (int i = 0; i < n; ++i) {
        t.start();
        s.commandText = QStringLiteral("?S\r");
        window.exchange().SerialWrite(s.commandText);
        window.exchange().SendCommand();
        times.push_back(double(t.nsecsElapsed()) / 1000.0);
        if (s.abortRequested || !s.responseText.endsWith(QLatin1Char('\r'))) {
            std::fprintf(stderr, "exchange %d failed\n", i);
            return 1;
        }
    }
    const double cpu = cpuSeconds() - cpu0;
    std::sort(times.begin(), times.end());
    const double median = times[times.size() / 2];
    const double p99 = times[times.size() * 99 / 100];

    // A 2-second wait for a reply that never comes.
    meter.setSilent(true);
    s.readTimeoutSec = 2.0;
    const double wait0 = cpuSeconds();
    window.exchange().ReadReply();
    const double waitCpuMs = (cpuSeconds() - wait0) * 1000.0;

    std::printf("exchanges                 %d\n", n);
    std::printf("round trip median         %.1f us\n", median);
    std::printf("round trip 99th pct       %.1f us\n", p99);
    std::printf("bare line round trip      %.1f us (meter's own reply time)\n", bareUs);
    std::printf("program CPU per exchange  %.1f us\n", cpu * 1e6 / n);
    std::printf("RESULT exchange_added_ms %.4f ms 0.2\n", std::max(0.0, median - bareUs) / 1000.0);
    std::printf("RESULT exchange_p99_ms %.4f ms 2\n", p99 / 1000.0);
    std::printf("RESULT wait_2s_cpu_ms %.3f ms 20\n", waitCpuMs);
    line.close();
    return 0;
}
