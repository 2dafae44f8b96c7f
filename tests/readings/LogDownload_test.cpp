// Logged Data against the simulated meter: both protocols, Stop, failures.
#include "ReadingsWindow.h"

#include "readings/LogDownload.h"
#include "support/DialogDriver.h"

using namespace readingstest;

class LogDownloadTest : public QObject {
    Q_OBJECT
private slots:
    void init() { DialogDriver::takeFailures(); }
    void cleanup() { QVERIFY2(DialogDriver::takeFailures().isEmpty(), "dialog driver failed"); }

    void threeRecords();
    void twoDigitYearAndConversions();
    void moreRecordsThanAnnounced();
    void qr32ReadsExactlyNumLogged();
    void nothingLogged();
    void stopDuringDownload();
    void meterVanishes();
    void recordTooShort();
    void exitReplyWaitsForStop();
    void percentLinesUnchangedHeaderShown();
    void k5Layout();
};

void LogDownloadTest::threeRecords() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("plain")));
    const QList<QByteArray> records = {
        "0001   1.413mS 25.0C 12/03/2004 10:15:00\r",
        "0002   2.500mS 25.0C 12/03/2004 10:16:00\r",
        "0003   0*950ppK 25.0C 12/03/2004 10:17:00\r",
    };
    fx.meter->setLogRecords(records);
    fx.meter->clearReceived();

    fx.c().cmdLoggedData->click();

    // The last acknowledgement may still be on its way to the meter.
    QVERIFY(fx.meter->waitForReceived("AAAA", 1, 2000));
    QTest::qWait(20);
    const QByteArray after = receivedAfter(*fx.meter, "?S\r");
    QCOMPARE(after.count("?L\r"), 1);
    QCOMPARE(receivedAfter(*fx.meter, "?L\r").count('A'), 4);
    QCOMPARE(lines(fx.state().workspaceText),
             (QStringList{"12/03/2004 10:15:00 0001   1.413mS 25.0C",
                          "12/03/2004 10:16:00 0002   2.500mS 25.0C",
                          "12/03/2004 10:17:00 0003   0*950ppK 25.0C"}));
    QVERIFY(fx.state().workspaceText.endsWith(QLatin1Char('\n')));
    QCOMPARE(fx.c().RichTextBox1->toPlainText(), fx.state().workspaceText);
    QVERIFY(fx.c().mnuLog->isChecked());
    QVERIFY(!fx.c().mnuRealTime->isChecked());
    QVERIFY(commandsBack(fx));
    QVERIFY(fx.c().cmdLoggedData->isVisible());
    QVERIFY(fx.c().ProgressBar1->isHidden());
    QCOMPARE(fx.c().lblMessage->text(), QString());
    QVERIFY(fx.prompts.shown.isEmpty());
}

void LogDownloadTest::twoDigitYearAndConversions() {
    WindowFixture fx;
    fx.settings.set(QStringLiteral("mS"), QStringLiteral("1"));
    QVERIFY(fx.startDetected(QStringLiteral("k50")));
    fx.meter->setLogRecords(
        {"0001  1.413mS 25.0C 31/12/75 23:59:00\r", "0002  1.413mS 25.0C 01/01/76 00:00:00\r"});
    fx.c().mnuLog->trigger();
    QCOMPARE(lines(fx.state().workspaceText),
             (QStringList{"31/12/2075  23:59:00 0001   1413uS 25.0C",
                          "01/01/1976  00:00:00 0002   1413uS 25.0C"}));
    QVERIFY(fx.c().mnuLog->isChecked());
}

void LogDownloadTest::moreRecordsThanAnnounced() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("plain")));
    fx.meter->setLogRecords(metersim::Meter::generateLog(fx.meter->profile(), 12));
    // The status reply said 4: the meter sends 12 all the same, and all are taken.
    fx.meter->setReply("?S", "CD200 V1.21 012345 0004\r");
    int highest = 0;
    connect(fx.c().ProgressBar1, &QProgressBar::valueChanged, fx.c().ProgressBar1,
            [&highest](int v) { highest = std::max(highest, v); });
    fx.c().cmdLoggedData->click();
    QCOMPARE(lines(fx.state().workspaceText).size(), 12);
    QCOMPARE(highest, 20);
    QVERIFY(commandsBack(fx));
}

void LogDownloadTest::qr32ReadsExactlyNumLogged() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("qr32")));
    const QList<QByteArray> log = metersim::Meter::generateLog(fx.meter->profile(), 5);
    fx.meter->setLogRecords(log);
    fx.meter->clearReceived();
    fx.c().cmdLoggedData->click();

    QCOMPARE(fx.state().numLogged, 5);
    QCOMPARE(fx.meter->count("?R\r"), 1);
    QCOMPARE(receivedAfter(*fx.meter, "?R\r").count('A'), 0);
    const QString text = fx.state().workspaceText;
    QCOMPARE(text.count(QLatin1Char('\r')), 5);
    // Colons and the four-digit year in every record, whichever way it arrived.
    const QStringList records = text.split(QLatin1Char('\r'), Qt::SkipEmptyParts);
    QCOMPARE(records.size(), 5);
    for (QString r : records) {
        if (r.startsWith(QLatin1Char('\n')))
            r.remove(0, 1);
        QCOMPARE(r.size(), 38); // 36 characters and "20"
        QCOMPARE(r.mid(6, 2), QStringLiteral("20"));
        QCOMPARE(r.mid(13, 1), QStringLiteral(":"));
        QCOMPARE(r.mid(16, 1), QStringLiteral(":"));
    }
    QVERIFY(commandsBack(fx));
}

void LogDownloadTest::nothingLogged() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("plain")));
    fx.meter->setLogRecords({});
    fx.meter->clearReceived();
    fx.c().cmdLoggedData->click();
    QVERIFY(fx.prompts.saw(QStringLiteral("No logged readings to display !")));
    QCOMPARE(fx.prompts.shown.constLast().icon, Prompts::Icon::Exclamation);
    QCOMPARE(receivedAfter(*fx.meter, "?S\r"), QByteArray());
    QVERIFY(!fx.c().mnuLog->isChecked());
    QVERIFY(fx.c().cmdStopCurrentData->isHidden());
}

void LogDownloadTest::stopDuringDownload() {
    WindowFixture fx;
    fx.settings.set(QStringLiteral("mS"), QStringLiteral("1"));
    QVERIFY(fx.startDetected(QStringLiteral("plain")));
    fx.meter->setLogRecords(metersim::Meter::generateLog(fx.meter->profile(), 3000));
    AppState& s = fx.state();
    bool stateSeen = false;
    clickWhen(fx.c().cmdStopCurrentData, [&] {
        if (s.workspaceText.count(QLatin1Char('\n')) < 20)
            return false;
        // The download state, as the user sees it before pressing Stop.
        stateSeen = fx.c().cmdLoggedData->isHidden() && fx.c().ProgressBar1->isVisible() &&
                    fx.c().lblMessage->text() == QStringLiteral("Retrieving  logged  data ...") &&
                    !fx.c().cmdCurrentData->isEnabled() && fx.c().mnuLog->isChecked();
        return true;
    });
    fx.c().cmdLoggedData->click();

    QVERIFY(stateSeen);
    QVERIFY(fx.meter->waitForReceived("Z", 1, 2000));
    const int taken = int(lines(s.workspaceText).size());
    QVERIFY2(taken >= 20 && taken < 3000, qPrintable(QString::number(taken)));
    // The partial table is converted and shown.
    QVERIFY(!s.workspaceText.contains(QStringLiteral("mS")));
    QVERIFY(s.workspaceText.contains(QStringLiteral("uS")));
    QCOMPARE(fx.c().RichTextBox1->toPlainText(), s.workspaceText);
    QVERIFY(commandsBack(fx));
    QVERIFY(s.stopRequested);
}

void LogDownloadTest::meterVanishes() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("plain")));
    fx.meter->setLogRecords(metersim::Meter::generateLog(fx.meter->profile(), 50));
    fx.meter->vanishAfterSending(7);
    DialogDriver::clickWhenModal(QStringLiteral("frmCommError"), QStringLiteral("cmdCancel"), 8000);
    fx.c().cmdLoggedData->click();

    QVERIFY(fx.meter->hasVanished());
    // The records that arrived are kept and shown.
    QCOMPARE(lines(fx.state().workspaceText).size(), 7);
    QCOMPARE(fx.c().RichTextBox1->toPlainText(), fx.state().workspaceText);
    QVERIFY(fx.c().cmdStopCurrentData->isHidden());
    QVERIFY(!fx.state().abortRequested);
}

void LogDownloadTest::recordTooShort() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("plain")));
    fx.meter->setLogRecords({"0001   1.413mS 25.0C 12/03/2004 10:15:00\r", "0002 12:00\r",
                             "0003   1.413mS 25.0C 12/03/2004 10:17:00\r"});
    DialogDriver::clickWhenModal(QStringLiteral("frmCommError"), QStringLiteral("cmdCancel"));
    fx.c().cmdLoggedData->click();
    QCOMPARE(lines(fx.state().workspaceText),
             QStringList{"12/03/2004 10:15:00 0001   1.413mS 25.0C"});
    QCOMPARE(fx.c().RichTextBox1->toPlainText(), fx.state().workspaceText);
}

void LogDownloadTest::exitReplyWaitsForStop() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("plain")));
    fx.meter->setLogRecords({"0001   1.413mS 25.0C 12/03/2004 10:15:00\r", "EXIT\r",
                             "0003   1.413mS 25.0C 12/03/2004 10:17:00\r"});
    fx.c().cmdLoggedData->click();
    QVERIFY(fx.prompts.saw(QStringLiteral("User has terminated this process.")));
    // The download state stays until Stop; the line received so far appears then.
    QVERIFY(fx.c().cmdStopCurrentData->isVisible());
    QVERIFY(fx.c().RichTextBox1->toPlainText().isEmpty());
    fx.c().cmdStopCurrentData->click();
    QVERIFY(fx.meter->waitForReceived("Z", 1, 2000));
    QCOMPARE(lines(fx.c().RichTextBox1->toPlainText()),
             QStringList{"12/03/2004 10:15:00 0001   1.413mS 25.0C"});
    QVERIFY(commandsBack(fx));
}

void LogDownloadTest::percentLinesUnchangedHeaderShown() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("percent-log")));
    const QList<QByteArray> log = metersim::Meter::generateLog(fx.meter->profile(), 4);
    fx.meter->setLogRecords(log);
    fx.c().cmdLoggedData->click();
    QString expected;
    for (const QByteArray& record : log)
        expected += QString::fromLatin1(record) + QLatin1Char('\n');
    QCOMPARE(fx.state().workspaceText, expected);
    QCOMPARE(fx.c().lblHeader->text(), fx.state().headerText);
    QVERIFY(fx.state().headerText.contains(QStringLiteral("Log#")));
    // CR LF is one line break in the view.
    QCOMPARE(lines(fx.c().RichTextBox1->toPlainText()).size(), 4);
}

void LogDownloadTest::k5Layout() {
    WindowFixture fx;
    QVERIFY(fx.startDetected(QStringLiteral("k5ac")));
    fx.meter->setLogRecords(
        {"0001  1.413mS 25.0C 12/03 10:15\r", "0002  0*950ppK 25.0C 12/03 10:16\r"});
    fx.c().cmdLoggedData->click();
    QCOMPARE(lines(fx.state().workspaceText),
             (QStringList{"12/03 10:15 0001  1.413mS 25.0C", "12/03 10:16 0002  0*950ppK 25.0C"}));
}

QTEST_MAIN(LogDownloadTest)
#include "LogDownload_test.moc"
