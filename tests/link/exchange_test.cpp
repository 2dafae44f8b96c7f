// The command exchange against the simulated meter: busy re-sends, time-outs, prompts, the
// drain, keyword messages and a vanished port, checked on the messages shown and on the bytes
// the meter received.
#include "DialogDriver.h"
#include "WindowFixture.h"
#include "link/Exchange.h"

#include <QElapsedTimer>
#include <QLabel>
#include <QTest>

using Answer = Prompts::Answer;

class ExchangeTest : public QObject {
    Q_OBJECT

    std::unique_ptr<WindowFixture> f;

    // A window whose link is open on the meter, without the detection polls running.
    void openLink(const QString& profile = QStringLiteral("plain")) {
        f = std::make_unique<WindowFixture>();
        QVERIFY(f->startMeter(profile));
        f->createWindow();
        f->start();
        QVERIFY(f->waitUntil([this] { return !f->c().tmrDetectMeter->isActive(); }, 8000));
        f->c().tmrDetectMeter->stop();
        f->prompts.clear();
        f->state().abortRequested = false;
        f->window->setMessage(QString());
        f->meter->clearReceived();
    }

private slots:
    void cleanup() {
        f.reset();
        QVERIFY2(DialogDriver::takeFailures().isEmpty(), "a dialog was not driven as expected");
    }

    void busyThenReplyResends() {
        openLink();
        f->meter->setBusyCount(1);
        QVERIFY(f->window->exchange().ExchangeCommand(QStringLiteral("?V")));
        QVERIFY2(!f->state().responseText.contains(QLatin1String("BUSY")),
                 qPrintable(f->state().responseText));
        QVERIFY(f->state().responseText.endsWith(QLatin1Char('\r')));
        QVERIFY(f->state().commandResent);
        QCOMPARE(f->meter->count("?V\r"), 2);
        QVERIFY(f->prompts.shown.isEmpty());
    }

    void busyPastWindowCancelResetsLink() {
        openLink();
        f->meter->setBusyCount(1000000);
        f->prompts.answerNext(Answer::Cancel);
        QVERIFY(f->window->exchange().ExchangeCommand(QStringLiteral("?V")));
        QCOMPARE(f->prompts.texts().size(), 1);
        QVERIFY(f->prompts.texts().first().startsWith(
            QLatin1String("Instrument  is  busy  with  other  processes.\r\n\r\n")));
        QCOMPARE(f->state().responseText, QStringLiteral("BUSY\r"));
        QVERIFY(!f->serial.isOpen());
        QVERIFY(f->c().mnuDetectMeter->isEnabled());
    }

    void busyRetryRepeatsTheExchange() {
        openLink();
        f->meter->setBusyCount(1000000);
        f->prompts.onShow = [this](const PromptRecorder::Shown&) { f->meter->setBusyCount(0); };
        f->prompts.answerNext(Answer::Retry);
        QVERIFY(f->window->exchange().ExchangeCommand(QStringLiteral("?V")));
        QCOMPARE(f->prompts.shown.size(), 1);
        QVERIFY(!f->state().responseText.contains(QLatin1String("BUSY")));
        QVERIFY(f->serial.isOpen());
    }

    void silenceGivesBusyPromptAfterAboutFourSeconds() {
        openLink();
        f->meter->setSilent(true);
        QElapsedTimer t;
        t.start();
        QVERIFY(f->window->exchange().ExchangeCommand(QStringLiteral("?V")));
        const qint64 ms = t.elapsed();
        QVERIFY2(ms > 3800 && ms < 6000, qPrintable(QString::number(ms)));
        QCOMPARE(f->prompts.shown.size(), 1);
        QVERIFY(f->prompts.texts().first().startsWith(QLatin1String("Instrument  is  busy")));
        QVERIFY(!f->prompts.saw(QStringLiteral("No response from meter !")));
        QCOMPARE(f->meter->count("?V\r"), 2);
    }

    void lateReplyAfterWindowStillPrompts() {
        openLink();
        // Busy at 1.5 s (the window opens) and 3 s, the good reply at 4.5 s: after the window.
        f->meter->setReplyDelayMs(1500);
        f->meter->setBusyCount(2);
        QVERIFY(f->window->exchange().ExchangeCommand(QStringLiteral("?V")));
        QVERIFY(f->prompts.texts().value(0).startsWith(QLatin1String("Instrument  is  busy")));
    }

    void errorReplies_data() {
        QTest::addColumn<QString>("command");
        QTest::addColumn<bool>("firmwareMessage");
        QTest::newRow("status") << "?S" << false;
        QTest::newRow("other") << "?V" << true;
    }
    void errorReplies() {
        QFETCH(QString, command);
        QFETCH(bool, firmwareMessage);
        openLink();
        f->meter->setReply(command.toLatin1(), "ERROR\r");
        QVERIFY(f->window->exchange().ExchangeCommand(command));
        QCOMPARE(f->state().responseText, QStringLiteral("ERROR\r"));
        QCOMPARE(f->prompts.saw(
                     QStringLiteral(" This function is not available with your firmware version.")),
                 firmwareMessage);
        QCOMPARE(f->prompts.shown.size(), firmwareMessage ? 1 : 0);
    }

    void exitAndErrorBothReported() {
        openLink();
        f->meter->setReply("?V", "ERROR EXIT\r");
        QVERIFY(f->window->exchange().ExchangeCommand(QStringLiteral("?V")));
        QCOMPARE(f->prompts.texts(),
                 (QStringList{
                     QStringLiteral(" This function is not available with your firmware version."),
                     QStringLiteral("User has terminated this process.")}));
    }

    void loneLineFeedOrCarriageReturnIsBusy_data() {
        QTest::addColumn<QByteArray>("reply");
        QTest::newRow("LF") << QByteArray("\n");
        QTest::newRow("CR") << QByteArray("\r");
        QTest::newRow("OK") << QByteArray("OK\r");
    }
    void loneLineFeedOrCarriageReturnIsBusy() {
        QFETCH(QByteArray, reply);
        openLink();
        f->meter->queueReplies("?V", {reply});
        QVERIFY(f->window->exchange().ExchangeCommand(QStringLiteral("?V")));
        QVERIFY(f->state().commandResent);
        QVERIFY(f->meter->count("?V\r") >= 2);
        QVERIFY(!f->state().responseText.contains(QLatin1String("BUSY")));
    }

    void endlessSendingAbortsTheDrain() {
        openLink();
        f->meter->startEndlessSending();
        f->window->exchange().FlushInput();
        f->meter->stopEndlessSending();
        QVERIFY(f->state().abortRequested);
        f->meter->waitForReceived("\n", 42, 500);
        QCOMPARE(f->meter->count("\n"), 41);
    }

    void replyWithoutEndIsBounded() {
        openLink();
        f->meter->setReply("?V", QByteArray(20000, 'x'));
        f->state().commandText = QStringLiteral("?V\r");
        f->window->exchange().SerialWrite(f->state().commandText);
        f->state().readTimeoutSec = 2.0;
        f->window->exchange().ReadReply();
        QCOMPARE(f->state().responseText.size(), Exchange::kMaxReplyLength);
    }

    void closedPortEndsInCommError() {
        openLink();
        f->serial.close();
        QVERIFY(!f->window->exchange().ExchangeCommand(QStringLiteral("?V")));
        DialogDriver::clickWhenModal(QStringLiteral("frmCommError"), QStringLiteral("cmdCancel"));
        f->window->exchange().ShowCommError();
        QVERIFY(!f->state().abortRequested);
        QVERIFY(f->c().mnuDetectMeter->isEnabled());
        QVERIFY(f->window->isEnabled());
    }

    void vanishedPortEndsInCommError() {
        openLink();
        f->meter->vanish();
        QVERIFY(!f->window->exchange().ExchangeCommand(QStringLiteral("?V")));
        DialogDriver::clickWhenModal(QStringLiteral("frmCommError"), QStringLiteral("cmdCancel"));
        f->window->exchange().ShowCommError();
        QVERIFY(!f->serial.isOpen());
        QCOMPARE(f->c().lblModelData->text(), QString());
    }

    void commErrorDialogTexts() {
        openLink();
        DialogDriver::whenModal(QStringLiteral("frmCommError"), [](QWidget* d) {
            QStringList texts;
            for (auto* l : d->findChildren<QLabel*>())
                texts << l->text();
            QVERIFY(texts.contains(QStringLiteral("-  Dislodged  serial  cable.")));
            QCOMPARE(d->windowTitle(), QString());
            DialogDriver::click(d, QStringLiteral("cmdCancel"));
        });
        f->window->exchange().ShowCommError();
    }

    void detectedMessageWidensTheWindow_data() {
        QTest::addColumn<QString>("message");
        QTest::addColumn<bool>("prompted");
        QTest::newRow("normal") << "" << true;
        QTest::newRow("detected") << "Device  detected  on  COM1 ..." << false;
        QTest::newRow("shutting") << "Shutting  down  meter ..." << false;
        QTest::newRow("case differs") << "device  detected" << true;
    }
    void detectedMessageWidensTheWindow() {
        QFETCH(QString, message);
        QFETCH(bool, prompted);
        openLink();
        f->window->setMessage(message);
        f->meter->setReplyDelayMs(250);
        f->meter->setBusyCount(12); // about 3 s of busy replies
        QVERIFY(f->window->exchange().ExchangeCommand(QStringLiteral("?V")));
        QCOMPARE(!f->prompts.shown.isEmpty(), prompted);
    }
};

QTEST_MAIN(ExchangeTest)
#include "exchange_test.moc"
