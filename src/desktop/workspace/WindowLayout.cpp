#include "desktop/workspace/WindowLayout.h"

#include "desktop/shell/MainWindow.h"
#include "desktop/shell/Twips.h"

#include <QFontMetrics>
#include <QFrame>
#include <QLabel>
#include <QPlainTextEdit>
#include <QProgressBar>

namespace {
constexpr int kHeaderToWorkspace = 210; // twips from the header's top to the workspace's top
} // namespace

int WindowLayout::fitHeader(const MainControls& c) {
    QLabel* header = c.lblHeader;
    const QFontMetrics metrics(header->font());
    const int lineHeight = qMax(metrics.height(), metrics.lineSpacing());
    header->setAlignment(Qt::AlignLeft | Qt::AlignTop);
    header->resize(header->width(), lineHeight);
    return qMax(0, lineHeight - twipsToPixels(kHeaderToWorkspace));
}

void WindowLayout::placeBelowHeader(const MainControls& c) {
    const int room = fitHeader(c);
    const QRect r = c.RichTextBox1->geometry();
    c.RichTextBox1->setGeometry(r.x(), r.y() + room, r.width(), qMax(0, r.height() - room));
}

void WindowLayout::apply() {
    if (w_.isMinimized())
        return;
    const QRect frame = w_.frameGeometry();
    int width = pixelsToTwips(frame.width());
    int height = pixelsToTwips(frame.height());
    if (!w_.isMaximized() && !w_.isFullScreen() && (width < kMinWidth || height < kMinHeight)) {
        width = qMax(width, kMinWidth);
        height = qMax(height, kMinHeight);
        // The frame itself (title bar, borders) is not part of resize()'s size.
        const int frameW = frame.width() - w_.width();
        const int frameH = frame.height() - w_.height();
        w_.resize(twipsToPixels(width) - frameW, twipsToPixels(height) - frameH);
    }

    const MainControls& c = w_.controls();
    const AppState& s = w_.state();
    // A second row of buttons (K5 power, or a percent meter's stirrer and logging buttons) sits
    // above the workspace and takes the same room as the status display gave it.
    const bool secondRow = s.isK5Family || (s.percentFormat && (s.canStir || s.canAutoLog));
    int workspaceHeight = height - (secondRow ? 3530 : 2510);
    if (s.percentFormat)
        workspaceHeight -= 340;
    const int headerRoom = s.percentFormat ? fitHeader(c) : 0;
    c.RichTextBox1->resize(qMax(0, twipsToPixels(width - 60)),
                           qMax(0, twipsToPixels(workspaceHeight) - headerRoom));

    const std::initializer_list<QWidget*> statusLabels{
        c.lblModel,  c.lblVersion, c.lblModelData,  c.lblVersionData,
        c.lblSerial, c.lblNumLog,  c.lblSerialData, c.lblNumLogData};
    for (QWidget* label : statusLabels)
        MainWindow::setTopTwips(label, height - 1050);
    MainWindow::setTopTwips(c.lblMessage, height - 1360);
    MainWindow::setTopTwips(c.ProgressBar1, height - 1360);

    // A horizontal line at the status area's top edge, running to the right edge.
    QFrame* line = c.Line1;
    line->setGeometry(line->x(), twipsToPixels(height - 1050) - line->height() / 2,
                      qMax(1, twipsToPixels(width) - line->x()), line->height());
    MainWindow::setLeftTwips(c.picKVOLogo, width - 1150);
}
