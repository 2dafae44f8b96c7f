#include "desktop/readings/ListenMode.h"

#include "core/link/SerialLine.h"
#include "desktop/link/Exchange.h"
#include "desktop/readings/WorkspaceLines.h"
#include "desktop/shell/MainWindow.h"
#include "desktop/workspace/WorkspaceCommands.h"

#include <QAction>
#include <QLabel>
#include <QPlainTextEdit>
#include <QPushButton>

namespace {
constexpr int kStopLeftWhileListening = 2550; // the place of cmdListen
constexpr int kStopLeft = 3390;
} // namespace

ListenMode::ListenMode(MainWindow& window) : w_(window), s_(window.state()) {}

void ListenMode::ListenForData() {
    const MainControls& c = w_.controls();
    w_.StopVoltageDisplay();
    w_.PromptSaveAndClear(QStringLiteral("Listen"));
    const bool continueListening = c.mnuListen->isChecked();
    w_.UncheckDisplayMenus();
    MainWindow::setLeftTwips(c.cmdStopCurrentData, kStopLeftWhileListening);
    w_.DisableCommandsForRun();
    c.cmdListen->hide();
    if (!continueListening) {
        c.RichTextBox1->clear();
        s_.workspaceText.clear();
    }
    c.mnuListen->setChecked(true);
    w_.setMessage(QStringLiteral("Listening  for  data  on  ") + s_.portName +
                  QStringLiteral("  at  ") + QString::number(s_.baudRate) +
                  QStringLiteral("  baud ..."));
    s_.runActive = true;
    s_.workspaceSaved = false;

    if (w_.exchange().FlushInput() == Exchange::Drain::KeptSending) {
        // A meter that is already printing never lets the line go quiet, and its lines are what
        // listening is for: the drain's abort is no link failure.
        s_.abortRequested = false;
        s_.flushing = false;
    } else if (s_.abortRequested) {
        fail();
        return;
    }
    reader_.clear();
    listening_ = true;
    SerialLine& port = w_.serial();
    bytesConnection_ = connect(&port, &SerialLine::bytesArrived, this, &ListenMode::onBytesArrived);
    failConnection_ = connect(&port, &SerialLine::failed, this, &ListenMode::onPortFailed);
    // Bytes that came between the drain and the connection are taken now.
    onBytesArrived();
}

void ListenMode::onBytesArrived() {
    // Reading the port can emit bytesArrived again from inside the read; the outer loop
    // takes those bytes.
    if (!listening_ || reading_)
        return;
    reading_ = true;
    // The lines completed by the bytes waiting now go into the workspace together: one change
    // of the view per batch instead of one per line when a meter prints fast.
    QString batch;
    bool failed = false;
    try {
        SerialLine& port = w_.serial();
        int taken = 0;
        while (listening_) {
            // A meter that never pauses must not keep the window from its events (and the
            // user from Stop): after a good portion the rest is taken on the next turn.
            if (++taken > kBytesPerTurn) {
                QMetaObject::invokeMethod(this, &ListenMode::onBytesArrived, Qt::QueuedConnection);
                break;
            }
            const int c = port.readByte();
            if (c > 0) {
                if (const auto line = reader_.take(c))
                    batch += *line;
                s_.dataLine = reader_.lastLine();
                continue;
            }
            // A NUL byte also reads as 0: go on while bytes are waiting.
            if (!port.waitForByte(0))
                break;
        }
    } catch (const std::exception&) {
        failed = true;
    }
    reading_ = false;
    if (!batch.isEmpty())
        WorkspaceLines::append(s_, w_.controls().RichTextBox1, batch);
    if (failed && listening_)
        fail();
}

void ListenMode::stopListening() {
    if (!listening_)
        return;
    listening_ = false;
    disconnect(bytesConnection_);
    disconnect(failConnection_);
    reader_.clear();
}

void ListenMode::afterStop() {
    const MainControls& c = w_.controls();
    if (c.RichTextBox1->document()->isEmpty())
        c.mnuListen->setChecked(false);
    w_.setMessage(QString());
}

void ListenMode::onPortFailed() {
    if (listening_)
        fail();
}

void ListenMode::fail() {
    const MainControls& c = w_.controls();
    stopListening();
    s_.runActive = false;
    c.mnuListen->setChecked(false);
    // What arrived stays in the workspace; the commands come back before the link dialog
    // resets the window, so Listen is shown again.
    MainWindow::setLeftTwips(c.cmdStopCurrentData, kStopLeft);
    w_.EnableCommandsAfterRun();
    w_.workspace().ApplyDataConversions();
    w_.exchange().ShowCommError();
}
