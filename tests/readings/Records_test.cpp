// GLP and max/min records, and the header and Log# column of percent-format meters.
#include "ReadingsWindow.h"

using namespace readingstest;

class RecordsTest : public QObject {
    Q_OBJECT
private slots:
    void init() { DialogDriver::takeFailures(); }
    void cleanup() { QVERIFY2(DialogDriver::takeFailures().isEmpty(), "dialog driver failed"); }

    void glpTwoLines();
    void maxMinTwoLines();
    void endsEndsAndLowerCaseDoesNot();
    void noLinesBeforeEnd();
    void busyLineEndsGlp();
    void exitLineEndsMaxMin();
    void headerWithLog();
    void headerWithoutLog();
    void headerWithoutLogColumn();
};

void RecordsTest::glpTwoLines() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("plain")));
    fx.meter->setRecordLines("?G", {"Cal 1  12.88mS\r", "Cal 2  1*413mS\r"});
    fx.meter->clearReceived();
    fx.c().cmdGLPData->click();

    QCOMPARE(fx.meter->count("?G\r"), 1);
    QVERIFY(fx.meter->waitForReceived("?G\r\n\n\n", 1, 2000));
    QTest::qWait(20);
    QCOMPARE(receivedAfter(*fx.meter, "?G\r"), QByteArray("\n\n\n"));
    QCOMPARE(fx.state().workspaceText, QStringLiteral("Cal 1  12.88mS\nCal 2  1*413mS\n"));
    QCOMPARE(fx.c().RichTextBox1->toPlainText(), fx.state().workspaceText);
    QVERIFY(fx.c().mnuGLP->isChecked());
    QVERIFY(fx.c().cmdSaveFile->isEnabled());
    QVERIFY(fx.c().mnuSave->isEnabled());
    QCOMPARE(fx.c().lblMessage->text(), QString());
}

void RecordsTest::maxMinTwoLines() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("qr34")));
    fx.c().lblHeader->setText(QStringLiteral("old header"));
    fx.meter->clearReceived();
    fx.c().mnuMaxMin->trigger();

    QCOMPARE(fx.meter->count("?M\r"), 1);
    QVERIFY(fx.meter->waitForReceived("?M\r\n\n\n", 1, 2000));
    QTest::qWait(20);
    QCOMPARE(receivedAfter(*fx.meter, "?M\r"), QByteArray("\n\n\n"));
    QCOMPARE(fx.state().workspaceText, QStringLiteral(" MAX   1.999mS  25.0C  01/03/2004 10:15\n"
                                                      " MIN   0.101mS  24.8C  01/03/2004 08:00\n"));
    QVERIFY(fx.c().mnuMaxMin->isChecked());
    QVERIFY(!fx.c().mnuGLP->isChecked());
    QCOMPARE(fx.c().lblHeader->text(), QString());
    QCOMPARE(fx.c().lblMessage->text(), QString());
}

void RecordsTest::endsEndsAndLowerCaseDoesNot() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("plain")));
    fx.meter->setRecordLines("?G", {"line 1\r", "end of block\r", "line 3\r", "ENDS\r"});
    fx.meter->clearReceived();
    fx.c().cmdGLPData->click();
    QCOMPARE(fx.state().workspaceText, QStringLiteral("line 1\nend of block\nline 3\n"));
    QVERIFY(fx.meter->waitForReceived("?G\r\n\n\n\n", 1, 2000));
}

void RecordsTest::noLinesBeforeEnd() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("plain")));
    fx.meter->setRecordLines("?G", {"END\r"});
    fx.c().mnuGLP->trigger();
    QCOMPARE(fx.state().workspaceText, QString());
    QVERIFY(fx.c().RichTextBox1->toPlainText().isEmpty());
    QVERIFY(fx.c().cmdSaveFile->isEnabled());
    QVERIFY(fx.c().mnuSave->isEnabled());
    QVERIFY(fx.c().mnuGLP->isChecked());
}

void RecordsTest::busyLineEndsGlp() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("plain")));
    fx.meter->setRecordLines("?G", {"line 1\r", "EXIT\r", "line 3\r"});
    fx.c().cmdGLPData->click();
    QVERIFY(fx.prompts.saw(QStringLiteral("User has terminated this process.")));
    QVERIFY(fx.c().RichTextBox1->toPlainText().isEmpty());
    QVERIFY(!fx.c().mnuGLP->isChecked());
}

void RecordsTest::exitLineEndsMaxMin() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("qr34")));
    fx.state().workspaceText = QStringLiteral("shown before\n");
    fx.c().RichTextBox1->setPlainText(fx.state().workspaceText);
    fx.meter->setRecordLines("?M", {"MAX 1\r", "EXIT\r", "MIN 2\r"});
    fx.c().cmdMaxMin->click();
    // Max/min clears its status line and leaves the workspace as it was.
    QCOMPARE(fx.c().lblMessage->text(), QString());
    QCOMPARE(fx.c().RichTextBox1->toPlainText(), QStringLiteral("shown before\n"));
    QCOMPARE(fx.state().workspaceText, QStringLiteral("shown before\n"));
    QVERIFY(!fx.c().mnuMaxMin->isChecked());
}

void RecordsTest::headerWithLog() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("percent-log")));
    const AppState& s = fx.state();
    QCOMPARE(s.headerText.toLatin1(), fx.meter->profile().headerReply());
    QCOMPARE(s.positionText.toLatin1(), fx.meter->profile().positionsReply());
    QCOMPARE(s.logColumnStart, 22);
    QCOMPARE(s.logColumnWidth, 4);
    QVERIFY(fx.window->readings().logColumnKnown());
}

void RecordsTest::headerWithoutLog() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("percent-nolog")));
    const AppState& s = fx.state();
    QCOMPARE(s.headerText, QStringLiteral("   Date      Time   Log# ") +
                               QString::fromLatin1(fx.meter->profile().headerReply()));
    QCOMPARE(s.logColumnWidth, 4);
}

void RecordsTest::headerWithoutLogColumn() {
    WindowFixture fx;
    QVERIFY(fx.startMeter(QStringLiteral("percent-log")));
    fx.meter->setReply("?H", " Date       Time     pH    Cond\r");
    fx.meter->setReply("?P", "4,2,10,13,8\r");
    fx.start();
    QVERIFY(fx.waitUntil([&] { return !fx.state().positionText.isEmpty(); }, 8000));
    // Nothing to scan for: the previous values stay, and lines keep the meter's own number.
    QCOMPARE(fx.state().logColumnStart, 0);
    QCOMPARE(fx.state().logColumnWidth, 0);
    QVERIFY(!fx.window->readings().logColumnKnown());
    fx.meter->setReadingReplies({" 12/03/2004 10:15:00 0042  7.00\r"});
    startRealTime(fx, QStringLiteral("1"));
    QCOMPARE(lines(fx.state().workspaceText), QStringList{" 12/03/2004 10:15:00 0042  7.00\r"});
    fx.c().cmdStopCurrentData->click();
}

QTEST_MAIN(RecordsTest)
#include "Records_test.moc"
