#include "workspace/ReadingConversions.h"

#include <QTest>

class ReadingConversionsTest : public QObject {
    Q_OBJECT
private slots:
    void convertsText_data();
    void convertsText();
    void convertsValueField_data();
    void convertsValueField();
    void rendersSingle_data();
    void rendersSingle();
    void secondRunChangesNothing_data();
    void secondRunChangesNothing();
};

// Flags: m = mS to uS, p = ppK to ppM, a = asterisks.
void ReadingConversionsTest::convertsText_data() {
    QTest::addColumn<QString>("flags");
    QTest::addColumn<QString>("input");
    QTest::addColumn<QString>("expected");

    auto row = [](const char* tag, const char* flags, const char* input, const char* expected) {
        QTest::newRow(tag) << QString(flags) << QString(input) << QString(expected);
    };
    row("1.413", "m", "ab 1.413mS/cm\n", "ab  1413uS/cm\n");
    row("1*413 no fraction left", "m", "ab 1*413mS\n", "ab  1413uS\n");
    row("12*345", "m", "ab12*345mS\n", "ab 12345uS\n");
    row("1*2345 keeps asterisk", "m", "ab1*2345mS\n", "ab1234*5uS\n");
    row("1234.5 over limit", "m", "ab1234.5mS\n", "ab  +OVRuS\n");
    row("999.99 under limit", "m", "ab999.99mS\n", "ab999990uS\n");
    row("1000 over limit", "m", "ab  1000mS\n", "ab  +OVRuS\n");
    row("dashes", "m", "ab ---.-mS\n", "ab ---.-uS\n");
    row("letters", "m", "abcdefghmS\n", "abcdefghuS\n");
    row("header word", "m", "Cond mS/cm  Temp\n", "Cond uS/cm  Temp\n");
    row("two numbers in field", "m", "ab1 2 3 mS\n", "ab1 2 3 uS\n");
    row("sign", "m", "ab +0.25mS\n", "ab   250uS\n");
    row("negative", "m", "ab -0.25mS\n", "ab  -250uS\n");
    row("rounding noise", "m", "ab0.0013mS\n", "ab   1.3uS\n");
    row("trailing blank", "m", "ab 0.52 mS\n", "ab   520uS\n");
    row("longer rendering overwrites", "m", "abc -100.0mS\n", "abc-100000uS\n");
    row("longer rendering stops at line", "m", "x\n-99999mS\n", "x\n-99999uS\n");
    row("units off", "", "ab 1.413mS 7*0ppK\n", "ab 1.413mS 7*0ppK\n");
    row("only ppK", "p", "ab 1.413mS  0.52ppK\n", "ab 1.413mS   520ppM\n");
    row("ppK asterisk", "p", "ab 0*525ppK\n", "ab   525ppM\n");
    row("ppK fraction asterisk", "p", "ab1*2345ppK\n", "ab1234*5ppM\n");
    row("asterisk pass last", "ma", "ab1*2345mS 7*00\n", "ab1234.5uS 7.00\n");
    row("asterisks only", "a", "7*00 pH 1*413mS\n", "7.00 pH 1.413mS\n");
    row("unit in first four", "m", "1mS 2mS\n", "1mS 2uS\n");
    row("short field at 5", "m", "1.41mS\n", "1410uS\n");
    row("short field at 6", "m", "0.005mS\n", "    5uS\n");
    row("short field too narrow", "m", "12.5mS\n", "12.5uS\n");
    row("unit at end", "m", "ab 1.413mS", "ab  1413uS");
    row("lone m at end", "m", "ab 1.413m", "ab 1.413m");
    row("empty", "map", "", "");
    row("many lines", "mp",
        "01/02/2024 10:00:00  1.413mS  0.70ppK\n"
        "01/02/2024 10:00:01  1.414mS  0.71ppK\n",
        "01/02/2024 10:00:00   1413uS   700ppM\n"
        "01/02/2024 10:00:01   1414uS   710ppM\n");
}

void ReadingConversionsTest::convertsText() {
    QFETCH(QString, flags);
    QFETCH(QString, input);
    QFETCH(QString, expected);
    ReadingConversions conv;
    conv.msToUs = flags.contains(u'm');
    conv.ppkToPpm = flags.contains(u'p');
    conv.asterisks = flags.contains(u'a');
    const QString out = conv.apply(input);
    QCOMPARE(out, expected);
    QCOMPARE(out.size(), input.size());
}

void ReadingConversionsTest::convertsValueField_data() {
    QTest::addColumn<QString>("field");
    QTest::addColumn<QString>("expected"); // "-" = not a number

    auto row = [](const char* tag, const char* field, const char* expected) {
        QTest::newRow(tag) << QString(field) << QString(expected);
    };
    row("exactly 999999", "999.999", "999999");
    row("just above", "999.9991", "+OVR");
    row("zero", "  0.00", "0");
    row("minus zero", " -0.00", "0");
    row("point only", "     .", "-");
    row("two points", " 1.2.3", "-");
    row("two asterisks", " 1*2*3", "-");
    row("sign alone", "     +", "-");
    row("sign then blank", "  - 12", "-");
    row("exponent", "   1E2", "-");
    row("blanks", "      ", "-");
    row("line feed", "\n12.34", "-");
    row("leading point", "  .005", "5");
    row("trailing point", "   12.", "12000");
    row("small", ".00001", "0.01");
    row("asterisk fraction", "0*0005", "0*5");
}

void ReadingConversionsTest::convertsValueField() {
    QFETCH(QString, field);
    QFETCH(QString, expected);
    const auto out = ReadingConversions::convertValueField(field);
    if (expected == QLatin1String("-"))
        QVERIFY2(!out, qPrintable(out.value_or(QString())));
    else
        QCOMPARE(out.value_or(QStringLiteral("<none>")), expected);
}

void ReadingConversionsTest::rendersSingle_data() {
    QTest::addColumn<float>("value");
    QTest::addColumn<QString>("expected");
    QTest::newRow("integer") << 1413.0f << "1413";
    QTest::newRow("fraction") << 1234.5f << "1234.5";
    QTest::newRow("tenth") << 0.1f << "0.1";
    QTest::newRow("seven digits") << 1234567.0f << "1234567";
    QTest::newRow("eight digits rounded") << 12345678.0f << "12345680";
    QTest::newRow("third") << (1.0f / 3.0f) << "0.3333333";
    QTest::newRow("small") << 0.000125f << "0.000125";
    QTest::newRow("negative") << -2.5f << "-2.5";
    QTest::newRow("round ten") << 100000.0f << "100000";
}

void ReadingConversionsTest::rendersSingle() {
    QFETCH(float, value);
    QFETCH(QString, expected);
    QCOMPARE(ReadingConversions::renderSingle(value), expected);
}

void ReadingConversionsTest::secondRunChangesNothing_data() {
    QTest::addColumn<QString>("input");
    QTest::newRow("mixed") << "ab1*2345mS ab 0*525ppK 7*00 pH\nCond mS/cm\n 12.5mS\n";
    QTest::newRow("overflow") << "ab1234.5mS\nab -100.0mS\n";
    QTest::newRow("short") << "1.41mS 0.5ppK";
}

void ReadingConversionsTest::secondRunChangesNothing() {
    QFETCH(QString, input);
    for (int bits = 0; bits < 8; ++bits) {
        ReadingConversions conv;
        conv.msToUs = bits & 1;
        conv.ppkToPpm = bits & 2;
        conv.asterisks = bits & 4;
        const QString once = conv.apply(input);
        QCOMPARE(conv.apply(once), once);
    }
}

QTEST_APPLESS_MAIN(ReadingConversionsTest)
#include "readingconversions_test.moc"
