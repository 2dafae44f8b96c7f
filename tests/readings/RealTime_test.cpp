// Real-time readings: the interval dialog, the schedule, the countdown and the ways a run ends.
#include "ReadingsWindow.h"

#include "readings/RealTimeIntervalDialog.h"
#include "readings/RealTimeRun.h"

using namespace readingstest;

class RealTimeTest : public QObject {
    Q_OBJECT
private slots:
    void init() { DialogDriver::takeFailures(); }
    void cleanup() { QVERIFY2(DialogDriver::takeFailures().isEmpty(), "dialog driver failed"); }

    void intervalDialog_data();
    void intervalDialog();
    void intervalDialogShowsStoredInterval();
    void cancelStartsNothing();
    void firstReadingAtOnceThenCountdown();
    void shortIntervalHasNoCountdown();
    void longIntervalSchedule();
    void continueAfterStopAndNewTableAfterLog();
    void lineLimit();
    void resendRestartsRun();
    void meterLost();
    void faultEndsRun_data();
    void faultEndsRun();
    void acrossMidnight();
    void percentWithLogNumbersLogColumn();

private:
    RealTimeRun& run(WindowFixture& fx) { return fx.window->readings().realTime(); }
    // tmrRealTime was armed for the rest of the time to the next reading's due time (counted
    // from the run's start) and never for more than maxMs.
    bool armedForDueTime(WindowFixture& fx, int maxMs) {
        const AppState& s = fx.state();
        const double due = s.runStartTime + s.lineCount * s.logInterval;
        const int atLeast = int((due - fx.clock.nowSeconds()) * 1000.0) - 1;
        const int interval = fx.c().tmrRealTime->interval();
        if (fx.c().tmrRealTime->isActive() && interval >= atLeast && interval <= maxMs)
            return true;
        qWarning("tmrRealTime: active %d, interval %d ms, expected %d..%d ms",
                 fx.c().tmrRealTime->isActive(), interval, atLeast, maxMs);
        return false;
    }
    // Moves the clock to the next reading's due time plus lateSeconds and lets tmrRealTime
    // fire there.
    void fireReading(WindowFixture& fx, double lateSeconds = 0) {
        QVERIFY(fx.c().tmrRealTime->isActive());
        const AppState& s = fx.state();
        const double due = s.runStartTime + s.lineCount * s.logInterval;
        fx.clock.advance(std::max(0.0, due - fx.clock.nowSeconds()) + lateSeconds);
        run(fx).tmrRealTime_Timer();
    }
};

void RealTimeTest::intervalDialog_data() {
    QTest::addColumn<int>("baud");
    QTest::addColumn<QString>("model");
    QTest::addColumn<QString>("entry");
    QTest::addColumn<int>("seconds"); // 0: rejected, the dialog stays open
    QTest::addColumn<QString>("message");

    auto row = [](const char* tag, int baud, const QString& model, const QString& entry,
                  int seconds, const QString& message) {
        QTest::newRow(tag) << baud << model << entry << seconds << message;
    };
    row("2 at 1200", 1200, "K50", "2", 0, "Minimum log interval is 3 second(s) at 1200  baud");
    row("3 at 1200", 1200, "K50", "3", 3, QString());
    row("2 at 9600", 9600, "K50", "2", 2, QString());
    row("-5", 9600, "K50", "-5", 5, QString());
    row("2.5", 9600, "K50", "2.5", 0, "Please specify log interval in whole seconds.");
    row("letters", 9600, "K50", "ten", 0, "Log interval must be numeric.");
    row("3601", 9600, "K50", "3601", 0, "Maximum  log  interval  is  3600  seconds");
    row("3600", 9600, "K50", "3600", 3600, QString());
    row("LXT needs 2 s", 19200, "LXT200", "1", 0,
        "Minimum log interval is 2 seconds for LXT200 model "
        "instrument.");
}

void RealTimeTest::intervalDialog() {
    QFETCH(int, baud);
    QFETCH(QString, model);
    QFETCH(QString, entry);
    QFETCH(int, seconds);
    QFETCH(QString, message);

    WindowFixture fx;
    MainWindow& w = fx.createWindow();
    w.state().baudRate = baud;
    w.state().modelCode = model;
    RealTimeIntervalDialog dialog(w);
    dialog.show();
    auto* text = dialog.findChild<QLineEdit*>(QStringLiteral("txtLogInterval"));
    text->setText(entry);
    dialog.findChild<QPushButton*>(QStringLiteral("cmdOK"))->click();

    if (seconds == 0) {
        QCOMPARE(fx.prompts.texts(), QStringList{message});
        QCOMPARE(fx.prompts.shown.constFirst().icon, Prompts::Icon::Exclamation);
        QVERIFY(dialog.isVisible());
        // The entry is selected for the next try.
        QCOMPARE(text->selectedText(), entry);
    } else {
        QVERIFY(fx.prompts.shown.isEmpty());
        QCOMPARE(dialog.result(), int(QDialog::Accepted));
        QCOMPARE(dialog.seconds(), seconds);
    }
}

void RealTimeTest::intervalDialogShowsStoredInterval() {
    WindowFixture fx;
    MainWindow& w = fx.createWindow();
    w.state().logInterval = 30;
    RealTimeIntervalDialog dialog(w);
    QCOMPARE(dialog.windowTitle(), QString());
    QCOMPARE(dialog.findChild<QLineEdit*>(QStringLiteral("txtLogInterval"))->text(),
             QStringLiteral("30"));
    QCOMPARE(dialog.findChild<QLabel*>(QStringLiteral("Label1"))->text(),
             QStringLiteral("Please  enter  desired  log  interval  (seconds)"));
}

void RealTimeTest::cancelStartsNothing() {
    WindowFixture fx;
    QVERIFY(fx.startDetected("plain"));
    fx.meter->clearReceived();
    DialogDriver::clickWhenModal(QStringLiteral("frmRealTimeInterval"),
                                 QStringLiteral("cmdCancel"));
    fx.c().mnuRealTime->trigger();
    QCOMPARE(fx.meter->received(), QByteArray());
    QVERIFY(!fx.state().runActive);
    QVERIFY(!fx.c().mnuRealTime->isChecked());
    QVERIFY(fx.c().cmdStopCurrentData->isHidden());
}

void RealTimeTest::firstReadingAtOnceThenCountdown() {
    WindowFixture fx;
    QVERIFY(fx.startDetected("plain"));
    fx.meter->setReadingReplies(
        {"0000  1.413mS 25.0C 12/03/2004 10:15:00\r", "0000  2.000mS 25.0C 12/03/2004 10:15:05\r"});
    fx.meter->clearReceived();
    startRealTime(fx, "5");

    const MainControls& c = fx.c();
    QCOMPARE(fx.meter->count("?D\r"), 1);
    QCOMPARE(lines(fx.state().workspaceText),
             QStringList{"12/03/2004 10:15:00    1  1.413mS 25.0C"});
    QCOMPARE(c.RichTextBox1->toPlainText(), fx.state().workspaceText);
    QVERIFY(fx.state().runActive);
    QVERIFY(c.mnuRealTime->isChecked());
    QVERIFY(c.cmdStopCurrentData->isVisible() && c.cmdStopCurrentData->isEnabled());
    QVERIFY(c.cmdCurrentData->isHidden());
    QVERIFY(!c.mnuDisplay->isEnabled());
    QVERIFY(armedForDueTime(fx, 5000));

    // The countdown: 5, then one tick a second down to 1, where it rests.
    QStringList shown{c.lblMessage->text()};
    for (int i = 0; i < 4; ++i) {
        QVERIFY(c.tmrDisplayInterval->isActive());
        fx.clock.advance(c.tmrDisplayInterval->interval() / 1000.0);
        run(fx).tmrDisplayInterval_Timer();
        shown << c.lblMessage->text();
    }
    QVERIFY(!c.tmrDisplayInterval->isActive());
    QStringList expected;
    for (int n = 5; n >= 1; --n)
        expected << RealTimeRun::countdownText(n);
    QCOMPARE(shown, expected);

    fireReading(fx);
    QCOMPARE(fx.meter->count("?D\r"), 2);
    QCOMPARE(lines(fx.state().workspaceText).constLast(),
             QStringLiteral("12/03/2004 10:15:05    2  2.000mS 25.0C"));
    QCOMPARE(c.lblMessage->text(), RealTimeRun::countdownText(5));
}

void RealTimeTest::shortIntervalHasNoCountdown() {
    WindowFixture fx;
    QVERIFY(fx.startDetected("plain"));
    startRealTime(fx, "2");
    QCOMPARE(fx.c().lblMessage->text(), QStringLiteral("Data logging in progress ..."));
    QVERIFY(!fx.c().tmrDisplayInterval->isActive());
    QVERIFY(fx.c().tmrRealTime->isActive());
    fx.c().cmdStopCurrentData->click();
    QVERIFY(commandsBack(fx));
    QCOMPARE(fx.settings.value(QStringLiteral("LogInvterval")), QStringLiteral("2"));
}

void RealTimeTest::longIntervalSchedule() {
    WindowFixture fx;
    QVERIFY(fx.startDetected("plain"));
    fx.meter->clearReceived();
    startRealTime(fx, "120");
    const MainControls& c = fx.c();
    QCOMPARE(fx.meter->count("?D\r"), 1);

    QVERIFY(c.tmrLong->isActive() && !c.tmrRealTime->isActive());
    QCOMPARE(c.tmrLong->interval(), 58000);
    fx.clock.advance(58);
    run(fx).tmrLong_Timer();
    // 62 s are left: still the long timer.
    QVERIFY(c.tmrLong->isActive() && !c.tmrRealTime->isActive());
    fx.clock.advance(58);
    run(fx).tmrLong_Timer();
    QVERIFY(!c.tmrLong->isActive());
    QVERIFY(armedForDueTime(fx, 4000));

    // Stop during the wait: no further reading.
    c.cmdStopCurrentData->click();
    QVERIFY(!c.tmrRealTime->isActive() && !c.tmrLong->isActive() &&
            !c.tmrDisplayInterval->isActive());
    QTest::qWait(50);
    QCOMPARE(fx.meter->count("?D\r"), 1);
    QVERIFY(commandsBack(fx));
    QCOMPARE(fx.settings.value(QStringLiteral("LogInvterval")), QStringLiteral("120"));
}

void RealTimeTest::continueAfterStopAndNewTableAfterLog() {
    WindowFixture fx;
    QVERIFY(fx.startDetected("plain"));
    startRealTime(fx, "1");
    fireReading(fx);
    QCOMPARE(fx.state().readingNumber, 2);
    fx.c().cmdStopCurrentData->click();

    // Continuing: no save prompt, the table goes on and so does the numbering.
    startRealTime(fx, "1");
    QVERIFY(fx.prompts.shown.isEmpty());
    QStringList l = lines(fx.state().workspaceText);
    QCOMPARE(l.size(), 3);
    QCOMPARE(l[2].mid(20, 4), QStringLiteral("   3"));
    fx.c().cmdStopCurrentData->click();

    // A log download in between: the save prompt, then a new table numbered from 1.
    fx.c().cmdLoggedData->click();
    QVERIFY(fx.prompts.saw(QStringLiteral("Data will be lost!  Would you like to save now?")));
    QVERIFY(fx.c().mnuLog->isChecked());
    startRealTime(fx, "1");
    l = lines(fx.state().workspaceText);
    QCOMPARE(l.size(), 1);
    QCOMPARE(l[0].mid(20, 4), QStringLiteral("   1"));
    fx.c().cmdStopCurrentData->click();
}

void RealTimeTest::lineLimit() {
    WindowFixture fx;
    QVERIFY(fx.startDetected("plain"));
    startRealTime(fx, "1");
    AppState& s = fx.state();
    s.lineCount = RealTimeRun::kLineLimit - 1;
    fx.c().tmrRealTime->stop();
    run(fx).GetCurrentDataReading();

    QCOMPARE(s.lineCount, 10000);
    QCOMPARE(lines(s.workspaceText).size(), 2);
    QCOMPARE(fx.prompts.texts(), QStringList{"Log has reached 10,000 line maximum!"});
    QVERIFY(fx.prompts.shown.constFirst().systemModal);
    QCOMPARE(fx.prompts.shown.constFirst().icon, Prompts::Icon::Exclamation);
    QVERIFY(commandsBack(fx));
    QVERIFY(!fx.c().tmrRealTime->isActive() && !fx.c().tmrLong->isActive());
}

void RealTimeTest::resendRestartsRun() {
    WindowFixture fx;
    QVERIFY(fx.startDetected("plain"));
    startRealTime(fx, "5");
    AppState& s = fx.state();
    const double firstStart = s.runStartTime;
    fx.meter->clearReceived();
    fx.meter->setBusyCount(1);
    fireReading(fx);

    // "?D" twice (busy, then a reading that is discarded), then the status and a new first
    // reading of the restarted run.
    QCOMPARE(fx.meter->count("?D\r"), 3);
    QCOMPARE(fx.meter->count("?S\r"), 1);
    QVERIFY(s.runStartTime >= firstStart + 5.0);
    QCOMPARE(s.lineCount, 1);
    QCOMPARE(s.readingNumber, 2);
    QCOMPARE(lines(s.workspaceText).size(), 2);
    QVERIFY(s.runActive);
    QVERIFY(!s.commandResent);
    QVERIFY(fx.c().tmrRealTime->isActive());
    fx.c().cmdStopCurrentData->click();
}

void RealTimeTest::faultEndsRun_data() {
    QTest::addColumn<QString>("interval");
    QTest::addColumn<QByteArray>("reply"); // empty: the meter's own reading
    QTest::addColumn<double>("late");
    QTest::addColumn<QString>("prompt"); // empty: the over-use dialog instead
    QTest::addColumn<int>("lineCount");
    QTest::newRow("error reply") << "4" << QByteArray("ERROR\r") << 0.0
                                 << " This function is not available with your firmware version."
                                 << 1;
    QTest::newRow("reply too short") << "4" << QByteArray("0000 1.4mS\r") << 0.0 << "" << 1;
    // The reading comes three seconds late: the one after it is overdue already.
    QTest::newRow("overdue reading") << "1" << QByteArray() << 3.0 << "" << 2;
}

void RealTimeTest::faultEndsRun() {
    QFETCH(QString, interval);
    QFETCH(QByteArray, reply);
    QFETCH(double, late);
    QFETCH(QString, prompt);
    WindowFixture fx;
    QVERIFY(fx.startDetected("plain"));
    startRealTime(fx, interval);
    if (!reply.isEmpty())
        fx.meter->setReply("?D", reply);
    if (prompt.isEmpty())
        DialogDriver::clickWhenModal(QStringLiteral("frmCPUOverUse"), QStringLiteral("Command1"));
    fireReading(fx, late);
    if (!prompt.isEmpty())
        QVERIFY(fx.prompts.saw(prompt));
    QVERIFY(commandsBack(fx));
    QTEST(int(lines(fx.state().workspaceText).size()), "lineCount");
    QTEST(fx.state().readingNumber, "lineCount");
    QVERIFY(!fx.c().tmrRealTime->isActive());
    QCOMPARE(fx.settings.value(QStringLiteral("LogInvterval")), interval);
}

void RealTimeTest::meterLost() {
    WindowFixture fx;
    QVERIFY(fx.startDetected("plain"));
    startRealTime(fx, "4");
    fx.meter->setReply("?D", "EXIT\r");
    fireReading(fx);

    const MainControls& c = fx.c();
    QVERIFY(fx.prompts.saw(QStringLiteral("User has terminated this process.")));
    QVERIFY(!fx.serial.isOpen());
    QCOMPARE(fx.state().modelCode, QString());
    QCOMPARE(c.lblModelData->text(), QString());
    QVERIFY(c.cmdCurrentData->isVisible() && !c.cmdCurrentData->isEnabled());
    QVERIFY(c.cmdStopCurrentData->isHidden());
    QVERIFY(!c.cmdLoggedData->isEnabled());
    QVERIFY(c.mnuDetectMeter->isEnabled());
    QVERIFY(!fx.state().runActive);
    QVERIFY(!c.tmrRealTime->isActive() && !c.tmrDisplayInterval->isActive());
    // The reading taken before is still there.
    QCOMPARE(lines(c.RichTextBox1->toPlainText()).size(), 1);
}

void RealTimeTest::acrossMidnight() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("percent-nolog")));
    fx.meter->setReadingReplies({"  7.00   1.413mS\r"});
    startRealTime(fx, "1");
    // Only the wall clock jumps, to just after midnight at the second reading's due time; the
    // schedule runs on the monotonic clock and must not notice.
    const AppState& s = fx.state();
    const double remaining = s.runStartTime + s.logInterval - fx.clock.nowSeconds();
    const QDateTime atDue = fx.clock.wallNow().addMSecs(qint64(remaining * 1000));
    const QDate nextDay = atDue.date().addDays(1);
    fx.clock.setWallShift(atDue.secsTo(QDateTime(nextDay, QTime(0, 0))) + 1);
    fireReading(fx);

    const QStringList l = lines(fx.state().workspaceText);
    QCOMPARE(l.size(), 2);
    QCOMPARE(l[0].mid(19, 6), QStringLiteral("    1 "));
    QCOMPARE(l[1].left(31), nextDay.toString(QStringLiteral("dd/MM/yyyy")) +
                                QStringLiteral(" 00:00:0") + l[1].mid(18, 1) +
                                QStringLiteral("    2   7.00"));
    // The schedule is unaffected: the third reading is due one second after the second.
    QVERIFY(armedForDueTime(fx, 1000));
    QVERIFY(fx.state().headerText.startsWith(QStringLiteral("   Date      Time   Log# ")));
    QCOMPARE(fx.c().lblHeader->text(), fx.state().headerText);
    fx.c().cmdStopCurrentData->click();
}

void RealTimeTest::percentWithLogNumbersLogColumn() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("percent-log")));
    const AppState& s = fx.state();
    QVERIFY(s.headerText.contains(QStringLiteral("Log#")));
    QCOMPARE(s.logColumnStart, 22);
    QCOMPARE(s.logColumnWidth, 4);
    QVERIFY(fx.window->readings().logColumnKnown());

    fx.meter->setReadingReplies({" 12/03/2004 10:15:00 0042  7.00    1.413mS\r"});
    startRealTime(fx, "1");
    QCOMPARE(lines(s.workspaceText), QStringList{" 12/03/2004 10:15:00    1  7.00    1.413mS\r"});
    fx.c().cmdStopCurrentData->click();
}

QTEST_MAIN(RealTimeTest)
#include "RealTime_test.moc"
