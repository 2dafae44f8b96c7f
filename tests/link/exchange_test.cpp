// The command exchange, the connection and the port dialogs against the simulated meter, and the
// meter misbehaving on the wire.
#include "core/link/PortNames.h"
#include "desktop/link/Connection.h"
#include "desktop/link/Exchange.h"
#include "link/QuickWindow.h"
#include "robustness/ModalDismisser.h"

#include <QComboBox>
#include <QRandomGenerator>

using namespace DialogDriver;

// What the window shows of the meter: a reply read whole shows all of it.
static QString identity(QuickWindow& f) {
    return f.c().lblModelData->text() + f.c().lblSerialData->text() + f.c().lblNumLogData->text();
}

class LinkTest : public QObject {
    Q_OBJECT
private slots:
    void cleanup() { QCOMPARE(takeFailures(), QStringList()); }

    void exchange() {
        // Stored "COMn" settings name the platform's serial devices.
        QCOMPARE(PortNames::platformPath("\\\\.\\COM1"), "/dev/ttyS0");
        QuickWindow f;
        QVERIFY(f.open("plain"));
        Exchange& x = f.window->exchange();
        AppState& s = f.state();
        metersim::Meter& m = *f.meter;
        // Busy, empty and "OK" replies are sent again while the reply window lasts; a window
        // that runs out brings the busy prompt, even when the good reply came at last. Retry
        // repeats the whole exchange.
        f.line.secondsPerWrite = 0.35;
        const QList<QByteArray> busy6(6, "BUSY\r"), busy12(12, "BUSY\r");
        const std::tuple<const char*, QList<QByteArray>, bool> rows[] = {
            {"", {"\n"}, false},
            {"", {"ok\r"}, false},
            {"Device  detected  on  COM1 ...", busy12, false},
            {"Shutting  down  meter ...", busy12, false},
            {"", busy6, true}};
        for (const auto& [message, replies, prompted] : rows) {
            f.window->setMessage(message);
            m.clearReceived();
            m.queueReplies("?V", replies);
            f.prompts.clear();
            if (prompted)
                f.prompts.answerNext(Prompts::Answer::Retry);
            QVERIFY(x.ExchangeCommand("?V") && s.commandResent && s.responseText == "  6.3V\r");
            QCOMPARE(f.prompts.texts().join("").startsWith("Instrument  is  busy"), prompted);
            const int sent = m.count("?V\r");
            QVERIFY(prompted ? sent > replies.size() : sent == replies.size() + 1);
        }
        f.line.secondsPerWrite = 0;

        // Silence: 2 s for the reply, one re-send and 2 s more, then the busy prompt, whose
        // Cancel resets the link; the next exchange fails on the closed port.
        m.setSilent(true);
        m.clearReceived();
        const double start = f.clock.nowSeconds();
        QVERIFY(x.ExchangeCommand("?V") && s.responseText == "BUSY\r" && m.count("?V\r") == 2);
        QVERIFY(qAbs(f.clock.nowSeconds() - start - 4.25) < 0.25);
        QVERIFY(f.prompts.texts().last().startsWith("Instrument  is  busy") && !f.line.isOpen());
        QVERIFY(f.c().mnuDetectMeter->isEnabled() && !x.ExchangeCommand("?V"));
        m.setSilent(false);
        clickWhenModal("frmCommError", "cmdRetry");
        x.ShowCommError();
        QVERIFY(f.waitUntil([&] { return !s.modelCode.isEmpty(); }));

        // A meter that keeps printing: 41 line feeds, then the drain gives up.
        m.clearReceived();
        m.startEndlessSending();
        f.line.patienceMs = 150;
        x.FlushInput();
        m.stopEndlessSending();
        QVERIFY(s.abortRequested && !m.waitForReceived("\n", 42, 100) && m.count("\n") == 41);
    }

    // A silent meter is polled until it answers; replies that trickle in at 1200 baud, a byte
    // every 8 ms, are read whole, also when the whole reply takes longer than the time-out. Then
    // the port dialog saves the new port and speed before it connects; that port is not there,
    // so the unavailable dialog comes.
    void connection() {
        QuickWindow f;
        QVERIFY(f.startMeter("plain"));
        f.meter->setSilent(true);
        f.meter->setBaud(1200);
        f.line.patienceMs = 150;
        f.begin();
        QVERIFY(f.waitUntil([&] { return f.meter->count("?S\r") > 2; }));
        f.meter->setSilent(false);
        QVERIFY(f.waitUntil([&] { return identity(f) == "CD2000123453"; }));
        f.line.secondsPerRead = 0.1;
        f.meter->setLogRecords({});
        f.query();
        QCOMPARE(identity(f), "CD2000123450");

        QString shown;
        whenModal("frmCommsPort", [&](QWidget* d) {
            d->findChild<QComboBox*>("cboCom")->setEditText("/dev/telvio-gone");
            d->findChild<QComboBox*>("cboBaud")->setEditText("4800");
            click(d, "cmdOK");
        });
        whenModal("frmSerialPortUnavailable", [&](QWidget* d) {
            shown = f.settings.value("COM") + f.settings.value("Baud");
            click(d, "cmdCancel");
        });
        f.window->connection().ShowCommsPortDialog();
        QCOMPARE(shown, "/dev/telvio-gone4800");
        QVERIFY(f.c().mnuDetectMeter->isEnabled());
    }

    // Garbage for a status reply, a line that never ends, and a port that vanishes while the
    // voltage display runs. The garbage comes from a fixed seed, so a failure reproduces.
    void faults() {
        QuickWindow f;
        QVERIFY(f.open("percent-log"));
        QRandomGenerator random(7);
        for (int i = 0; i < 3; ++i) {
            quint32 words[6];
            random.fillRange(words);
            f.meter->queueReplies("?S", {QByteArray(reinterpret_cast<char*>(words), 24)});
            f.query();
        }
        f.meter->queueReplies("?V", {QByteArray(20000, 'x')});
        QVERIFY(f.window->exchange().ExchangeCommand("?V"));
        QCOMPARE(f.state().responseText.size(), Exchange::kMaxReplyLength);
        f.query();
        QCOMPARE(identity(f), "CP6000678903");

        f.c().mnuVoltage->trigger();
        QVERIFY(f.waitUntil([&] { return !f.state().workspaceText.isEmpty(); }));
        f.meter->vanish();
        // A tick while the dialog is up must not bring a second one.
        std::optional<ModalDismisser> dismiss;
        whenModal("frmCommError", [&](QWidget*) {
            f.c().tmrDisplayVoltage->start(1);
            dismiss.emplace();
        });
        f.c().tmrDisplayVoltage->start(1);
        QVERIFY(f.waitUntil([&] { return dismiss && !QApplication::activeModalWidget(); }));
        QCOMPARE(dismiss->seen, QStringList{"frmCommError"});
        QVERIFY(!f.state().abortRequested);
        QCOMPARE(identity(f) + f.c().RichTextBox1->toPlainText(), "Meter Battery Voltage = 6.3V\n");
    }
};

QTEST_MAIN(LinkTest)
#include "exchange_test.moc"
