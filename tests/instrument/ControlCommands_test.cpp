#include "link/Exchange.h"
#include "support/DialogDriver.h"
#include "support/WindowFixture.h"

#include <QAction>
#include <QApplication>
#include <QLabel>
#include <QMenu>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QSignalSpy>
#include <QTest>
#include <QTimer>

namespace {
const QString kVoltageLine = QStringLiteral("Meter Battery Voltage = 6.3V\r");

bool noModal() {
    return QApplication::activeModalWidget() == nullptr;
}

// Starts the voltage display and waits for its first line.
bool startVoltage(WindowFixture& f, const QString& profile) {
    if (!f.startDetected(profile))
        return false;
    f.c().mnuVoltage->trigger();
    return f.waitUntil([&] { return f.state().workspaceText == kVoltageLine; }, 1000);
}

int visibleCommErrorDialogs() {
    int n = 0;
    for (QWidget* w : QApplication::topLevelWidgets())
        n += w->objectName() == QLatin1String("frmCommError") && w->isVisible();
    return n;
}
} // namespace

class ControlCommandsTest : public QObject {
    Q_OBJECT
private slots:
    void init() { DialogDriver::takeFailures(); }
    void cleanup() { QCOMPARE(DialogDriver::takeFailures(), QStringList()); }
    void commands_data();
    void commands();
    void blowShowsOnlyBatteryMessage();
    void powerOffSequence();
    void powerOffRefused();
    void powerOnDetectsAgain_data();
    void powerOnDetectsAgain();
    void eraseConfirmed();
    void eraseRefused();
    void eraseNotConfirmedByMeter();
    void eraseWithEmptyLog();
    void eraseAfterErrorStatus();
    void voltageDisplay();
    void voltageEndsOnBusy();
    void voltageLinkLost();
    void commandStopsVoltage();
    void vanishDuringCommand();
};

void ControlCommandsTest::commands_data() {
    QTest::addColumn<QString>("profile");
    QTest::addColumn<QString>("button");
    QTest::addColumn<QByteArray>("sent");
    QTest::addColumn<QByteArray>("notSent");
    QTest::addColumn<QString>("message");

    auto row = [](const char* tag, const QString& profile, const QString& button,
                  const QByteArray& sent, const QByteArray& notSent, const QString& message) {
        QTest::newRow(tag) << profile << button << sent << notSent << message;
    };
    row("start stirring", "k5ac", "cmdStartStirring", "?M\r", "", "Stirrer  started.");
    row("stop stirring", "k5ac", "cmdStopStirring", "?N\r", "", "Stirrer  stopped.");
    row("enable logging K5AC", "k5ac", "cmdEnableLogging", "?G\r", "?J\r", "Logging  enabled.");
    row("enable logging K5AH", "k5ah", "cmdEnableLogging", "?J\r", "?G\r", "Logging  enabled.");
    row("enable logging percent", "percent-log", "cmdEnableLogging", "?J\r", "?G\r",
        "Logging  enabled.");
    row("disable logging", "k5gj", "cmdDisableLogging", "?F\r", "", "Logging  disabled.");
}

void ControlCommandsTest::commands() {
    QFETCH(QString, profile);
    QFETCH(QString, button);
    QFETCH(QByteArray, sent);
    QFETCH(QByteArray, notSent);
    WindowFixture f;
    QVERIFY(f.startDetected(profile));
    f.meter->clearReceived();
    auto* b = f.window->findChild<QPushButton*>(button);
    QVERIFY(b && b->isVisibleTo(f.window.get()) && b->isEnabled());
    b->click();
    QTEST(f.c().lblMessage->text(), "message");
    QCOMPARE(f.meter->count(sent), 1);
    if (!notSent.isEmpty())
        QCOMPARE(f.meter->count(notSent), 0);
    QVERIFY(f.prompts.shown.isEmpty());

    // A reply that passes no test changes nothing and shows nothing.
    f.window->setMessage(QStringLiteral("before"));
    f.meter->setReply(sent.left(2), "WHAT?\r");
    b->click();
    QCOMPARE(f.c().lblMessage->text(), QStringLiteral("before"));
    QVERIFY(f.prompts.shown.isEmpty());
}

void ControlCommandsTest::blowShowsOnlyBatteryMessage() {
    WindowFixture f;
    QVERIFY(f.startDetected("k5ac"));
    f.meter->setReply("?M", "BLOW\r");
    f.c().cmdStartStirring->click();
    QCOMPARE(f.prompts.texts(), QStringList{"Meter  battery  is  low!"});
    QCOMPARE(f.prompts.shown.first().icon, Prompts::Icon::Critical);
    QCOMPARE(f.c().lblMessage->text(), QString());
}

void ControlCommandsTest::powerOffSequence() {
    WindowFixture f;
    QVERIFY(f.startDetected("k5ac"));
    const MainControls& c = f.c();
    f.meter->clearReceived();
    c.cmdK5Off->click();

    const QByteArray wakeUp = QByteArray("{@").repeated(24) + "?S\r";
    const QByteArray received = f.meter->received();
    QVERIFY(received.startsWith(wakeUp));
    const qsizetype powerOff = received.indexOf("?K\r");
    QVERIFY(powerOff > wakeUp.size());
    // Two drains in between: each writes at least one line feed.
    QVERIFY(received.mid(wakeUp.size(), powerOff - wakeUp.size()).count('\n') >= 2);
    QCOMPARE(f.meter->count("?K\r"), 1);
    const QList<double> wake = f.meter->commandTimes(wakeUp);
    const QList<double> off = f.meter->commandTimes("?K\r");
    QVERIFY(!wake.isEmpty() && !off.isEmpty());
    QVERIFY2(off.first() - wake.first() >= 0.5, "a half-second pause between the drains");

    QCOMPARE(c.lblMessage->text(), QStringLiteral("Meter  has  been  shut  down."));
    for (QLabel* l : {c.lblModelData, c.lblVersionData, c.lblSerialData, c.lblNumLogData})
        QCOMPARE(l->text(), QString());
    for (QPushButton* b : {c.cmdSaveFile, c.cmdCurrentData, c.cmdLoggedData, c.cmdGLPData,
                           c.cmdListen, c.cmdEnableLogging, c.cmdStartStirring, c.cmdK5Off,
                           c.cmdStopStirring, c.cmdDisableLogging, c.cmdEraseLog})
        QVERIFY2(!b->isEnabled(), qPrintable(b->objectName()));
    QVERIFY(c.cmdK5On->isEnabled());
    QVERIFY(!c.mnuDisplay->isEnabled());
    QVERIFY(c.mnuDetectMeter->isEnabled());
    QVERIFY(!c.mnuEraseLog->isVisible());
    QVERIFY(!c.mnuSave->isEnabled());
    QVERIFY(!f.serial.isOpen());
    QVERIFY(f.prompts.shown.isEmpty());
}

void ControlCommandsTest::powerOffRefused() {
    WindowFixture f;
    QVERIFY(f.startDetected("k5ac"));
    f.meter->setReply("?K", "NO\r");
    f.c().cmdK5Off->click();
    QCOMPARE(f.c().lblMessage->text(), QStringLiteral("Shutting  down  meter ..."));
    QCOMPARE(f.c().lblModelData->text(), QStringLiteral("K5AC"));
    QVERIFY(f.serial.isOpen());
    QVERIFY(f.c().cmdK5Off->isEnabled());
}

void ControlCommandsTest::powerOnDetectsAgain_data() {
    QTest::addColumn<bool>("fromMenu");
    QTest::newRow("Power On") << false;
    QTest::newRow("Detect Meter") << true;
}

void ControlCommandsTest::powerOnDetectsAgain() {
    QFETCH(bool, fromMenu);
    WindowFixture f;
    QVERIFY(f.startDetected("k5ac"));
    f.c().cmdK5Off->click();
    QCOMPARE(f.c().lblModelData->text(), QString());
    // The meter stays silent after "SSD" until it is woken again.
    if (fromMenu)
        f.c().mnuDetectMeter->trigger();
    else
        f.c().cmdK5On->click();
    QVERIFY(f.waitUntil([&] { return f.c().lblModelData->text() == QLatin1String("K5AC"); }));
    QVERIFY(f.c().cmdK5Off->isEnabled());
    QVERIFY(f.c().cmdEraseLog->isEnabled());
    QVERIFY(f.serial.isOpen());
    QCOMPARE(f.c().lblMessage->text(), QString());
}

void ControlCommandsTest::eraseConfirmed() {
    WindowFixture f;
    QVERIFY(f.startDetected("k5ac"));
    f.meter->clearReceived();
    bool labelAtMessage = false;
    f.prompts.onShow = [&](const PromptRecorder::Shown&) {
        labelAtMessage = f.c().lblNumLogData->text() == QLatin1String("0");
    };
    DialogDriver::whenModal("frmLogEraseCheck", [](QWidget* d) {
        QCOMPARE(d->findChild<QLabel*>("Label1")->text(),
                 QStringLiteral("Would  you  like  to  erase  logged  data?"));
        QCOMPARE(d->findChild<QPushButton*>("cmdOK")->text(), QStringLiteral("&Yes"));
        QVERIFY(d->findChild<QPushButton*>("cmdOK")->isDefault());
        QCOMPARE(d->findChild<QPushButton*>("cmdCancel")->text(), QStringLiteral("&No"));
        DialogDriver::click(d, "cmdOK");
    });
    f.c().cmdEraseLog->click();
    QCOMPARE(f.meter->received(), QByteArray("\n?S\r\n?E\r"));
    QCOMPARE(f.prompts.texts(), QStringList{"Logged readings erased."});
    QCOMPARE(f.prompts.shown.first().icon, Prompts::Icon::None);
    QVERIFY(labelAtMessage);
    QCOMPARE(f.state().numLogged, 0);
    QCOMPARE(f.c().lblNumLogData->text(), QStringLiteral("0"));
    QVERIFY(noModal());
}

void ControlCommandsTest::eraseRefused() {
    WindowFixture f;
    QVERIFY(f.startDetected("plain"));
    DialogDriver::clickWhenModal("frmLogEraseCheck", "cmdCancel");
    f.c().mnuEraseLog->trigger();
    QCOMPARE(f.meter->count("?E\r"), 0);
    QCOMPARE(f.c().lblNumLogData->text(), QStringLiteral("3"));
    QVERIFY(f.prompts.shown.isEmpty());
}

void ControlCommandsTest::eraseNotConfirmedByMeter() {
    WindowFixture f;
    QVERIFY(f.startDetected("plain"));
    f.meter->setReply("?E", "NOT NOW\r");
    bool stillOpen = false;
    DialogDriver::whenModal("frmLogEraseCheck", [&](QWidget* d) {
        DialogDriver::click(d, "cmdOK");
        stillOpen = d->isVisible();
        DialogDriver::click(d, "cmdCancel");
    });
    f.c().cmdEraseLog->click();
    QVERIFY(stillOpen);
    QCOMPARE(f.meter->count("?E\r"), 1);
    QCOMPARE(f.state().numLogged, 3);
    QVERIFY(f.prompts.shown.isEmpty());
}

void ControlCommandsTest::eraseWithEmptyLog() {
    WindowFixture f;
    QVERIFY(f.startDetected("k5ah"));
    f.meter->setLogRecords({});
    f.c().cmdEraseLog->click();
    QCOMPARE(f.prompts.texts(), QStringList{"No logged readings to erase!"});
    QCOMPARE(f.prompts.shown.first().icon, Prompts::Icon::Information);
    QCOMPARE(f.meter->count("?E\r"), 0);
    QCOMPARE(f.c().lblNumLogData->text(), QStringLiteral("0"));
}

void ControlCommandsTest::eraseAfterErrorStatus() {
    WindowFixture f;
    QVERIFY(f.startDetected("plain"));
    f.meter->setReply("?S", "ERROR\r");
    f.c().cmdEraseLog->click();
    QVERIFY(f.prompts.shown.isEmpty());
    QCOMPARE(f.meter->count("?E\r"), 0);
}

void ControlCommandsTest::voltageDisplay() {
    WindowFixture f;
    QVERIFY(f.startDetected("percent-log"));
    const MainControls& c = f.c();
    QVERIFY(c.mnuVoltage->isVisible());
    QSignalSpy redraws(c.RichTextBox1, &QPlainTextEdit::textChanged);
    f.meter->clearReceived();
    c.mnuVoltage->trigger();
    QVERIFY(c.mnuVoltage->isChecked());
    QVERIFY(f.waitUntil([&] { return f.state().workspaceText == kVoltageLine; }, 1000));
    QCOMPARE(redraws.count(), 1);
    // Two more identical readings leave the workspace alone.
    QVERIFY(f.waitUntil([&] { return f.meter->count("?V\r") >= 3; }, 6000));
    QTest::qWait(100);
    QCOMPARE(redraws.count(), 1);
    QCOMPARE(c.RichTextBox1->toPlainText(), QStringLiteral("Meter Battery Voltage = 6.3V\n"));
    // A new value is shown.
    f.meter->setReply("?V", "  6.1V \r");
    QVERIFY(f.waitUntil([&] { return redraws.count() == 2; }, 3000));
    QCOMPARE(f.state().workspaceText, QStringLiteral("Meter Battery Voltage = 6.1V \r"));
    // An unusable reply ends the display and keeps the last line.
    f.meter->setReply("?V", "ERROR\r");
    QVERIFY(f.waitUntil([&] { return !c.tmrDisplayVoltage->isActive(); }, 3000));
    QCOMPARE(f.prompts.texts(),
             QStringList{" This function is not available with your firmware version."});
    QCOMPARE(c.RichTextBox1->toPlainText(), QStringLiteral("Meter Battery Voltage = 6.1V \n"));
}

void ControlCommandsTest::voltageEndsOnBusy() {
    WindowFixture f;
    QVERIFY(startVoltage(f, "percent-nolog"));
    const MainControls& c = f.c();
    f.meter->setReply("?V", "BUSY\r");
    // The busy prompt comes when the reply window has run out; its Cancel leaves "BUSY".
    QVERIFY(f.waitUntil([&] { return !c.tmrDisplayVoltage->isActive(); }, 10000));
    QVERIFY(f.prompts.texts().first().startsWith("Instrument  is  busy"));
    QCOMPARE(c.RichTextBox1->toPlainText(), QStringLiteral("Meter Battery Voltage = 6.3V\n"));
    QVERIFY(noModal());
}

void ControlCommandsTest::voltageLinkLost() {
    WindowFixture f;
    QVERIFY(startVoltage(f, "percent-log"));
    const MainControls& c = f.c();
    f.meter->vanish();
    int dialogsWhileOpen = -1;
    DialogDriver::whenModal("frmCommError", [&](QWidget* d) {
        // Ticks that would have come meanwhile must not stack a second dialog.
        QTest::qWait(4500);
        dialogsWhileOpen = visibleCommErrorDialogs();
        DialogDriver::click(d, "cmdCancel");
    });
    QVERIFY(f.waitUntil([&] { return dialogsWhileOpen >= 0 && noModal(); }, 15000));
    QCOMPARE(dialogsWhileOpen, 1);
    QVERIFY(!c.tmrDisplayVoltage->isActive());
    QVERIFY(!f.state().abortRequested);
    QVERIFY(c.mnuDetectMeter->isEnabled());
    QCOMPARE(c.RichTextBox1->toPlainText(), QStringLiteral("Meter Battery Voltage = 6.3V\n"));
    QTest::qWait(2500);
    QVERIFY(noModal());
}

void ControlCommandsTest::commandStopsVoltage() {
    WindowFixture f;
    QVERIFY(startVoltage(f, "percent-log"));
    const MainControls& c = f.c();
    c.cmdStopStirring->click();
    QVERIFY(!c.tmrDisplayVoltage->isActive());
    QCOMPARE(c.RichTextBox1->toPlainText(), QString());
    QCOMPARE(c.lblMessage->text(), QStringLiteral("Stirrer  stopped."));
}

void ControlCommandsTest::vanishDuringCommand() {
    WindowFixture f;
    QVERIFY(f.startDetected("k5ac"));
    f.meter->vanish();
    DialogDriver::clickWhenModal("frmCommError", "cmdCancel");
    f.c().cmdStartStirring->click();
    QVERIFY(f.waitUntil(noModal));
    QVERIFY(!f.state().abortRequested);
    QVERIFY(f.window->isEnabled());
    QVERIFY(f.c().mnuDetectMeter->isEnabled());
    QCOMPARE(f.c().lblModelData->text(), QString());
    // The window still answers: a second command after the reset ends the same way.
    DialogDriver::clickWhenModal("frmCommError", "cmdCancel");
    f.c().cmdK5Off->click();
    QVERIFY(f.waitUntil(noModal));
    QVERIFY(!f.state().abortRequested);
}

QTEST_MAIN(ControlCommandsTest)
#include "ControlCommands_test.moc"
