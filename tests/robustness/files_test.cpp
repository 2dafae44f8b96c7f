// Saving and opening when the file system works against the program: a full disk, a file size
// limit, a folder that cannot be written, a file that vanishes after the dialog, binary files.
#include "DialogDriver.h"
#include "workspace/WorkspaceCommands.h"
#include "workspace/WorkspaceWindow.h"

#include <QDir>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QRandomGenerator>
#include <QTemporaryDir>
#include <QTest>
#include <csignal>
#include <sys/mount.h>
#include <sys/resource.h>

using Icon = Prompts::Icon;

namespace {

const QByteArray kPrecious = "01/02/2024 10:11:12     1  1.413 mS/cm  25.0 C\r\n";

// A log big enough to fill a small disk, in the instrument's layout.
QString bigLog(int lines) {
    QString text;
    for (int i = 0; i < lines; ++i)
        text += QStringLiteral("01/02/2024 10:%1:00  %2  1*413 mS/cm  25.0 C\n")
                    .arg(i % 60, 2, 10, QLatin1Char('0'))
                    .arg(i, 5);
    return text;
}

// A small RAM disk mounted on a folder for the test's lifetime (needs the right to mount).
struct SmallDisk {
    QString path;
    bool ok = false;
    SmallDisk(const QString& folder, const char* size) : path(folder) {
        QDir().mkpath(path);
        const QByteArray options = QByteArray("size=") + size;
        ok = ::mount("tmpfs", QFile::encodeName(path).constData(), "tmpfs", 0,
                     options.constData()) == 0;
    }
    ~SmallDisk() {
        if (ok)
            ::umount2(QFile::encodeName(path).constData(), MNT_DETACH);
    }
};

// Writing past this many bytes of any file fails (EFBIG), as on a full disk.
struct FileSizeLimit {
    rlimit old{};
    explicit FileSizeLimit(rlim_t bytes) {
        std::signal(SIGXFSZ, SIG_IGN);
        getrlimit(RLIMIT_FSIZE, &old);
        rlimit limited = old;
        limited.rlim_cur = bytes;
        setrlimit(RLIMIT_FSIZE, &limited);
    }
    ~FileSizeLimit() { setrlimit(RLIMIT_FSIZE, &old); }
};

// A folder nobody may change, root included (immutable attribute); undone at the end.
struct ImmutableFolder {
    QString path;
    bool ok = false;
    explicit ImmutableFolder(const QString& p) : path(p) {
        QDir().mkpath(path);
        QProcess::execute(QStringLiteral("chattr"), {QStringLiteral("+i"), path});
        QFile probe(path + QStringLiteral("/probe"));
        ok = !probe.open(QIODevice::WriteOnly);
        probe.remove();
    }
    ~ImmutableFolder() {
        QProcess::execute(QStringLiteral("chattr"), {QStringLiteral("-i"), path});
    }
};

// The open dialog answers a file that is deleted the moment the dialog closes.
class VanishingOpenDialogs : public ScriptedDialogs {
public:
    std::optional<QString> askOpenFile(QWidget* parent, const QString& folder,
                                       const QStringList& filters) override {
        auto path = ScriptedDialogs::askOpenFile(parent, folder, filters);
        if (path)
            QFile::remove(*path);
        return path;
    }
};

} // namespace

class FilesStressTest : public QObject {
    Q_OBJECT

    std::unique_ptr<WorkspaceWindow> ws;
    std::unique_ptr<QTemporaryDir> dir;
    QString path(const QString& name) { return dir->filePath(name); }
    void save() { ws->w->workspace().SaveWorkspace(); }

    // Nothing saved, the old file whole, one message with the platform's reason.
    void checkFailedSave(const QString& file, const QByteArray& before) {
        QCOMPARE(readBytes(file), before);
        QCOMPARE(ws->f->prompts.shown.size(), 1);
        QCOMPARE(ws->f->prompts.shown.first().icon, Icon::Exclamation);
        QVERIFY(!ws->f->prompts.shown.first().text.trimmed().isEmpty());
        QVERIFY(!ws->state().workspaceSaved);
        // The workspace still holds what was to be saved, and saving elsewhere works.
        QCOMPARE(ws->edit()->toPlainText(), ws->state().workspaceText);
    }

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

    void fullDiskKeepsOldFile_data() {
        QTest::addColumn<QString>("button");
        QTest::addColumn<bool>("ramDisk");
        QTest::newRow("overwrite, disk full") << "cmdOverwrite" << true;
        QTest::newRow("append, disk full") << "cmdAppend" << true;
        QTest::newRow("overwrite, file size limit") << "cmdOverwrite" << false;
        QTest::newRow("append, file size limit") << "cmdAppend" << false;
    }
    void fullDiskKeepsOldFile() {
        QFETCH(QString, button);
        QFETCH(bool, ramDisk);
        std::unique_ptr<SmallDisk> disk;
        QString folder = dir->path();
        if (ramDisk) {
            disk = std::make_unique<SmallDisk>(path("disk"), "64k");
            if (!disk->ok)
                QSKIP("cannot mount a small RAM disk here");
            folder = disk->path;
        }
        const QString file = folder + QStringLiteral("/log.txt");
        QVERIFY(writeBytes(file, kPrecious));
        ws->fill(bigLog(4000), ws->c().mnuLog); // about 200 KB
        ws->dialogs.answerSave(file);
        DialogDriver::clickWhenModal(QStringLiteral("frmAppendRenameOverwrite"), button);
        {
            std::unique_ptr<FileSizeLimit> limit;
            if (!ramDisk)
                limit = std::make_unique<FileSizeLimit>(32 * 1024);
            save();
        }
        checkFailedSave(file, kPrecious);
        // No temporary file is left behind to fill the disk further.
        QCOMPARE(QDir(folder).entryList(QDir::Files), QStringList{"log.txt"});
        // Room again: the same save now succeeds.
        ws->f->prompts.clear();
        ws->dialogs.answerSave(path("elsewhere.txt"));
        save();
        QVERIFY(ws->f->prompts.shown.isEmpty());
        QVERIFY(ws->state().workspaceSaved);
        QCOMPARE(readBytes(path("elsewhere.txt")).size(), ws->state().workspaceText.size());
    }

    void unwritableFolder() {
        ImmutableFolder locked(path("locked"));
        if (!locked.ok)
            QSKIP("cannot make a folder unwritable here");
        ws->fill(bigLog(3), ws->c().mnuLog);
        ws->dialogs.answerSave(locked.path + QStringLiteral("/new.txt"));
        save();
        checkFailedSave(locked.path + QStringLiteral("/new.txt"), "<unreadable>");
        QVERIFY(QDir(locked.path).entryList(QDir::Files).isEmpty());
    }

    void fileVanishesAfterDialog() {
        VanishingOpenDialogs dialogs;
        WindowFixture f(&dialogs);
        MainWindow& w = f.createWindow();
        w.show();
        const QString log = bigLog(2);
        w.UncheckDisplayMenus();
        f.c().mnuLog->setChecked(true);
        f.state().workspaceText = log;
        f.c().RichTextBox1->setPlainText(log);
        QVERIFY(writeBytes(path("gone.txt"), kPrecious));
        dialogs.answerOpen(path("gone.txt"));
        f.c().cmdOpenFile->click();
        QVERIFY(!QFile::exists(path("gone.txt")));
        QCOMPARE(f.prompts.texts(), QStringList{"        File not found!        "});
        QCOMPARE(f.state().workspaceText, log);
        QCOMPARE(f.c().RichTextBox1->toPlainText(), log);
        QVERIFY(f.c().mnuLog->isChecked());
    }

    void binaryFileShownSafely_data() {
        QTest::addColumn<QByteArray>("bytes");
        QByteArray all;
        for (int i = 0; i < 256; ++i)
            all.append(char(i));
        QTest::newRow("every byte value") << all.repeated(4);
        QRandomGenerator random(7); // fixed seed: a failure reproduces
        QByteArray noise(256 * 1024, '\0');
        for (char& b : noise)
            b = char(random.bounded(256));
        QTest::newRow("256 KB of noise") << noise;
        QTest::newRow("zeros only") << QByteArray(10000, '\0');
        QTest::newRow("one long line") << QByteArray(300000, 'x');
        QTest::newRow("cut-off UTF-8") << QByteArray("caf\xc3");
    }
    void binaryFileShownSafely() {
        QFETCH(QByteArray, bytes);
        QVERIFY(writeBytes(path("binary.bin"), bytes));
        ws->fill(bigLog(2), ws->c().mnuLog, QStringLiteral("header"));
        ws->dialogs.answerOpen(path("binary.bin"));
        ws->c().cmdOpenFile->click();
        QVERIFY(ws->f->prompts.shown.isEmpty());
        // Shown whole: every character of the file is in the workspace or was a separator.
        QVERIFY(!ws->state().workspaceText.isEmpty());
        QVERIFY(ws->state().workspaceText.size() <= 2 * bytes.size() + 1);
        QVERIFY(!ws->edit()->toPlainText().isEmpty());
        QVERIFY(ws->c().lblHeader->text().isEmpty());
        QVERIFY(!ws->c().mnuLog->isChecked());
        // And the window goes on working: the text saves as it is held.
        ws->dialogs.answerSave(path("again.txt"));
        save();
        QVERIFY(ws->f->prompts.shown.isEmpty());
        QVERIFY(ws->state().workspaceSaved);
        QVERIFY(!readBytes(path("again.txt")).isEmpty());
    }
};

QTEST_MAIN(FilesStressTest)
#include "files_test.moc"
