#include "desktop/readings/RealTimeRun.h"

#include "core/readings/RealTimeReading.h"

#include "core/Prompts.h"
#include "core/link/SerialLine.h"
#include "core/readings/LineLayout.h"
#include "core/readings/ReadingSchedule.h"
#include "core/readings/RealTimeLine.h"
#include "core/settings/Clock.h"
#include "desktop/instrument/InstrumentCommands.h"
#include "desktop/link/Exchange.h"
#include "desktop/readings/ReadingCommands.h"
#include "desktop/readings/RealTimeIntervalDialog.h"
#include "desktop/readings/WorkspaceLines.h"
#include "desktop/shell/MainWindow.h"
#include "desktop/workspace/WorkspaceCommands.h"

#include <QAction>
#include <QCoreApplication>
#include <QLabel>
#include <QMenu>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QTimer>

namespace {
constexpr int kStopLeft = 3390; // the place of cmdCurrentData
} // namespace

RealTimeRun::RealTimeRun(MainWindow& window, ReadingCommands& owner)
    : w_(window), s_(window.state()), owner_(owner) {}

double RealTimeRun::runClock() const {
    return w_.clock().nowSeconds();
}

QString RealTimeRun::countdownText(double seconds) {
    return QStringLiteral("Next  reading  will  occur  in  ") + QString::number(seconds) +
           QStringLiteral("  second(s)");
}

void RealTimeRun::cmdCurrentData_Click() {
    w_.StopVoltageDisplay();
    w_.PromptSaveAndClear(QStringLiteral("RealTime"));
    int seconds = 0;
    {
        RealTimeIntervalDialog dialog(w_);
        if (dialog.exec() != QDialog::Accepted)
            return;
        seconds = dialog.seconds();
    }
    s_.runActive = true;
    s_.logInterval = seconds;
    QCoreApplication::processEvents();
    StartRealTimeRun();
}

void RealTimeRun::StartRealTimeRun() {
    do {
        restartRequested_ = false;
        if (!beginRun())
            return;
        GetCurrentDataReading();
    } while (restartRequested_ && s_.runActive);
}

bool RealTimeRun::beginRun() {
    const MainControls& c = w_.controls();
    // The view always mirrors workspaceText, so a continued table goes on from workspaceText.
    const bool continueTable = c.mnuRealTime->isChecked() && !c.RichTextBox1->document()->isEmpty();
    if (!continueTable) {
        s_.workspaceText.clear();
        c.RichTextBox1->clear();
        s_.readingNumber = 0;
    }
    w_.instrument().QueryStatus();
    if (s_.abortRequested) {
        s_.runActive = false;
        w_.EnableCommandsAfterRun();
        w_.exchange().ShowCommError();
        return false;
    }
    c.cmdCurrentData->hide();
    MainWindow::setLeftTwips(c.cmdStopCurrentData, kStopLeft);
    w_.DisableCommandsForRun();
    s_.workspaceSaved = false;
    if (s_.logInterval < 3)
        w_.setMessage(QStringLiteral("Data logging in progress ..."));
    w_.UncheckDisplayMenus();
    c.mnuRealTime->setChecked(true);
    c.lblHeader->setText(s_.headerText);
    s_.lineCount = 0;
    s_.runStartTime = runClock();
    return true;
}

void RealTimeRun::GetCurrentDataReading() {
    const MainControls& c = w_.controls();
    Exchange& exchange = w_.exchange();
    if (s_.logInterval >= 3)
        w_.setMessage(countdownText(s_.logInterval));
    switch (RealTimeReading::request(exchange, s_)) {
    case RealTimeReading::Outcome::LinkFailed:
        c.tmrDisplayInterval->stop();
        exchange.ShowCommError();
        return;
    case RealTimeReading::Outcome::MeterError:
        owner_.cmdStopCurrentData_Click();
        return;
    case RealTimeReading::Outcome::Reading:
        acceptReading();
        return;
    case RealTimeReading::Outcome::Restart:
        c.tmrRealTime->stop();
        c.tmrDisplayInterval->stop();
        restartRequested_ = true;
        return;
    case RealTimeReading::Outcome::MeterLost:
        RealTimeMeterLost();
        return;
    }
}

void RealTimeRun::acceptReading() {
    const MainControls& c = w_.controls();
    RealTimeLine::Context context;
    context.layout = LineLayout::fromState(s_);
    context.logColumnKnown = owner_.logColumnKnown();
    context.logColumnStart = s_.logColumnStart;
    context.logColumnWidth = s_.logColumnWidth;
    context.now = w_.clock().wallNow();
    const int number = s_.readingNumber + 1;
    const auto line = RealTimeLine::build(s_.responseText, number, context);
    if (!line) {
        cannotKeepUp();
        return;
    }
    ++s_.lineCount;
    s_.readingNumber = number;
    s_.dataLine = *line;
    WorkspaceLines::append(s_, c.RichTextBox1, *line + QLatin1Char('\n'));

    // At the limit nothing is scheduled: no reading may start while the message is up.
    if (s_.lineCount >= kLineLimit) {
        c.tmrDisplayInterval->stop();
        w_.setMessage(QString());
        w_.prompts().show(QStringLiteral("Log has reached 10,000 line maximum!"),
                          Prompts::Icon::Exclamation, Prompts::Buttons::Ok, true);
        owner_.cmdStopCurrentData_Click();
        return;
    }
    if (s_.logInterval >= 3)
        ShowCountdown();
    if (!ScheduleNextReading())
        cannotKeepUp();
}

bool RealTimeRun::ScheduleNextReading() {
    const MainControls& c = w_.controls();
    const double due = ReadingSchedule::dueTime(s_.runStartTime, s_.lineCount, s_.logInterval);
    const ReadingSchedule::Next next = ReadingSchedule::next(due, runClock());
    switch (next.kind) {
    case ReadingSchedule::Next::Kind::Overdue:
        return false;
    case ReadingSchedule::Next::Kind::Now:
        // Due this very moment: a zero-length timer takes it as soon as control returns to
        // the event loop, without nesting one reading inside another.
        c.tmrRealTime->start(0);
        return true;
    case ReadingSchedule::Next::Kind::Short:
        c.tmrRealTime->start(next.ms);
        return true;
    case ReadingSchedule::Next::Kind::Long:
        c.tmrLong->start(ReadingSchedule::kLongWaitMs);
        return true;
    }
    return false;
}

void RealTimeRun::ShowCountdown() {
    const double due = ReadingSchedule::dueTime(s_.runStartTime, s_.lineCount, s_.logInterval);
    const ReadingSchedule::Countdown countdown = ReadingSchedule::countdown(due, runClock());
    w_.setMessage(countdownText(countdown.secs));
    if (countdown.tick)
        w_.controls().tmrDisplayInterval->start(countdown.tickMs);
}

void RealTimeRun::cannotKeepUp() {
    w_.controls().tmrDisplayInterval->stop();
    w_.exchange().ShowCpuOverUse();
    owner_.cmdStopCurrentData_Click();
}

void RealTimeRun::RealTimeMeterLost() {
    const MainControls& c = w_.controls();
    c.tmrRealTime->stop();
    c.tmrDisplayInterval->stop();
    try {
        w_.serial().close();
    } catch (const std::exception&) {
        // A port that has gone is closed already.
    }
    // The run is over; the workspace rules must see it so.
    s_.runActive = false;
    s_.modelCode.clear();
    s_.firmwareVersion.clear();
    s_.serialNumber.clear();
    s_.numLogged = 0;
    for (QLabel* l : {c.lblModelData, c.lblVersionData, c.lblSerialData, c.lblNumLogData})
        l->clear();
    c.lblHeader->hide();
    w_.setMessage(QString());

    for (QPushButton* b : {c.cmdHelp, c.cmdOpenFile, c.cmdSaveFile})
        b->setEnabled(true);
    for (QMenu* m : {c.mnuFile, c.mnuDisplay, c.mnuSetup, c.mnuHelp})
        m->setEnabled(true);
    c.mnuSave->setEnabled(true);
    c.mnuDetectMeter->setEnabled(true);
    c.cmdCurrentData->show();
    c.cmdCurrentData->setEnabled(false);
    c.cmdStopCurrentData->hide();
    for (QPushButton* b :
         {c.cmdLoggedData, c.cmdGLPData, c.cmdEnableLogging, c.cmdDisableLogging,
          c.cmdStartStirring, c.cmdStopStirring, c.cmdK5On, c.cmdK5Off, c.cmdEraseLog, c.cmdPrint})
        b->setEnabled(false);
    w_.workspace().ApplyDataConversions();
}

void RealTimeRun::tmrRealTime_Timer() {
    w_.controls().tmrRealTime->stop();
    // A tick that finds another exchange (or a link dialog) running waits for the next chance.
    if (w_.exchange().inProgress()) {
        w_.controls().tmrRealTime->start(50);
        return;
    }
    GetCurrentDataReading();
    if (restartRequested_ && s_.runActive)
        StartRealTimeRun();
}

void RealTimeRun::tmrLong_Timer() {
    w_.controls().tmrLong->stop();
    if (!ScheduleNextReading())
        cannotKeepUp();
}

void RealTimeRun::tmrDisplayInterval_Timer() {
    w_.controls().tmrDisplayInterval->stop();
    ShowCountdown();
}
