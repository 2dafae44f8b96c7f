// The main window offscreen: initial command states, the save prompt, closing, the wizard,
// the voltage stop and the enabling routines.
#include "WindowFixture.h"

#include <QAction>
#include <QApplication>
#include <QDialog>
#include <QLabel>
#include <QMenu>
#include <QPlainTextEdit>
#include <QProgressBar>
#include <QPushButton>
#include <QTest>

using Answer = Prompts::Answer;

namespace {
// Closes every modal dialog that shows up and remembers their names, in order.
class ModalCloser : public QObject {
public:
    QStringList seen;
    ModalCloser() {
        timer_.callOnTimeout(this, &ModalCloser::poll);
        timer_.start(20);
    }

private:
    void poll() {
        if (auto* d = qobject_cast<QDialog*>(QApplication::activeModalWidget())) {
            seen << d->objectName();
            d->reject();
        }
    }
    QTimer timer_;
};
} // namespace

class MainWindowTest : public QObject {
    Q_OBJECT

    std::unique_ptr<WindowFixture> f;

    MainWindow& window() {
        f = std::make_unique<WindowFixture>();
        return f->createWindow();
    }
    // The workspace as one kind of display holds: text, check mark, saved flag.
    void fill(const QString& text, QAction* mark, bool saved) {
        f->window->UncheckDisplayMenus();
        if (mark)
            mark->setChecked(true);
        f->state().workspaceText = text;
        f->c().RichTextBox1->setPlainText(text);
        f->state().workspaceSaved = saved;
    }

private slots:
    void cleanup() { f.reset(); }

    void initialStates_data() {
        QTest::addColumn<QString>("name");
        QTest::addColumn<QString>("caption");
        QTest::addColumn<bool>("enabled");
        QTest::addColumn<bool>("visible");
        auto row = [](const char* n, const char* caption, bool enabled, bool visible) {
            QTest::newRow(n) << QString::fromLatin1(n) << QString::fromLatin1(caption) << enabled
                             << visible;
        };
        row("cmdOpenFile", "Open", true, true);
        row("cmdSaveFile", "Save", false, true);
        row("cmdPrint", "Print", false, true);
        row("cmdListen", "Listen", false, true);
        row("cmdCurrentData", "Current Data", false, true);
        row("cmdStopCurrentData", "Stop", true, false);
        row("cmdLoggedData", "Logged Data", false, true);
        row("cmdEraseLog", "Erase Log", false, true);
        row("cmdGLPData", "GLP  Data", false, true);
        row("cmdMaxMin", "Max / Min", true, false);
        row("cmdHelp", "Help", true, true);
        row("cmdEnableLogging", "Enable Logging", true, false);
        row("cmdDisableLogging", "Disable Logging", true, false);
        row("cmdStartStirring", "Start Stirring", true, false);
        row("cmdStopStirring", "Stop Stirring", true, false);
        row("cmdK5On", "Power On", true, false);
        row("cmdK5Off", "Power Off", true, false);
        row("mnuOpen", "&Open", true, true);
        row("mnuSave", "&Save", false, true);
        row("mnuPrint", "&Print", false, true);
        row("mnuPrintSetUp", "Print  Set&up", true, true);
        row("mnuDetectMeter", "&Detect  Meter", false, true);
        row("mnuEraseLog", "&EraseLog", false, true);
        row("mnuExit", "E&xit", true, true);
        row("mnuSelectAll", "&Select  All", false, true);
        row("mnuCopy", "&Copy", false, true);
        row("mnuClear", "Clea&r", false, true);
        row("mnuUndoClear", "&Undo  Clear ", false, true);
        row("mnuFind", "&Find", false, true);
        row("mnuRealTime", "&Current ", true, true);
        row("mnuLog", "&Log", true, true);
        row("mnuGLP", "&GLP", true, true);
        row("mnuVoltage", "&Voltage", false, false); // a hidden action is disabled too
        row("mnuMaxMin", "&Max / Min", false, false);
        row("mnuListen", "Li&sten", true, true);
        row("mnuCommsPort", "&Serial  Port", true, true);
        row("mnuFormatDisplay", "&Data  Format", true, true);
        row("mnuWizard", "&Wizard", true, true);
        row("mnuAboutKVO", "About  &KVO", true, true);
        row("mnuAboutTelvio", "About  &Telvio", true, true);
        row("mnuCatalog", "&Browse  Catalogue", true, true);
        row("mnuHelpGeneral", "&Help  (General)", true, true);
        row("mnuK5help", "Help  (Other)", true, true);
        row("mnuFile", "&File", true, true);
        row("mnuEdit", "&Edit", false, true);
        row("mnuDisplay", " &Display", false, true);
        row("mnuSetup", " &Setup", true, true);
        row("mnuHelp", " &Help", true, true);
    }
    void initialStates() {
        QFETCH(QString, name);
        QFETCH(QString, caption);
        QFETCH(bool, enabled);
        QFETCH(bool, visible);
        MainWindow& w = window();
        w.show();
        if (auto* b = w.findChild<QPushButton*>(name)) {
            QCOMPARE(b->text(), caption);
            QCOMPARE(b->isEnabled(), enabled);
            QCOMPARE(b->isVisible(), visible);
        } else if (auto* m = w.findChild<QMenu*>(name)) {
            QCOMPARE(m->title(), caption);
            QCOMPARE(m->menuAction()->isEnabled(), enabled);
        } else if (auto* a = w.findChild<QAction*>(name)) {
            QCOMPARE(a->text(), caption);
            QCOMPARE(a->isEnabled(), enabled);
            QCOMPARE(a->isVisible(), visible);
        } else {
            QFAIL("no such control");
        }
    }

    void shortcutsAndTimers() {
        MainWindow& w = window();
        QCOMPARE(w.controls().mnuUndoClear->shortcut(), QKeySequence(QStringLiteral("Ctrl+Z")));
        QCOMPARE(w.controls().mnuHelpGeneral->shortcut(), QKeySequence(QStringLiteral("Ctrl+H")));
        QCOMPARE(w.controls().tmrDetectMeter->interval(), 600);
        QCOMPARE(w.controls().tmrLong->interval(), 58000);
        for (QTimer* t : w.findChildren<QTimer*>(QRegularExpression(QStringLiteral("^tmr"))))
            QVERIFY2(!t->isActive(), qPrintable(t->objectName()));
        QCOMPARE(w.controls().ProgressBar1->maximum(), 20);
    }

    void savePromptRules_data() {
        QTest::addColumn<QString>("kind");
        QTest::addColumn<QString>("mode");
        QTest::addColumn<bool>("saved");
        QTest::addColumn<bool>("empty");
        QTest::addColumn<bool>("asks");
        auto row = [](const char* tag, const char* kind, const char* mode, bool saved, bool empty,
                      bool asks) {
            QTest::newRow(tag) << QString(kind) << QString(mode) << saved << empty << asks;
        };
        row("real-time, exit", "mnuRealTime", "", false, false, true);
        row("listen, exit", "mnuListen", "", false, false, true);
        row("log, exit", "mnuLog", "", false, false, false);
        row("glp, exit", "mnuGLP", "", false, false, false);
        row("opened file", "", "", false, false, false);
        row("real-time saved", "mnuRealTime", "", true, false, false);
        row("real-time empty", "mnuRealTime", "", false, true, false);
        row("real-time then real-time", "mnuRealTime", "RealTime", false, false, false);
        row("real-time then listen", "mnuRealTime", "Listen", false, false, true);
        row("listen then listen", "mnuListen", "Listen", false, false, false);
        row("listen then real-time", "mnuListen", "RealTime", false, false, true);
    }
    void savePromptRules() {
        QFETCH(QString, kind);
        QFETCH(QString, mode);
        QFETCH(bool, saved);
        QFETCH(bool, empty);
        QFETCH(bool, asks);
        MainWindow& w = window();
        fill(empty ? QString() : QStringLiteral("12/03/2004 10:15:00 7.00 pH\n"),
             kind.isEmpty() ? nullptr : w.findChild<QAction*>(kind), saved);
        QCOMPARE(w.NeedsSavePrompt(mode), asks);
        w.PromptSaveAndClear(mode);
        QCOMPARE(f->prompts.saw(QStringLiteral("Data will be lost!  Would you like to save now?")),
                 asks);
        if (asks) {
            QVERIFY(w.controls().RichTextBox1->toPlainText().isEmpty());
            QVERIFY(f->state().workspaceSaved);
        } else {
            QCOMPARE(w.controls().RichTextBox1->toPlainText().isEmpty(), empty);
        }
    }

    void closingAsksOnlyForUnsavedRealTimeOrListenData() {
        MainWindow& w = window();
        w.show();
        fill(QStringLiteral("reading\n"), w.controls().mnuRealTime, false);
        f->prompts.answerNext(Answer::No);
        w.close();
        QVERIFY(f->exited);
        QCOMPARE(f->prompts.texts(),
                 QStringList{QStringLiteral("Data will be lost!  Would you like to save now?")});
        QCOMPARE(f->prompts.shown.first().icon, Prompts::Icon::Exclamation);

        MainWindow& w2 = window();
        w2.show();
        fill(QStringLiteral("log line\n"), w2.controls().mnuLog, false);
        w2.controls().mnuExit->trigger();
        QVERIFY(f->exited);
        QVERIFY(f->prompts.shown.isEmpty());
    }

    void closingNeverWritesSettings() {
        MainWindow& w = window();
        f->state().baudRate = 1234;
        w.ExitProgram();
        QVERIFY(f->exited);
        QVERIFY(!f->settings.contains(QStringLiteral("Baud")));
    }

    void wizardAnsweredNoShowsNothing() {
        MainWindow& w = window();
        ModalCloser closer;
        f->prompts.answerNext(Answer::No);
        w.RunSetupWizard();
        QCOMPARE(f->prompts.texts(),
                 QStringList{QStringLiteral(
                     "Welcome to Telvio setup wizard.  Would you like to continue?\r\n\r\n")});
        QVERIFY(closer.seen.isEmpty());
    }

    void wizardAnsweredYesShowsTheDialogsThenConfigured() {
        MainWindow& w = window();
        ModalCloser closer;
        f->prompts.answerNext(Answer::Yes);
        w.RunSetupWizard();
        QVERIFY(!closer.seen.isEmpty());
        QCOMPARE(closer.seen.last(), QStringLiteral("frmCommsPort"));
        if (closer.seen.size() == 2)
            QCOMPARE(closer.seen.first(), QStringLiteral("frmFormatDisplay"));
        QCOMPARE(f->prompts.texts().last(), QStringLiteral("Telvio is configured.\r\n"));
        QCOMPARE(f->prompts.shown.last().icon, Prompts::Icon::Information);
    }

    void stopVoltageDisplay() {
        MainWindow& w = window();
        fill(QStringLiteral("Meter Battery Voltage = 6.3V\r"), w.controls().mnuVoltage, true);
        w.StopVoltageDisplay(); // timer off: nothing changes
        QVERIFY(!w.controls().RichTextBox1->toPlainText().isEmpty());
        QVERIFY(!f->state().workspaceText.isEmpty());
        w.controls().tmrDisplayVoltage->start(60000);
        w.StopVoltageDisplay();
        QVERIFY(!w.controls().tmrDisplayVoltage->isActive());
        QVERIFY(w.controls().RichTextBox1->toPlainText().isEmpty());
        QVERIFY(f->state().workspaceText.isEmpty());
    }

    void runStatesWithoutLog() {
        MainWindow& w = window();
        w.show();
        const MainControls& c = w.controls();
        c.cmdLoggedData->hide();
        f->state().hasLog = false;
        w.DisableCommandsForRun();
        QVERIFY(c.cmdStopCurrentData->isVisible());
        QVERIFY(!c.cmdCurrentData->isEnabled());
        QVERIFY(!c.mnuFile->isEnabled());
        QVERIFY(!c.mnuHelp->menuAction()->isEnabled());
        w.EnableCommandsAfterRun();
        QVERIFY(c.cmdLoggedData->isEnabled());
        QVERIFY(!c.cmdLoggedData->isVisible());
        QVERIFY(!c.cmdStopCurrentData->isVisible());
        QVERIFY(c.cmdCurrentData->isVisible() && c.cmdCurrentData->isEnabled());
        QVERIFY(c.mnuSave->isEnabled());
        QVERIFY(!c.cmdPrint->isEnabled()); // follows the workspace, not the run
        QVERIFY(c.mnuDisplay->menuAction()->isEnabled());
    }

    void captionAndPlacement() {
        WindowFixture fixture;
        fixture.settings.set(QStringLiteral("COM"), QStringLiteral("/dev/telvio-no-such-port"));
        fixture.createWindow();
        ModalCloser closer;
        fixture.start();
        QCOMPARE(fixture.window->windowTitle(), QStringLiteral("  Telvio  v1.36"));
        QCOMPARE(closer.seen, QStringList{QStringLiteral("frmSerialPortUnavailable")});
        QVERIFY(fixture.c().mnuDetectMeter->isEnabled());
    }
};

QTEST_MAIN(MainWindowTest)
#include "mainwindow_test.moc"
