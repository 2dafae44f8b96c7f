// Help files, the help windows, the about boxes, the catalogue and the Help menu's glue.
#include "PdfText.h"
#include "ScriptedDialogs.h"
#include "WindowFixture.h"
#include "desktop/help/AboutKvoDialog.h"
#include "desktop/help/AboutTelvioDialog.h"
#include "desktop/help/CatalogDialog.h"
#include "desktop/help/Catalogue.h"
#include "desktop/help/HelpCommands.h"
#include "desktop/help/HelpWindow.h"

#include <QtTest>
#include <QtWidgets>

static void click(QWidget* w) {
    QTest::mouseClick(w, Qt::LeftButton);
}

// What the last dialog action saw.
static QString seen;

// Runs `call`; a modal dialog it opens gets `act` as soon as it is up.
static void withModal(const std::function<void()>& call, std::function<void(QWidget*)> act) {
    seen.clear();
    QTimer::singleShot(0, qApp, [act] {
        if (QWidget* m = QApplication::activeModalWidget()) {
            act(m);
            // A dialog the action should have closed must not hang the run.
            QTimer::singleShot(2000, m, [m] {
                QTest::qFail("left open", __FILE__, __LINE__);
                m->close();
            });
        }
    });
    call();
    QCoreApplication::processEvents();
}

// In the drive chooser: types a drive and presses a button.
static void choose(QWidget* chooser, const QString& drive, const char* button) {
    chooser->findChild<QComboBox*>()->setEditText(drive);
    chooser->findChild<QPushButton*>(button)->click();
}

class HelpTest : public QObject {
    Q_OBJECT
    AppState s;
    PromptRecorder prompts;
    ScriptedDialogs dialogs;
    QTemporaryDir tmp;
    std::unique_ptr<HelpWindow> w;

    void open(HelpKind kind, const QString& dir = TELVIO_TEST_DATA_DIR) {
        w = std::make_unique<HelpWindow>(kind, s, prompts, dialogs, dir);
        w->show();
    }
    void key(Qt::Key k, QWidget* to = nullptr) { QTest::keyClick(to ? to : w.get(), k); }

private slots:
    void init() {
        w.reset();
        prompts = {};
        dialogs = {};
    }

    // CR LF, LF and CR end lines; empty lines stay; only a lone "#" ends a block; a missing block
    // is empty, an unended last one keeps its text, and text after the last is not read.
    void helpFileRules() {
        const struct {
            const char* text;
            int count;
            QStringList topics;
        } rows[] = {{"A\r\n\r\nb\r\n#\r\nB\n#\nC\r#\r", 3, {"A\r\n\r\nb\r\n", "B\r\n", "C\r\n"}},
                    {"A\n#x\n #\n#", 1, {"A\r\n#x\r\n #\r\n"}},
                    {"#\nB\nC", 3, {"", "B\r\nC\r\n", ""}},
                    {"A\n#\nB\n#\n", 1, {"A\r\n"}}};
        for (const auto& row : rows)
            QCOMPARE(HelpFile::parseBlocks(row.text, row.count), row.topics);
        QCOMPARE(HelpFile::composePrintText({"A", "B", "C"}, 2), "A\r\n\r\n\r\nB\r\n\r\n\r\n");
    }

    // The keys walk every topic of the installed files and wrap; each title names its label and
    // is a heading over a plain body.
    void keysWalkTheShippedTopics() {
        auto bold = [&](int line) {
            QTextBlock block = w->textArea()->document()->findBlockByNumber(line);
            QTextCharFormat format = block.begin().fragment().charFormat();
            return format.fontWeight() == QFont::Bold && format.fontUnderline();
        };
        for (HelpKind kind : {HelpKind::General, HelpKind::Other}) {
            open(kind);
            const int n = HelpFile::topicCount(kind);
            for (int k = 0; k <= n; ++k) {
                QCOMPARE(w->textArea()->toPlainText().section('\n', 0, 0).simplified(),
                         w->topicLabel(k % n)->text().simplified());
                QVERIFY(bold(0) && !bold(2));
                for (int j = 0; j < n; ++j)
                    QCOMPARE(w->arrow(j)->isVisible(), j == k % n);
                key(k % 3 ? Qt::Key_Down : Qt::Key_Tab, k % 2 ? w->textArea() : nullptr);
            }
            key(Qt::Key_Up);
            key(Qt::Key_Up);
            // Enter on "Exit  help".
            key(Qt::Key_Return, w->textArea());
            QVERIFY(!w->isVisible());
        }
    }

    void clicksAndPrinting() {
        const QString pdf = tmp.filePath("h.pdf");
        dialogs.printToPdf(pdf);
        dialogs.cancelPrint();
        dialogs.printToPdf(tmp.filePath("no/such/h.pdf"));
        open(HelpKind::Other);
        click(w->topicLabel(3));
        // Enter on a topic does nothing; Up moves from the key position, not the clicked topic.
        key(Qt::Key_Return);
        QCOMPARE(w->shownTopic(), 3);
        key(Qt::Key_Up);
        QCOMPARE(w->shownTopic(), 7);
        key(Qt::Key_Up);
        const QString shown = w->textArea()->toPlainText();
        key(Qt::Key_Return);
        QCOMPARE(printedText(pdf), HelpFile::composePrintText(s.helpTopics, 6).simplified());
        QVERIFY(pdfFonts(pdf).contains("LiberationMono"));
        // Cancelled: silent. Failed: said.
        click(w->topicLabel(6));
        QVERIFY(prompts.shown.isEmpty());
        click(w->printPicture());
        QCOMPARE(prompts.shown.size(), 1);
        QCOMPARE(dialogs.printDialogs, 3);
        QCOMPARE(w->textArea()->toPlainText(), shown);
        click(w->topicLabel(7));
        QVERIFY(!w->isVisible());
    }

    void aboutBoxesAndCatalogue() {
        QCOMPARE(AboutTelvioDialog().findChild<QLabel*>("lblVersion")->text(), "Version : v1.36");
        QImage picture(64, 40, QImage::Format_RGB32);
        picture.fill(0);
        QVERIFY(picture.save(tmp.filePath("Splash.jpg")));
        AboutKvoDialog box(s, prompts, dialogs, tmp.path());
        QCOMPARE(box.label("imgSplash")->pixmap().size(), QSize(64, 40));
        click(box.label("lblEmail"));
        QCOMPARE(dialogs.openedWithDefault.takeFirst().toString(),
                 "mailto:" + box.label("lblEmail")->text());

        // Only a file at an absolute path is the page, whatever characters the path holds.
        const QString cd = tmp.filePath("cd; rm x & y");
        QDir().mkpath(cd + "/kvo");
        QFile(cd + "/kvo/index.html").open(QIODevice::WriteOnly);
        QDir::setCurrent(tmp.path());
        QVERIFY(!Catalogue::pageExists("cd; rm x & y"));
        s.catalogDrive = cd;
        const auto browse = [&] { Catalogue::browse(s, prompts, dialogs, nullptr); };
        withModal(browse, [&](QWidget* m) {
            seen = m->objectName();
            m->close();
        });
        QCOMPARE(seen, "");
        QCOMPARE(dialogs.openedWithDefault, QList{QUrl::fromLocalFile(cd + "/kvo/index.html")});

        for (auto [kept, chosen] : {std::pair{"E:", "e:"}, {"x:", "c:"}}) {
            s.catalogDrive = kept;
            CatalogDialog chooser(s, prompts, dialogs, {"c:", "d:", "e:"});
            QCOMPARE(chooser.driveList()->currentText(), chosen);
        }
        // Not found: said, remembered, still open; Cancel then changes nothing.
        withModal(browse, [&](QWidget* m) {
            choose(m, tmp.path(), "cmdOK");
            seen = m->isVisible() ? "open" : "closed";
            choose(m, "/elsewhere", "cmdCancel");
        });
        QCOMPARE(seen, "open");
        QCOMPARE(prompts.texts(), QStringList{"Catalogue  not  found."});
        QCOMPARE(s.catalogDrive, tmp.path());
        // Found, from the about box: opened, and the box shows the new page.
        withModal([&] { click(box.label("lblCatalogue")); },
                  [&](QWidget* m) { choose(m, cd, "cmdOK"); });
        QCOMPARE(dialogs.openedWithDefault.size(), 2);
        QCOMPARE(box.label("lblCatalogue")->text(), cd + "/kvo/index.html");
    }

    // Each Help item opens its window modal over the main window, from the program's folder;
    // all but About Telvio end a running voltage display first.
    void menuItemsThroughTheWindow() {
        WindowFixture f(&dialogs);
        MainWindow& main = f.createWindow();
        const MainControls& c = f.c();
        QCOMPARE(main.help().folder(), QCoreApplication::applicationDirPath());
        main.help().setFolder(TELVIO_TEST_DATA_DIR);
        f.state().catalogDrive = "/no/such/drive";
        for (QString row :
             {"mnuHelpGeneral frmHelp", "cmdHelp frmHelp", "mnuAboutKVO frmAboutKVO",
              "mnuCatalog frmCatalog", "mnuAboutTelvio frmAboutTelvio", "mnuK5help frmK5Help"}) {
            const QString name = row.section(' ', 0, 0);
            c.tmrDisplayVoltage->start(60000);
            c.RichTextBox1->setPlainText("Meter Battery Voltage = 6.3V");
            auto* button = main.findChild<QPushButton*>(name);
            withModal([&] { button ? button->click() : main.findChild<QAction*>(name)->trigger(); },
                      [&](QWidget* m) {
                          seen = m->parentWidget() == &main ? m->objectName() : "";
                          m->close();
                      });
            QCOMPARE(seen, row.section(' ', 1));
            QCOMPARE(c.tmrDisplayVoltage->isActive(), name == "mnuAboutTelvio");
            QCOMPARE(c.RichTextBox1->toPlainText().isEmpty(), name != "mnuAboutTelvio");
        }
        QVERIFY(f.state().helpTopics.value(0).startsWith("Enable"));
        QVERIFY(f.prompts.shown.isEmpty() && dialogs.openedWithDefault.isEmpty());
        // Help prints on the printer chosen in Print Setup.
        dialogs.printToPdf(tmp.filePath("setup.pdf"));
        dialogs.acceptPrinter();
        c.mnuPrintSetUp->trigger();
        withModal([&] { c.mnuHelpGeneral->trigger(); },
                  [](QWidget* m) {
                      static_cast<HelpWindow*>(m)->PrintHelpFile();
                      m->close();
                  });
        QVERIFY(QFileInfo(tmp.filePath("setup.pdf")).size() > 0);
    }
};

QTEST_MAIN(HelpTest)
#include "help_test.moc"
