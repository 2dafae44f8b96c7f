// The meter misbehaving on the wire while the program detects it and asks for its status:
// garbage and flipped bytes, a flood of "BUSY", replies a byte at a time, a meter that resets.
// Random faults use fixed seeds, so a failure reproduces.
#include "ModalDismisser.h"
#include "WindowFixture.h"
#include "instrument/InstrumentCommands.h"

#include <QAction>
#include <QLabel>
#include <QPushButton>
#include <QRandomGenerator>
#include <QTest>

namespace {

bool noModal() {
    return QApplication::activeModalWidget() == nullptr;
}

// The identity the "plain" meter shows once detected with its default log.
void checkPlainIdentity(WindowFixture& f) {
    QCOMPARE(f.state().modelCode, QStringLiteral("CD200"));
    QCOMPARE(f.c().lblModelData->text(), QStringLiteral("CD200"));
    QCOMPARE(f.c().lblVersionData->text(), QStringLiteral("V1.21"));
    QCOMPARE(f.c().lblSerialData->text(), QStringLiteral("012345"));
    QCOMPARE(f.state().numLogged, f.meter->logRecords().size());
    QVERIFY(f.c().cmdLoggedData->isEnabled());
}

// After a fault: Detect Meter where the window offers it (the link was reset), otherwise the
// status query every data command starts with. Either must bring the right identity back.
bool recover(WindowFixture& f) {
    f.state().modelCode.clear();
    if (f.c().mnuDetectMeter->isEnabled())
        f.c().mnuDetectMeter->trigger();
    else
        f.window->instrument().QueryStatus();
    return f.waitUntil([&] { return !f.state().modelCode.isEmpty() && noModal(); }, 15000);
}

QByteArray garbage(QRandomGenerator& random, bool withCR) {
    QByteArray bytes(1 + int(random.bounded(80)), '\0');
    for (char& b : bytes)
        b = char(1 + random.bounded(255)); // the wire carries codes 1 to 255
    bytes.replace('\r', "");
    return withCR ? bytes + '\r' : bytes;
}

QByteArray flipped(QRandomGenerator& random, QByteArray reply) {
    const int flips = 1 + int(random.bounded(3));
    for (int i = 0; i < flips; ++i) {
        const int at = int(random.bounded(reply.size()));
        reply[at] = char(reply[at] ^ (1 << random.bounded(8)));
    }
    return reply;
}

} // namespace

class LinkFaultsTest : public QObject {
    Q_OBJECT

private slots:
    // Several bad status replies in a row, then the meter answers properly again.
    void garbageAndFlippedReplies_data() {
        QTest::addColumn<int>("seed");
        QTest::addColumn<QString>("kind");
        for (int seed : {1, 2, 3})
            for (const char* kind : {"random with CR", "random without CR", "flipped bits"})
                QTest::newRow(qPrintable(QStringLiteral("%1, seed %2").arg(kind).arg(seed)))
                    << seed << QString::fromLatin1(kind);
    }
    void garbageAndFlippedReplies() {
        QFETCH(int, seed);
        QFETCH(QString, kind);
        WindowFixture f;
        QVERIFY(f.startDetected(QStringLiteral("plain")));
        checkPlainIdentity(f);
        const QByteArray good = f.meter->profile().statusReply(f.meter->logRecords().size());

        QRandomGenerator random{quint32(seed)};
        ModalDismisser dismiss;
        for (int i = 0; i < 4; ++i) {
            f.meter->queueReplies("?S", {kind.startsWith(u"flipped")
                                             ? flipped(random, good)
                                             : garbage(random, kind == u"random with CR")});
            f.window->instrument().QueryStatus();
            // Whatever the bad reply did, nothing is left hanging.
            QVERIFY(f.waitUntil(noModal, 5000));
            QVERIFY(f.window->isEnabled());
        }
        QVERIFY2(recover(f), qPrintable(f.prompts.texts().join(u'|') + QStringLiteral(" | ") +
                                        dismiss.seen.join(u'|') + QStringLiteral(" | ") +
                                        f.c().lblMessage->text()));
        checkPlainIdentity(f);
    }

    // "BUSY" over and over: the command is sent again each time, then the reply is taken.
    void busyFlood() {
        WindowFixture f;
        QVERIFY(f.startDetected(QStringLiteral("plain")));
        f.meter->clearReceived();
        f.meter->setBusyCount(500);
        f.window->instrument().QueryStatus();
        QVERIFY(f.prompts.texts().isEmpty());
        QVERIFY(f.meter->count("?S\r") >= 501);
        checkPlainIdentity(f);
    }

    // A meter that stays busy past the reply window: the busy prompt, then a usable window.
    void endlessBusy() {
        WindowFixture f;
        QVERIFY(f.startDetected(QStringLiteral("plain")));
        f.meter->setBusyCount(1000000);
        ModalDismisser dismiss;
        f.window->instrument().QueryStatus();
        QVERIFY(!f.prompts.texts().isEmpty());
        QVERIFY(f.prompts.texts().first().startsWith(QStringLiteral("Instrument  is  busy")));
        f.meter->setBusyCount(0);
        QVERIFY(recover(f));
        checkPlainIdentity(f);
    }

    // Replies that trickle in a byte at a time, or come late: all arrive, nothing is lost.
    void slowBytes_data() {
        QTest::addColumn<int>("baud");
        QTest::addColumn<int>("delayMs");
        QTest::newRow("1200 baud") << 1200 << 0;
        QTest::newRow("300 baud") << 300 << 0;
        QTest::newRow("late by 1.5 s") << 0 << 1500;
    }
    void slowBytes() {
        QFETCH(int, baud);
        QFETCH(int, delayMs);
        WindowFixture f;
        QVERIFY(f.startMeter(QStringLiteral("plain")));
        f.meter->setBaud(baud);
        f.meter->setReplyDelayMs(delayMs);
        f.start();
        QVERIFY(f.waitUntil([&] { return !f.state().modelCode.isEmpty(); }, 20000));
        QVERIFY(f.prompts.texts().isEmpty());
        checkPlainIdentity(f);
    }

    // The meter resets: it says nothing for a while, then answers again after Detect Meter.
    void meterResets() {
        WindowFixture f;
        QVERIFY(f.startDetected(QStringLiteral("plain")));
        f.meter->setSilent(true);
        ModalDismisser dismiss;
        f.window->instrument().QueryStatus();
        // Silence counts as busy until the reply window ends: one prompt, then the link reset.
        QCOMPARE(f.prompts.texts().size(), 1);
        QVERIFY(f.prompts.texts().first().startsWith(QStringLiteral("Instrument  is  busy")));
        QVERIFY(f.waitUntil(noModal, 5000));
        // Detection keeps calling the silent meter without piling up dialogs.
        f.c().mnuDetectMeter->trigger();
        QTest::qWait(1500);
        QVERIFY(f.c().tmrDetectMeter->isActive());
        QVERIFY(f.state().modelCode.isEmpty());
        f.meter->setSilent(false);
        QVERIFY(f.waitUntil([&] { return !f.state().modelCode.isEmpty(); }, 8000));
        checkPlainIdentity(f);
        QCOMPARE(f.prompts.texts().size(), 1);
    }
};

QTEST_MAIN(LinkFaultsTest)
#include "link_test.moc"
