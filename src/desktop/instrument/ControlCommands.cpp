#include "desktop/instrument/ControlCommands.h"

#include "core/instrument/MeterControl.h"
#include "core/readings/ReplyWords.h"

#include "core/Prompts.h"
#include "core/instrument/ModelTable.h"
#include "core/link/SerialLine.h"
#include "desktop/instrument/InstrumentCommands.h"
#include "desktop/instrument/LogEraseCheckDialog.h"
#include "desktop/link/Connection.h"
#include "desktop/link/Exchange.h"
#include "desktop/shell/MainWindow.h"

#include <QAction>
#include <QLabel>
#include <QMenu>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QTimer>

namespace {
// The workspace control turns a CR into a line break; compare texts the way it shows them.
QString asShown(QString text) {
    return text.replace(u'\r', u'\n');
}
} // namespace

ControlCommands::ControlCommands(MainWindow& window)
    : QObject(&window), w_(window), s_(window.state()) {
    const MainControls& c = w_.controls();
    connect(c.cmdStartStirring, &QPushButton::clicked, this,
            &ControlCommands::cmdStartStirring_Click);
    connect(c.cmdStopStirring, &QPushButton::clicked, this,
            &ControlCommands::cmdStopStirring_Click);
    connect(c.cmdEnableLogging, &QPushButton::clicked, this,
            &ControlCommands::cmdEnableLogging_Click);
    connect(c.cmdDisableLogging, &QPushButton::clicked, this,
            &ControlCommands::cmdDisableLogging_Click);
    connect(c.cmdK5Off, &QPushButton::clicked, this, &ControlCommands::cmdK5Off_Click);
    connect(c.cmdK5On, &QPushButton::clicked, this, &ControlCommands::cmdK5On_Click);
    connect(c.cmdEraseLog, &QPushButton::clicked, this, &ControlCommands::cmdEraseLog_Click);
    connect(c.mnuEraseLog, &QAction::triggered, this, &ControlCommands::cmdEraseLog_Click);
    connect(c.mnuVoltage, &QAction::triggered, this, &ControlCommands::mnuVoltage_Click);
    connect(c.tmrDisplayVoltage, &QTimer::timeout, this, &ControlCommands::tmrDisplayVoltage_Timer);
}

bool ControlCommands::runCommand(const QString& command) {
    w_.StopVoltageDisplay();
    Exchange& exchange = w_.exchange();
    if (exchange.ExchangeCommand(command))
        return true;
    exchange.ShowCommError();
    return false;
}

void ControlCommands::cmdStartStirring_Click() {
    if (!runCommand(QStringLiteral("?M")))
        return;
    if (MeterControl::batteryTooLow(s_.responseText))
        w_.prompts().show(QStringLiteral("Meter  battery  is  low!"), Prompts::Icon::Critical,
                          Prompts::Buttons::Ok);
    if (MeterControl::stirrerStarted(s_.responseText))
        w_.setMessage(QStringLiteral("Stirrer  started."));
}

void ControlCommands::cmdStopStirring_Click() {
    if (runCommand(QStringLiteral("?N")) && MeterControl::stirrerStopped(s_.responseText))
        w_.setMessage(QStringLiteral("Stirrer  stopped."));
}

void ControlCommands::cmdEnableLogging_Click() {
    const QString command = modeltable::enableLoggingCommand(s_.modelCode, s_.percentFormat);
    if (runCommand(command) && MeterControl::loggingStarted(s_.responseText))
        w_.setMessage(QStringLiteral("Logging  enabled."));
}

void ControlCommands::cmdDisableLogging_Click() {
    if (runCommand(QStringLiteral("?F")) && MeterControl::loggingStopped(s_.responseText))
        w_.setMessage(QStringLiteral("Logging  disabled."));
}

void ControlCommands::cmdK5Off_Click() {
    w_.StopVoltageDisplay();
    // "Shutting" also gives the reply to "?K" the long reply window.
    w_.setMessage(QStringLiteral("Shutting  down  meter ..."));
    if (!MeterControl::powerOff(w_.exchange(), s_)) {
        w_.exchange().ShowCommError();
        return;
    }
    if (MeterControl::poweredOff(s_.responseText))
        enterShutdownState();
}

void ControlCommands::enterShutdownState() {
    const MainControls& c = w_.controls();
    for (QLabel* l : {c.lblModelData, c.lblVersionData, c.lblSerialData, c.lblNumLogData})
        l->clear();
    w_.setMessage(QStringLiteral("Meter  has  been  shut  down."));
    for (QPushButton* b : {c.cmdSaveFile, c.cmdCurrentData, c.cmdLoggedData, c.cmdGLPData,
                           c.cmdListen, c.cmdEnableLogging, c.cmdStartStirring, c.cmdK5Off,
                           c.cmdStopStirring, c.cmdDisableLogging, c.cmdEraseLog})
        b->setEnabled(false);
    c.mnuDisplay->setEnabled(false);
    c.mnuDetectMeter->setEnabled(true);
    c.mnuEraseLog->setVisible(false);
    c.mnuSave->setEnabled(false);
    try {
        s_.ioResult = w_.serial().close();
    } catch (const std::exception&) {
        // A port that has already gone is as closed as it gets.
    }
}

void ControlCommands::cmdK5On_Click() {
    // Voltage polls must not mix with the detection polls that follow.
    w_.controls().tmrDisplayVoltage->stop();
    w_.connection().ConnectMeter();
}

void ControlCommands::cmdEraseLog_Click() {
    w_.StopVoltageDisplay();
    w_.instrument().QueryStatus();
    if (s_.abortRequested) {
        w_.exchange().ShowCommError();
        return;
    }
    if (replywords::unusable(s_.responseText) || replywords::has(s_.replyText, "ERROR"))
        return;
    if (s_.numLogged == 0) {
        w_.prompts().show(QStringLiteral("No logged readings to erase!"),
                          Prompts::Icon::Information, Prompts::Buttons::Ok);
        return;
    }
    LogEraseCheckDialog dialog(&w_);
    connect(&dialog, &LogEraseCheckDialog::yesClicked, this,
            [this, &dialog] { eraseConfirmed(dialog); });
    dialog.exec();
}

void ControlCommands::eraseConfirmed(LogEraseCheckDialog& dialog) {
    Exchange& exchange = w_.exchange();
    if (!exchange.ExchangeCommand(QStringLiteral("?E"))) {
        // The link is reset by frmCommError; asking again would only fail again.
        dialog.reject();
        exchange.ShowCommError();
        return;
    }
    if (!MeterControl::logErased(s_.responseText))
        return;
    s_.numLogged = 0;
    w_.controls().lblNumLogData->setText(QStringLiteral("0"));
    dialog.accept();
    w_.prompts().show(QStringLiteral("Logged readings erased."), Prompts::Icon::None,
                      Prompts::Buttons::Ok);
}

void ControlCommands::mnuVoltage_Click() {
    const MainControls& c = w_.controls();
    w_.PromptSaveAndClear(QString());
    c.lblHeader->clear();
    w_.UncheckDisplayMenus();
    c.mnuVoltage->setChecked(true);
    w_.repaint();
    w_.exchange().FlushInput();
    // The first reading follows at once, the next ones every two seconds.
    c.tmrDisplayVoltage->setInterval(1);
    c.tmrDisplayVoltage->start();
}

void ControlCommands::tmrDisplayVoltage_Timer() {
    Exchange& exchange = w_.exchange();
    const MainControls& c = w_.controls();
    c.tmrDisplayVoltage->setInterval(2000);
    // A tick inside another exchange's prompt, or while frmCommError is open, waits its turn.
    if (exchange.inProgress())
        return;
    if (!exchange.ExchangeCommand(QStringLiteral("?V"))) {
        voltageLinkFailed();
        return;
    }
    if (!MeterControl::isUsable(s_.responseText)) {
        c.tmrDisplayVoltage->stop();
        return;
    }
    s_.workspaceText = MeterControl::voltageLine(s_.responseText);
    // An unchanged voltage leaves the workspace alone, so it does not flicker every 2 s.
    if (c.RichTextBox1->toPlainText() != asShown(s_.workspaceText))
        c.RichTextBox1->setPlainText(s_.workspaceText);
}

void ControlCommands::voltageLinkFailed() {
    // frmCommError resets the link whatever the user chooses; polling a closed or reconnecting
    // line would only raise the dialog again every two seconds.
    w_.controls().tmrDisplayVoltage->stop();
    w_.exchange().ShowCommError();
}
