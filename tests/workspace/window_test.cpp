// The workspace through the real main window, offscreen, with scripted file and print dialogs:
// Edit menu, find, data format, saving and opening (also when the file system fails), printing and
// layout. The text rules themselves are checked in rules_test; here they serve as oracles.
#include "DialogDriver.h"
#include "PdfText.h"
#include "ScriptedDialogs.h"
#include "WindowFixture.h"
#include "core/text/CommaDelimited.h"
#include "desktop/shell/Twips.h"

#include <QTest>
#include <QtWidgets>
#include <csignal>
#include <sys/resource.h>

namespace {
const QString kLog = "01/02/2024 10:11:12 1*2345 mS/cm 25.0 C\n";
const char* kExists = "frmAppendRenameOverwrite";
} // namespace

class WindowTest : public QObject {
    Q_OBJECT
    std::unique_ptr<ScriptedDialogs> d;
    std::unique_ptr<WindowFixture> f;
    std::unique_ptr<QTemporaryDir> dir;
    MainWindow* w = nullptr;
    QPlainTextEdit* edit = nullptr;

    const MainControls& c() { return f->c(); }
    AppState& s() { return f->state(); }
    QList<PromptRecorder::Shown>& shown() { return f->prompts.shown; }
    QString at(const QString& name) { return dir->filePath(name); }
    QByteArray bytesOf(const QString& name) {
        QFile file(at(name));
        return file.open(QIODevice::ReadOnly) ? file.readAll() : "<none>";
    }
    // The workspace as a filling operation leaves it.
    void fill(const QString& text, QAction* mark, const QString& header = {}) {
        w->UncheckDisplayMenus();
        if (mark)
            mark->setChecked(true);
        s().headerText = header;
        c().lblHeader->setText(header);
        s().workspaceText = text;
        edit->setPlainText(text);
        s().workspaceSaved = false;
    }
    // Saves through the Save button under that name; returns what the file then holds.
    QByteArray save(const QString& name, int filter = 0) {
        d->answerSave(at(name), filter);
        c().cmdSaveFile->click();
        return bytesOf(name);
    }
    void open(const QString& name) {
        d->answerOpen(at(name));
        c().cmdOpenFile->click();
    }

private slots:
    void init() {
        d = std::make_unique<ScriptedDialogs>();
        f = std::make_unique<WindowFixture>(d.get());
        w = &f->createWindow();
        edit = c().RichTextBox1;
        w->show();
        dir = std::make_unique<QTemporaryDir>();
    }
    void cleanup() {
        const QStringList failures = DialogDriver::takeFailures();
        f.reset();
        QCOMPARE(failures, QStringList());
    }

    void editMenu() {
        const QList<QObject*> commands{c().cmdSaveFile, c().cmdPrint, c().mnuSave,
                                       c().mnuPrint,    c().mnuFind,  c().mnuClear};
        auto followText = [&](bool on) {
            for (QObject* o : commands)
                QVERIFY2(o->property("enabled") == on, qPrintable(o->objectName()));
        };
        fill("abc\ndef\n", c().mnuLog, "Head");
        followText(true);
        QVERIFY(!c().mnuCopy->isEnabled());
        edit->moveCursor(QTextCursor::Right);
        edit->moveCursor(QTextCursor::Down, QTextCursor::KeepAnchor);
        // Copy does nothing while disabled.
        c().mnuCopy->trigger();
        QVERIFY(c().mnuSelectAll->isEnabled() && qApp->clipboard()->text() == "bc\nd");
        c().mnuSelectAll->trigger();
        QVERIFY(!c().mnuSelectAll->isEnabled());

        c().mnuClear->trigger();
        QVERIFY(s().workspaceText.isEmpty() && c().lblHeader->text().isEmpty());
        QVERIFY(!c().mnuLog->isChecked());
        followText(false);
        c().mnuUndoClear->trigger();
        QCOMPARE(edit->toPlainText() + s().workspaceText + c().lblHeader->text(),
                 "abc\ndef\nabc\ndef\nHead");
        // Any change of the text ends the chance to undo.
        QVERIFY(!c().mnuUndoClear->isEnabled());

        // Real-time data: no Clear while readings run, an offer to save before it otherwise.
        fill("12:00:00 7.00\n", c().mnuRealTime);
        c().tmrRealTime->start(100000);
        c().mnuClear->trigger();
        QCOMPARE(edit->toPlainText(), "12:00:00 7.00\n");
        c().tmrRealTime->stop();
        c().mnuClear->trigger();
        QCOMPARE(shown().size(), 1);
    }

    // Each match shows as its start in the control and the text selected there.
    void find() {
        fill("Abc aab\r\naaa ABC\n", c().mnuLog);
        c().mnuFind->trigger();
        QWidget* dialog = nullptr;
        for (QWidget* top : qApp->topLevelWidgets())
            dialog = top->objectName() == "frmFind" ? top : dialog;
        QVERIFY(dialog->isVisible() && !w->isEnabled());
        auto* text = dialog->findChild<QLineEdit*>("Text1");
        auto next = [&](const QString& search) {
            text->setText(search);
            QTest::keyClick(text, Qt::Key_Return);
            const QTextCursor k = edit->textCursor();
            return QString::number(k.selectionStart()) + k.selectedText();
        };
        // From position 2, past the CR LF; then on from each match, overlapping.
        QCOMPARE(next("abc"), "12ABC");
        QCOMPARE(next("aa"), "4aa");
        next("aa");
        QCOMPARE(next("aa"), "9aa");

        // A selection becomes the search text.
        edit->find("ABC");
        c().mnuFind->trigger();
        QCOMPARE(text->selectedText(), "ABC");
        bool dialogUpDuringMessage = false;
        f->prompts.onShow = [&](auto&) { dialogUpDuringMessage = dialog->isVisible(); };
        text->setText("xyz");
        dialog->findChild<QPushButton*>("cmdFind")->click();
        QCOMPARE(f->prompts.texts(), {"Search  text  not  found."});
        QVERIFY(dialogUpDuringMessage && !dialog->isVisible() && w->isEnabled());
    }

    // Only the value 1 shows as Yes. Each pass turns every choice round: Cancel keeps them, OK
    // stores them.
    void dataFormat() {
        s().convertAsterisks = 1;
        s().convertMsToUs = 7;
        s().convertPpkToPpm = 1;
        for (QString button : {"cmdCancel", "cmdOK"}) {
            DialogDriver::whenModal("frmFormatDisplay", [&](QWidget* dialog) {
                // Yes and No of each choice, in turn.
                const auto options = dialog->findChildren<QRadioButton*>();
                for (int i : {0, 2, 4})
                    (options[i]->isChecked() ? options[i + 1] : options[i])->setChecked(true);
                DialogDriver::click(dialog, button);
            });
            c().mnuFormatDisplay->trigger();
        }
        QCOMPARE(f->settings.value("Asterisk") + f->settings.value("mS") + f->settings.value("ppK"),
                 "010");
    }

    void saveDialogFollowsDisplayKind() {
        const QList<QAction*> marks{c().mnuLog,    c().mnuRealTime, c().mnuListen, c().mnuGLP,
                                    c().mnuMaxMin, c().mnuVoltage,  nullptr};
        const QStringList names{"Log", "Current", "Instrument", "GLP", "MaxMin", "Voltage"};
        for (int i = 0; i < 7; ++i) {
            fill("x\n", marks[i]);
            d->cancelSave();
            c().mnuSave->trigger();
            QCOMPARE(d->saveCalls[i].proposedName, names.value(i, "Instrument") + " data");
            QCOMPARE(d->saveCalls[i].filters.size(), i < 3 ? 2 : 1);
        }
        QVERIFY(s().saveCancelled && QDir(dir->path()).isEmpty());
    }

    // Save starts on the filter last chosen, Open on the file last saved or opened.
    void fileDialogsRemember() {
        fill("1 2 3\n", c().mnuLog);
        save("a.csv", 1);
        c().cmdSaveFile->click();
        c().cmdOpenFile->click();
        QCOMPARE(d->saveCalls[1].filterIndex, 1);
        QCOMPARE(d->saveCalls[1].proposedName, "Log data");
        QCOMPARE(d->openCalls[0].fileName, at("a.csv"));
    }

    // Characters up to 255 are written as single bytes (here a lone UTF-8 lead byte at the end),
    // anything else as UTF-8; either opens as it was saved. A header is written only while it is
    // shown.
    void savedTextOpensAgain() {
        const QByteArray bytes[] = {"25.0 1*4\nx \xC3", "5 \xE2\x82\xAC 25\xC2\xB0"};
        const QString texts[] = {QString::fromLatin1(bytes[0]), QString::fromUtf8(bytes[1])};
        for (int i : {0, 1}) {
            const QString name = QString::number(i);
            fill(texts[i], c().mnuLog);
            s().headerText = "Head";
            save(name);
            QVERIFY(s().workspaceSaved);
            QCOMPARE(bytesOf(name + ".txt"), bytes[i]);
            c().lblHeader->setText("Head");
            open(name + ".txt");
            QCOMPARE(edit->toPlainText() + s().workspaceText + c().lblHeader->text(),
                     (texts[i] + "\n").repeated(2));
            QVERIFY(!c().mnuLog->isChecked());
        }
        // Asterisks become points in a comma-delimited file, or when asked, never in GLP data.
        fill(kLog, c().mnuListen, "Date Time");
        save("log", 1);
        QCOMPARE(bytesOf("log.csv"), CommaDelimited::convert(QString(kLog).replace('*', '.')));
        for (QAction* mark : {c().mnuLog, c().mnuGLP})
            for (int setting : {1, 2}) {
                fill("7*00\n", mark);
                s().convertAsterisks = setting;
                QCOMPARE(save(mark->objectName() + QString::number(setting) + ".txt"),
                         setting == 1 && mark == c().mnuLog ? "7.00\n" : "7*00\n");
            }
    }

    // Rename and closing the dialog by its frame ask for a name again; Append, Overwrite.
    void existingFile() {
        fill("old\n", c().mnuGLP);
        save("old.txt");
        fill("7.00\n", c().mnuLog, "Head");
        d->answerSave(at("old.txt"));
        d->answerSave(at("old.txt"));
        DialogDriver::whenModal(kExists, [](QWidget* dialog) {
            DialogDriver::whenModal(kExists, [](QWidget* again) { again->close(); });
            DialogDriver::click(dialog, "cmdRename");
        });
        QCOMPARE(save("new.txt"), "Head\r\n7.00\n");
        QCOMPARE(d->saveCalls.last().proposedName, "Log data");
        DialogDriver::clickWhenModal(kExists, "cmdAppend");
        QCOMPARE(save("old.txt"), "old\nHead\r\n7.00\n");
        DialogDriver::clickWhenModal(kExists, "cmdOverwrite");
        QCOMPARE(save("old.txt"), "Head\r\n7.00\n");
    }

    // A write that fails half-way (a file size limit, as on a full disk) leaves the old file
    // whole and no temporary file behind; the workspace keeps everything for another try.
    void failedWriteKeepsOldFile() {
        std::signal(SIGXFSZ, SIG_IGN);
        fill("old\n", c().mnuLog);
        save("log.txt");
        fill(kLog.repeated(2000), c().mnuLog);
        rlimit unlimited{};
        getrlimit(RLIMIT_FSIZE, &unlimited);
        rlimit limited{32 * 1024, unlimited.rlim_max};
        for (const char* button : {"cmdOverwrite", "cmdAppend"}) {
            DialogDriver::clickWhenModal(kExists, button);
            d->answerSave(at("log.txt"));
            setrlimit(RLIMIT_FSIZE, &limited);
            c().cmdSaveFile->click();
            setrlimit(RLIMIT_FSIZE, &unlimited);
            QCOMPARE(bytesOf("log.txt"), "old\n");
        }
        save("no/folder.txt");
        QCOMPARE(shown().size(), 3);
        for (const auto& message : shown())
            QVERIFY(message.icon == Prompts::Icon::Exclamation && !message.text.isEmpty());
        QVERIFY(!s().workspaceSaved);
        QCOMPARE(QDir(dir->path()).entryList(QDir::Files), {"log.txt"});
        QCOMPARE(save("big.txt"), kLog.repeated(2000).toLatin1());
    }

    // A file that cannot be read, or is missing, leaves the workspace as it was.
    void failedOpenKeepsWorkspace() {
        fill(kLog, c().mnuLog, "Head");
        c().cmdSaveFile->setEnabled(false);
        d->cancelOpen();
        // This process's memory file opens, but cannot be read.
        d->answerOpen("/proc/self/mem");
        c().mnuOpen->trigger();
        c().mnuOpen->trigger();
        QVERIFY(!c().cmdSaveFile->isEnabled());
        open("missing.txt");
        QCOMPARE(shown().size(), 2);
        QCOMPARE(shown()[0].icon, Prompts::Icon::Information);
        QCOMPARE(shown()[1].text, "        File not found!        ");
        QCOMPARE(edit->toPlainText() + s().workspaceText + c().lblHeader->text(),
                 kLog + kLog + "Head");
        QVERIFY(c().mnuLog->isChecked() && c().cmdSaveFile->isEnabled());
    }

    // A selection prints alone, in Courier New; trailing carriage returns leave the control.
    void prints() {
        fill("Line one   7.00 pH\nLine two   8.00 pH\r\r", c().mnuLog);
        edit->moveCursor(QTextCursor::NextWord);
        edit->moveCursor(QTextCursor::Down, QTextCursor::KeepAnchor);
        d->printToPdf(at("part.pdf"));
        c().cmdPrint->click();
        QCOMPARE(printedText(at("part.pdf")), "one 7.00 pH Line");
        QVERIFY(pdfFonts(at("part.pdf")).contains("LiberationMono"));
        QCOMPARE(edit->toPlainText(), "Line one   7.00 pH\nLine two   8.00 pH");
        d->cancelPrint();
        d->printToPdf(at("no/folder.pdf"));
        c().mnuPrint->trigger();
        c().mnuPrint->trigger();
        QCOMPARE(QDir(dir->path()).entryList(QDir::Files), {"part.pdf"});
        QVERIFY(shown().size() == 1 && shown()[0].icon == Prompts::Icon::Information);
    }

    // The workspace and the status area follow the window's outer size, in twips. Made smaller
    // than 10000 by 5000 twips, the window snaps back, in whole pixels.
    void layoutFollowsWindow() {
        w->resize(700, 400);
        qApp->processEvents();
        const int W = pixelsToTwips(w->frameGeometry().width());
        const int H = pixelsToTwips(w->frameGeometry().height());
        // Plain; percent (with the column header); percent with the header's font at 2x.
        for (int k5 : {0, 1, 2}) {
            s().isK5Family = s().percentFormat = k5;
            QFont font = c().lblHeader->font();
            font.setPointSizeF(font.pointSizeF() * qMax(1, k5));
            c().lblHeader->setFont(font);
            emit w->resized();
            // A header taller than its room pushes the workspace down by the difference.
            const int line = QFontMetrics(c().lblHeader->font()).lineSpacing();
            const int room = k5 ? qMax(0, line - twipsToPixels(210)) : 0;
            QCOMPARE(edit->size(),
                     QSize(twipsToPixels(W - 60), twipsToPixels(H - (k5 ? 3870 : 2510)) - room));
            QVERIFY(!k5 || c().lblHeader->height() >= line);
            QCOMPARE(c().lblNumLogData->y(), twipsToPixels(H - 1050));
            QCOMPARE(c().ProgressBar1->y(), twipsToPixels(H - 1360));
            QCOMPARE(c().picKVOLogo->x(), twipsToPixels(W - 1150));
        }
        w->resize(300, 200);
        qApp->processEvents();
        QCOMPARE(w->frameGeometry().size(), QSize(667, 333));
    }
};

QTEST_MAIN(WindowTest)
#include "window_test.moc"
