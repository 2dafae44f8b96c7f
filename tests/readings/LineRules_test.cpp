// Log records, real-time lines and the Log# column scan: the text rules, without a window.
#include "readings/HeaderPosition.h"
#include "readings/LogLineFormat.h"
#include "readings/RealTimeLine.h"

#include <QtTest>

namespace {

const QString CR = QStringLiteral("\r");

LineLayout general() {
    return {};
}
LineLayout k5() {
    LineLayout l;
    l.isK5Family = true;
    return l;
}
LineLayout marin() {
    LineLayout l;
    l.marinLago = true;
    return l;
}
LineLayout percent(bool withLog) {
    LineLayout l;
    l.percentFormat = true;
    l.hasLog = withLog;
    return l;
}
LineLayout qr32() {
    LineLayout l;
    l.qr32 = true;
    return l;
}

// A QR32 record: dd/mm/yy, one character, hh?mm?ss with other separators, a 19-character
// reading and CR: 37 characters in all.
QString qr32Reply(const QString& reading = QStringLiteral("  12.34 mS/cm  25.0")) {
    return QStringLiteral("12/03/04 10.15.00") + reading + CR;
}

} // namespace

class LineRulesTest : public QObject {
    Q_OBJECT
private slots:
    void reformat_data();
    void reformat();
    void marinLagoModelCodes();
    void qr32Record_data();
    void qr32Record();
    void realTimeLine_data();
    void realTimeLine();
    void numberText();
    void logColumn_data();
    void logColumn();
    void headerWithoutLog();
};

void LineRulesTest::reformat_data() {
    QTest::addColumn<QString>("record");
    QTest::addColumn<LineLayout>("layout");
    QTest::addColumn<bool>("ok");
    QTest::addColumn<QString>("line");

    QTest::newRow("four-digit year")
        << QStringLiteral("  7.03 pH 25.0C 12/03/2004 10:15:00\r") << general() << true
        << QStringLiteral("12/03/2004 10:15:00   7.03 pH 25.0C");
    QTest::newRow("four-digit year, reading right against the date")
        << QStringLiteral("1.413mS12/03/2004 10:15:00\r") << general() << true
        << QStringLiteral("12/03/2004 10:15:00 1.413mS");
    QTest::newRow("two-digit year 04") << QStringLiteral("R 12/03/04 10:15:00\r") << general()
                                       << true << QStringLiteral("12/03/2004  10:15:00 R");
    QTest::newRow("two-digit year 75")
        << QStringLiteral(" 1*413ppK 31/12/75 23:59:59\r") << general() << true
        << QStringLiteral("31/12/2075  23:59:59  1*413ppK");
    QTest::newRow("two-digit year 76")
        << QStringLiteral(" 1*413ppK 01/01/76 00:00:00\r") << general() << true
        << QStringLiteral("01/01/1976  00:00:00  1*413ppK");
    QTest::newRow("two-digit year 99") << QStringLiteral("X 01/01/99 00:00:00\r") << general()
                                       << true << QStringLiteral("01/01/1999  00:00:00 X");
    QTest::newRow("two-digit year 00") << QStringLiteral("X 01/01/00 00:00:00\r") << general()
                                       << true << QStringLiteral("01/01/2000  00:00:00 X");
    QTest::newRow("K5 family") << QStringLiteral("  1.413mS 12/03 10:15\r") << k5() << true
                               << QStringLiteral("12/03 10:15   1.413mS");
    QTest::newRow("K5, no space before the field") << QStringLiteral("0.5ppK12/03 10:15\r") << k5()
                                                   << true << QStringLiteral("12/03 10:15 0.5ppK");
    QTest::newRow("marin: two characters dropped")
        << QStringLiteral("1.413mS--12/03/2004 10:15\r") << marin() << true
        << QStringLiteral("12/03/2004 10:15 1.413mS");
    QTest::newRow("only one trailing space dropped")
        << QStringLiteral("R   12/03/2004 10:15:00\r") << general() << true
        << QStringLiteral("12/03/2004 10:15:00 R  ");
    QTest::newRow("percent unchanged, CR kept")
        << QStringLiteral(" 12/03/2004 10:15 0003  7.00\r") << percent(true) << true
        << QStringLiteral(" 12/03/2004 10:15 0003  7.00\r");
    QTest::newRow("percent, even a short line")
        << QStringLiteral("x\r") << percent(false) << true << QStringLiteral("x\r");
    QTest::newRow("shortest general record: empty reading")
        << QStringLiteral("12/03/2004 10:15:00\r") << general() << true
        << QStringLiteral("12/03/2004 10:15:00 ");
    QTest::newRow("shortest two-digit record") << QStringLiteral("12/03/04 10:15:00\r") << general()
                                               << true << QStringLiteral("12/03/2004  10:15:00 ");

    QTest::newRow("too short: general 19")
        << QStringLiteral("2/03/2004 10:15:00\r") << general() << false << QString();
    QTest::newRow("too short: two-digit 17")
        << QStringLiteral("2/03/04 10:15:00\r") << general() << false << QString();
    QTest::newRow("too short: K5 11")
        << QStringLiteral("2/03 10:15\r") << k5() << false << QString();
    QTest::newRow("too short: marin 18")
        << QStringLiteral("-12/03/2004 10:15\r") << marin() << false << QString();
    QTest::newRow("empty") << QString() << general() << false << QString();
    QTest::newRow("lone CR") << CR << k5() << false << QString();
    QTest::newRow("year that is not a number")
        << QStringLiteral("R 12/03/x4 10:15:00\r") << general() << false << QString();
}

void LineRulesTest::reformat() {
    QFETCH(QString, record);
    QFETCH(LineLayout, layout);
    QFETCH(bool, ok);
    QFETCH(QString, line);
    const auto result = LogLineFormat::reformat(record, layout);
    QCOMPARE(result.has_value(), ok);
    if (ok)
        QCOMPARE(*result, line);
}

void LineRulesTest::marinLagoModelCodes() {
    // The layout the download uses comes from the identity: marin/lago by model code prefix.
    AppState s;
    for (const char* code : {"marin", "marine2", "lago3"}) {
        s.modelCode = QString::fromLatin1(code);
        QVERIFY2(LineLayout::fromState(s).marinLago, code);
    }
    for (const char* code : {"Marin", "mari", "xlago", "QR32"}) {
        s.modelCode = QString::fromLatin1(code);
        QVERIFY2(!LineLayout::fromState(s).marinLago, code);
    }
    s.modelCode = QStringLiteral("QR32");
    QVERIFY(LineLayout::fromState(s).qr32);
}

void LineRulesTest::qr32Record_data() {
    QTest::addColumn<QString>("record");
    QTest::addColumn<bool>("ok");
    QTest::addColumn<QString>("line");

    const QString reading = QStringLiteral("  12.34 mS/cm  25.0");
    QTest::newRow("37 characters")
        << qr32Reply() << true << QStringLiteral("12/03/2004 10:15:00") + reading + CR;
    QTest::newRow("38: line feed in front kept")
        << QStringLiteral("\n") + qr32Reply() << true
        << QStringLiteral("\n12/03/2004 10:15:00") + reading + CR;
    QTest::newRow("39: nothing cut off")
        << QStringLiteral("\n\n") + qr32Reply() << true
        << QStringLiteral("\n\n12/03/2004 10:15:00") + reading + CR;
    QTest::newRow("short record is not repeated") << QStringLiteral("12/03/04 10.15.00 7\r") << true
                                                  << QStringLiteral("12/03/2004 10:15:00 7\r");
    QTest::newRow("15 characters")
        << QStringLiteral("12/03/04 10.15.") << true << QStringLiteral("12/03/2004 10:15:");
    QTest::newRow("14 characters") << QStringLiteral("12/03/04 10.15") << false << QString();
    QTest::newRow("empty") << QString() << false << QString();
}

void LineRulesTest::qr32Record() {
    QFETCH(QString, record);
    QFETCH(bool, ok);
    QFETCH(QString, line);
    const auto result = LogLineFormat::qr32Record(record);
    QCOMPARE(result.has_value(), ok);
    if (ok)
        QCOMPARE(*result, line);
}

void LineRulesTest::realTimeLine_data() {
    QTest::addColumn<QString>("reply");
    QTest::addColumn<int>("number");
    QTest::addColumn<LineLayout>("layout");
    QTest::addColumn<bool>("columnKnown");
    QTest::addColumn<int>("columnStart");
    QTest::addColumn<int>("columnWidth");
    QTest::addColumn<bool>("ok");
    QTest::addColumn<QString>("line");

    const QString pLog = QStringLiteral("ABCDEFGHIJK0001XYZ\r");
    QTest::newRow("percent with log: Log# overwritten")
        << pLog << 7 << percent(true) << true << 12 << 4 << true
        << QStringLiteral("ABCDEFGHIJK   7XYZ\r");
    QTest::newRow("percent with log: at most the column width")
        << pLog << 7 << percent(true) << true << 12 << 3 << true
        << QStringLiteral("ABCDEFGHIJK   1XYZ\r");
    QTest::newRow("percent with log: at most the line's end")
        << QStringLiteral("ABCDEFGHIJK00") << 1234 << percent(true) << true << 12 << 4 << true
        << QStringLiteral("ABCDEFGHIJK12");
    QTest::newRow("percent with log: long number in a 4-wide column")
        << pLog << 12345 << percent(true) << true << 12 << 4 << true
        << QStringLiteral("ABCDEFGHIJK1234XYZ\r");
    QTest::newRow("percent with log: column unknown, line unchanged")
        << pLog << 7 << percent(true) << false << 12 << 4 << true << pLog;
    QTest::newRow("percent with log: reply shorter than the column")
        << QStringLiteral("ABCDEFGHI\r") << 7 << percent(true) << true << 12 << 4 << false
        << QString();
    QTest::newRow("percent without log: date, time, number in front")
        << QStringLiteral("  7.00 pH\r") << 7 << percent(false) << false << 0 << 0 << true
        << QStringLiteral("06/12/2026 09:05:03    7   7.00 pH\r");
    QTest::newRow("QR32") << qr32Reply() << 7 << qr32() << false << 0 << 0 << true
                          << QStringLiteral("12/03/2004 10:15:00    7.34 mS/cm  25.0\r");
    QTest::newRow("QR32 too short")
        << QStringLiteral("12/03/04 10.15") << 1 << qr32() << false << 0 << 0 << false << QString();
    QTest::newRow("general: number replaces the first four")
        << QStringLiteral("0000  7.03pH 12/03/2004 10:15:00\r") << 7 << general() << false << 0 << 0
        << true << QStringLiteral("12/03/2004 10:15:00    7  7.03pH");
    QTest::newRow("general, two-digit year")
        << QStringLiteral("0000  7.03pH 12/03/80 10:15:00\r") << 10 << general() << false << 0 << 0
        << true << QStringLiteral("12/03/1980  10:15:00   10  7.03pH");
    QTest::newRow("K5") << QStringLiteral("0000 1.4mS 12/03 10:15\r") << 7 << k5() << false << 0
                        << 0 << true << QStringLiteral("12/03 10:15    7 1.4mS");
    QTest::newRow("fewer than four characters")
        << QStringLiteral("12\r") << 1 << general() << false << 0 << 0 << false << QString();
    QTest::newRow("too short to move the date")
        << QStringLiteral("0000 1.4mS 10:15\r") << 1 << general() << false << 0 << 0 << false
        << QString();
}

void LineRulesTest::realTimeLine() {
    QFETCH(QString, reply);
    QFETCH(int, number);
    QFETCH(LineLayout, layout);
    QFETCH(bool, columnKnown);
    QFETCH(int, columnStart);
    QFETCH(int, columnWidth);
    QFETCH(bool, ok);
    QFETCH(QString, line);

    RealTimeLine::Context context;
    context.layout = layout;
    context.logColumnKnown = columnKnown;
    context.logColumnStart = columnStart;
    context.logColumnWidth = columnWidth;
    context.now = QDateTime(QDate(2026, 12, 6), QTime(9, 5, 3));
    const auto result = RealTimeLine::build(reply, number, context);
    QCOMPARE(result.has_value(), ok);
    if (ok)
        QCOMPARE(*result, line);
}

void LineRulesTest::numberText() {
    QCOMPARE(RealTimeLine::numberText(1), QStringLiteral("   1"));
    QCOMPARE(RealTimeLine::numberText(9999), QStringLiteral("9999"));
    QCOMPARE(RealTimeLine::numberText(10000), QStringLiteral("10000"));
}

void LineRulesTest::logColumn_data() {
    QTest::addColumn<QString>("header");
    QTest::addColumn<QString>("position");
    QTest::addColumn<bool>("found");
    QTest::addColumn<int>("start");
    QTest::addColumn<int>("width");

    QTest::newRow("three columns, two-digit start")
        << QStringLiteral(" Date Time Log# pH\r") << QStringLiteral("4,2,4,7,4,12,4,17,2\r") << true
        << 12 << 4;
    QTest::newRow("two columns, one-digit start")
        << QStringLiteral(" Date Log# pH\r") << QStringLiteral("3,1,4,5,4,9,2\r") << true << 5 << 4;
    QTest::newRow("first column") << QStringLiteral(" Log# pH\r") << QStringLiteral("2,1,4,6,2\r")
                                  << true << 1 << 4;
    QTest::newRow("runs of spaces count once")
        << QStringLiteral("   Date     Time    Log#   pH") << QStringLiteral("4,2,4,7,4,12,4,17,2")
        << true << 12 << 4;
    QTest::newRow("three-digit start")
        << QStringLiteral(" A B Log#") << QStringLiteral("3,1,40,50,45,100,4") << true << 100 << 4;
    QTest::newRow("no Log in the header") << QStringLiteral(" Date Time pH\r")
                                          << QStringLiteral("3,2,4,7,4,12,4\r") << false << 0 << 0;
    QTest::newRow("too few commas")
        << QStringLiteral(" Date Time Log# pH\r") << QStringLiteral("4,2,4,7\r") << false << 0 << 0;
    QTest::newRow("start without width") << QStringLiteral(" Date Time Log# pH\r")
                                         << QStringLiteral("4,2,4,7,4,12\r") << false << 0 << 0;
    QTest::newRow("no commas at all")
        << QStringLiteral(" Date Time Log# pH\r") << QStringLiteral("BUSY\r") << false << 0 << 0;
    QTest::newRow("Log with no column before it")
        << QStringLiteral("Log# pH") << QStringLiteral("2,1,4,6,2") << false << 0 << 0;
    QTest::newRow("fields that are not numbers")
        << QStringLiteral(" Date Time Log# pH") << QStringLiteral("4,2,4,7,4,x2,4,17,2") << false
        << 0 << 0;
    QTest::newRow("empty") << QString() << QString() << false << 0 << 0;
}

void LineRulesTest::logColumn() {
    QFETCH(QString, header);
    QFETCH(QString, position);
    QFETCH(bool, found);
    QFETCH(int, start);
    QFETCH(int, width);
    const auto column = HeaderPosition::findLogColumn(header, position);
    QCOMPARE(column.found, found);
    if (found) {
        QCOMPARE(column.start, start);
        QCOMPARE(column.width, width);
    }
}

void LineRulesTest::headerWithoutLog() {
    const QString reply = QStringLiteral("  pH     mV\r");
    QCOMPARE(HeaderPosition::headerFor(reply, true), reply);
    const QString header = HeaderPosition::headerFor(reply, false);
    QVERIFY(header.startsWith(QStringLiteral("   Date      Time   Log# ")));
    QCOMPARE(header.mid(25), reply);
}

QTEST_APPLESS_MAIN(LineRulesTest)
#include "LineRules_test.moc"
