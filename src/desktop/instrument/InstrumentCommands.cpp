#include "desktop/instrument/InstrumentCommands.h"

#include "core/Prompts.h"
#include "core/instrument/ModelTable.h"
#include "core/instrument/StatusQuery.h"
#include "core/instrument/StatusReply.h"
#include "desktop/instrument/ControlCommands.h"
#include "desktop/link/Exchange.h"
#include "desktop/readings/ReadingCommands.h"
#include "desktop/shell/MainWindow.h"
#include "desktop/shell/Twips.h"
#include "desktop/workspace/WindowLayout.h"

#include <QAction>
#include <QLabel>
#include <QMenu>
#include <QPlainTextEdit>
#include <QPushButton>

namespace {
const QString kDetectedPrefix = QStringLiteral("Device  detected");

void showAndEnable(QWidget* w, bool on) {
    w->setEnabled(on);
    w->setVisible(on);
}

void showAndEnable(QAction* a, bool on) {
    a->setEnabled(on);
    a->setVisible(on);
}
} // namespace

InstrumentCommands::InstrumentCommands(MainWindow& window)
    : QObject(&window), w_(window), s_(window.state()),
      control_(std::make_unique<ControlCommands>(window)) {}

InstrumentCommands::~InstrumentCommands() = default;

void InstrumentCommands::QueryStatus() {
    Exchange& exchange = w_.exchange();
    // Timer ticks must not start an exchange between the queries of one status display.
    Exchange::Scope busy(exchange);
    const auto queried = StatusQuery::query(exchange, s_);
    if (!queried) {
        s_.abortRequested = true;
        return;
    }
    const StatusReply& reply = *queried;
    const MainControls& c = w_.controls();
    switch (reply.format) {
    case StatusReply::Format::Unusable:
        return;
    case StatusReply::Format::Error:
        ResetStatusDisplay();
        return;
    case StatusReply::Format::Percent:
        s_.percentFormat = true;
        c.lblHeader->show();
        DisplayPercentStatus(reply);
        return;
    case StatusReply::Format::K5:
        s_.percentFormat = false;
        c.lblHeader->hide();
        s_.isK5Family = true;
        DisplayK5Status(reply);
        return;
    case StatusReply::Format::Plain:
        s_.percentFormat = false;
        c.lblHeader->hide();
        s_.isK5Family = false;
        DisplayPlainStatus(reply);
        return;
    }
}

void InstrumentCommands::DisplayPlainStatus(const StatusReply& reply) {
    const MainControls& c = w_.controls();
    MainWindow::setTopTwips(c.lblHeader, 1210);
    placeWorkspace(1080, 2510);
    if (reply.modelCode)
        s_.modelCode = *reply.modelCode;
    if (reply.needsVersionQuery) {
        if (reply.numLogged)
            s_.numLogged = *reply.numLogged;
        s_.hasLog = true;
    }
    if (reply.firmwareVersion)
        s_.firmwareVersion = *reply.firmwareVersion;
    if (reply.serialNumber)
        s_.serialNumber = *reply.serialNumber;
    c.lblModelData->setText(s_.modelCode);
    c.lblVersionData->setText(s_.firmwareVersion);
    c.lblSerialData->setText(s_.serialNumber);
    restoreIdentityCaptions();
    w_.setMessage(QString());

    s_.hasLog = reply.hasLog;
    s_.hasGLP = reply.hasGLP;
    if (s_.hasLog && !reply.needsVersionQuery) {
        if (reply.replyTail)
            s_.replyTail = *reply.replyTail;
        if (reply.numLogged)
            s_.numLogged = *reply.numLogged;
    }
    s_.capabilityText.clear();
    c.mnuVoltage->setVisible(false);
    runCapabilityRoutines(false);
    c.mnuDisplay->setEnabled(true);
    c.cmdListen->setEnabled(true);
    c.cmdCurrentData->setEnabled(true);
    w_.repaint();
}

void InstrumentCommands::DisplayK5Status(const StatusReply& reply) {
    const MainControls& c = w_.controls();
    takeIdentity(reply);
    if (modeltable::k5ReportsSerial(s_.modelCode)) {
        c.lblSerialData->setText(s_.serialNumber);
        c.lblSerial->show();
    } else {
        c.lblSerialData->clear();
        c.lblSerial->hide();
    }
    c.lblModelData->setText(s_.modelCode);
    c.lblVersionData->clear();
    c.lblVersion->clear();
    c.lblNumLogData->setText(QString::number(s_.numLogged));

    MainWindow::setTopTwips(c.lblHeader, 2230);
    s_.hasGLP = reply.hasGLP;
    s_.hasLog = true;
    s_.capabilityText = reply.capabilityText;
    c.mnuVoltage->setVisible(false);
    runCapabilityRoutines(true);
    placeWorkspace(2100, 3530);
    finishDisplay();
    warnIfBatteryLow();
}

void InstrumentCommands::DisplayPercentStatus(const StatusReply& reply) {
    const MainControls& c = w_.controls();
    s_.hasLog = reply.hasLog;
    s_.hasGLP = reply.hasGLP;
    s_.isK5Family = reply.isK5Family;
    takeIdentity(reply);
    c.lblModelData->setText(s_.modelCode);
    c.lblVersionData->setText(s_.firmwareVersion);
    c.lblSerialData->setText(s_.serialNumber);
    restoreIdentityCaptions();
    s_.capabilityText = reply.capabilityText;

    w_.readings().GetHeaderAndPosition();

    runCapabilityRoutines(true);
    if (s_.isK5Family || s_.canStir || s_.canAutoLog) {
        MainWindow::setTopTwips(c.lblHeader, 2230);
        placeWorkspace(2440, 3530 + 340);
    } else {
        MainWindow::setTopTwips(c.lblHeader, 1210);
        placeWorkspace(1420, 2510 + 340);
    }
    WindowLayout::placeBelowHeader(c);
    c.mnuVoltage->setVisible(reply.reportsVoltage());
    finishDisplay();
    warnIfBatteryLow();
}

void InstrumentCommands::ResetStatusDisplay() {
    const MainControls& c = w_.controls();
    c.cmdOpenFile->setEnabled(true);
    c.cmdSaveFile->setEnabled(true);
    for (QPushButton* b : {c.cmdLoggedData, c.cmdGLPData, c.cmdEraseLog})
        b->setEnabled(false);
    for (QLabel* l : {c.lblModelData, c.lblVersionData, c.lblSerialData, c.lblNumLogData})
        l->clear();
    c.mnuDisplay->setEnabled(false);
    c.mnuEdit->setEnabled(true);
    for (QPushButton* b : {c.cmdMaxMin, c.cmdK5Off, c.cmdK5On, c.cmdEnableLogging,
                           c.cmdDisableLogging, c.cmdStartStirring, c.cmdStopStirring})
        b->hide();
    c.mnuMaxMin->setVisible(false);
    c.mnuVoltage->setVisible(false);
    MainWindow::setLeftTwips(c.cmdHelp, 7590);
    MainWindow::setTopTwips(c.lblHeader, 1210);
}

void InstrumentCommands::ShowLoggingButtons() {
    const MainControls& c = w_.controls();
    s_.canAutoLog = s_.capabilityText.contains(u'+');
    showAndEnable(c.cmdEnableLogging, s_.canAutoLog);
    showAndEnable(c.cmdDisableLogging, s_.canAutoLog);
}

void InstrumentCommands::ShowStirringButtons() {
    const MainControls& c = w_.controls();
    s_.canStir = s_.capabilityText.contains(u'm', Qt::CaseInsensitive);
    showAndEnable(c.cmdStartStirring, s_.canStir);
    showAndEnable(c.cmdStopStirring, s_.canStir);
}

void InstrumentCommands::ShowPowerButtons() {
    const MainControls& c = w_.controls();
    showAndEnable(c.cmdK5Off, s_.isK5Family);
    showAndEnable(c.cmdK5On, s_.isK5Family);
}

void InstrumentCommands::ShowGLPCommands() {
    const MainControls& c = w_.controls();
    showAndEnable(c.cmdGLPData, s_.hasGLP);
    showAndEnable(c.mnuGLP, s_.hasGLP);
}

void InstrumentCommands::ShowLogCommands() {
    const MainControls& c = w_.controls();
    c.lblNumLogData->setText(s_.hasLog ? QString::number(s_.numLogged) : QString());
    c.lblNumLog->setVisible(s_.hasLog);
    c.mnuLog->setVisible(s_.hasLog);
    c.cmdLoggedData->setVisible(s_.hasLog);
    c.cmdEraseLog->setVisible(s_.hasLog);
    c.mnuEraseLog->setVisible(s_.hasLog);
    c.cmdEraseLog->setEnabled(true);
    c.mnuEraseLog->setEnabled(true);
    c.cmdLoggedData->setEnabled(true);
}

void InstrumentCommands::ShowMaxMinCommands() {
    const MainControls& c = w_.controls();
    s_.hasMaxMin = modeltable::keepsMaxMin(s_.modelCode);
    if (s_.hasMaxMin)
        s_.modelCode = modeltable::maxMinCode();
    showAndEnable(c.cmdMaxMin, s_.hasMaxMin);
    showAndEnable(c.mnuMaxMin, s_.hasMaxMin);
}

void InstrumentCommands::PlaceHelpButton() {
    const MainControls& c = w_.controls();
    int left = 7590;
    if (!s_.hasMaxMin && !s_.hasGLP)
        left = s_.hasLog ? 6750 : 5070;
    MainWindow::setLeftTwips(c.cmdHelp, left);
}

void InstrumentCommands::ArrangeControlButtons() {
    const MainControls& c = w_.controls();
    const int first = s_.canAutoLog ? 2550 : 30;
    const int second = s_.canAutoLog ? 3390 : 870;
    if (s_.canStir) {
        MainWindow::setLeftTwips(c.cmdStartStirring, first);
        MainWindow::setLeftTwips(c.cmdStopStirring, second);
    }
    if (!s_.isK5Family)
        return;
    if (s_.canStir) {
        MainWindow::setLeftTwips(c.cmdK5On, first + 2520);
        MainWindow::setLeftTwips(c.cmdK5Off, second + 2520);
    } else {
        MainWindow::setLeftTwips(c.cmdK5On, first);
        MainWindow::setLeftTwips(c.cmdK5Off, second);
    }
}

void InstrumentCommands::runCapabilityRoutines(bool arrangeControls) {
    ShowLoggingButtons();
    ShowStirringButtons();
    ShowPowerButtons();
    ShowGLPCommands();
    ShowLogCommands();
    ShowMaxMinCommands();
    PlaceHelpButton();
    if (arrangeControls)
        ArrangeControlButtons();
}

void InstrumentCommands::takeIdentity(const StatusReply& reply) {
    if (reply.modelCode)
        s_.modelCode = *reply.modelCode;
    if (reply.firmwareVersion)
        s_.firmwareVersion = *reply.firmwareVersion;
    if (reply.serialNumber)
        s_.serialNumber = *reply.serialNumber;
    if (reply.replyTail)
        s_.replyTail = *reply.replyTail;
    if (reply.numLogged)
        s_.numLogged = *reply.numLogged;
}

void InstrumentCommands::placeWorkspace(int topTwips, int marginTwips) {
    QPlainTextEdit* workspace = w_.controls().RichTextBox1;
    const int windowTwips = pixelsToTwips(w_.frameGeometry().height());
    const int height = std::max(0, twipsToPixels(windowTwips - marginTwips));
    workspace->setGeometry(workspace->x(), twipsToPixels(topTwips), workspace->width(), height);
}

void InstrumentCommands::restoreIdentityCaptions() {
    const MainControls& c = w_.controls();
    c.lblVersion->setText(QStringLiteral("Version:"));
    c.lblSerial->show();
}

void InstrumentCommands::finishDisplay() {
    const MainControls& c = w_.controls();
    c.mnuDisplay->setEnabled(true);
    c.cmdListen->setEnabled(true);
    c.cmdCurrentData->setEnabled(true);
    if (c.lblMessage->text().startsWith(kDetectedPrefix))
        w_.setMessage(QString());
    w_.repaint();
}

void InstrumentCommands::warnIfBatteryLow() {
    // Shown only once the display is complete, so the user sees which meter it is about.
    if (s_.capabilityText.contains(u'B', Qt::CaseInsensitive))
        w_.prompts().show(QStringLiteral("The  meter  battery  is  low !"), Prompts::Icon::Critical,
                          Prompts::Buttons::Ok);
}
