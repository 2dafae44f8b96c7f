// telvio-cli against the simulated meter: log download time (unpaced, and paced at 115,200 baud
// against the wire time), start-up to the first byte, and how closely timed readings keep to
// their schedule.
//   bench_cli [READINGS]   (default 120 readings at 1 s: two minutes)
#include "BenchTimer.h"

#include <Meter.h>
#include <QCoreApplication>
#include <QProcess>
#include <chrono>
#include <cmath>
#include <cstdio>

namespace {

void result(const char* figure, double measured, const char* unit, double target) {
    std::printf("RESULT %s %.2f %s %.2f\n", figure, measured, unit, target);
    std::fflush(stdout);
}

// Runs the tool to its end; the wall time in ms, or -1 when it failed.
double run(const QStringList& args) {
    BenchTimer timer;
    QProcess p;
    p.setStandardOutputFile(QProcess::nullDevice());
    p.start(TELVIO_CLI_PATH, args);
    if (!p.waitForFinished(600000) || p.exitCode() != 0)
        return -1;
    return timer.wallMs();
}

double logMs(int baud, qint64* bytes) {
    metersim::Meter meter(metersim::profile("plain"));
    if (!meter.start())
        return -1;
    const auto log = metersim::Meter::generateLog(meter.profile(), 10000);
    meter.setLogRecords(log);
    meter.setBaud(baud);
    *bytes = 0;
    for (const QByteArray& record : log)
        *bytes += record.size();
    return run({"log", "-p", meter.portPath()});
}

} // namespace

int main(int argc, char* argv[]) {
    QCoreApplication app(argc, argv);
    const int readings = argc > 1 ? std::atoi(argv[1]) : 120;
    qint64 bytes = 0;
    result("log_10000_unpaced", logMs(0, &bytes), "ms", 1000);
    const double paced = logMs(115200, &bytes);
    const double wireMs = double(bytes) * 10 / 115200 * 1000;
    result("log_10000_115200_over_wire", (paced / wireMs - 1) * 100, "%", 1);

    result("version_run", run({"--version"}), "ms", 50);
    {
        metersim::Meter meter(metersim::profile("plain"));
        meter.start();
        const auto meterStart = std::chrono::steady_clock::now();
        QProcess p;
        const auto launched = std::chrono::steady_clock::now();
        p.start(TELVIO_CLI_PATH, {"status", "-p", meter.portPath()});
        p.waitForFinished(20000);
        const double startS = std::chrono::duration<double>(launched - meterStart).count();
        const auto received = meter.receivedWithTimes();
        result("status_first_byte", received.isEmpty() ? -1 : (received[0].t - startS) * 1000, "ms",
               50);
    }
    {
        metersim::Meter meter(metersim::profile("plain"));
        meter.start();
        run({"read", "--interval", "1", "--count", QString::number(readings), "-p",
             meter.portPath()});
        const QList<double> at = meter.commandTimes("?D\r");
        double worst = at.size() == readings ? 0 : 1e9;
        for (int i = 1; i < at.size(); ++i)
            worst = std::max(worst, std::fabs(at[i] - at[0] - i) * 1000);
        result("read_1s_worst_deviation", worst, "ms", 20);
    }
    return 0;
}
