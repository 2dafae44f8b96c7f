// Listen mode: lines the meter prints by itself.
#include "ReadingsWindow.h"

#include "readings/ListenMode.h"

using namespace readingstest;

class ListenTest : public QObject {
    Q_OBJECT
private slots:
    void init() { DialogDriver::takeFailures(); }
    void cleanup() { QVERIFY2(DialogDriver::takeFailures().isEmpty(), "dialog driver failed"); }

    void threeLinesAsTheyArrive();
    void keywordLinesLeftOut();
    void stopMidLine();
    void continueWithoutPrompt();
    void afterLogStartsEmpty();
    void nothingReceived();
    void portGone();
    void nulBytesDoNotStall();
    void endlessPrintingStillStops();

private:
    bool waitForText(WindowFixture& fx, const QString& text) {
        return fx.waitUntil([&] { return fx.state().workspaceText == text; }, 3000);
    }
};

void ListenTest::threeLinesAsTheyArrive() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("plain")));
    fx.meter->clearReceived();
    fx.c().cmdListen->click();

    const MainControls& c = fx.c();
    QVERIFY(fx.state().runActive);
    QVERIFY(c.mnuListen->isChecked());
    QVERIFY(c.cmdListen->isHidden());
    QVERIFY(c.cmdStopCurrentData->isVisible());
    QCOMPARE(c.lblMessage->text(), QStringLiteral("Listening  for  data  on  ") +
                                       fx.state().portName +
                                       QStringLiteral("  at  9600  baud ..."));

    fx.meter->sendUnsolicited("first  1.413mS\r");
    QVERIFY(waitForText(fx, QStringLiteral("first  1.413mS\r")));
    fx.meter->sendUnsolicited("\nsecond 2.000mS\r");
    QVERIFY(waitForText(fx, QStringLiteral("first  1.413mS\r\nsecond 2.000mS\r")));
    fx.meter->sendUnsolicited("\nthird");
    QTest::qWait(100);
    QCOMPARE(fx.state().workspaceText.count(QLatin1Char('\r')), 2);
    fx.meter->sendUnsolicited(" 3.000mS\r");
    QVERIFY(waitForText(fx, QStringLiteral("first  1.413mS\r\nsecond 2.000mS\r\nthird 3.000mS\r")));
    // The view shows each line once, CR LF being one break.
    QCOMPARE(c.RichTextBox1->toPlainText(),
             QStringLiteral("first  1.413mS\nsecond 2.000mS\nthird 3.000mS\n"));

    c.cmdStopCurrentData->click();
    QVERIFY(fx.meter->waitForReceived("Z", 1, 2000));
    QVERIFY(commandsBack(fx));
    QVERIFY(c.cmdListen->isVisible());
    QVERIFY(c.mnuListen->isChecked());
    QCOMPARE(c.lblMessage->text(), QString());
}

void ListenTest::keywordLinesLeftOut() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("plain")));
    fx.c().mnuListen->trigger();
    fx.meter->sendUnsolicited("one\r\nMeter Error 3\r\nbusy\r\nENDS\r\nexit\r\ntwo\r");
    QVERIFY(waitForText(fx, QStringLiteral("one\r\ntwo\r")));
    fx.c().cmdStopCurrentData->click();
}

void ListenTest::stopMidLine() {
    WindowFixture fx;
    fx.settings.set(QStringLiteral("mS"), QStringLiteral("1"));
    QVERIFY(fx.startDetected(QStringLiteral("plain")));
    fx.c().cmdListen->click();
    fx.meter->sendUnsolicited("  1.413mS\r\n  2.0");
    QVERIFY(waitForText(fx, QStringLiteral("  1.413mS\r")));
    QTest::qWait(50);
    fx.c().cmdStopCurrentData->click();
    fx.meter->sendUnsolicited("00mS\r");
    QTest::qWait(100);
    // The finished line stays (converted); the unfinished one is dropped.
    QCOMPARE(fx.state().workspaceText, QStringLiteral("   1413uS\r"));
    QCOMPARE(fx.c().RichTextBox1->toPlainText(), QStringLiteral("   1413uS\n"));
}

void ListenTest::continueWithoutPrompt() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("plain")));
    fx.c().cmdListen->click();
    fx.meter->sendUnsolicited("one\r");
    QVERIFY(waitForText(fx, QStringLiteral("one\r")));
    fx.c().cmdStopCurrentData->click();

    fx.c().cmdListen->click();
    QVERIFY(fx.prompts.shown.isEmpty());
    fx.meter->sendUnsolicited("\ntwo\r");
    QVERIFY(waitForText(fx, QStringLiteral("one\r\ntwo\r")));
    QCOMPARE(fx.c().RichTextBox1->toPlainText(), QStringLiteral("one\ntwo\n"));
    fx.c().cmdStopCurrentData->click();
}

void ListenTest::afterLogStartsEmpty() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("plain")));
    fx.c().cmdListen->click();
    fx.meter->sendUnsolicited("one\r");
    QVERIFY(waitForText(fx, QStringLiteral("one\r")));
    fx.c().cmdStopCurrentData->click();

    fx.c().cmdLoggedData->click(); // asks to save the listened data (answered No)
    QVERIFY(fx.prompts.saw(QStringLiteral("Data will be lost!  Would you like to save now?")));
    fx.prompts.clear();
    fx.c().cmdListen->click();
    QVERIFY(fx.prompts.shown.isEmpty()); // log data is not guarded
    QCOMPARE(fx.state().workspaceText, QString());
    QVERIFY(fx.c().RichTextBox1->toPlainText().isEmpty());
    fx.c().cmdStopCurrentData->click();
}

void ListenTest::nothingReceived() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("plain")));
    fx.c().cmdListen->click();
    QTest::qWait(50);
    fx.c().cmdStopCurrentData->click();
    QVERIFY(!fx.c().mnuListen->isChecked());
    QVERIFY(commandsBack(fx));
}

void ListenTest::portGone() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("plain")));
    fx.c().cmdListen->click();
    fx.meter->sendUnsolicited("one\r");
    QVERIFY(waitForText(fx, QStringLiteral("one\r")));
    DialogDriver::clickWhenModal(QStringLiteral("frmCommError"), QStringLiteral("cmdCancel"));
    fx.meter->vanish();
    QVERIFY(fx.waitUntil([&] { return !fx.c().mnuListen->isChecked(); }, 3000));
    QVERIFY(fx.waitUntil([&] { return !fx.window->readings().listen().isListening(); }, 3000));
    QTest::qWait(100);
    QVERIFY(fx.c().cmdStopCurrentData->isHidden());
    QVERIFY(!fx.state().runActive);
    QVERIFY(fx.c().cmdListen->isVisible());
    QCOMPARE(fx.c().RichTextBox1->toPlainText(), QStringLiteral("one\n"));
}

void ListenTest::nulBytesDoNotStall() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("plain")));
    fx.c().cmdListen->click();
    fx.meter->sendUnsolicited(QByteArray("a\0\0b\r", 5));
    QVERIFY(waitForText(fx, QStringLiteral("ab\r")));
    fx.c().cmdStopCurrentData->click();
}

void ListenTest::endlessPrintingStillStops() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("plain")));
    fx.c().cmdListen->click();
    fx.meter->startEndlessSending();
    // The window keeps handling its events while the meter never pauses.
    QVERIFY(fx.waitUntil([&] { return fx.state().workspaceText.count(QLatin1Char('\r')) > 200; },
                         5000));
    fx.c().cmdStopCurrentData->click();
    fx.meter->stopEndlessSending();
    QVERIFY(commandsBack(fx));
    QVERIFY(!fx.window->readings().listen().isListening());
    const QString text = fx.state().workspaceText;
    QVERIFY(text.endsWith(QLatin1Char('\r')));
    QTest::qWait(100);
    QCOMPARE(fx.state().workspaceText, text);
}

QTEST_MAIN(ListenTest)
#include "Listen_test.moc"
