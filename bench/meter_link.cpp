// Round trips against the simulated meter over a real pseudo-terminal: the status exchange,
// a 10,000-record log download with acknowledgements, and what an idle meter costs in CPU.
#include "Meter.h"

#include <QCoreApplication>
#include <QElapsedTimer>
#include <QSerialPort>

#include <algorithm>
#include <cstdio>
#include <sys/resource.h>
#include <thread>
#include <vector>

namespace {

double cpuSeconds() {
    rusage u{};
    getrusage(RUSAGE_SELF, &u);
    return double(u.ru_utime.tv_sec + u.ru_stime.tv_sec) +
           double(u.ru_utime.tv_usec + u.ru_stime.tv_usec) / 1e6;
}

QByteArray readLine(QSerialPort& port, QByteArray& pending) {
    while (!pending.contains('\r')) {
        if (port.bytesAvailable() == 0 && !port.waitForReadyRead(2000))
            return {};
        pending += port.readAll();
    }
    const qsizetype end = pending.indexOf('\r');
    const QByteArray line = pending.left(end + 1);
    pending.remove(0, line.size());
    return line;
}

} // namespace

int main(int argc, char* argv[]) {
    QCoreApplication app(argc, argv);
    metersim::Meter meter(metersim::profile("k50"));
    meter.setLogRecords(metersim::Meter::generateLog(meter.profile(), 10000));
    if (!meter.start()) {
        std::fprintf(stderr, "meter: %s\n", qPrintable(meter.errorString()));
        return 1;
    }
    QSerialPort port;
    port.setPortName(meter.portPath());
    if (!port.open(QIODevice::ReadWrite)) {
        std::fprintf(stderr, "open: %s\n", qPrintable(port.errorString()));
        return 1;
    }
    QByteArray pending;

    const QByteArray status = meter.profile().statusReply(10000);
    std::vector<double> trips;
    QElapsedTimer timer;
    for (int i = 0; i < 2000; ++i) {
        timer.start();
        port.write("?S\r");
        if (readLine(port, pending) != status) {
            std::fprintf(stderr, "unexpected status reply\n");
            return 1;
        }
        trips.push_back(double(timer.nsecsElapsed()) / 1000.0);
    }
    std::sort(trips.begin(), trips.end());
    std::printf("status round trip: median %.0f us, 99th percentile %.0f us (%zu trips)\n",
                trips[trips.size() / 2], trips[trips.size() * 99 / 100], trips.size());

    timer.start();
    double cpu = cpuSeconds();
    port.write("?L\r");
    int records = 0;
    for (;;) {
        const QByteArray line = readLine(port, pending);
        if (line.isEmpty())
            return 1;
        port.write("A");
        if (line.contains("ENDS"))
            break;
        ++records;
    }
    std::printf("log download: %d records acknowledged one by one in %.2f s, %.2f s CPU\n", records,
                double(timer.elapsed()) / 1000.0, cpuSeconds() - cpu);

    cpu = cpuSeconds();
    std::this_thread::sleep_for(std::chrono::seconds(2));
    std::printf("idle meter for 2 s: %.4f s CPU\n", cpuSeconds() - cpu);
    return 0;
}
