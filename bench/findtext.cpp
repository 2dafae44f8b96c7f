// One Find press over 1 MiB and 2 MiB of workspace text: the match at the very end (the whole
// text searched) and a text that is not there (searched and wrapped). Target: 1 MiB < 10 ms.
#include "workspace/FindText.h"

#include <QElapsedTimer>
#include <algorithm>
#include <cstdio>
#include <vector>

static double medianMs(const QString& text, const QString& search, qsizetype& found) {
    std::vector<double> ms;
    for (int run = 0; run < 21; ++run) {
        QElapsedTimer t;
        t.start();
        found = FindText::find(text, search, 2);
        ms.push_back(t.nsecsElapsed() / 1e6);
    }
    std::sort(ms.begin(), ms.end());
    return ms[ms.size() / 2];
}

int main() {
    const QString line = QStringLiteral("01/02/2024 10:11:12     17  1.413 mS/cm  25.0 C\n");
    for (qsizetype mib : {1, 2}) {
        QString text;
        while (text.size() < mib * 1024 * 1024)
            text += line;
        text += QStringLiteral("Last Line\n");
        qsizetype at = 0;
        const double end = medianMs(text, QStringLiteral("last line"), at);
        qsizetype none = 0;
        const double missing = medianMs(text, QStringLiteral("ms/cm  26"), none);
        std::printf("find: %lld MiB: match at end %.2f ms (position %lld), not found %.2f ms\n",
                    static_cast<long long>(mib), end, static_cast<long long>(at), missing);
    }
    return 0;
}
