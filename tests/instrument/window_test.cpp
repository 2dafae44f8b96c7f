// The status display and the control commands, through the main window and a simulated meter.
#include "core/instrument/ModelTable.h"
#include "core/instrument/StatusReply.h"
#include "desktop/shell/Twips.h"
#include "link/QuickWindow.h"
#include "robustness/ModalDismisser.h"

#include <QSignalSpy>

using namespace DialogDriver;

class InstrumentWindowTest : public QObject {
    Q_OBJECT
private slots:
    void cleanup() { QCOMPARE(takeFailures(), QStringList()); }

    // Every meter profile: the window shows what the reply parser and the model table say.
    void statusDisplayFollowsTheParser() {
        QuickWindow f;
        QVERIFY(f.open("plain"));
        const MainControls& c = f.c();
        auto on = [&](QWidget* w) { return w->isVisibleTo(f.window.get()) && w->isEnabled(); };
        // First a K5 meter with the stirrer alone and a low battery.
        QList<metersim::Profile> profiles{metersim::profile("k5ac")};
        profiles[0].capabilities = "m";
        profiles[0].lowBattery = true;
        for (const QString& name : metersim::profileNames())
            profiles << metersim::profile(name);
        // The model shown when the battery warning came.
        QString warned;
        f.prompts.onShow = [&](const auto&) { warned = c.lblModelData->text(); };
        for (const metersim::Profile& p : profiles) {
            for (auto [command, reply] : {std::pair{"?S", p.statusReply(3)},
                                          {"?W", p.secondStatusReply()},
                                          {"?H", p.headerReply()},
                                          {"?P", p.positionsReply()}})
                f.meter->setReply(command, reply);
            f.meter->clearReceived();
            warned.clear();
            f.query();

            StatusReply r = parseStatusReply(p.statusReply(3), "");
            if (r.needsVersionQuery)
                parseVersionReply(p.secondStatusReply(), r);
            const QString model = *r.modelCode;
            const bool maxMin = modeltable::keepsMaxMin(model), stir = r.canStir(), log = r.hasLog;
            const bool pct = r.format == StatusReply::Format::Percent;
            QCOMPARE(QStringList({c.lblModelData->text(), c.lblVersionData->text(),
                                  c.lblSerialData->text(), c.lblNumLogData->text(),
                                  f.state().modelCode, warned}),
                     QStringList({model, *r.firmwareVersion, *r.serialNumber, log ? "3" : "",
                                  maxMin ? "QR34" : model, r.batteryLow() ? model : ""}));
            QCOMPARE(QList<bool>({on(c.cmdEnableLogging), on(c.cmdStopStirring), on(c.cmdK5Off),
                                  on(c.cmdGLPData), on(c.cmdEraseLog), on(c.cmdMaxMin),
                                  c.mnuVoltage->isVisible(), on(c.lblHeader),
                                  f.meter->count("?W\r") == 1}),
                     QList<bool>({r.canAutoLog(), stir, r.isK5Family, r.hasGLP, log, maxMin,
                                  pct && r.reportsVoltage(), pct, r.needsVersionQuery}));
            // Power button, help button and workspace, in twips; the workspace moves down by
            // what a header line needs beyond its room.
            const int first = r.canAutoLog() ? 2550 : 30, help = log ? 6750 : 5070;
            const int line = QFontMetrics(c.lblHeader->font()).lineSpacing();
            const int room = pct ? qMax(0, line - twipsToPixels(210)) : 0;
            QVERIFY(!pct || (c.lblHeader->height() >= line &&
                             c.lblHeader->geometry().bottom() < c.RichTextBox1->y()));
            QCOMPARE(QList<int>({c.cmdK5On->x(), c.cmdHelp->x(), c.RichTextBox1->y()}),
                     QList<int>({r.isK5Family ? twipsToPixels(first + 2520 * stir) : c.cmdK5On->x(),
                                 twipsToPixels(maxMin || r.hasGLP ? 7590 : help),
                                 room + twipsToPixels(
                                            pct ? 1420 + 1020 * (r.isK5Family || first > 30 || stir)
                                                : 1080 + 1020 * r.isK5Family)}));
        }

        // After "qr34"; the battery warning was the only message.
        f.meter->setReply("?S", "ERROR\r");
        f.query();
        QVERIFY(c.lblModelData->text().isEmpty() && !on(c.cmdMaxMin) && c.cmdSaveFile->isEnabled());
        QVERIFY(!c.cmdLoggedData->isEnabled() && f.prompts.shown.size() == 1);
    }

    // One meter through every control command in turn.
    void controlCommands() {
        QuickWindow f;
        QVERIFY(f.open("percent-log"));
        const MainControls& c = f.c();
        metersim::Meter& m = *f.meter;
        // The voltage: the same value twice is drawn once; "ERROR" ends the display.
        QSignalSpy redraws(c.RichTextBox1, &QPlainTextEdit::textChanged);
        c.mnuVoltage->trigger();
        m.queueReplies("?V", {" 6.3V \r", "6.3V \r", "error Exit\r"});
        for (int polls = 1; polls <= 3; ++polls) {
            // The next tick now rather than in two seconds.
            c.tmrDisplayVoltage->start(1);
            QVERIFY(f.waitUntil([&] { return m.count("?V\r") == polls; }));
        }
        QCOMPARE(c.RichTextBox1->toPlainText() + QString::number(redraws.count()),
                 "Meter Battery Voltage = 6.3V \n1");
        QCOMPARE(f.prompts.texts(),
                 QStringList({" This function is not available with your firmware version.",
                              "User has terminated this process."}));
        QVERIFY(!c.tmrDisplayVoltage->isActive());

        // A reply other than "ERASED" leaves the confirmation open; Yes once more.
        f.prompts.clear();
        m.queueReplies("?E", {"NOT NOW\r"});
        whenModal("frmLogEraseCheck", [&](QWidget* d) {
            click(d, "cmdOK");
            click(d, "cmdOK");
        });
        c.mnuEraseLog->trigger();
        QCOMPARE(f.prompts.texts().join("") + c.lblNumLogData->text(), "Logged readings erased.0");

        // A status reply to take first, the button, the meter's replies, the command sent, and
        // the status line and message shown.
        using Row = std::tuple<QList<QByteArray>, QPushButton*, QList<QByteArray>, const char*,
                               const char*>;
        const Row rows[] = {
            {{}, c.cmdEnableLogging, {}, "?J", "Logging  enabled."},
            {{"K5AC 0003 +m\r"}, c.cmdEnableLogging, {}, "?G", "Logging  enabled."},
            {{}, c.cmdDisableLogging, {}, "?F", "Logging  disabled."},
            {{}, c.cmdStartStirring, {}, "?M", "Stirrer  started."},
            {{}, c.cmdStartStirring, {"BLOW\r"}, "?M", "-Meter  battery  is  low!"},
            {{}, c.cmdStopStirring, {}, "?N", "Stirrer  stopped."},
            {{"K5AH 0003 +m 51234\r"}, c.cmdEnableLogging, {}, "?J", "Logging  enabled."},
            {{}, c.cmdK5Off, {"NO\r"}, "?K", "Shutting  down  meter ..."}};
        for (const auto& [status, button, replies, sent, shown] : rows) {
            m.queueReplies("?S", status);
            if (!status.isEmpty())
                f.query();
            m.queueReplies(sent, replies);
            f.window->setMessage("-");
            m.clearReceived();
            f.prompts.clear();
            button->click();
            QVERIFY(m.received().endsWith("\n" + QByteArray(sent) + "\r"));
            QCOMPARE(c.lblMessage->text() + f.prompts.texts().join(""), shown);
        }

        m.clearReceived();
        c.cmdK5Off->click();
        // The wake-up, two drains (the first reads the wake-up's reply), "?K".
        QCOMPARE(m.received(), QByteArray("{@").repeated(24) + "?S\r\n\n\n?K\r");
        QCOMPARE(c.lblMessage->text() + c.lblModelData->text() + c.lblNumLogData->text(),
                 "Meter  has  been  shut  down.");
        QVERIFY(!c.cmdK5Off->isEnabled() && !c.mnuDisplay->isEnabled() && !f.line.isOpen());
        QVERIFY(c.cmdK5On->isEnabled() && c.mnuDetectMeter->isEnabled());
        c.cmdK5On->click();
        QVERIFY(f.waitUntil([&] { return c.lblModelData->text() == "CP600"; }));

        // The log is empty now: no confirmation.
        ModalDismisser dismiss;
        c.cmdEraseLog->click();
        QCOMPARE(f.prompts.texts().last() + dismiss.seen.join(""), "No logged readings to erase!");
    }
};

QTEST_MAIN(InstrumentWindowTest)
#include "window_test.moc"
