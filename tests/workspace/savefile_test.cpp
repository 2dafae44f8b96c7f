// Saving and opening through the main window with scripted file dialogs.
#include "DialogDriver.h"
#include "WorkspaceWindow.h"
#include "workspace/WorkspaceCommands.h"

#include <QPushButton>
#include <QTemporaryDir>
#include <QTest>

using Icon = Prompts::Icon;

namespace {
const QString kTxtFilter = QStringLiteral("Text File   (*.txt)");
const QString kCsvFilter = QStringLiteral("Comma Delimited    (*.csv)");
const QString kLog = QStringLiteral("01/02/2024 10:11:12     1  1*413 mS/cm  25.0 C\n"
                                    "01/02/2024 10:11:22     2  1*414 mS/cm  25.1 C\n");
const QString kHeader = QStringLiteral("Date       Time      Log#  Reading");

// Makes a file unwritable for this process, also for root (immutable attribute), and undoes
// it when the guard ends so the temporary folder can be removed.
struct Unwritable {
    QString path;
    bool ok = false;
    explicit Unwritable(const QString& p) : path(p) {
        QFile::setPermissions(path, QFile::ReadOwner | QFile::ReadGroup | QFile::ReadOther);
        ok = !QFile(path).open(QIODevice::WriteOnly | QIODevice::Append);
        if (!ok) {
            QProcess::execute(QStringLiteral("chattr"), {QStringLiteral("+i"), path});
            ok = !QFile(path).open(QIODevice::WriteOnly | QIODevice::Append);
        }
    }
    ~Unwritable() {
        QProcess::execute(QStringLiteral("chattr"), {QStringLiteral("-i"), path});
        QFile::setPermissions(path, QFile::ReadOwner | QFile::WriteOwner);
    }
};
} // namespace

class SaveFileTest : public QObject {
    Q_OBJECT

    std::unique_ptr<WorkspaceWindow> ws;
    std::unique_ptr<QTemporaryDir> dir;
    QString path(const QString& name) { return dir->filePath(name); }
    void save() { ws->w->workspace().SaveWorkspace(); }

private slots:
    void init() {
        ws = std::make_unique<WorkspaceWindow>();
        dir = std::make_unique<QTemporaryDir>();
    }
    void cleanup() {
        const QStringList failures = DialogDriver::takeFailures();
        ws.reset();
        dir.reset();
        QVERIFY2(failures.isEmpty(), qPrintable(failures.join(u'\n')));
    }

    void offersFiltersAndNameByDisplayKind_data() {
        QTest::addColumn<QString>("mark");
        QTest::addColumn<QString>("name");
        QTest::addColumn<bool>("both");
        auto row = [](const char* mark, const char* name, bool both) {
            QTest::newRow(*mark ? mark : "opened file") << QString(mark) << QString(name) << both;
        };
        row("mnuLog", "Log data", true);
        row("mnuRealTime", "Current data", true);
        row("mnuListen", "Instrument data", true);
        row("mnuGLP", "GLP data", false);
        row("mnuMaxMin", "MaxMin data", false);
        row("mnuVoltage", "Voltage data", false);
        row("", "Instrument data", false);
    }
    void offersFiltersAndNameByDisplayKind() {
        QFETCH(QString, mark);
        QFETCH(QString, name);
        QFETCH(bool, both);
        ws->fill(kLog, mark.isEmpty() ? nullptr : ws->w->findChild<QAction*>(mark));
        ws->dialogs.cancelSave();
        ws->c().cmdSaveFile->click();
        QCOMPARE(ws->dialogs.saveCalls.size(), 1);
        const auto call = ws->dialogs.saveCalls.first();
        QCOMPARE(call.proposedName, name);
        const QStringList expected =
            both ? QStringList{kTxtFilter, kCsvFilter} : QStringList{kTxtFilter};
        QCOMPARE(call.filters, expected);
        QVERIFY(ws->state().saveCancelled);
        QVERIFY(!ws->state().workspaceSaved);
        QCOMPARE(QDir(dir->path()).entryList(QDir::Files), QStringList());
    }

    void namesFileByFilter_data() {
        QTest::addColumn<QString>("typed");
        QTest::addColumn<int>("filter");
        QTest::addColumn<QString>("written");
        QTest::addColumn<bool>("csv");
        QTest::newRow("no dot, text") << "run" << 0 << "run.txt" << false;
        QTest::newRow("no dot, csv") << "run" << 1 << "run.csv" << true;
        QTest::newRow("own extension, csv") << "run.dat" << 1 << "run.dat" << true;
        QTest::newRow("own extension, text") << "run.csv" << 0 << "run.csv" << false;
        QTest::newRow("dot in folder") << "v1.2/run" << 0 << "v1.2/run" << false;
    }
    void namesFileByFilter() {
        QFETCH(QString, typed);
        QFETCH(int, filter);
        QFETCH(QString, written);
        QFETCH(bool, csv);
        QVERIFY(QDir(dir->path()).mkdir(QStringLiteral("v1.2")));
        ws->fill(kLog, ws->c().mnuLog, kHeader);
        ws->dialogs.answerSave(path(typed), filter);
        ws->c().mnuSave->trigger();
        const QByteArray bytes = readBytes(path(written));
        if (csv)
            QCOMPARE(bytes, QByteArray("01/02/2024 10:11:12,1,1.413,,25.0,\n"
                                       "01/02/2024 10:11:22,2,1.414,,25.1,\n"));
        else
            QCOMPARE(bytes, (kHeader + "\r\n" + kLog).toLatin1());
        QVERIFY(ws->state().workspaceSaved);
        // The workspace keeps what it shows; only the file is converted.
        QCOMPARE(ws->state().workspaceText, kLog);
    }

    void convertsAsterisksOnlyWhenAsked_data() {
        QTest::addColumn<QString>("mark");
        QTest::addColumn<int>("setting");
        QTest::addColumn<QString>("expected");
        const QString text = QStringLiteral("7*00 pH\n");
        QTest::newRow("log, off") << "mnuLog" << 0 << text;
        QTest::newRow("log, on") << "mnuLog" << 1 << "7.00 pH\n";
        QTest::newRow("log, other value") << "mnuLog" << 2 << text;
        QTest::newRow("glp, on") << "mnuGLP" << 1 << text;
        QTest::newRow("max min, on") << "mnuMaxMin" << 1 << "7.00 pH\n";
    }
    void convertsAsterisksOnlyWhenAsked() {
        QFETCH(QString, mark);
        QFETCH(int, setting);
        QFETCH(QString, expected);
        ws->fill(QStringLiteral("7*00 pH\n"), ws->w->findChild<QAction*>(mark));
        ws->state().convertAsterisks = static_cast<qint16>(setting);
        ws->dialogs.answerSave(path("a"), 0);
        save();
        QCOMPARE(QString::fromLatin1(readBytes(path("a.txt"))), expected);
    }

    void writesHeaderOnlyWhenShown() {
        ws->fill(kLog, ws->c().mnuLog);
        ws->state().headerText = kHeader; // kept, but the label is empty
        ws->dialogs.answerSave(path("plain.txt"));
        save();
        QCOMPARE(readBytes(path("plain.txt")), kLog.toLatin1());
    }

    void keepsInstrumentBytes() {
        const QString text = QString::fromLatin1("25.0\xB0"
                                                 "C  \xB5S\n");
        ws->fill(text, ws->c().mnuGLP);
        ws->dialogs.answerSave(path("deg.txt"));
        save();
        QCOMPARE(readBytes(path("deg.txt")), QByteArray("25.0\xB0"
                                                        "C  \xB5S\n"));
        ws->dialogs.answerOpen(path("deg.txt"));
        ws->c().cmdOpenFile->click();
        QCOMPARE(ws->state().workspaceText, text);
    }

    void renameAndFrameCloseAskAgain() {
        QVERIFY(writeBytes(path("old.txt"), "old\n"));
        ws->fill(kLog, ws->c().mnuLog);
        ws->dialogs.answerSave(path("old.txt"));
        ws->dialogs.answerSave(path("old.txt"));
        ws->dialogs.answerSave(path("new"));
        DialogDriver::whenModal(QStringLiteral("frmAppendRenameOverwrite"), [](QWidget* d) {
            // The second time the dialog is closed by its frame.
            DialogDriver::whenModal(QStringLiteral("frmAppendRenameOverwrite"),
                                    [](QWidget* again) { again->close(); });
            DialogDriver::click(d, QStringLiteral("cmdRename"));
        });
        save();
        QCOMPARE(ws->dialogs.saveCalls.size(), 3);
        for (const auto& call : ws->dialogs.saveCalls)
            QCOMPARE(call.proposedName, QStringLiteral("Log data"));
        QCOMPARE(readBytes(path("old.txt")), QByteArray("old\n"));
        QCOMPARE(readBytes(path("new.txt")), kLog.toLatin1());
        QVERIFY(ws->state().workspaceSaved);
    }

    // Also checks the file-exists dialog's own texts.
    void appendAndOverwrite_data() {
        QTest::addColumn<QString>("button");
        QTest::addColumn<QByteArray>("expected");
        QTest::newRow("append") << "cmdAppend" << ("old\n" + kHeader + "\r\n" + kLog).toLatin1();
        QTest::newRow("overwrite") << "cmdOverwrite" << (kHeader + "\r\n" + kLog).toLatin1();
    }
    void appendAndOverwrite() {
        QFETCH(QString, button);
        QFETCH(QByteArray, expected);
        QVERIFY(writeBytes(path("old.txt"), "old\n"));
        ws->fill(kLog, ws->c().mnuLog, kHeader);
        ws->dialogs.answerSave(path("old.txt"));
        QStringList seen;
        DialogDriver::whenModal(QStringLiteral("frmAppendRenameOverwrite"), [&](QWidget* d) {
            seen << d->windowTitle() << d->findChild<QLabel*>(QStringLiteral("Label1"))->text();
            for (const char* b : {"cmdAppend", "cmdOverwrite", "cmdRename"})
                seen << d->findChild<QPushButton*>(QLatin1String(b))->text();
            DialogDriver::click(d, button);
        });
        save();
        QCOMPARE(seen, (QStringList{QString(),
                                    "The  file  you  specified  already  exists.    Please  "
                                    "select  one  of  the following  options.",
                                    "&Append", "&Overwrite", "&Rename"}));
        QCOMPARE(readBytes(path("old.txt")), expected);
        QCOMPARE(ws->state().fileExistsChoice, button.mid(3));
    }

    void failedWriteKeepsOldFile_data() {
        QTest::addColumn<QString>("button");
        QTest::newRow("overwrite") << "cmdOverwrite";
        QTest::newRow("append") << "cmdAppend";
    }
    void failedWriteKeepsOldFile() {
        QFETCH(QString, button);
        QVERIFY(writeBytes(path("locked.txt"), "precious\n"));
        Unwritable lock(path("locked.txt"));
        if (!lock.ok)
            QSKIP("cannot make a file unwritable here");
        ws->fill(kLog, ws->c().mnuLog);
        ws->dialogs.answerSave(path("locked.txt"));
        DialogDriver::clickWhenModal(QStringLiteral("frmAppendRenameOverwrite"), button);
        save();
        QCOMPARE(readBytes(path("locked.txt")), QByteArray("precious\n"));
        QCOMPARE(ws->f->prompts.shown.size(), 1);
        QCOMPARE(ws->f->prompts.shown.first().icon, Icon::Exclamation);
        QVERIFY(!ws->f->prompts.shown.first().text.isEmpty());
        QVERIFY(!ws->state().workspaceSaved);
        QCOMPARE(QDir(dir->path()).entryList(QDir::Files), QStringList{"locked.txt"});
    }

    void savePromptYesSaves() {
        ws->fill(kLog, ws->c().mnuRealTime);
        ws->dialogs.answerSave(path("rt"), 1);
        ws->f->prompts.answerNext(Prompts::Answer::Yes);
        ws->w->PromptSaveAndClear(QString());
        QCOMPARE(ws->f->prompts.texts(),
                 QStringList{"Data will be lost!  Would you like to save now?"});
        QVERIFY(QFile::exists(path("rt.csv")));
        QVERIFY(ws->state().workspaceSaved);
    }

    void opensCsvOneFieldPerLine() {
        ws->fill(kLog, ws->c().mnuLog, kHeader);
        ws->dialogs.answerSave(path("log"), 1);
        save();
        ws->dialogs.answerOpen(path("log.csv"));
        ws->c().mnuOpen->trigger();
        QCOMPARE(ws->state().workspaceText,
                 QStringLiteral("01/02/2024 10:11:12\n1\n1.413\n\n25.0\n\n"
                                "01/02/2024 10:11:22\n2\n1.414\n\n25.1\n\n"));
        QCOMPARE(ws->edit()->toPlainText(), ws->state().workspaceText);
        QVERIFY(ws->c().lblHeader->text().isEmpty());
        QVERIFY(!ws->c().mnuLog->isChecked());
        QVERIFY(ws->c().cmdSaveFile->isEnabled());
        QCOMPARE(ws->dialogs.openCalls.last().filters, QStringList{"All Files   (*.*)"});
    }

    void opensTxtWithoutLeadingBlanks() {
        QVERIFY(writeBytes(path("t.txt"), "Head, er\r\n   7.00 pH\n\"a, b\",c\n"));
        ws->dialogs.answerOpen(path("t.txt"));
        ws->c().cmdOpenFile->click();
        QCOMPARE(ws->state().workspaceText, QStringLiteral("Head\ner\n7.00 pH\na, b\nc\n"));
    }

    void openMissingFile() {
        ws->fill(kLog, ws->c().mnuGLP, kHeader);
        ws->dialogs.answerOpen(path("missing.txt"));
        ws->c().cmdOpenFile->click();
        QCOMPARE(ws->f->prompts.texts(), QStringList{"        File not found!        "});
        QCOMPARE(ws->f->prompts.shown.first().icon, Icon::None);
        QCOMPARE(ws->state().workspaceText, kLog);
        QVERIFY(ws->c().mnuSave->isEnabled());
    }

    void openCancelledChangesNothing() {
        ws->fill(kLog, ws->c().mnuLog, kHeader);
        ws->dialogs.cancelOpen();
        ws->c().cmdOpenFile->click();
        QCOMPARE(ws->state().workspaceText, kLog);
        QCOMPARE(ws->edit()->toPlainText(), kLog);
        QVERIFY(ws->c().mnuLog->isChecked());
        QVERIFY(ws->f->prompts.shown.isEmpty());
    }

    void unreadableFileKeepsWorkspace() {
        // Reading this process's own memory file fails at the first read.
        const QString unreadable = QStringLiteral("/proc/self/mem");
        QFile probe(unreadable);
        if (!probe.open(QIODevice::ReadOnly) || !probe.readAll().isEmpty() ||
            probe.error() == QFileDevice::NoError)
            QSKIP("no file here that opens but cannot be read");
        ws->fill(kLog, ws->c().mnuLog, kHeader);
        ws->c().cmdSaveFile->setEnabled(false);
        ws->dialogs.answerOpen(unreadable);
        ws->c().cmdOpenFile->click();
        QCOMPARE(ws->f->prompts.shown.size(), 1);
        QCOMPARE(ws->f->prompts.shown.first().icon, Icon::Information);
        QCOMPARE(ws->state().workspaceText, kLog);
        QCOMPARE(ws->c().lblHeader->text(), kHeader);
        QVERIFY(!ws->c().cmdSaveFile->isEnabled());
    }
};

QTEST_MAIN(SaveFileTest)
#include "savefile_test.moc"
