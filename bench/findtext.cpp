// One Find press over 1 MiB and 2 MiB of workspace text: the match at the very end (the whole
// text searched) and a text that is not there (searched and wrapped). Target: 1 MiB < 10 ms.
#include "core/text/FindText.h"
#include "BenchTimer.h"

#include <QElapsedTimer>
#include <algorithm>
#include <cstdio>
#include <vector>

static Samples measure(const QString& text, const QString& search, qsizetype& found) {
    Samples samples;
    for (int run = 0; run < 21; ++run) {
        BenchTimer t;
        found = FindText::find(text, search, 2);
        samples.add(t);
    }
    return samples;
}

int main() {
    const QString line = QStringLiteral("01/02/2024 10:11:12     17  1.413 mS/cm  25.0 C\n");
    for (qsizetype mib : {1, 2}) {
        QString text;
        while (text.size() < mib * 1024 * 1024)
            text += line;
        text += QStringLiteral("Last Line\n");
        qsizetype at = 0;
        const Samples end = measure(text, QStringLiteral("last line"), at);
        qsizetype none = 0;
        const Samples missing = measure(text, QStringLiteral("ms/cm  26"), none);
        std::printf("find: %lld MiB: match at end %.2f ms wall, %.2f ms CPU (position %lld); "
                    "not found %.2f ms wall, %.2f ms CPU\n",
                    static_cast<long long>(mib), end.wallMedian(), end.cpuMedian(),
                    static_cast<long long>(at), missing.wallMedian(), missing.cpuMedian());
        if (mib == 1)
            std::printf("RESULT find_1MiB_ms %.3f ms 10\n",
                        std::max(end.wallMedian(), missing.wallMedian()));
    }
    return 0;
}
