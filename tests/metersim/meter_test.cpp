#include "Meter.h"

#include <QElapsedTimer>
#include <QSerialPort>
#include <QtTest>

using metersim::Meter;

namespace {

const QByteArray kWakeUp = QByteArray("{@").repeated(24) + "?S\r";

// The program's side of the line, kept minimal: write, then read one CR-ended line.
class Port {
public:
    explicit Port(const QString& path) {
        port.setPortName(path);
        opened = port.open(QIODevice::ReadWrite);
    }
    void write(const QByteArray& bytes) {
        port.write(bytes);
        port.waitForBytesWritten(500);
    }
    QByteArray readLine(int timeoutMs = 1000) {
        QElapsedTimer timer;
        timer.start();
        while (!pending.contains('\r') && timer.elapsed() < timeoutMs) {
            if (port.bytesAvailable() == 0 &&
                !port.waitForReadyRead(int(timeoutMs - timer.elapsed())))
                break;
            pending += port.readAll();
        }
        const qsizetype end = pending.indexOf('\r');
        const QByteArray line = end < 0 ? pending : pending.left(end + 1);
        pending.remove(0, line.size());
        return line;
    }
    QByteArray exchange(const QByteArray& bytes, int timeoutMs = 1000) {
        write(bytes);
        return readLine(timeoutMs);
    }
    QSerialPort port;
    QByteArray pending;
    bool opened = false;
};

} // namespace

class MeterTest : public QObject {
    Q_OBJECT
private slots:
    void statusPerProfile_data();
    void statusPerProfile();
    void scriptedRepliesAndFaults();
    void logWithAcksThenEnds();
    void percentHeaderMatchesPositions();
    void logLayouts_data();
    void logLayouts();
    void vanishGivesPortError();
    void recordsReceivedBytes();
};

void MeterTest::statusPerProfile_data() {
    QTest::addColumn<QString>("name");
    QTest::addColumn<QByteArray>("status");
    QTest::newRow("plain") << "plain" << QByteArray("CD200 V1.21 012345 0003\r");
    QTest::newRow("k51 without count") << "k51" << QByteArray("K51 V1.00 056789\r");
    QTest::newRow("k5ac") << "k5ac" << QByteArray("K5AC 0003 +m\r");
    QTest::newRow("k5ad") << "k5ad" << QByteArray("K5AD 0003 +\r");
    QTest::newRow("k5ah serial") << "k5ah" << QByteArray("K5AH 0003 +m 51234\r");
    QTest::newRow("percent log") << "percent-log" << QByteArray("CP600 V2.01 067890 0003 +mv%g\r");
    QTest::newRow("percent nolog") << "percent-nolog" << QByteArray("CP500 V1.10 078901 v%n\r");
    QTest::newRow("qr32") << "qr32" << QByteArray("QR32 0003 \r");
    QTest::newRow("zum410") << "zum410" << QByteArray("ZUM410 0003 \r");
    QTest::newRow("qr34 long word") << "qr34" << QByteArray("QR34A V1.40 089012 0003\r");
}

void MeterTest::statusPerProfile() {
    QFETCH(QString, name);
    QFETCH(QByteArray, status);
    Meter meter(metersim::profile(name));
    QVERIFY2(meter.start(), qPrintable(meter.errorString()));
    Port port(meter.portPath());
    QVERIFY(port.opened);
    QCOMPARE(port.exchange(kWakeUp), status);
    QCOMPARE(port.exchange("?S\r"), status);
}

void MeterTest::scriptedRepliesAndFaults() {
    Meter meter(metersim::profile("plain"));
    QVERIFY(meter.start());
    Port port(meter.portPath());
    meter.queueReplies("?D", {"OK\r", "EXIT\r"});
    meter.setReply("?V", "  5.9V\r");
    QCOMPARE(port.exchange("?D\r"), QByteArray("OK\r"));
    QCOMPARE(port.exchange("?D\r"), QByteArray("EXIT\r"));
    QCOMPARE(port.exchange("?D\r"), Meter::generateLog(meter.profile(), 1).constFirst());
    QCOMPARE(port.exchange("?V\r"), QByteArray("  5.9V\r"));
    QCOMPARE(port.exchange("?X\r"), QByteArray("ERROR\r"));
    QCOMPARE(port.exchange("?N\r"), QByteArray("SOFF\r"));
    QCOMPARE(port.exchange("?F\r"), QByteArray("LOG STOP\r"));
    // Line feeds from a drain get no answer.
    QCOMPARE(port.exchange("\n\n\n", 200), QByteArray());
    meter.setSilent(true);
    QCOMPARE(port.exchange("?S\r", 200), QByteArray());
    meter.setSilent(false);
    meter.setReplyDelayMs(300);
    QElapsedTimer timer;
    timer.start();
    QCOMPARE(port.exchange("?S\r", 2000), QByteArray("CD200 V1.21 012345 0003\r"));
    QVERIFY(timer.elapsed() >= 250);
    meter.setReplyDelayMs(0);
    meter.sendUnsolicited("\x81\xfe garbage");
    QCOMPARE(port.readLine(200), QByteArray("\x81\xfe garbage"));
    meter.setBusyCount(2);
    QCOMPARE(port.exchange("?S\r"), QByteArray("BUSY\r"));
    QCOMPARE(port.exchange("?S\r"), QByteArray("BUSY\r"));
    QCOMPARE(port.exchange("?S\r"), QByteArray("CD200 V1.21 012345 0003\r"));
    // 25 bytes at 1200 baud take about 200 ms.
    meter.setBaud(1200);
    timer.restart();
    QCOMPARE(port.exchange("?S\r"), QByteArray("CD200 V1.21 012345 0003\r"));
    QVERIFY(timer.elapsed() >= 180);
}

void MeterTest::logWithAcksThenEnds() {
    Meter meter(metersim::profile("k50"));
    QVERIFY(meter.start());
    const QList<QByteArray> log = Meter::generateLog(meter.profile(), 3);
    meter.setLogRecords(log);
    Port port(meter.portPath());
    QCOMPARE(port.exchange("?L\r"), log.at(0));
    // Nothing more comes until the acknowledgement.
    QCOMPARE(port.readLine(150), QByteArray());
    QCOMPARE(port.exchange("A"), log.at(1));
    QCOMPARE(port.exchange("A"), log.at(2));
    QCOMPARE(port.exchange("A"), QByteArray("ENDS\r"));
    QCOMPARE(port.exchange("A", 150), QByteArray());
    QCOMPARE(meter.count("A"), 4);
    // "Z" ends a transfer early.
    QCOMPARE(port.exchange("?L\r"), log.at(0));
    QCOMPARE(port.exchange("Z", 150), QByteArray());
    QCOMPARE(port.exchange("A", 150), QByteArray());
}

void MeterTest::percentHeaderMatchesPositions() {
    const metersim::Profile p = metersim::profile("percent-log");
    Meter meter(p);
    QVERIFY(meter.start());
    Port port(meter.portPath());
    const QByteArray header = port.exchange("?H\r");
    const QList<QByteArray> pos = port.exchange("?P\r").chopped(1).split(',');
    QCOMPARE(pos.size(), 1 + 2 * pos.at(0).toInt());
    const QByteArray reading = port.exchange("?D\r");
    // Every column of a reading starts where the positions say and lines up with the header.
    for (int c = 0; c < pos.at(0).toInt(); ++c) {
        const int start = pos.at(1 + 2 * c).toInt();
        QCOMPARE(header.at(start - 2), ' ');
        QVERIFY(header.at(start - 1) != ' ');
        QCOMPARE(reading.at(start - 2), ' ');
    }
    const int log = int(header.indexOf("Log#")) + 1;
    QCOMPARE(pos.at(5).toInt(), log);
    QCOMPARE(reading.mid(log - 1, 4), QByteArray("0001"));
}

void MeterTest::logLayouts_data() {
    QTest::addColumn<QString>("name");
    QTest::addColumn<int>("dateLength");
    QTest::addColumn<QByteArray>("dateStart");
    QTest::newRow("four-digit year") << "plain" << 19 << QByteArray("01/03/2004 08:00:00");
    QTest::newRow("two-digit year") << "k50" << 17 << QByteArray("01/03/04 08:00:00");
    QTest::newRow("k5") << "k5gj" << 11 << QByteArray("01/03 08:00");
}

void MeterTest::logLayouts() {
    QFETCH(QString, name);
    QFETCH(int, dateLength);
    QFETCH(QByteArray, dateStart);
    const QList<QByteArray> log = Meter::generateLog(metersim::profile(name), 10000);
    QCOMPARE(log.size(), 10000);
    QCOMPARE(log.first().chopped(1).right(dateLength), dateStart);
    // The record number wraps instead of widening the line.
    QCOMPARE(log.last().left(5), QByteArray("0000 "));
    bool sawPpk = false, sawAsterisk = false, sawMs = false;
    for (const QByteArray& r : log) {
        QVERIFY(r.endsWith('\r'));
        QCOMPARE(r.count('\r'), 1);
        QCOMPARE(r.at(r.size() - 1 - dateLength - 1), ' ');
        sawPpk |= r.contains("ppK");
        sawMs |= r.contains("mS");
        sawAsterisk |= r.contains('*');
    }
    QVERIFY(sawPpk && sawMs && sawAsterisk);
    // One record a minute: the last is almost a week later, so dates cross days.
    QVERIFY(log.last().contains("08/03"));
}

void MeterTest::vanishGivesPortError() {
    Meter meter(metersim::profile("k5ac"));
    QVERIFY(meter.start());
    const QString path = meter.portPath();
    Port port(path);
    QCOMPARE(port.exchange("?S\r"), QByteArray("K5AC 0003 +m\r"));
    meter.vanish();
    QVERIFY(meter.hasVanished());
    port.write("?S\r");
    port.port.waitForReadyRead(300);
    QVERIFY(port.port.error() != QSerialPort::NoError);
    QSerialPort again;
    again.setPortName(path);
    QVERIFY(!again.open(QIODevice::ReadWrite));
}

void MeterTest::recordsReceivedBytes() {
    Meter meter(metersim::profile("lxt"));
    QVERIFY(meter.start());
    Port port(meter.portPath());
    port.exchange(kWakeUp);
    port.exchange("?D\r");
    port.exchange("?D\r");
    QVERIFY(meter.waitForReceived("?D\r", 2, 1000));
    QCOMPARE(meter.received(), kWakeUp + "?D\r?D\r");
    const QList<metersim::ReceivedByte> bytes = meter.receivedWithTimes();
    QCOMPARE(bytes.size(), meter.received().size());
    for (int i = 1; i < bytes.size(); ++i)
        QVERIFY(bytes.at(i).t >= bytes.at(i - 1).t);
    const QList<double> times = meter.commandTimes("?D\r");
    QCOMPARE(times.size(), 2);
    QCOMPARE(times.at(1), bytes.last().t);
    QVERIFY(times.at(0) < times.at(1));
    QVERIFY(!meter.waitForReceived("?Q", 1, 50));
    meter.clearReceived();
    QCOMPARE(meter.count("?"), 0);
}

QTEST_GUILESS_MAIN(MeterTest)
#include "meter_test.moc"
