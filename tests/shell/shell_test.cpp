// Settings in a temporary store, and the main window offscreen: start-up, initial command
// states, the save prompt, closing, the wizard and the enabling routines.
#include "WindowFixture.h"
#include "core/settings/Settings.h"
#include "desktop/shell/Twips.h"

#include <QtTest>
#include <QtWidgets>

static const char* const keys[] = {"COM", "Baud", "LogInvterval", "Asterisk", "mS", "ppK", "Drive"};

// The seven settings as loaded (the port as its device path) and as stored.
static QString fields(const AppState& s) {
    QString out;
    QDebug(&out).noquote() << s.portDevicePath << s.baudRate << s.logInterval << s.convertAsterisks
                           << s.convertMsToUs << s.convertPpkToPpm << s.catalogDrive;
    out.chop(1);
    return out;
}

static QString stored(const TestSettings& t) {
    QStringList values;
    for (const char* key : keys)
        values << t.value(key);
    return values.join(' ');
}

// Runs `call`, closing every modal dialog that comes up; returns their names.
static QStringList modalsDuring(const std::function<void()>& call) {
    QStringList names;
    QTimer timer;
    timer.callOnTimeout([&] {
        if (QWidget* m = QApplication::activeModalWidget()) {
            names << m->objectName();
            m->close();
        }
    });
    timer.start(5);
    call();
    return names;
}

class ShellTest : public QObject {
    Q_OBJECT
private slots:
    void settingsWrittenBackAsRead() {
        TestSettings t;
        t.clearFirstRun();
        AppState s;
        PromptRecorder p;
        bool first = false;
        // Only a caller that asks about the first start marks it done (the CLI does not ask).
        QVERIFY(Settings::LoadSettings(s, p) && t.firstRunValue().isEmpty());
        QVERIFY(Settings::LoadSettings(s, p, &first) && first);
        QCOMPARE(fields(s), "\\\\.\\COM1 9600 1 0 0 0 d:");
        QVERIFY(Settings::LoadSettings(s, p, &first) && !first);
        QVERIFY(Settings::SaveSettings(s, p) && p.shown.isEmpty());
        QCOMPARE(stored(t), "COM1 9600 1 0 0 0 d:");
        for (QString text : {"COM7 19200 0.5 1 0 1 e:", "/dev/ttyUSB0 1200 3600 0 1 0 /mnt/cd"}) {
            for (int i = 0; i < 7; ++i)
                t.set(keys[i], text.section(' ', i, i));
            QVERIFY(Settings::LoadSettings(s, p));
            for (const char* key : keys)
                t.set(key, "");
            QVERIFY(Settings::SaveSettings(s, p));
            QCOMPARE(stored(t), text);
        }
    }

    // A value that cannot be read stops the load there with one message and no first-run check;
    // a settings file of noise loads as written after it or, if the store gives up, as new.
    void badSettings() {
        TestSettings t;
        t.clearFirstRun();
        t.set("COM", "COM4");
        t.set("Baud", "abc");
        AppState s;
        PromptRecorder p;
        bool first = true;
        QVERIFY(!Settings::LoadSettings(s, p, &first) && !first && t.firstRunValue().isEmpty());
        QCOMPARE(p.texts(), QStringList{Settings::kRetrieveError});
        QCOMPARE(fields(s), "\\\\.\\COM4 0 0 0 0 0 ");
        quint32 noise[16384];
        QRandomGenerator(11).fillRange(noise);
        QFile file(QSettings("Telvio", "Telvio").fileName());
        QVERIFY(file.open(QIODevice::WriteOnly));
        file.write(reinterpret_cast<const char*>(noise), sizeof noise);
        file.write("\n[Settings]\nCOM=/dev/ttyS4\nLogInvterval=5\n");
        file.close();
        QVERIFY(Settings::LoadSettings(s, p));
        QVERIFY(QStringList({"\\\\.\\/dev/ttyS4 9600 5 0 0 0 d:", "\\\\.\\COM1 9600 1 0 0 0 d:"})
                    .contains(fields(s)));
        // A value of another type, as another program may leave it.
        QSettings("Telvio", "Telvio").setValue("Settings/mS", QVariantMap());
        QVERIFY(!Settings::LoadSettings(s, p) && p.shown.size() == 2);
        // A file the store cannot parse is reported, then moved aside (never lost) at the next
        // save, which writes a fresh one.
        TestSettings fresh;
        fresh.set("COM", "COM7");
        QFile broken(QSettings("Telvio", "Telvio").fileName());
        QVERIFY(broken.open(QIODevice::WriteOnly) && broken.write("[Settings\nCOM=COM7\n") > 0);
        broken.close();
        QVERIFY(!Settings::LoadSettings(s, p) && Settings::SaveSettings(s, p));
        const QFileInfo aside = QFileInfo(broken).dir().entryInfoList({"*.broken*"}).value(0);
        QVERIFY(p.shown.last().text.contains(aside.filePath()) && aside.size() == 19);
        QCOMPARE(fresh.value("Baud"), "9600");
    }

    // Start-up goes on after a bad setting (no wizard on this first run) to the connection
    // attempt; settings are never written at exit.
    void startUpAndExit() {
        WindowFixture f;
        f.settings.clearFirstRun();
        f.settings.set("COM", QString(10000, 'x'));
        f.settings.set("Baud", "abc");
        QCOMPARE(modalsDuring([&] { f.start(); }), QStringList{"frmSerialPortUnavailable"});
        QCOMPARE(f.prompts.texts(), QStringList{Settings::kRetrieveError});
        QCOMPARE(f.window->windowTitle(), "  Telvio  v1.36");
        const QRect screen = f.window->screen()->geometry();
        QCOMPARE(f.window->frameGeometry().topLeft(),
                 screen.topLeft() + QPoint(1, 1) * twipsToPixels(1000));
        // The width keeps its minimum on this screen.
        QCOMPARE(f.window->height(), screen.height() - twipsToPixels(3000));
        QVERIFY(f.c().mnuDetectMeter->isEnabled());
        f.c().mnuExit->trigger();
        QVERIFY(f.exited && f.settings.value("Baud") == "abc");
    }

    void commandStates() {
        WindowFixture f;
        MainWindow& w = f.createWindow();
        const MainControls& c = w.controls();
        w.show();
        QStringList off, hidden;
        for (QObject* o : w.findChildren<QObject*>(QRegularExpression("^(cmd|mnu)"))) {
            auto* a = qobject_cast<QAction*>(o);
            auto* b = qobject_cast<QPushButton*>(o);
            if ((a && !a->isVisible()) || (b && !b->isVisible()))
                hidden << o->objectName().mid(3);
            else if ((a && !a->isEnabled()) || (b && !b->isEnabled()))
                off << o->objectName().mid(3);
        }
        off.sort();
        hidden.sort();
        QCOMPARE(off.join(' '),
                 "Clear Copy CurrentData DetectMeter DisplayAction EditAction EraseLog EraseLog "
                 "Find GLPData Listen LoggedData Print Print Save SaveFile SelectAll UndoClear");
        QCOMPARE(hidden.join(' '), "DisableLogging EnableLogging K5Off K5On MaxMin MaxMin "
                                   "StartStirring StopCurrentData StopStirring Voltage");

        // The voltage display is not running: nothing changes.
        c.RichTextBox1->setPlainText("Meter Battery Voltage = 6.3V");
        w.StopVoltageDisplay();
        QVERIFY(!c.RichTextBox1->toPlainText().isEmpty());

        const auto buttons = w.findChildren<QPushButton*>(QRegularExpression("^cmd"));
        for (QPushButton* b : buttons)
            b->show();
        c.cmdLoggedData->hide();
        w.DisableCommandsForRun();
        for (QPushButton* b : buttons)
            QCOMPARE(b->isEnabled(), b == c.cmdStopCurrentData);
        for (QMenu* m : {c.mnuFile, c.mnuEdit, c.mnuDisplay, c.mnuSetup, c.mnuHelp})
            QVERIFY(!m->isEnabled());
        w.EnableCommandsAfterRun();
        for (QPushButton* b : buttons)
            QCOMPARE(b->isEnabled(), b != c.cmdPrint);
        QVERIFY(!c.cmdStopCurrentData->isVisible() && !c.cmdLoggedData->isVisible());
        QVERIFY(c.mnuSave->isEnabled() && !c.mnuEdit->isEnabled());
        for (QMenu* m : {c.mnuFile, c.mnuDisplay, c.mnuSetup, c.mnuHelp})
            QVERIFY(m->isEnabled());
    }

    void wizardAndSavePrompt() {
        WindowFixture f;
        MainWindow& w = f.createWindow();
        const MainControls& c = w.controls();
        QCOMPARE(modalsDuring([&] { w.RunSetupWizard(); }), QStringList());
        QCOMPARE(f.prompts.texts(),
                 {"Welcome to Telvio setup wizard.  Would you like to continue?\r\n\r\n"});
        f.prompts.answerNext(Prompts::Answer::Yes);
        QCOMPARE(modalsDuring([&] { w.RunSetupWizard(); }),
                 QStringList({"frmFormatDisplay", "frmCommsPort"}));
        QCOMPARE(f.prompts.texts().last(), "Telvio is configured.\r\n");

        const QString lost = "Data will be lost!  Would you like to save now?";
        // Display kind, mode, saved, empty, asks.
        // clang-format off
        const struct {
            QString mark, mode;
            bool saved, empty, asks;
        } rows[] = {
            {"RealTime", "", 0, 0, 1}, {"Listen", "", 0, 0, 1}, {"Log", "", 0, 0, 0},
            {"RealTime", "", 1, 0, 0}, {"RealTime", "", 0, 1, 0}, {"RealTime", "RealTime", 0, 0, 0},
            {"RealTime", "Listen", 0, 0, 1}, {"Listen", "Listen", 0, 0, 0}, {"Listen", "RealTime", 0, 0, 1}};
        // clang-format on
        for (const auto& row : rows) {
            w.UncheckDisplayMenus();
            w.findChild<QAction*>("mnu" + row.mark)->setChecked(true);
            c.RichTextBox1->setPlainText(row.empty ? "" : "10:15:00 7.00 pH");
            f.state().workspaceSaved = row.saved;
            c.lblHeader->setText("Time pH");
            f.prompts.clear();
            w.PromptSaveAndClear(row.mode);
            QCOMPARE(f.prompts.saw(lost), row.asks);
            QCOMPARE(c.RichTextBox1->toPlainText().isEmpty(), row.asks || row.empty);
            QCOMPARE(c.lblHeader->text().isEmpty(), row.asks);
            QCOMPARE(f.state().workspaceSaved, row.asks || row.saved);
        }
        // Closing the window asks as exit does.
        w.show();
        c.RichTextBox1->setPlainText("reading");
        f.state().workspaceSaved = false;
        w.close();
        QVERIFY(f.exited && f.prompts.saw(lost));
    }
};

QTEST_MAIN(ShellTest)
#include "shell_test.moc"
