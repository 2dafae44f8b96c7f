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

    QTest::newRow("date time reading unit temperature") << "01/02/2024 10:11:12  7.00 pH  25.0 C\n"
                                                        << "01/02/2024 10:11:12,7.00,,25.0,\n";
    QTest::newRow("three numbers") << "1.0 2.0 3.0\n"
                                   << "1.0 2.0,3.0\n";
    QTest::newRow("three words") << "abc def ghi\n"
                                 << "abc def,\n";
    QTest::newRow("plus OVR") << "01/02/2024 10:11:12  +OVR mS  25.0 C\n"
                              << "01/02/2024 10:11:12, OVR,,25.0,\n";
    QTest::newRow("minus OVR") << "d t  -OVR uS\n"
                               << "d t, OVR,\n";
    QTest::newRow("OVR without sign") << "d t  OVR mS\n"
                                      << "d t,OVR,\n";
    QTest::newRow("sign away from OVR") << "d t  +1 OVR\n"
                                        << "d t,+1,OVR\n";
    QTest::newRow("exponent kept, lower e dropped") << "1 2 1E-3 1e5\n"
                                                    << "1 2,1E-3,15\n";
    QTest::newRow("line without comma") << "Title\n1 2 3\n"
                                        << "Title\n1 2,3\n";
    QTest::newRow("blank lines") << "\n\n1 2\n"
                                 << "\n\n1 2\n";
    QTest::newRow("no final line feed") << "1.0 2.0 3.0"
                                        << "1.0 2.0,3.0";
    QTest::newRow("no comma after last line feed") << "1 2 3\nend"
                                                   << "1 2,3\nend";
    QTest::newRow("last line one word") << "1 2 3\nend\n"
                                        << "1 2,3\nend\n";
    QTest::newRow("trailing space") << "a b \n"
                                    << "a b \n";
    QTest::newRow("leading spaces of text") << "  1.5 2.5\n"
                                            << "1.5 2.5\n";
    QTest::newRow("leading spaces of line") << "x\n  7 8 9\n"
                                            << "x\n 7,8,9\n";
    QTest::newRow("comma first") << ",a b\n"
                                 << ",\n";
    QTest::newRow("CR LF, unit last") << "1 2 pH\r\n"
                                      << "1 2,\n";
    QTest::newRow("CR LF, one field") << "7.00 pH\r\n"
                                      << "7.00 pH\r\n";
    QTest::newRow("slashes and colons after first field") << "a b 1/2 3:4\n"
                                                          << "a b,12,34\n";
    QTest::newRow("ends with comma and no line feed") << "a b c "
                                                      << "a b,,";
    QTest::newRow("empty") << ""
                           << "";
    QTest::newRow("only spaces") << "   "
                                 << "";
    QTest::newRow("log table") << "Date       Time      Log#  Reading\n"
                                  "01/02/2024 10:00:00  1     1.413 mS/cm  25.0 C\n"
                                  "01/02/2024 10:00:10  2     1*414 mS/cm  25.1 C\n"
                               << "Date Time,,\n"
                                  "01/02/2024 10:00:00,1,1.413,,25.0,\n"
                                  "01/02/2024 10:00:10,2,1414,,25.1,\n";
}

void CommaDelimitedTest::converts() {
    QFETCH(QString, input);
    QFETCH(QString, expected);
    QCOMPARE(CommaDelimited::convert(input), expected);
}

QTEST_APPLESS_MAIN(CommaDelimitedTest)
#include "commadelimited_test.moc"
