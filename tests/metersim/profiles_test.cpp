// The simulated meter's replies must be what the program's own rules can read: every profile's
// status, its log records and its readings go through the parsers the program uses.
#include "Meter.h"
#include "instrument/StatusReply.h"
#include "readings/HeaderPosition.h"
#include "readings/LineLayout.h"
#include "readings/LogLineFormat.h"
#include "readings/RealTimeLine.h"

#include <QtTest>

namespace {

LineLayout layoutOf(const StatusReply& s) {
    LineLayout l;
    l.percentFormat = s.format == StatusReply::Format::Percent;
    l.hasLog = s.hasLog;
    l.isK5Family = s.isK5Family;
    l.qr32 = s.modelCode.value_or(QString()) == "QR32";
    return l;
}

QString text(const QByteArray& bytes) {
    return QString::fromLatin1(bytes);
}

} // namespace

class ProfilesTest : public QObject {
    Q_OBJECT
private slots:
    void statusParses_data();
    void statusParses();
    void recordsAndReadingsFitTheirLayout_data();
    void recordsAndReadingsFitTheirLayout();
    void percentLogColumn();
};

void ProfilesTest::statusParses_data() {
    QTest::addColumn<QString>("name");
    QTest::addColumn<QString>("model");
    QTest::addColumn<int>("logged"); // -1: the reply carries no count
    QTest::addColumn<bool>("hasLog");
    QTest::addColumn<bool>("hasGlp");
    auto row = [](const char* name, const char* model, int logged, bool hasLog, bool hasGlp) {
        QTest::newRow(name) << QString(name) << QString(model) << logged << hasLog << hasGlp;
    };
    row("plain", "CD200", 42, true, true);
    row("k50", "K50", 42, true, true);
    row("k50v3", "K50V3", 42, true, true);
    row("lxt", "LXT200", 42, true, true);
    row("k51", "K51", -1, false, false);
    row("k5ac", "K5AC", 42, true, false);
    row("k5acmv", "K5ACMV", 42, true, false);
    row("k5ad", "K5ACMV", 42, true, false);
    row("k5gj", "K5GJ", 42, true, false);
    row("k5ah", "K5AH", 42, true, true);
    row("percent-log", "CP600", 42, true, false);
    row("percent-nolog", "CP500", -1, false, false);
    row("qr32", "QR32", 42, true, false);
    row("zum410", "QR32", 42, true, false);
    row("qr34", "QR34A", 42, true, true);
}

void ProfilesTest::statusParses() {
    QFETCH(QString, name);
    QFETCH(QString, model);
    QFETCH(int, logged);
    QFETCH(bool, hasLog);
    QFETCH(bool, hasGlp);
    const metersim::Profile p = metersim::profile(name);
    StatusReply s = parseStatusReply(text(p.statusReply(42)), QString());
    QCOMPARE(s.modelCode.value_or("?"), model);
    QCOMPARE(s.hasLog, hasLog);
    QCOMPARE(s.hasGLP, hasGlp);
    QCOMPARE(s.numLogged.value_or(-1), logged);
    // Only K5 and percent replies carry capability letters (a K5 model word counts too).
    const bool letters =
        p.format == metersim::StatusFormat::K5 || p.format == metersim::StatusFormat::Percent;
    QCOMPARE(s.canStir(), letters && (p.capabilities.contains('m') || p.model.contains('M')));
    QCOMPARE(s.canAutoLog(), letters && p.capabilities.contains('+'));
    QVERIFY(!s.batteryLow());
    if (s.needsVersionQuery) {
        parseVersionReply(text(p.secondStatusReply()), s);
        QCOMPARE(s.firmwareVersion.value_or("?"), text(p.version));
        QCOMPARE(s.serialNumber.value_or("?"), text(p.serial));
    }
    if (p.format != metersim::StatusFormat::Plain && p.format != metersim::StatusFormat::Qr32) {
        metersim::Profile low = p;
        low.lowBattery = true;
        QVERIFY(parseStatusReply(text(low.statusReply(42)), QString()).batteryLow());
    }
}

void ProfilesTest::recordsAndReadingsFitTheirLayout_data() {
    QTest::addColumn<QString>("name");
    for (const QString& name : metersim::profileNames())
        QTest::newRow(qPrintable(name)) << name;
}

void ProfilesTest::recordsAndReadingsFitTheirLayout() {
    QFETCH(QString, name);
    const metersim::Profile p = metersim::profile(name);
    const StatusReply s = parseStatusReply(text(p.statusReply(3)), QString());
    const LineLayout layout = layoutOf(s);
    const QList<QByteArray> records = metersim::Meter::generateLog(p, 10000);
    for (qsizetype i : {qsizetype(0), qsizetype(1), qsizetype(2), records.size() - 1}) {
        const QString record = text(records.at(i));
        if (p.hasLog) {
            const auto line = layout.qr32 ? LogLineFormat::qr32Record(record)
                                          : LogLineFormat::reformat(record, layout);
            QVERIFY2(line.has_value(), qPrintable(record));
            // Dated layouts put the date first: day and month of the generated stamps.
            if (!layout.percentFormat)
                QVERIFY2(line->startsWith("01/03/") || line->startsWith("01/03 ") ||
                             line->startsWith("08/03"),
                         qPrintable(*line));
        }
        RealTimeLine::Context context{layout, true, 22, 4, QDateTime::currentDateTime()};
        const auto reading = RealTimeLine::build(record, 7, context);
        QVERIFY2(reading.has_value(), qPrintable(record));
        QVERIFY2(reading->contains("   7"), qPrintable(*reading));
    }
}

void ProfilesTest::percentLogColumn() {
    const metersim::Profile p = metersim::profile("percent-log");
    const auto column =
        HeaderPosition::findLogColumn(text(p.headerReply()), text(p.positionsReply()));
    QVERIFY(column.found);
    QCOMPARE(column.start, 22);
    QCOMPARE(column.width, 4);
    QCOMPARE(metersim::Meter::generateLog(p, 5).at(4).mid(21, 4), QByteArray("0005"));
}

QTEST_GUILESS_MAIN(ProfilesTest)
#include "profiles_test.moc"
