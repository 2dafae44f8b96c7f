// The cost of adding real-time reading 10,000 to the workspace (one line appended to the text
// and the view of the real main window, whose change rules run as in a run), and the peak
// memory of a 10,000-line table.
#include "ReadingsBench.h"

#include "core/readings/LineLayout.h"
#include "core/readings/RealTimeLine.h"
#include "desktop/readings/WorkspaceLines.h"

#include <QAction>
#include <QApplication>
#include <QPlainTextEdit>
#include <algorithm>

using namespace readingsbench;

int main(int argc, char** argv) {
    QApplication app(argc, argv);
    BenchWindow b;
    if (!b.start(QStringLiteral("plain")))
        return 2;
    MainWindow& w = *b.window;
    AppState& s = w.state();
    const MainControls& c = w.controls();
    c.RichTextBox1->clear();
    s.workspaceText.clear();
    w.UncheckDisplayMenus();
    c.mnuRealTime->setChecked(true);
    s.runActive = true;
    w.show();

    RealTimeLine::Context context;
    context.layout = LineLayout::fromState(s);
    const QList<QByteArray> replies = metersim::Meter::generateLog(b.meter->profile(), 100);
    QList<double> costMs;
    costMs.reserve(10000);
    QElapsedTimer t;
    for (int n = 1; n <= 10000; ++n) {
        const QString reply = QString::fromLatin1(replies[n % replies.size()]);
        context.now = b.clock.wallNow();
        t.start();
        const auto line = RealTimeLine::build(reply, n, context);
        WorkspaceLines::append(s, c.RichTextBox1, *line + QLatin1Char('\n'));
        costMs << t.nsecsElapsed() / 1e6;
        // As between readings: the window paints.
        QCoreApplication::processEvents();
    }
    QList<double> last100 = costMs.mid(9900);
    std::sort(last100.begin(), last100.end());
    std::printf("real-time append: reading 10,000 took %.3f ms (readings 9,901-10,000: median "
                "%.3f ms, max %.3f ms; first reading %.3f ms) (target < 2 ms); %d lines, "
                "peak memory %.1f MB (target < 100 MB)\n",
                costMs.constLast(), last100[50], last100.constLast(), costMs.constFirst(),
                int(s.workspaceText.count(QLatin1Char('\n'))), peakMegabytes());
    std::printf("RESULT realtime_append_10000th_ms %.3f ms 2\n", costMs.constLast());
    std::printf("RESULT realtime_10000_lines_peak_mb %.1f MB 100\n", peakMegabytes());
    return costMs.constLast() < 2.0 ? 0 : 1;
}
