// Faults in the middle of the continuous operations: the port vanishing at random points of a
// log download, a GLP download, a real-time run and listen mode; garbage, flipped bytes, a
// flood of "BUSY" and byte-by-byte replies during a download. Every line received before the
// fault stays in the workspace and the window is usable afterwards. Seeds are fixed.
#include "ModalDismisser.h"
#include "WindowFixture.h"
#include "readings/LogLineFormat.h"

#include <QAction>
#include <QLabel>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QRandomGenerator>
#include <QTest>
#include <QTimer>

namespace {

QStringList lines(const QString& text) {
    QStringList l = text.split(QLatin1Char('\n'));
    if (!l.isEmpty() && l.constLast().isEmpty())
        l.removeLast();
    return l;
}

// The table lines the plain meter's records become (no conversions are switched on).
QStringList tableLines(const QList<QByteArray>& records) {
    QStringList out;
    for (const QByteArray& r : records)
        out << LogLineFormat::reformat(QString::fromLatin1(r), LineLayout()).value_or("?");
    return out;
}

// No operation running, every command back, the workspace shown as held. After the port was
// lost, Detect Meter is offered again.
void checkUsable(WindowFixture& f, bool linkLost) {
    const MainControls& c = f.c();
    QVERIFY(f.waitUntil([] { return QApplication::activeModalWidget() == nullptr; }, 5000));
    QVERIFY(f.window->isEnabled());
    QVERIFY(c.cmdStopCurrentData->isHidden());
    QVERIFY(!f.state().runActive);
    QVERIFY(!f.state().abortRequested);
    if (linkLost)
        QVERIFY(c.mnuDetectMeter->isEnabled());
    QVERIFY(c.cmdOpenFile->isEnabled());
    // A line the meter ended with CR shows as one line break, with or without LF after it.
    const auto normal = [](QString t) {
        t.replace(QStringLiteral("\r\n"), QStringLiteral("\n")).replace(u'\r', u'\n');
        while (t.endsWith(u'\n'))
            t.chop(1);
        return t;
    };
    const QString shown = normal(c.RichTextBox1->toPlainText());
    const QString held = normal(f.state().workspaceText);
    if (shown != held) {
        qsizetype at = 0;
        while (at < shown.size() && at < held.size() && shown[at] == held[at])
            ++at;
        QFAIL(qPrintable(QStringLiteral("view and workspace differ at %1: \"%2\" / \"%3\"")
                             .arg(at)
                             .arg(shown.mid(at, 40).replace(u'\n', QStringLiteral("\\n")),
                                  held.mid(at, 40).replace(u'\n', QStringLiteral("\\n")))));
    }
}

void startRealTime(WindowFixture& f, const QString& entry) {
    auto* timer = new QTimer(f.window.get());
    timer->setInterval(10);
    QObject::connect(timer, &QTimer::timeout, timer, [timer, entry] {
        QWidget* d = QApplication::activeModalWidget();
        if (!d || d->objectName() != QLatin1String("frmRealTimeInterval"))
            return;
        timer->stop();
        timer->deleteLater();
        d->findChild<QLineEdit*>(QStringLiteral("txtLogInterval"))->setText(entry);
        d->findChild<QPushButton*>(QStringLiteral("cmdOK"))->click();
    });
    timer->start();
    f.c().cmdCurrentData->click();
}

QByteArray flipped(QRandomGenerator& random, QByteArray bytes) {
    const int at = int(random.bounded(bytes.size()));
    bytes[at] = char(bytes[at] ^ (1 << random.bounded(8)));
    return bytes == "\0" ? "x" : bytes;
}

} // namespace

class ReadingFaultsTest : public QObject {
    Q_OBJECT

private slots:
    void logDownloadPortVanishes_data() {
        QTest::addColumn<int>("seed");
        for (int seed : {1, 2, 3, 4, 5})
            QTest::newRow(qPrintable(QStringLiteral("seed %1").arg(seed))) << seed;
    }
    void logDownloadPortVanishes() {
        QFETCH(int, seed);
        const int records = 60;
        const int after = int(QRandomGenerator(quint32(seed)).bounded(records));
        WindowFixture f;
        QVERIFY(f.startDetected(QStringLiteral("plain")));
        const auto log = metersim::Meter::generateLog(f.meter->profile(), records);
        f.meter->setLogRecords(log);
        f.meter->vanishAfterSending(after);
        ModalDismisser dismiss;
        f.c().cmdLoggedData->click();
        QVERIFY(f.meter->hasVanished());
        QCOMPARE(dismiss.seen, QStringList{"frmCommError"});
        QCOMPARE(lines(f.state().workspaceText), tableLines(log.mid(0, after)));
        checkUsable(f, true);
    }

    void glpDownloadPortVanishes_data() {
        QTest::addColumn<int>("after");
        QTest::newRow("before the first line") << 0;
        QTest::newRow("after one line") << 1;
        QTest::newRow("after three lines") << 3;
    }
    void glpDownloadPortVanishes() {
        QFETCH(int, after);
        WindowFixture f;
        QVERIFY(f.startDetected(QStringLiteral("plain")));
        const QList<QByteArray> glp = {"GLP  Calibration  01/03/2004 07:30\r", "Std 1  12.88mS\r",
                                       "Std 2  1*413mS\r", "Std 3  111.8mS\r", "Std 4  0.5ppK\r"};
        f.meter->setRecordLines("?G", glp);
        f.meter->vanishAfterSending(after);
        ModalDismisser dismiss;
        f.c().cmdGLPData->click();
        QVERIFY(f.waitUntil([&] { return f.meter->hasVanished(); }, 5000));
        QVERIFY(f.waitUntil([&] { return !dismiss.seen.isEmpty(); }, 8000));
        QCOMPARE(dismiss.seen, QStringList{"frmCommError"});
        QStringList expected;
        for (const QByteArray& l : glp.mid(0, after))
            expected << QString::fromLatin1(l).chopped(1);
        QCOMPARE(lines(f.state().workspaceText.remove(u'\r')), expected);
        checkUsable(f, true);
    }

    void realTimeRunPortVanishes_data() {
        QTest::addColumn<int>("seed");
        for (int seed : {1, 2, 3})
            QTest::newRow(qPrintable(QStringLiteral("seed %1").arg(seed))) << seed;
    }
    void realTimeRunPortVanishes() {
        QFETCH(int, seed);
        const int before = 1 + int(QRandomGenerator(quint32(seed)).bounded(4));
        WindowFixture f;
        QVERIFY(f.startDetected(QStringLiteral("plain")));
        startRealTime(f, QStringLiteral("1"));
        QVERIFY(f.waitUntil([&] { return lines(f.state().workspaceText).size() >= before; },
                            before * 1000 + 4000));
        const QStringList kept = lines(f.state().workspaceText);
        ModalDismisser dismiss;
        f.meter->vanish();
        QVERIFY(f.waitUntil([&] { return !f.state().runActive && !dismiss.seen.isEmpty(); }, 8000));
        QCOMPARE(dismiss.seen, QStringList{"frmCommError"});
        const QStringList now = lines(f.state().workspaceText);
        QVERIFY(now.size() >= kept.size());
        QCOMPARE(now.mid(0, kept.size()), kept);
        checkUsable(f, true);
    }

    void listenPortVanishes_data() {
        QTest::addColumn<int>("seed");
        for (int seed : {1, 2, 3})
            QTest::newRow(qPrintable(QStringLiteral("seed %1").arg(seed))) << seed;
    }
    void listenPortVanishes() {
        QFETCH(int, seed);
        QRandomGenerator random{quint32(seed)};
        const int count = 1 + int(random.bounded(200));
        WindowFixture f;
        QVERIFY(f.startDetected(QStringLiteral("plain")));
        f.c().cmdListen->click();
        QStringList sent;
        for (int i = 0; i < count; ++i) {
            sent << QStringLiteral("%1  1.%2mS")
                        .arg(i, 4)
                        .arg(random.bounded(1000), 3, 10, QLatin1Char('0'));
            f.meter->sendUnsolicited(sent.last().toLatin1() + "\r\n");
        }
        QVERIFY(f.waitUntil([&] { return f.state().workspaceText.count(u'\r') >= count; }, 8000));
        ModalDismisser dismiss;
        f.meter->vanish();
        QVERIFY(f.waitUntil([&] { return !f.c().mnuListen->isChecked() || !f.state().runActive; },
                            5000));
        QVERIFY(f.waitUntil([&] { return f.c().cmdStopCurrentData->isHidden(); }, 5000));
        const QStringList got =
            lines(QString(f.state().workspaceText).remove(u'\r')).filter(QStringLiteral("mS"));
        QCOMPARE(got, sent);
        checkUsable(f, true);
    }

    // Records with a flipped bit or random bytes: the download goes on or ends with the
    // communication-error dialog, but every record before the bad one is in the table.
    void logDownloadGarbage_data() {
        QTest::addColumn<int>("seed");
        for (int seed : {1, 2, 3, 4, 5, 6})
            QTest::newRow(qPrintable(QStringLiteral("seed %1").arg(seed))) << seed;
    }
    void logDownloadGarbage() {
        QFETCH(int, seed);
        QRandomGenerator random{quint32(seed)};
        WindowFixture f;
        QVERIFY(f.startDetected(QStringLiteral("plain")));
        auto log = metersim::Meter::generateLog(f.meter->profile(), 30);
        const int bad = int(random.bounded(30));
        if (seed % 2) {
            log[bad] = flipped(random, log[bad]);
        } else {
            QByteArray noise(1 + int(random.bounded(60)), 'x');
            for (char& b : noise)
                b = char(1 + random.bounded(255));
            log[bad] = noise.replace('\r', "") + '\r';
        }
        f.meter->setLogRecords(log);
        ModalDismisser dismiss;
        f.c().cmdLoggedData->click();
        QVERIFY(f.waitUntil([&] { return f.c().cmdStopCurrentData->isHidden(); }, 15000));
        const QStringList got = lines(f.state().workspaceText);
        QVERIFY(got.size() >= bad);
        QCOMPARE(got.mid(0, bad), tableLines(log.mid(0, bad)));
        checkUsable(f, false);
    }

    // A log download whose records trickle in at 2400 baud, with "BUSY" floods on the way.
    void logDownloadSlowAndBusy() {
        WindowFixture f;
        QVERIFY(f.startDetected(QStringLiteral("plain")));
        const auto log = metersim::Meter::generateLog(f.meter->profile(), 20);
        f.meter->setLogRecords(log);
        f.meter->setBaud(2400);
        f.meter->setBusyCount(50);
        f.c().cmdLoggedData->click();
        QVERIFY(f.waitUntil([&] { return f.c().cmdStopCurrentData->isHidden(); }, 30000));
        QCOMPARE(lines(f.state().workspaceText), tableLines(log));
        QVERIFY(f.prompts.texts().isEmpty());
        checkUsable(f, false);
    }
};

QTEST_MAIN(ReadingFaultsTest)
#include "readings_test.moc"
