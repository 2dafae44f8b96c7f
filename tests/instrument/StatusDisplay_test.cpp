#include "instrument/InstrumentCommands.h"
#include "shell/Twips.h"
#include "support/DialogDriver.h"
#include "support/WindowFixture.h"

#include <QAction>
#include <QApplication>
#include <QLabel>
#include <QMenu>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QTest>

namespace {
// The commands whose visibility depends on the meter.
const QStringList kOptionalButtons = {
    "cmdEnableLogging", "cmdDisableLogging", "cmdStartStirring", "cmdStopStirring", "cmdK5On",
    "cmdK5Off",         "cmdLoggedData",     "cmdEraseLog",      "cmdGLPData",      "cmdMaxMin"};
const QStringList kOptionalMenus = {"mnuLog", "mnuGLP", "mnuMaxMin", "mnuVoltage", "mnuEraseLog"};

QStringList visibleButtons(MainWindow& w) {
    QStringList names;
    for (const QString& name : kOptionalButtons) {
        auto* b = w.findChild<QPushButton*>(name);
        if (b && b->isVisibleTo(&w) && b->isEnabled())
            names << name;
    }
    return names;
}

QStringList visibleMenus(MainWindow& w) {
    QStringList names;
    for (const QString& name : kOptionalMenus) {
        auto* a = w.findChild<QAction*>(name);
        if (a && a->isVisible() && a->isEnabled())
            names << name;
    }
    return names;
}

// Positions are given in twips and placed in whole pixels.
bool isLeftAt(QWidget* w, int twips) {
    return w->x() == twipsToPixels(twips);
}
bool isTopAt(QWidget* w, int twips) {
    return w->y() == twipsToPixels(twips);
}
} // namespace

class StatusDisplayTest : public QObject {
    Q_OBJECT
private slots:
    void init() { DialogDriver::takeFailures(); }
    void cleanup() { QCOMPARE(DialogDriver::takeFailures(), QStringList()); }
    void profiles_data();
    void profiles();
    void buttonPositions_data();
    void buttonPositions();
    void lowBatteryAfterLabels_data();
    void lowBatteryAfterLabels();
    void errorReplyResetsDisplay();
    void nextMeterRestoresCaptions();
    void garbledStatusKeepsCount();
    void vanishDuringStatusQuery();
};

void StatusDisplayTest::profiles_data() {
    QTest::addColumn<QString>("profile");
    QTest::addColumn<QString>("model");
    QTest::addColumn<QString>("version");
    QTest::addColumn<QString>("serial");
    QTest::addColumn<QString>("logged");
    QTest::addColumn<QString>("modelCode");
    QTest::addColumn<QStringList>("buttons");
    QTest::addColumn<QStringList>("menus");
    QTest::addColumn<int>("helpLeft");
    QTest::addColumn<bool>("header");

    const QStringList logGlp = {"cmdLoggedData", "cmdEraseLog", "cmdGLPData"};
    const QStringList logGlpMenus = {"mnuLog", "mnuGLP", "mnuEraseLog"};
    const QStringList k5 = {"cmdEnableLogging", "cmdDisableLogging", "cmdStartStirring",
                            "cmdStopStirring",  "cmdK5On",           "cmdK5Off",
                            "cmdLoggedData",    "cmdEraseLog"};
    const QStringList logMenus = {"mnuLog", "mnuEraseLog"};
    // Fields: profile, model, version, serial, logged count, model code.
    auto row = [](const QStringList& f, const QStringList& buttons, const QStringList& menus,
                  int helpLeft, bool header = false) {
        QTest::newRow(qPrintable(f[0])) << f[0] << f[1] << f[2] << f[3] << f[4] << f[5] << buttons
                                        << menus << helpLeft << header;
    };
    row({"plain", "CD200", "V1.21", "012345", "3", "CD200"}, logGlp, logGlpMenus, 7590);
    row({"k50", "K50", "V2.10", "023456", "3", "K50"}, logGlp, logGlpMenus, 7590);
    row({"k50v3", "K50V3", "V3.00", "034567", "3", "K50V3"}, logGlp, logGlpMenus, 7590);
    row({"lxt", "LXT200", "V1.05", "045678", "3", "LXT200"}, logGlp, logGlpMenus, 7590);
    row({"k51", "K51", "V1.00", "056789", "", "K51"}, {}, {}, 5070);
    row({"k5ac", "K5AC", "", "", "3", "K5AC"}, k5, logMenus, 6750);
    row({"k5acmv", "K5ACMV", "", "", "3", "K5ACMV"}, k5, logMenus, 6750);
    row({"k5ad", "K5ACMV", "", "", "3", "K5ACMV"},
        {"cmdEnableLogging", "cmdDisableLogging", "cmdK5On", "cmdK5Off", "cmdLoggedData",
         "cmdEraseLog"},
        logMenus, 6750);
    row({"k5gj", "K5GJ", "", "", "3", "K5GJ"}, k5, logMenus, 6750);
    row({"k5ah", "K5AH", "", "51234", "3", "K5AH"}, k5 + QStringList{"cmdGLPData"}, logGlpMenus,
        7590);
    row({"percent-log", "CP600", "V2.01", "067890", "3", "CP600"},
        {"cmdEnableLogging", "cmdDisableLogging", "cmdStartStirring", "cmdStopStirring",
         "cmdLoggedData", "cmdEraseLog"},
        {"mnuLog", "mnuVoltage", "mnuEraseLog"}, 6750, true);
    row({"percent-nolog", "CP500", "V1.10", "078901", "", "CP500"}, {}, {"mnuVoltage"}, 5070, true);
    row({"qr32", "QR32", "2.1", "A12345", "3", "QR32"}, {"cmdLoggedData", "cmdEraseLog"}, logMenus,
        6750);
    row({"zum410", "QR32", "2.1", "A12345", "3", "QR32"}, {"cmdLoggedData", "cmdEraseLog"},
        logMenus, 6750);
    row({"qr34", "QR34A", "V1.40", "089012", "3", "QR34"},
        {"cmdLoggedData", "cmdEraseLog", "cmdGLPData", "cmdMaxMin"},
        {"mnuLog", "mnuGLP", "mnuMaxMin", "mnuEraseLog"}, 7590);
}

void StatusDisplayTest::profiles() {
    QFETCH(QString, profile);
    WindowFixture f;
    QVERIFY(f.startDetected(profile));
    MainWindow& w = *f.window;
    const MainControls& c = f.c();
    QTEST(c.lblModelData->text(), "model");
    QTEST(c.lblVersionData->text(), "version");
    QTEST(c.lblSerialData->text(), "serial");
    QTEST(c.lblNumLogData->text(), "logged");
    QTEST(f.state().modelCode, "modelCode");
    QTEST(visibleButtons(w), "buttons");
    QTEST(visibleMenus(w), "menus");
    QFETCH(int, helpLeft);
    QVERIFY(isLeftAt(c.cmdHelp, helpLeft));
    QTEST(c.lblHeader->isVisibleTo(&w), "header");
    QCOMPARE(c.lblMessage->text(), QString());
    QVERIFY(c.mnuDisplay->isEnabled());
    QVERIFY(c.cmdListen->isEnabled());
    QVERIFY(c.cmdCurrentData->isEnabled());
    QVERIFY(f.prompts.shown.isEmpty());
    const bool k5 = f.state().isK5Family;
    QCOMPARE(c.lblVersion->text(), k5 ? QString() : QStringLiteral("Version:"));
    QCOMPARE(c.lblSerial->isVisibleTo(&w), !k5 || profile == "k5ah");
    // Only QR32-layout meters are asked the second status question.
    QCOMPARE(f.meter->count("?W\r"), profile == "qr32" || profile == "zum410" ? 1 : 0);
}

void StatusDisplayTest::buttonPositions_data() {
    QTest::addColumn<QString>("profile");
    QTest::addColumn<QByteArray>("status");
    QTest::addColumn<QList<int>>(
        "lefts"); // EnableLogging, StartStirring, StopStirring, K5On, K5Off
    QTest::addColumn<int>("headerTop");
    QTest::addColumn<int>("workspaceTop");

    QTest::newRow("K5 logging and stirrer")
        << "k5ac" << QByteArray("K5AC 0003 +m\r") << QList<int>{30, 2550, 3390, 5070, 5910} << 2230
        << 2100;
    QTest::newRow("K5 stirrer only") << "k5ac" << QByteArray("K5AC 0003 m\r")
                                     << QList<int>{-1, 30, 870, 2550, 3390} << 2230 << 2100;
    QTest::newRow("K5 logging only") << "k5ac" << QByteArray("K5AC 0003 +\r")
                                     << QList<int>{30, -1, -1, 2550, 3390} << 2230 << 2100;
    QTest::newRow("K5 neither") << "k5ac" << QByteArray("K5AC 0003\r")
                                << QList<int>{-1, -1, -1, 30, 870} << 2230 << 2100;
    QTest::newRow("percent stirrer") << "percent-log" << QByteArray("CP600 V2 S1 0003 m%g\r")
                                     << QList<int>{-1, 30, 870, -1, -1} << 2230 << 2440;
    QTest::newRow("percent plain letters") << "percent-log" << QByteArray("CP600 V2 S1 0003 v%g\r")
                                           << QList<int>{-1, -1, -1, -1, -1} << 1210 << 1420;
    QTest::newRow("percent K5 family") << "percent-log" << QByteArray("K5XP V2 S1 0003 %g\r")
                                       << QList<int>{-1, -1, -1, 30, 870} << 2230 << 2440;
    QTest::newRow("plain") << "plain" << QByteArray("CD200 V1 S1 0003\r")
                           << QList<int>{-1, -1, -1, -1, -1} << 1210 << 1080;
}

void StatusDisplayTest::buttonPositions() {
    QFETCH(QString, profile);
    QFETCH(QByteArray, status);
    QFETCH(QList<int>, lefts);
    WindowFixture f;
    QVERIFY(f.startMeter(profile));
    f.meter->setReply("?S", status);
    f.start();
    QVERIFY(f.waitUntil([&] { return !f.state().modelCode.isEmpty(); }));
    const MainControls& c = f.c();
    const QList<QPushButton*> buttons = {c.cmdEnableLogging, c.cmdStartStirring, c.cmdStopStirring,
                                         c.cmdK5On, c.cmdK5Off};
    for (int i = 0; i < buttons.size(); ++i) {
        const bool shown = buttons[i]->isVisibleTo(f.window.get());
        QCOMPARE(shown, lefts[i] >= 0);
        if (shown)
            QVERIFY(isLeftAt(buttons[i], lefts[i]));
    }
    QFETCH(int, headerTop);
    QFETCH(int, workspaceTop);
    QVERIFY(isTopAt(c.lblHeader, headerTop));
    QVERIFY(isTopAt(c.RichTextBox1, workspaceTop));
}

void StatusDisplayTest::lowBatteryAfterLabels_data() {
    QTest::addColumn<QString>("profile");
    QTest::addColumn<QByteArray>("status");
    QTest::addColumn<QString>("model");
    QTest::addColumn<QString>("serial");
    QTest::newRow("K5AH") << "k5ah" << QByteArray("K5AH 0003 +mB 51234\r") << "K5AH"
                          << "51234";
    QTest::newRow("percent") << "percent-log" << QByteArray("CP600 V2.01 067890 0003 +mvB%g\r")
                             << "CP600"
                             << "067890";
}

void StatusDisplayTest::lowBatteryAfterLabels() {
    QFETCH(QString, profile);
    QFETCH(QByteArray, status);
    WindowFixture f;
    QVERIFY(f.startMeter(profile));
    f.meter->setReply("?S", status);
    QString modelWhenShown;
    QString serialWhenShown;
    bool stirWhenShown = false;
    f.prompts.onShow = [&](const PromptRecorder::Shown&) {
        modelWhenShown = f.c().lblModelData->text();
        serialWhenShown = f.c().lblSerialData->text();
        stirWhenShown = f.c().cmdStartStirring->isVisibleTo(f.window.get());
    };
    f.start();
    QVERIFY(f.waitUntil([&] { return !f.prompts.shown.isEmpty(); }));
    QCOMPARE(f.prompts.texts(), QStringList{"The  meter  battery  is  low !"});
    QCOMPARE(f.prompts.shown.first().icon, Prompts::Icon::Critical);
    QTEST(modelWhenShown, "model");
    QTEST(serialWhenShown, "serial");
    QVERIFY(stirWhenShown);
}

void StatusDisplayTest::errorReplyResetsDisplay() {
    WindowFixture f;
    QVERIFY(f.startDetected("qr34"));
    const MainControls& c = f.c();
    f.meter->setReply("?S", "ERROR\r");
    f.window->instrument().QueryStatus();
    QVERIFY(!f.state().abortRequested);
    for (QLabel* l : {c.lblModelData, c.lblVersionData, c.lblSerialData, c.lblNumLogData})
        QCOMPARE(l->text(), QString());
    for (QPushButton* b : {c.cmdLoggedData, c.cmdGLPData, c.cmdEraseLog})
        QVERIFY(!b->isEnabled());
    for (QPushButton* b : {c.cmdMaxMin, c.cmdK5On, c.cmdK5Off, c.cmdEnableLogging,
                           c.cmdDisableLogging, c.cmdStartStirring, c.cmdStopStirring})
        QVERIFY(!b->isVisibleTo(f.window.get()));
    QVERIFY(!c.mnuMaxMin->isVisible());
    QVERIFY(c.cmdOpenFile->isEnabled());
    QVERIFY(c.cmdSaveFile->isEnabled());
    QVERIFY(!c.mnuDisplay->isEnabled());
    QVERIFY(c.mnuEdit->isEnabled());
    QVERIFY(isLeftAt(c.cmdHelp, 7590));
    QVERIFY(f.prompts.shown.isEmpty());
}

void StatusDisplayTest::nextMeterRestoresCaptions() {
    // A K5 meter blanks the version caption and hides the serial caption; a plain meter found
    // later in the same run shows them again.
    WindowFixture f;
    QVERIFY(f.startDetected("k5ac"));
    const MainControls& c = f.c();
    QCOMPARE(c.lblVersion->text(), QString());
    QVERIFY(!c.lblSerial->isVisibleTo(f.window.get()));
    f.meter->setReply("?S", "CD200 V1.21 012345 0007\r");
    f.window->instrument().QueryStatus();
    QCOMPARE(c.lblVersion->text(), QStringLiteral("Version:"));
    QVERIFY(c.lblSerial->isVisibleTo(f.window.get()));
    QCOMPARE(c.lblVersionData->text(), QStringLiteral("V1.21"));
    QCOMPARE(c.lblNumLogData->text(), QStringLiteral("7"));
    QVERIFY(!c.cmdK5On->isVisibleTo(f.window.get()));
    QVERIFY(!f.state().isK5Family);
}

void StatusDisplayTest::garbledStatusKeepsCount() {
    WindowFixture f;
    QVERIFY(f.startDetected("plain"));
    const MainControls& c = f.c();
    QCOMPARE(f.state().numLogged, 3);
    // Bytes 128-255, a control character and a count that is not a number.
    f.meter->setReply("?S", QByteArray("CD200 V\xe9\x01 S\xff\x80 0x12\r"));
    f.window->instrument().QueryStatus();
    QCOMPARE(f.state().numLogged, 3);
    QCOMPARE(c.lblNumLogData->text(), QStringLiteral("3"));
    QCOMPARE(c.lblVersionData->text(), QString::fromLatin1("V\xe9\x01"));
    QCOMPARE(c.lblSerialData->text(), QString::fromLatin1("S\xff\x80"));
    // No CR at all: the reply ends by time-out; nothing is read out of range.
    f.meter->setReply("?S", "K5");
    f.window->instrument().QueryStatus();
    QCOMPARE(f.state().numLogged, 3);
    QVERIFY(f.state().isK5Family);
}

void StatusDisplayTest::vanishDuringStatusQuery() {
    WindowFixture f;
    QVERIFY(f.startDetected("k5ac"));
    f.meter->vanish();
    DialogDriver::clickWhenModal("frmCommError", "cmdCancel");
    f.c().cmdEraseLog->click(); // runs the status query first
    QVERIFY(f.waitUntil([&] { return QApplication::activeModalWidget() == nullptr; }));
    QVERIFY(!f.state().abortRequested);
    QVERIFY(f.window->isEnabled());
    QVERIFY(f.c().mnuDetectMeter->isEnabled());
    QVERIFY(f.c().cmdOpenFile->isEnabled());
    QCOMPARE(f.c().lblModelData->text(), QString());
}

QTEST_MAIN(StatusDisplayTest)
#include "StatusDisplay_test.moc"
