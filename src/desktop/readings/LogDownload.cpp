#include "desktop/readings/LogDownload.h"

#include "core/Prompts.h"
#include "core/readings/ReadingSchedule.h"
#include "core/readings/ReplyWords.h"
#include "desktop/instrument/InstrumentCommands.h"
#include "desktop/link/Exchange.h"
#include "desktop/shell/MainWindow.h"
#include "desktop/workspace/WorkspaceCommands.h"

#include <QAction>
#include <QCoreApplication>
#include <QLabel>
#include <QPlainTextEdit>
#include <QProgressBar>
#include <QPushButton>

namespace {
constexpr int kStopLeftDuringDownload = 4230; // the place of cmdLoggedData
constexpr int kStopLeft = 3390;
} // namespace

LogDownload::LogDownload(MainWindow& window) : w_(window), s_(window.state()) {}

void LogDownload::DownloadLog() {
    w_.StopVoltageDisplay();
    w_.PromptSaveAndClear(QString());
    w_.instrument().QueryStatus();
    if (s_.abortRequested) {
        w_.exchange().ShowCommError();
        return;
    }
    if (s_.responseText.isEmpty() || replywords::hasAny(s_.replyText, {"BUSY", "EXIT", "ERROR"}))
        return;
    if (s_.numLogged == 0) {
        w_.prompts().show(QStringLiteral("No logged readings to display !"),
                          Prompts::Icon::Exclamation, Prompts::Buttons::Ok);
        return;
    }

    enterDownloadState();
    s_.stopRequested = false;
    lastProgress_ = 0;
    switch (LogTransfer(w_.exchange(), s_, *this).run()) {
    case LogTransfer::End::Complete:
        if (!s_.stopRequested)
            finish();
        break;
    case LogTransfer::End::Stopped:     // Stop has restored the window already
    case LogTransfer::End::ReplyFailed: // the window waits for Stop
        break;
    case LogTransfer::End::LinkFailed:
        failLink();
        break;
    }
}

void LogDownload::enterDownloadState() {
    const MainControls& c = w_.controls();
    w_.UncheckDisplayMenus();
    MainWindow::setLeftTwips(c.cmdStopCurrentData, kStopLeftDuringDownload);
    c.cmdLoggedData->hide();
    w_.setMessage(QStringLiteral("Retrieving  logged  data ..."));
    c.mnuLog->setChecked(true);
    c.ProgressBar1->setValue(0);
    c.ProgressBar1->show();
    c.RichTextBox1->clear();
    w_.DisableCommandsForRun();
    s_.workspaceText.clear();
}

void LogDownload::progress(long long count) {
    const int p = ReadingSchedule::twentieths(count, s_.numLogged);
    if (p <= 20 && p != lastProgress_) {
        QProgressBar* bar = w_.controls().ProgressBar1;
        bar->setValue(p);
        bar->repaint();
        lastProgress_ = p;
    }
}

bool LogDownload::stopRequested() {
    QCoreApplication::processEvents();
    return s_.stopRequested;
}

void LogDownload::finish() {
    const MainControls& c = w_.controls();
    c.ProgressBar1->hide();
    w_.setMessage(QString());
    c.lblHeader->setText(s_.headerText);
    w_.EnableCommandsAfterRun();
    w_.workspace().ApplyDataConversions();
}

void LogDownload::failLink() {
    // The records that did arrive are kept and shown (converted, as Stop shows a partial
    // table) before the link dialog resets the window.
    MainWindow::setLeftTwips(w_.controls().cmdStopCurrentData, kStopLeft);
    w_.EnableCommandsAfterRun();
    w_.workspace().ApplyDataConversions();
    w_.exchange().ShowCommError();
}
