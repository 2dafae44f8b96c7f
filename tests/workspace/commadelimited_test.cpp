#include "workspace/CommaDelimited.h"

#include <QTest>

class CommaDelimitedTest : public QObject {
    Q_OBJECT
private slots:
    void converts_data();
    void converts();
};

void CommaDelimitedTest::converts_data() {
    QTest::addColumn<QString>("input");
    QTest::addColumn<QString>("expected");

    auto row = [](const char* tag, const char* input, const char* expected) {
        QTest::newRow(tag) << QString(input) << QString(expected);
    };
    row("date time reading unit temperature", "01/02/2024 10:11:12  7.00 pH  25.0 C\n",
        "01/02/2024 10:11:12,7.00,,25.0,\n");
    row("three numbers", "1.0 2.0 3.0\n", "1.0 2.0,3.0\n");
    row("three words", "abc def ghi\n", "abc def,\n");
    row("plus OVR", "01/02/2024 10:11:12  +OVR mS  25.0 C\n", "01/02/2024 10:11:12, OVR,,25.0,\n");
    row("minus OVR", "d t  -OVR uS\n", "d t, OVR,\n");
    row("OVR without sign", "d t  OVR mS\n", "d t,OVR,\n");
    row("sign away from OVR", "d t  +1 OVR\n", "d t,+1,OVR\n");
    row("exponent kept, lower e dropped", "1 2 1E-3 1e5\n", "1 2,1E-3,15\n");
    row("line without comma", "Title\n1 2 3\n", "Title\n1 2,3\n");
    row("blank lines", "\n\n1 2\n", "\n\n1 2\n");
    row("no final line feed", "1.0 2.0 3.0", "1.0 2.0,3.0");
    row("no comma after last line feed", "1 2 3\nend", "1 2,3\nend");
    row("last line one word", "1 2 3\nend\n", "1 2,3\nend\n");
    row("trailing space", "a b \n", "a b \n");
    row("leading spaces of text", "  1.5 2.5\n", "1.5 2.5\n");
    row("leading spaces of line", "x\n  7 8 9\n", "x\n 7,8,9\n");
    row("comma first", ",a b\n", ",\n");
    row("CR LF, unit last", "1 2 pH\r\n", "1 2,\n");
    row("CR LF, one field", "7.00 pH\r\n", "7.00 pH\r\n");
    row("slashes and colons after first field", "a b 1/2 3:4\n", "a b,12,34\n");
    row("ends with comma and no line feed", "a b c ", "a b,,");
    row("empty", "", "");
    row("only spaces", "   ", "");
    row("log table",
        "Date       Time      Log#  Reading\n"
        "01/02/2024 10:00:00  1     1.413 mS/cm  25.0 C\n"
        "01/02/2024 10:00:10  2     1*414 mS/cm  25.1 C\n",
        "Date Time,,\n"
        "01/02/2024 10:00:00,1,1.413,,25.0,\n"
        "01/02/2024 10:00:10,2,1414,,25.1,\n");
}

void CommaDelimitedTest::converts() {
    QFETCH(QString, input);
    QFETCH(QString, expected);
    QCOMPARE(CommaDelimited::convert(input), expected);
}

QTEST_APPLESS_MAIN(CommaDelimitedTest)
#include "commadelimited_test.moc"
