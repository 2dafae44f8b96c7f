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

    auto row = [](const char* tag, const QString& record, const LineLayout& layout, bool ok,
                  const QString& line) { QTest::newRow(tag) << record << layout << ok << line; };
    row("four-digit year", "  7.03 pH 25.0C 12/03/2004 10:15:00\r", general(), true,
        "12/03/2004 10:15:00   7.03 pH 25.0C");
    row("four-digit year, reading right against the date", "1.413mS12/03/2004 10:15:00\r",
        general(), true, "12/03/2004 10:15:00 1.413mS");
    row("two-digit year 04", "R 12/03/04 10:15:00\r", general(), true, "12/03/2004  10:15:00 R");
    row("two-digit year 75", " 1*413ppK 31/12/75 23:59:59\r", general(), true,
        "31/12/2075  23:59:59  1*413ppK");
    row("two-digit year 76", " 1*413ppK 01/01/76 00:00:00\r", general(), true,
        "01/01/1976  00:00:00  1*413ppK");
    row("two-digit year 99", "X 01/01/99 00:00:00\r", general(), true, "01/01/1999  00:00:00 X");
    row("two-digit year 00", "X 01/01/00 00:00:00\r", general(), true, "01/01/2000  00:00:00 X");
    row("K5 family", "  1.413mS 12/03 10:15\r", k5(), true, "12/03 10:15   1.413mS");
    row("K5, no space before the field", "0.5ppK12/03 10:15\r", k5(), true, "12/03 10:15 0.5ppK");
    row("marin: two characters dropped", "1.413mS--12/03/2004 10:15\r", marin(), true,
        "12/03/2004 10:15 1.413mS");
    row("only one trailing space dropped", "R   12/03/2004 10:15:00\r", general(), true,
        "12/03/2004 10:15:00 R  ");
    row("percent unchanged, CR kept", " 12/03/2004 10:15 0003  7.00\r", percent(true), true,
        " 12/03/2004 10:15 0003  7.00\r");
    row("percent, even a short line", "x\r", percent(false), true, "x\r");
    row("shortest general record: empty reading", "12/03/2004 10:15:00\r", general(), true,
        "12/03/2004 10:15:00 ");
    row("shortest two-digit record", "12/03/04 10:15:00\r", general(), true,
        "12/03/2004  10:15:00 ");

    row("too short: general 19", "2/03/2004 10:15:00\r", general(), false, QString());
    row("too short: two-digit 17", "2/03/04 10:15:00\r", general(), false, QString());
    row("too short: K5 11", "2/03 10:15\r", k5(), false, QString());
    row("too short: marin 18", "-12/03/2004 10:15\r", marin(), false, QString());
    row("empty", QString(), general(), false, QString());
    row("lone CR", CR, k5(), false, QString());
    row("year that is not a number", "R 12/03/x4 10:15:00\r", general(), false, QString());
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
    auto row = [](const char* tag, const QString& record, bool ok, const QString& line) {
        QTest::newRow(tag) << record << ok << line;
    };
    row("37 characters", qr32Reply(), true, "12/03/2004 10:15:00" + reading + CR);
    row("38: line feed in front kept", "\n" + qr32Reply(), true,
        "\n12/03/2004 10:15:00" + reading + CR);
    row("39: nothing cut off", "\n\n" + qr32Reply(), true,
        "\n\n12/03/2004 10:15:00" + reading + CR);
    row("short record is not repeated", "12/03/04 10.15.00 7\r", true, "12/03/2004 10:15:00 7\r");
    row("15 characters", "12/03/04 10.15.", true, "12/03/2004 10:15:");
    row("14 characters", "12/03/04 10.15", false, QString());
    row("empty", QString(), false, QString());
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
    auto row = [](const char* tag, const QString& reply, int number, const LineLayout& layout,
                  bool known, int start, int width, bool ok, const QString& line) {
        QTest::newRow(tag) << reply << number << layout << known << start << width << ok << line;
    };
    row("percent with log: Log# overwritten", pLog, 7, percent(true), true, 12, 4, true,
        "ABCDEFGHIJK   7XYZ\r");
    row("percent with log: at most the column width", pLog, 7, percent(true), true, 12, 3, true,
        "ABCDEFGHIJK   1XYZ\r");
    row("percent with log: at most the line's end", "ABCDEFGHIJK00", 1234, percent(true), true, 12,
        4, true, "ABCDEFGHIJK12");
    row("percent with log: long number in a 4-wide column", pLog, 12345, percent(true), true, 12, 4,
        true, "ABCDEFGHIJK1234XYZ\r");
    row("percent with log: column unknown, line unchanged", pLog, 7, percent(true), false, 12, 4,
        true, pLog);
    row("percent with log: reply shorter than the column", "ABCDEFGHI\r", 7, percent(true), true,
        12, 4, false, QString());
    row("percent without log: date, time, number in front", "  7.00 pH\r", 7, percent(false), false,
        0, 0, true, "06/12/2026 09:05:03    7   7.00 pH\r");
    row("QR32", qr32Reply(), 7, qr32(), false, 0, 0, true,
        "12/03/2004 10:15:00    7.34 mS/cm  25.0\r");
    row("QR32 too short", "12/03/04 10.15", 1, qr32(), false, 0, 0, false, QString());
    row("general: number replaces the first four", "0000  7.03pH 12/03/2004 10:15:00\r", 7,
        general(), false, 0, 0, true, "12/03/2004 10:15:00    7  7.03pH");
    row("general, two-digit year", "0000  7.03pH 12/03/80 10:15:00\r", 10, general(), false, 0, 0,
        true, "12/03/1980  10:15:00   10  7.03pH");
    row("K5", "0000 1.4mS 12/03 10:15\r", 7, k5(), false, 0, 0, true, "12/03 10:15    7 1.4mS");
    row("fewer than four characters", "12\r", 1, general(), false, 0, 0, false, QString());
    row("too short to move the date", "0000 1.4mS 10:15\r", 1, general(), false, 0, 0, false,
        QString());
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

    auto row = [](const char* tag, const QString& header, const QString& position, bool found,
                  int start, int width) {
        QTest::newRow(tag) << header << position << found << start << width;
    };
    row("three columns, two-digit start", " Date Time Log# pH\r", "4,2,4,7,4,12,4,17,2\r", true, 12,
        4);
    row("two columns, one-digit start", " Date Log# pH\r", "3,1,4,5,4,9,2\r", true, 5, 4);
    row("first column", " Log# pH\r", "2,1,4,6,2\r", true, 1, 4);
    row("runs of spaces count once", "   Date     Time    Log#   pH", "4,2,4,7,4,12,4,17,2", true,
        12, 4);
    row("three-digit start", " A B Log#", "3,1,40,50,45,100,4", true, 100, 4);
    row("no Log in the header", " Date Time pH\r", "3,2,4,7,4,12,4\r", false, 0, 0);
    row("too few commas", " Date Time Log# pH\r", "4,2,4,7\r", false, 0, 0);
    row("start without width", " Date Time Log# pH\r", "4,2,4,7,4,12\r", false, 0, 0);
    row("no commas at all", " Date Time Log# pH\r", "BUSY\r", false, 0, 0);
    row("Log with no column before it", "Log# pH", "2,1,4,6,2", false, 0, 0);
    row("fields that are not numbers", " Date Time Log# pH", "4,2,4,7,4,x2,4,17,2", false, 0, 0);
    row("empty", QString(), QString(), false, 0, 0);
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
