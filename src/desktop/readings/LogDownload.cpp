#include "desktop/readings/LogDownload.h"

#include "core/Prompts.h"
#include "core/readings/LineLayout.h"
#include "core/readings/LogLineFormat.h"
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
    const End end = LineLayout::fromState(s_).qr32 ? qr32Protocol() : generalProtocol();
    switch (end) {
    case End::Complete:
        if (!s_.stopRequested)
            finish();
        break;
    case End::Stopped:
    case End::ReplyFailed:
        break;
    case End::LinkFailed:
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

void LogDownload::showProgress(long long count) {
    const int p = ReadingSchedule::twentieths(count, s_.numLogged);
    if (p <= 20 && p != lastProgress_) {
        QProgressBar* bar = w_.controls().ProgressBar1;
        bar->setValue(p);
        bar->repaint();
        lastProgress_ = p;
    }
}

bool LogDownload::sendRequest(const QString& command) {
    Exchange& exchange = w_.exchange();
    exchange.FlushInput();
    if (s_.abortRequested)
        return false;
    s_.commandText = command;
    exchange.SerialWrite(s_.commandText);
    return !s_.abortRequested;
}

std::optional<LogDownload::End> LogDownload::readRecord(long long progressCount) {
    showProgress(progressCount);
    w_.exchange().SendCommand();
    if (s_.abortRequested)
        return End::LinkFailed;
    if (replywords::unusable(s_.responseText))
        return End::ReplyFailed;
    s_.dataLine = s_.responseText;
    return std::nullopt;
}

LogDownload::End LogDownload::generalProtocol() {
    Exchange& exchange = w_.exchange();
    Exchange::Scope busy(exchange);
    const LineLayout layout = LineLayout::fromState(s_);
    if (!sendRequest(QStringLiteral("?L\r")))
        return End::LinkFailed;

    long long count = 0;
    lastProgress_ = 0;
    for (;;) {
        if (const auto failed = readRecord(count))
            return *failed;
        // Every record is acknowledged, the "ENDS" line too.
        exchange.SerialWrite(QStringLiteral("A"));
        if (s_.abortRequested)
            return End::LinkFailed;
        if (replywords::has(s_.dataLine, "ENDS"))
            return End::Complete;
        const auto line = LogLineFormat::reformat(s_.dataLine, layout);
        if (!line)
            return End::LinkFailed;
        s_.dataLine = *line;
        s_.workspaceText += *line;
        s_.workspaceText += QLatin1Char('\n');
        ++count;
        // The window stays responsive (and Stop usable) between records.
        QCoreApplication::processEvents();
        if (s_.stopRequested)
            return End::Stopped;
    }
}

LogDownload::End LogDownload::qr32Protocol() {
    Exchange& exchange = w_.exchange();
    Exchange::Scope busy(exchange);
    if (!sendRequest(QStringLiteral("?R\r")))
        return End::LinkFailed;

    // Exactly numLogged records, no acknowledgement and no end marker.
    const long long total = s_.numLogged;
    lastProgress_ = 0;
    for (long long i = 1; i <= total; ++i) {
        if (const auto failed = readRecord(i))
            return *failed;
        const auto line = LogLineFormat::qr32Record(s_.dataLine);
        if (!line)
            return End::LinkFailed;
        s_.dataLine = *line;
        s_.workspaceText += *line;
    }
    return End::Complete;
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
