// Listen mode: processor use while nothing arrives for 30 s, and a burst of 10,000 lines at
// 115,200 baud taken whole.
#include "ReadingsBench.h"

#include "desktop/readings/ListenMode.h"
#include "desktop/readings/ReadingCommands.h"

#include <QApplication>
#include <sys/prctl.h>

using namespace readingsbench;

int main(int argc, char** argv) {
    prctl(PR_SET_TIMERSLACK, 1UL, 0, 0, 0); // exact pacing in the simulated meter's thread
    QApplication app(argc, argv);
    const int idleSeconds = argc > 1 ? std::max(1, atoi(argv[1])) : 30;
    BenchWindow b;
    if (!b.start(QStringLiteral("plain")))
        return 2;
    AppState& s = b.window->state();
    b.window->readings().listen().ListenForData();

    // Idle: the window's event loop runs, nothing arrives.
    const double cpu0 = cpuSeconds();
    QElapsedTimer wall;
    wall.start();
    idleFor(idleSeconds * 1000);
    const double idleCpu = cpuSeconds() - cpu0;
    const double idleShare = idleCpu / (wall.nsecsElapsed() / 1e9) * 100.0;
    std::printf("listen, idle for %d s: %.3f s of processor time, %.3f %% of one core "
                "(target < 1 %%; the simulated meter's thread is counted too)\n",
                idleSeconds, idleCpu, idleShare);

    // Burst: 10,000 lines back to back at 115,200 baud.
    const int lines = 10000;
    const int baud = 115200;
    QByteArray burst;
    QString expected;
    for (int i = 1; i <= lines; ++i) {
        const QByteArray line = (i > 1 ? QByteArray("\n") : QByteArray()) +
                                QByteArray::number(i).rightJustified(5, '0') +
                                "   1.413mS  25.0C 01/03/2004 08:00:00\r";
        burst += line;
        expected += QString::fromLatin1(line);
    }
    b.meter->setBaud(baud);
    QElapsedTimer t;
    t.start();
    const double burstCpu0 = cpuSeconds();
    const double burstThread0 = threadCpuSeconds();
    b.meter->sendUnsolicited(burst);
    const double wire = double(burst.size()) * 10.0 / baud;
    const bool whole = waitFor([&] { return s.workspaceText.size() >= expected.size(); },
                               int(wire * 3000) + 30000);
    const double took = t.nsecsElapsed() / 1e9;
    const double burstCpu = cpuSeconds() - burstCpu0;
    const double burstThread = threadCpuSeconds() - burstThread0;
    const bool same = s.workspaceText == expected;
    std::printf("listen, burst of %d lines (%lld bytes) at %d baud: %s in %.2f s "
                "(wire time %.2f s; processor time %.2f s, of which the program's thread %.2f s), "
                "%lld lines taken, %s\n",
                lines, static_cast<long long>(burst.size()), baud,
                whole ? "arrived" : "DID NOT ARRIVE", took, wire, burstCpu, burstThread,
                static_cast<long long>(s.workspaceText.count(QLatin1Char('\r'))),
                same ? "identical to what was sent" : "DIFFERENT from what was sent");
    b.window->readings().cmdStopCurrentData_Click();
    const long long missing =
        lines - static_cast<long long>(s.workspaceText.count(QLatin1Char('\r')));
    std::printf("RESULT listen_idle_cpu_pct %.3f %% 1\n", idleShare);
    std::printf("RESULT listen_burst_10000_missing_lines %lld lines 0\n", missing);
    std::printf("RESULT listen_burst_10000_s %.2f s %.2f\n", took, wire * 1.05);
    return idleShare < 1.0 && same ? 0 : 1;
}
