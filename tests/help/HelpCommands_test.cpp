#include "PdfAndDialogChecks.h"
#include "help/AboutTelvioDialog.h"
#include "help/HelpWindow.h"
#include "support/DialogDriver.h"
#include "support/ScriptedDialogs.h"
#include "support/WindowFixture.h"

#include <QAction>
#include <QDir>
#include <QFile>
#include <QLabel>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QTemporaryDir>
#include <QTextEdit>
#include <QtTest>

// The Help menu and the Help button, driven through the real main window.
class HelpCommandsTest : public QObject {
    Q_OBJECT
private slots:
    void init() { DialogDriver::takeFailures(); }
    void itemsOpenTheirWindows_data();
    void itemsOpenTheirWindows();
    void helpFromMenuPrintsThroughSeam();
    void cataloguePresentOpensWithoutChooser();
    void captionAndAboutBoxShowOneVersion();
    void realVoltageDisplayStopsForHelpOnly();
};

// A voltage display in progress, as far as the Help commands can see it.
static void fakeVoltageDisplay(WindowFixture& f) {
    f.c().tmrDisplayVoltage->start(3600000);
    f.state().workspaceText = QStringLiteral("Meter Battery Voltage = 6.3V");
    f.c().RichTextBox1->setPlainText(f.state().workspaceText);
}

void HelpCommandsTest::itemsOpenTheirWindows_data() {
    QTest::addColumn<QString>("control");
    QTest::addColumn<QString>("dialog");
    QTest::addColumn<QString>("caption");
    QTest::addColumn<bool>("stopsVoltage");
    auto row = [](const char* tag, const char* control, const char* dialog, const char* caption,
                  bool stopsVoltage) {
        QTest::newRow(tag) << QString(control) << QString(dialog) << QString(caption)
                           << stopsVoltage;
    };
    row("Help (General)", "mnuHelpGeneral", "frmHelp", "  Help  (General)", true);
    row("Help button", "cmdHelp", "frmHelp", "  Help  (General)", true);
    row("Help (Other)", "mnuK5help", "frmK5Help", "  Help  (Other)", true);
    row("About KVO", "mnuAboutKVO", "frmAboutKVO", " About  KVO", true);
    row("About Telvio", "mnuAboutTelvio", "frmAboutTelvio", "About Telvio", false);
    row("Browse Catalogue, no CD", "mnuCatalog", "frmCatalog", "  Catalogue", true);
}

void HelpCommandsTest::itemsOpenTheirWindows() {
    QFETCH(QString, control);
    QFETCH(QString, dialog);
    QFETCH(QString, caption);
    QFETCH(bool, stopsVoltage);
    ScriptedDialogs dialogs;
    WindowFixture f(&dialogs);
    MainWindow& window = f.createWindow();
    f.state().catalogDrive = QStringLiteral("no-such-drive:");
    fakeVoltageDisplay(f);

    QWidget* parent = nullptr;
    QString title;
    QString firstTopic;
    DialogDriver::whenModal(dialog, [&](QWidget* modal) {
        parent = modal->parentWidget();
        title = modal->windowTitle();
        if (auto* help = qobject_cast<HelpWindow*>(modal))
            firstTopic = help->textArea()->toPlainText().section('\n', 0, 0);
        modal->close();
    });
    if (auto* action = window.findChild<QAction*>(control))
        action->trigger();
    else
        window.findChild<QPushButton*>(control)->click();

    QCOMPARE(DialogDriver::takeFailures(), QStringList());
    QCOMPARE(parent, static_cast<QWidget*>(&window));
    QCOMPARE(title, caption);
    if (dialog == "frmHelp")
        QCOMPARE(firstTopic, QStringLiteral("Introduction")); // the installed help file
    if (dialog == "frmK5Help")
        QCOMPARE(firstTopic, QStringLiteral("Enable Logging"));
    QCOMPARE(f.c().tmrDisplayVoltage->isActive(), !stopsVoltage);
    QCOMPARE(f.c().RichTextBox1->toPlainText().isEmpty(), stopsVoltage);
    QVERIFY(f.prompts.shown.isEmpty());
    QVERIFY(dialogs.openedWithDefault.isEmpty());
}

void HelpCommandsTest::helpFromMenuPrintsThroughSeam() {
    QTemporaryDir out;
    const QString pdf = out.filePath("other.pdf");
    ScriptedDialogs dialogs;
    dialogs.printToPdf(pdf);
    WindowFixture f(&dialogs);
    MainWindow& window = f.createWindow();
    QStringList topics;
    int shown = -1;
    DialogDriver::whenModal("frmK5Help", [&](QWidget* modal) {
        auto* help = qobject_cast<HelpWindow*>(modal);
        QTest::keyClick(help->textArea(), Qt::Key_Up);
        QTest::keyClick(help->textArea(), Qt::Key_Up);
        QTest::keyClick(help->textArea(), Qt::Key_Return);
        shown = help->shownTopic();
        topics = f.state().helpTopics;
        QTest::keyClick(help->textArea(), Qt::Key_Down);
        QTest::keyClick(help->textArea(), Qt::Key_Return); // on "Exit  help": closes
    });
    window.controls().mnuK5help->trigger();
    QCOMPARE(DialogDriver::takeFailures(), QStringList());
    QCOMPARE(dialogs.printDialogs, 1);
    QCOMPARE(shown, 6);
    QCOMPARE(printedText(pdf), HelpFile::composePrintText(topics, 6).simplified());
}

void HelpCommandsTest::cataloguePresentOpensWithoutChooser() {
    QTemporaryDir cd;
    QDir().mkpath(cd.filePath("kvo"));
    QFile page(cd.filePath("kvo/index.html"));
    QVERIFY(page.open(QIODevice::WriteOnly));
    page.close();
    ScriptedDialogs dialogs;
    WindowFixture f(&dialogs);
    MainWindow& window = f.createWindow();
    f.state().catalogDrive = cd.path();
    fakeVoltageDisplay(f);
    QVERIFY(noModalDuring([&] { window.controls().mnuCatalog->trigger(); }));
    QCOMPARE(dialogs.openedWithDefault,
             QList<QUrl>{QUrl::fromLocalFile(cd.path() + "/kvo/index.html")});
    QVERIFY(!f.c().tmrDisplayVoltage->isActive());
}

void HelpCommandsTest::captionAndAboutBoxShowOneVersion() {
    WindowFixture f;
    QVERIFY(f.startMeter(QStringLiteral("plain")));
    f.start();
    QString version;
    DialogDriver::whenModal("frmAboutTelvio", [&](QWidget* modal) {
        version = modal->findChild<QLabel*>("lblVersion")->text();
        DialogDriver::click(modal, "cmdOK");
    });
    f.c().mnuAboutTelvio->trigger();
    QCOMPARE(DialogDriver::takeFailures(), QStringList());
    QCOMPARE(version, AboutTelvioDialog::versionText());
    QCOMPARE(version, QStringLiteral("Version : v1.36"));
    QCOMPARE(f.window->windowTitle(), QStringLiteral("  Telvio  v1.36"));
}

// Against a meter that reports its battery voltage: About Telvio leaves the display running,
// Help (General) ends it and empties the workspace.
void HelpCommandsTest::realVoltageDisplayStopsForHelpOnly() {
    WindowFixture f;
    QVERIFY(f.startDetected(QStringLiteral("percent-log")));
    QVERIFY(f.c().mnuVoltage->isVisible());
    f.c().mnuVoltage->trigger();
    QVERIFY(f.waitUntil(
        [&] { return f.c().RichTextBox1->toPlainText().startsWith("Meter Battery Voltage = "); }));

    DialogDriver::clickWhenModal("frmAboutTelvio", "cmdOK");
    f.c().mnuAboutTelvio->trigger();
    QVERIFY(f.c().tmrDisplayVoltage->isActive());
    QVERIFY(!f.c().RichTextBox1->toPlainText().isEmpty());

    DialogDriver::whenModal("frmHelp", [](QWidget* modal) { modal->close(); });
    f.c().mnuHelpGeneral->trigger();
    QCOMPARE(DialogDriver::takeFailures(), QStringList());
    QVERIFY(!f.c().tmrDisplayVoltage->isActive());
    QCOMPARE(f.c().RichTextBox1->toPlainText(), QString());
    QCOMPARE(f.state().workspaceText, QString());
}

QTEST_MAIN(HelpCommandsTest)
#include "HelpCommands_test.moc"
