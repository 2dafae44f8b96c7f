// The comma-delimited conversion at 1 MiB and 2 MiB. Target: 1 MiB in under 50 ms.
#include "core/text/CommaDelimited.h"
#include "BenchTimer.h"

#include <QElapsedTimer>
#include <algorithm>
#include <cstdio>
#include <vector>

static QString makeText(qsizetype bytes) {
    const QString line = QStringLiteral("01/02/2024 10:11:12     17  1.413 mS/cm  25.0 C\n");
    QString text;
    text.reserve(bytes + line.size());
    while (text.size() < bytes)
        text += line;
    return text;
}

int main() {
    for (qsizetype mib : {1, 2}) {
        const QString text = makeText(mib * 1024 * 1024);
        Samples samples;
        QString out;
        for (int run = 0; run < 15; ++run) {
            BenchTimer t;
            out = CommaDelimited::convert(text);
            samples.add(t);
        }
        std::printf("comma-delimited: %lld MiB: median %.2f ms wall, %.2f ms CPU (%s)\n",
                    static_cast<long long>(mib), samples.wallMedian(), samples.cpuMedian(),
                    qPrintable(out.left(out.indexOf(QLatin1Char('\n')))));
        if (mib == 1)
            std::printf("RESULT comma_delimited_1MiB_ms %.3f ms 50\n", samples.wallMedian());
    }
    return 0;
}
