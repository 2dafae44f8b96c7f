// Logged Data: 10,000 records from the simulated meter, first as fast as the pseudo-terminal
// allows, then paced at 38,400 baud and compared with the time the bytes need on the wire.
#include "ReadingsBench.h"

#include "desktop/readings/LogDownload.h"
#include "desktop/readings/ReadingCommands.h"

#include <QApplication>
#include <cmath>
#include <sys/prctl.h>

using namespace readingsbench;

namespace {

struct Result {
    double seconds = 0;   // the whole command, status query included
    double transfer = 0;  // from "?L" at the meter to the last acknowledgement at the meter
    double threadCpu = 0; // processor time of the program's thread
    int lines = 0;
    qint64 bytes = 0;
};

Result download(int records, int baud) {
    BenchWindow b;
    if (!b.start(QStringLiteral("plain"))) {
        std::fprintf(stderr, "meter or window did not start\n");
        return {};
    }
    const QList<QByteArray> log = metersim::Meter::generateLog(b.meter->profile(), records);
    b.meter->setLogRecords(log);
    b.meter->setBaud(baud);
    Result r;
    for (const QByteArray& record : log)
        r.bytes += record.size();
    r.bytes += 5; // "ENDS" CR
    QElapsedTimer t;
    t.start();
    const double cpu0 = threadCpuSeconds();
    b.window->readings().logDownload().DownloadLog();
    r.seconds = t.nsecsElapsed() / 1e9;
    r.threadCpu = threadCpuSeconds() - cpu0;
    r.lines = int(b.window->state().workspaceText.count(QLatin1Char('\n')));
    b.meter->waitForReceived("A", records + 1, 2000);
    const QList<double> start = b.meter->commandTimes("?L\r");
    const QList<metersim::ReceivedByte> bytes = b.meter->receivedWithTimes();
    if (!start.isEmpty() && !bytes.isEmpty())
        r.transfer = bytes.constLast().t - start.constFirst();
    return r;
}

} // namespace

int main(int argc, char** argv) {
    // The simulated meter paces its bytes by sleeping; with the default 50 us timer slack each
    // sleep overshoots and the meter, not the program, would set the pace. A real UART has no
    // such slack. The meter's thread inherits this setting.
    prctl(PR_SET_TIMERSLACK, 1UL, 0, 0, 0);
    QApplication app(argc, argv);
    const int records = argc > 1 ? std::max(1, atoi(argv[1])) : 10000;

    // The status query ("?S" with its drain) is part of the command; it costs about 0.3 s.
    const Result fast = download(records, 0);
    std::printf("log download, %d records, no pacing: %.3f s total, %.1f us per record, "
                "%d lines (target < 3 s)\n",
                records, fast.seconds, fast.seconds * 1e6 / records, fast.lines);

    const int baud = 38400;
    const Result paced = download(records, baud);
    const double wire = double(paced.bytes) * 10.0 / baud;
    std::printf(
        "log download, %d records at %d baud: transfer %.3f s (\"?L\" to the last "
        "acknowledgement), whole command %.3f s; wire time of the %lld record bytes "
        "%.3f s: transfer %+.2f %% (target within 5 %%), %d lines; the program's thread used "
        "%.2f s of processor time\n",
        records, baud, paced.transfer, paced.seconds, static_cast<long long>(paced.bytes), wire,
        (paced.transfer - wire) / wire * 100.0, paced.lines, paced.threadCpu);
    std::printf("RESULT log_download_10000_s %.3f s 3\n", fast.seconds * 10000.0 / records);
    std::printf("RESULT log_download_per_record_us %.1f us 300\n", fast.seconds * 1e6 / records);
    std::printf("RESULT log_download_38400_vs_wire_pct %.2f %% 5\n",
                std::fabs(paced.transfer - wire) / wire * 100.0);
    return fast.lines == records && paced.lines == records ? 0 : 1;
}
