// Unit and asterisk conversions over a whole workspace, at two sizes to show linearity.
// Target: a 10,000-line, 600 KB workspace in under 20 ms.
#include "BenchTimer.h"
#include "core/readings/ReadingConversions.h"

#include <QElapsedTimer>
#include <algorithm>
#include <cstdio>
#include <vector>

static QString makeWorkspace(int lines) {
    QString text;
    for (int i = 0; i < lines; ++i) {
        // 60 characters a line: date, time, log number, conductivity, solids, temperature.
        text += QStringLiteral("01/02/2024 10:%1:%2 %3  1*%4mS  0.%5ppK 25.0 C         \n")
                    .arg(i / 60 % 60, 2, 10, QLatin1Char('0'))
                    .arg(i % 60, 2, 10, QLatin1Char('0'))
                    .arg(i + 1, 5)
                    .arg(i % 1000, 3, 10, QLatin1Char('0'))
                    .arg(i % 100, 2, 10, QLatin1Char('0'));
    }
    return text;
}

int main() {
    ReadingConversions conv;
    conv.msToUs = conv.ppkToPpm = conv.asterisks = true;
    for (int lines : {10000, 20000}) {
        const QString text = makeWorkspace(lines);
        Samples samples;
        QString out;
        for (int run = 0; run < 15; ++run) {
            BenchTimer t;
            out = conv.apply(text);
            samples.add(t);
        }
        std::printf("conversions: %d lines, %lld KB: median %.2f ms wall, %.2f ms CPU (%s)\n",
                    lines, static_cast<long long>(text.size() / 1024), samples.wallMedian(),
                    samples.cpuMedian(), qPrintable(out.left(out.indexOf(QLatin1Char('\n')))));
        if (lines == 10000)
            std::printf("RESULT conversions_10000_lines_ms %.3f ms 20\n", samples.wallMedian());
    }
    return 0;
}
