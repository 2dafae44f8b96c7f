// Opening a text file into the workspace: read, decode, lay out one field per line and show it
// in the fixed-pitch workspace control. Run once per size (peak memory is per process):
//   bench_openfile 10     (MiB; target under 1 s and under 150 MB peak)
#include "BenchTimer.h"
#include "core/text/WorkspaceFileIO.h"
#include "desktop/workspace/WorkspaceView.h"

#include <QApplication>
#include <QElapsedTimer>
#include <QFile>
#include <QPlainTextEdit>
#include <QTemporaryDir>
#include <cstdio>
#include <sys/resource.h>

static long peakKb() {
    rusage usage{};
    getrusage(RUSAGE_SELF, &usage);
    return usage.ru_maxrss;
}

int main(int argc, char** argv) {
    qputenv("QT_QPA_PLATFORM", "offscreen");
    QApplication app(argc, argv);
    const qsizetype mib = argc > 1 ? QByteArray(argv[1]).toLongLong() : 10;
    QTemporaryDir dir;
    const QString path = dir.filePath(QStringLiteral("big.txt"));
    {
        const QByteArray line("01/02/2024 10:11:12     17  1.413 mS/cm  25.0\xB0"
                              "C\r\n");
        QByteArray bytes;
        bytes.reserve(mib * 1024 * 1024 + line.size());
        while (bytes.size() < mib * 1024 * 1024)
            bytes += line;
        QFile f(path);
        if (!f.open(QIODevice::WriteOnly) || f.write(bytes) != bytes.size())
            return 1;
    }
    QPlainTextEdit edit;
    WorkspaceView::configure(edit);
    edit.resize(800, 600);
    edit.show();
    QCoreApplication::processEvents();
    const long before = peakKb();

    BenchTimer t;
    QString text;
    QString error;
    if (!WorkspaceFileIO::readForDisplay(path, text, error)) {
        std::printf("read failed: %s\n", qPrintable(error));
        return 1;
    }
    const double readMs = t.wallMs();
    const long afterRead = peakKb();
    edit.setPlainText(text);
    QCoreApplication::processEvents();
    const double totalMs = t.wallMs();
    const double totalCpuMs = t.cpuElapsedMs();
    std::printf("open: %lld MiB, %lld lines: read+layout %.0f ms, shown %.0f ms wall "
                "(%.0f ms CPU); peak %ld MB "
                "(%ld MB before opening, %ld MB after reading)\n",
                static_cast<long long>(mib), static_cast<long long>(edit.blockCount()), readMs,
                totalMs, totalCpuMs, peakKb() / 1024, before / 1024, afterRead / 1024);
    std::printf("RESULT open_%lldMiB_ms %.0f ms 1000\n", static_cast<long long>(mib), totalMs);
    std::printf("RESULT open_%lldMiB_peak_MB %ld MB 150\n", static_cast<long long>(mib),
                peakKb() / 1024);
    return 0;
}
