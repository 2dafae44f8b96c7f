// What the program keeps from one use to the next (settings file, file dialogs, printer), and
// the room the column header gets above the workspace.
#include "DialogDriver.h"
#include "ScriptedDialogs.h"
#include "WindowFixture.h"
#include "help/HelpWindow.h"
#include "shell/Settings.h"
#include "workspace/WorkspaceCommands.h"

#include <QAction>
#include <QDir>
#include <QLabel>
#include <QPlainTextEdit>
#include <QPrinter>
#include <QSettings>
#include <QTest>

namespace {
// A print dialog that finds a printer chosen keeps it.
class KeepingDialogs : public ScriptedDialogs {
public:
    bool askPrinter(QWidget* p, QPrinter& printer) override {
        return !printer.outputFileName().isEmpty() || ScriptedDialogs::askPrinter(p, printer);
    }
};
} // namespace

class SettingsDialogsLayoutTest : public QObject {
    Q_OBJECT
private slots:
    void brokenSettingsFileIsMovedAside() {
        TestSettings settings;
        PromptRecorder prompts;
        AppState s;
        settings.set(QStringLiteral("COM"), QStringLiteral("COM7"));
        const QString path =
            QSettings(QStringLiteral("Telvio"), QStringLiteral("Telvio")).fileName();
        QFile file(path);
        QVERIFY(file.open(QIODevice::WriteOnly) && file.write("[Settings\nCOM=COM7\n") > 0);
        file.close();
        Settings::LoadSettings(s, prompts);
        QCOMPARE(prompts.texts(), QStringList{Settings::kRetrieveError});
        QVERIFY(Settings::SaveSettings(s, prompts));
        const QDir dir = QFileInfo(path).dir();
        const QStringList aside = dir.entryList({QStringLiteral("*.broken*")});
        QCOMPARE(aside.size(), 1);
        QVERIFY(prompts.shown.last().text.contains(dir.filePath(aside[0])));
        QCOMPARE(settings.value(QStringLiteral("Baud")), QStringLiteral("9600"));
    }

    void fileDialogsKeepNameAndFilter() {
        KeepingDialogs d;
        WindowFixture fx(&d);
        WorkspaceCommands& ws = fx.createWindow().workspace();
        fx.c().mnuLog->setChecked(true);
        fx.state().workspaceText = QStringLiteral("1 2 3\n");
        const QString csv = fx.settings.folder() + QStringLiteral("/a.csv");
        d.answerSave(csv, 1);
        ws.SaveWorkspace();
        ws.SaveWorkspace();
        ws.OpenFileIntoWorkspace();
        QCOMPARE(d.saveCalls.size(), 2);
        QCOMPARE(d.saveCalls[1].filterIndex, 1);
        QCOMPARE(d.saveCalls[1].proposedName, QStringLiteral("Log data"));
        QCOMPARE(d.openCalls.size(), 1);
        QCOMPARE(d.openCalls[0].fileName, csv);
    }

    void helpPrintsOnTheSetUpPrinter() {
        KeepingDialogs d;
        WindowFixture fx(&d);
        fx.createWindow();
        const QString pdf = fx.settings.folder() + QStringLiteral("/help.pdf");
        d.printToPdf(pdf);
        fx.c().mnuPrintSetUp->trigger();
        DialogDriver::whenModal(QStringLiteral("frmHelp"), [](QWidget* help) {
            static_cast<HelpWindow*>(help)->PrintHelpFile();
            help->close();
        });
        fx.c().mnuHelpGeneral->trigger();
        QVERIFY(DialogDriver::takeFailures().isEmpty());
        QVERIFY(QFileInfo(pdf).size() > 0);
    }

    void headerFitsAboveWorkspace_data() {
        QTest::addColumn<qreal>("scale");
        QTest::newRow("96 dpi") << 1.0;
        QTest::newRow("fonts at 2x") << 2.0;
    }
    void headerFitsAboveWorkspace() {
        QFETCH(qreal, scale);
        WindowFixture fx;
        QVERIFY(fx.startMeter(QStringLiteral("percent-log")));
        QLabel* header = fx.createWindow().controls().lblHeader;
        QFont font = header->font();
        font.setPointSizeF(font.pointSizeF() * scale);
        header->setFont(font);
        fx.start();
        QVERIFY(fx.waitUntil([&] { return fx.state().percentFormat && header->isVisible(); }));
        for (int height : {700, 900}) {
            fx.window->resize(900, height);
            QTest::qWait(20);
            QVERIFY(header->height() >= QFontMetrics(header->font()).lineSpacing());
            QVERIFY(header->y() + header->height() <= fx.c().RichTextBox1->y());
        }
    }
};

QTEST_MAIN(SettingsDialogsLayoutTest)
#include "SettingsDialogsLayout_test.moc"
