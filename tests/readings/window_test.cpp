// The readings commands through the main window and the simulated meter: what goes to the meter,
// what lands in the workspace (checked against the line rules) and the window afterwards, also
// when the port vanishes or the line misbehaves in the middle of an operation.
#include "core/readings/LogLineFormat.h"
#include "core/readings/ReadingConversions.h"
#include "core/readings/RealTimeLine.h"
#include "desktop/readings/ReadingCommands.h"
#include "desktop/readings/RealTimeRun.h"
#include "robustness/ModalDismisser.h"
#include "support/DialogDriver.h"
#include "support/WindowFixture.h"

#include <QAction>
#include <QLabel>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QTest>
#include <atomic>
#include <thread>

using namespace std::chrono_literals;

namespace {

// A fault that leaves an operation looping (the meter waiting for an acknowledgement that never
// comes) fails its test within half a minute instead of hanging the suite.
const bool kWatchdog = qputenv("QTEST_FUNCTION_TIMEOUT", "30000");

// The meter detected; the detection poll runs every millisecond instead of every 600.
bool up(WindowFixture& f, const QString& profile, int baud = 9600) {
    if (!f.startMeter(profile, baud))
        return false;
    f.createWindow();
    f.c().tmrDetectMeter->setInterval(1);
    f.start();
    return f.waitUntil([&] { return !f.state().modelCode.isEmpty(); });
}

// A log of n of the meter's own records.
QList<QByteArray> newLog(WindowFixture& f, int n) {
    const auto log = metersim::Meter::generateLog(f.meter->profile(), n);
    f.meter->setLogRecords(log);
    return log;
}

// The log table the line rules make of records.
QString table(const QList<QByteArray>& records, const LineLayout& layout = {}) {
    QString t;
    for (const QByteArray& r : records)
        t += layout.qr32 ? LogLineFormat::qr32Record(r).value_or("-")
                         : LogLineFormat::reformat(r, layout).value_or("-") + '\n';
    return t;
}

// No operation runs and the commands are back.
bool idle(WindowFixture& f) {
    const MainControls& c = f.c();
    return c.cmdStopCurrentData->isHidden() && c.cmdCurrentData->isEnabled() &&
           !f.state().runActive && !c.tmrRealTime->isActive() && !c.tmrLong->isActive();
}

// Current Data, answering the interval dialog with each entry in turn.
void startRun(WindowFixture& f, const QStringList& entries) {
    DialogDriver::whenModal("frmRealTimeInterval", [entries](QWidget* d) {
        for (const QString& e : entries) {
            d->findChild<QLineEdit*>("txtLogInterval")->setText(e);
            DialogDriver::click(d, "cmdOK");
        }
    });
    f.c().cmdCurrentData->click();
}

// Moves the clock to the next reading's due time (plus late seconds) and lets tmrRealTime fire.
void fire(WindowFixture& f, double late = 0) {
    const AppState& s = f.state();
    const double due = s.runStartTime + s.lineCount * s.logInterval;
    f.clock.advance(std::max(0.0, due - f.clock.nowSeconds()) + late);
    f.window->readings().realTime().tmrRealTime_Timer();
}

// After a fault: the link dialog came once and has gone, nothing runs, and the view shows what
// the workspace holds (the view breaks lines at CR).
void usable(WindowFixture& f, const ModalDismisser& dismiss) {
    QVERIFY(f.waitUntil([&] { return dismiss.seen.size() && !QApplication::activeModalWidget(); }));
    QCOMPARE(dismiss.seen, QStringList{"frmCommError"});
    QVERIFY(f.c().cmdStopCurrentData->isHidden() && !f.state().runActive &&
            !f.state().abortRequested);
    QCOMPARE(f.c().RichTextBox1->toPlainText().remove('\n'),
             QString(f.state().workspaceText).remove('\n').remove('\r'));
}

} // namespace

class WindowTest : public QObject {
    Q_OBJECT
private slots:
    void cleanup() { QCOMPARE(DialogDriver::takeFailures(), QStringList()); }

    // Every log layout: the table is the meter's own records through the line rule, then the
    // conversions. A percent meter's header is shown, and its real-time lines get the run's
    // number in its Log# column.
    void logDownload() {
        for (const QByteArray name : {"qr34", "percent-log", "qr32"}) {
            WindowFixture f;
            for (const char* key : {"mS", "ppK", "Asterisk"})
                f.settings.set(key, "1");
            QVERIFY(up(f, name));
            LineLayout layout;
            layout.percentFormat = name == "percent-log";
            layout.qr32 = name == "qr32";
            QList<QByteArray> log = newLog(f, 30);
            // A line feed that followed the previous record's CR.
            log[1].prepend(layout.qr32 ? "\n" : "");
            f.meter->setLogRecords(log);
            f.c().cmdLoggedData->click();

            const ReadingConversions all{true, true, true};
            QCOMPARE(f.state().workspaceText, all.apply(table(log, layout)));
            const QByteArray sent = layout.qr32 ? "?R\r" : "?L\r" + QByteArray(31, 'A');
            QVERIFY(f.meter->waitForReceived(sent, 1, 1000) && f.meter->received().endsWith(sent));
            QVERIFY(f.c().mnuLog->isChecked() && idle(f));
            QCOMPARE(f.c().lblHeader->text(), QString(f.meter->profile().headerReply()));
            if (layout.percentFormat) {
                startRun(f, {"5"});
                QCOMPARE(f.state().workspaceText, QString(log[0]).replace(21, 4, "   1") + '\n');
            }
        }
    }

    void logStopAndRecords() {
        WindowFixture f;
        f.settings.set("mS", "1");
        QVERIFY(up(f, "qr34"));
        const MainControls& c = f.c();
        const QString& text = f.state().workspaceText;
        const auto log = newLog(f, 500);
        // Stop at the first chance the download gives: after its first record.
        QTimer::singleShot(0, c.cmdStopCurrentData, &QAbstractButton::click);
        c.cmdLoggedData->click();
        QVERIFY(f.meter->waitForReceived("Z", 1, 1000) && idle(f));
        QCOMPARE(text, ReadingConversions{true}.apply(table(log.mid(0, 1))));

        // GLP and max/min blocks: each line acknowledged, the "END" line too.
        f.meter->setRecordLines("?G", {"Cal 1\r", "end x\r", "ENDS\r"});
        c.cmdGLPData->click();
        QCOMPARE(text, "Cal 1\nend x\n");
        QVERIFY(f.meter->waitForReceived("?G\r\n\n\n", 1, 1000) &&
                f.meter->received().endsWith("?G\r\n\n\n"));
        QVERIFY(c.mnuGLP->isChecked() && c.cmdSaveFile->isEnabled());
        f.meter->setRecordLines("?M", {"MAX 1\r", "MIN 2\r"});
        c.cmdMaxMin->click();
        QCOMPARE(text, " MAX 1\n MIN 2\n");
        QVERIFY(f.meter->waitForReceived("?M\r\n\n\n", 1, 1000) && c.mnuMaxMin->isChecked());

        newLog(f, 0);
        c.cmdLoggedData->click();
        QCOMPARE(f.prompts.texts(), QStringList{"No logged readings to display !"});
        QVERIFY(f.meter->received().endsWith("?S\r"));

        // The port vanishes after the first GLP line: that line is kept.
        f.meter->vanishAfterSending(1);
        ModalDismisser dismiss;
        c.cmdGLPData->click();
        QCOMPARE(text, "Cal 1\n");
        usable(f, dismiss);
    }

    void realTime() {
        WindowFixture f;
        QVERIFY(up(f, "plain", 1200));
        const MainControls& c = f.c();
        RealTimeRun& run = f.window->readings().realTime();
        AppState& s = f.state();
        const auto replies = metersim::Meter::generateLog(f.meter->profile(), 9);
        // The line of the meter's next reply.
        int taken = 0;
        auto next = [&](int number) {
            return *RealTimeLine::build(replies[taken++], number, {}) + '\n';
        };
        startRun(f, {"2", "5"});
        QCOMPARE(f.prompts.texts(),
                 QStringList{"Minimum log interval is 3 second(s) at 1200  baud"});
        QString table = next(1);
        QCOMPARE(s.workspaceText, table);
        QCOMPARE(c.lblMessage->text(), RealTimeRun::countdownText(5));
        f.clock.advance(c.tmrDisplayInterval->interval() / 1000.0);
        run.tmrDisplayInterval_Timer();
        QCOMPARE(c.lblMessage->text(), RealTimeRun::countdownText(4));
        // A reading taken late leaves the next one overdue: the run cannot keep up and ends as
        // Stop ends it (interval saved, no "Z").
        DialogDriver::clickWhenModal("frmCPUOverUse", "Command1");
        fire(f, 6);
        QCOMPARE(s.workspaceText, table += next(2));
        QVERIFY(idle(f) && !f.meter->waitForReceived("Z", 1, 50));
        QCOMPARE(f.settings.value("LogInvterval"), "5");

        // Continued, numbering on; tmrLong waits while 60 s or more are left.
        startRun(f, {"120"});
        QCOMPARE(s.workspaceText, table += next(3));
        for (int i = 0; i < 2; ++i) {
            QVERIFY(c.tmrLong->isActive() && !c.tmrRealTime->isActive());
            f.clock.advance(58);
            run.tmrLong_Timer();
        }
        const int ms = c.tmrRealTime->interval();
        QVERIFY(c.tmrRealTime->isActive() && ms <= 4000 && ms > 3000);
        // A reply that needed a re-send is dropped and the run starts again from now.
        f.meter->clearReceived();
        f.meter->setBusyCount(1);
        fire(f);
        ++taken;
        QCOMPARE(s.workspaceText, table += next(4));
        QCOMPARE(QList<int>({f.meter->count("?D\r"), f.meter->count("?S\r"), s.lineCount}),
                 QList<int>({3, 1, 1}));
        // Reading 10,000 is added, then the limit message ends the run.
        s.lineCount = 9999;
        fire(f);
        QCOMPARE(s.workspaceText, table += next(5));
        QVERIFY(idle(f) && f.prompts.saw("Log has reached 10,000 line maximum!"));

        // After a log download in between: the save prompt, and a new table from number 1.
        c.cmdLoggedData->click();
        QVERIFY(f.prompts.saw("Data will be lost!  Would you like to save now?"));
        startRun(f, {"5"});
        QCOMPARE(s.workspaceText, table = next(1));
        // "EXIT": the run ends, the port closes and the meter must be detected again.
        f.meter->queueReplies("?D", {"EXIT\r"});
        fire(f);
        QVERIFY(!f.serial.isOpen() && s.modelCode.isEmpty() && c.mnuDetectMeter->isEnabled());
        QVERIFY(!c.cmdCurrentData->isEnabled() && c.cmdStopCurrentData->isHidden());
        QCOMPARE(s.workspaceText, table);
    }

    // A percent meter without a log: each line begins with the computer's date and time of the
    // reading, here a few seconds before and after a midnight. Then the port vanishes.
    void realTimeAcrossMidnight() {
        WindowFixture f;
        QVERIFY(up(f, "percent-nolog"));
        const QDateTime midnight(QDate(2030, 1, 1), QTime(0, 0));
        f.clock.setWallShift(f.clock.wallNow().secsTo(midnight) - 3);
        startRun(f, {"9"});
        fire(f);
        const QString& text = f.state().workspaceText;
        QVERIFY(text.startsWith("31/12/2029 23:59:5") && text.contains("\n01/01/2030 00:00:0"));
        ModalDismisser dismiss;
        f.meter->vanish();
        fire(f);
        QCOMPARE(text.count('\n'), 2);
        usable(f, dismiss);
    }

    void listen() {
        WindowFixture f;
        QVERIFY(up(f, "plain"));
        const MainControls& c = f.c();
        const QString& text = f.state().workspaceText;
        auto holds = [&](const QString& t) { return f.waitUntil([&] { return text == t; }); };
        c.cmdListen->click();
        // A line appears when its CR arrives, not before.
        f.meter->sendUnsolicited("one\r\ntw");
        QVERIFY(holds("one\r"));
        QTest::qWait(20);
        QCOMPARE(text, "one\r");
        // A burst loses nothing; a line holding a keyword is left out.
        QByteArray burst = "o\r\nError 3\r";
        QString kept = "one\r\ntwo\r";
        for (int i = 0; i < 300; ++i) {
            burst += "\n" + QByteArray::number(i) + "  1.413mS\r";
            kept += QString("\n%1  1.413mS\r").arg(i);
        }
        f.meter->sendUnsolicited(burst);
        QVERIFY(holds(kept));
        // Stop in the middle of a line: "Z" goes out and the unfinished line is dropped.
        f.meter->sendUnsolicited("\npart");
        QTest::qWait(20);
        c.cmdStopCurrentData->click();
        QVERIFY(f.meter->waitForReceived("Z", 1, 1000));
        QCOMPARE(text, kept);
        QVERIFY(idle(f) && c.mnuListen->isChecked() && c.cmdListen->isVisible());
        // Listening again goes on in the same workspace without asking.
        c.cmdListen->click();
        f.meter->sendUnsolicited("\nmore\r");
        QVERIFY(holds(kept += "\nmore\r"));
        QVERIFY(f.prompts.shown.isEmpty());
        // The port vanishes: listening ends with the link dialog, every line kept.
        ModalDismisser dismiss;
        f.meter->vanish();
        usable(f, dismiss);
        QCOMPARE(text, kept);
    }

    // A meter that prints every 50 ms never lets the line go quiet: it is listened to all the
    // same, and every line after the drain arrives, in order.
    void listenToPrintingMeter() {
        WindowFixture f;
        QVERIFY(up(f, "plain"));
        std::atomic<int> sent{0};
        std::jthread meter([&](std::stop_token stop) {
            for (; !stop.stop_requested(); std::this_thread::sleep_for(50ms))
                f.meter->sendUnsolicited(QByteArray::number(++sent) + " 7.00pH\r");
        });
        ModalDismisser dismiss;
        f.c().cmdListen->click();
        const QString& text = f.state().workspaceText;
        QVERIFY(f.waitUntil([&] { return text.count('\r') >= 5; }));
        meter.request_stop();
        meter.join();
        QVERIFY(f.waitUntil([&] { return text.endsWith(QString("%1 7.00pH\r").arg(sent)); }));
        f.c().cmdStopCurrentData->click();
        QVERIFY(f.meter->waitForReceived("Z", 1, 1000) && idle(f) && dismiss.seen.isEmpty());
        const QStringList got = text.split('\r', Qt::SkipEmptyParts);
        for (int i = 1; i < got.size(); ++i)
            QCOMPARE(got[i].section(' ', 0, 0).toInt(), got[i - 1].section(' ', 0, 0).toInt() + 1);
    }

    // The port vanishes in a download: the records that came are kept.
    void logPortVanishes() {
        WindowFixture f;
        QVERIFY(up(f, "plain"));
        const auto log = newLog(f, 40);
        f.meter->vanishAfterSending(7);
        ModalDismisser dismiss;
        f.c().cmdLoggedData->click();
        QCOMPARE(f.state().workspaceText, table(log.mid(0, 7)));
        usable(f, dismiss);
    }

    // Records trickling in byte by byte behind a flood of "BUSY", then a garbled record: the
    // records before it stay.
    void slowLineAndGarbage() {
        WindowFixture f;
        QVERIFY(up(f, "plain"));
        auto log = newLog(f, 8);
        f.meter->setBaud(19200);
        f.meter->setBusyCount(10);
        f.c().cmdLoggedData->click();
        QCOMPARE(f.state().workspaceText, table(log));
        QVERIFY(f.prompts.shown.isEmpty());

        f.meter->setBaud(0);
        log[5] = "\x93\x01\xfe\xa0\x7f garbled\r";
        f.meter->setLogRecords(log);
        ModalDismisser dismiss;
        f.c().cmdLoggedData->click();
        QCOMPARE(f.state().workspaceText, table(log.mid(0, 5)));
        usable(f, dismiss);
    }
};

QTEST_MAIN(WindowTest)
#include "window_test.moc"
