// Fields cut from replies and records: where they end, when they count as present, and which
// comparisons are exact.
#include "instrument/ModelTable.h"
#include "instrument/StatusReply.h"
#include "readings/HeaderPosition.h"
#include "readings/LogLineFormat.h"
#include "workspace/ReadingConversions.h"

#include <QTest>

class ReplyFieldsTest : public QObject {
    Q_OBJECT
private slots:
    void valueFieldEndsAtLineBreak_data() {
        QTest::addColumn<QString>("text");
        QTest::addColumn<QString>("converted");
        QTest::newRow("LF") << "x\n1.413mS"
                            << "x\n 1413uS";
        QTest::newRow("CR") << "x\r1.413mS"
                            << "x\r 1413uS";
        QTest::newRow("no room before the break") << "abc\n1*5mS"
                                                  << "abc\n1*5uS";
        QTest::newRow("dashes") << "\n--.--mS"
                                << "\n--.--uS";
    }
    void valueFieldEndsAtLineBreak() {
        QFETCH(QString, text);
        const ReadingConversions msToUs{true, false, false};
        QTEST(msToUs.apply(text), "converted");
    }

    void shortVersionReplyKeepsItsFields() {
        StatusReply r = parseStatusReply(QStringLiteral("ZUM410 0042 \r"), QString());
        parseVersionReply(QStringLiteral("QR32VER 1.5 A1234"), r);
        QCOMPARE(r.firmwareVersion, QStringLiteral("1.5"));
        QVERIFY(!r.serialNumber);
    }

    void yearFieldIsTheNumberInIt_data() {
        QTest::addColumn<QString>("record");
        QTest::addColumn<QString>("line");
        QTest::newRow("space, digit") << "R 12/03/ 4 10:15:00\r"
                                      << "12/03/2004  10:15:00 R";
        QTest::newRow("digit, space") << "R 12/03/9  10:15:00\r"
                                      << "12/03/2009  10:15:00 R";
        QTest::newRow("no number") << "R 12/03/-- 10:15:00\r"
                                   << "-";
    }
    void yearFieldIsTheNumberInIt() {
        QFETCH(QString, record);
        QTEST(LogLineFormat::reformat(record, LineLayout{}).value_or(QStringLiteral("-")), "line");
    }

    void modelAndHeaderWordsAreExact() {
        QCOMPARE(modeltable::modelMinimumIntervalSeconds(QStringLiteral("AB-LXT9")), 2);
        QCOMPARE(modeltable::modelMinimumIntervalSeconds(QStringLiteral("lxt")), 0);
        const QString positions = QStringLiteral("4,2,4,7,4,12,4,17,2");
        QVERIFY(
            HeaderPosition::findLogColumn(QStringLiteral(" Date Time Log# pH"), positions).found);
        QVERIFY(
            !HeaderPosition::findLogColumn(QStringLiteral(" Date Time log# pH"), positions).found);
    }
};

QTEST_APPLESS_MAIN(ReplyFieldsTest)
#include "ReplyFields_test.moc"
