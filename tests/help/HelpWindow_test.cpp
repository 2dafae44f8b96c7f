#include "PdfAndDialogChecks.h"
#include "help/HelpFile.h"
#include "help/HelpWindow.h"
#include "shell/AppState.h"
#include "support/PromptRecorder.h"
#include "support/ScriptedDialogs.h"

#include <QFile>
#include <QLabel>
#include <QTemporaryDir>
#include <QTextBlock>
#include <QTextEdit>
#include <QtTest>
#include <memory>

Q_DECLARE_METATYPE(HelpKind)

class HelpWindowTest : public QObject {
    Q_OBJECT
private slots:
    void init();
    void opensOnFirstTopic_data();
    void opensOnFirstTopic();
    void keysMoveAndWrap_data();
    void keysMoveAndWrap();
    void clickShowsTopicButKeepsKeyPosition();
    void enterOnTopicDoesNothing();
    void enterOnPrintPrintsWholeFile_data();
    void enterOnPrintPrintsWholeFile();
    void exitCloses_data();
    void exitCloses();
    void clicksOnPrintLabelAndPicturePrint();
    void printCancelledPrintsNothing();
    void printFailureIsReported();
    void titleIsHeadingAndEmptyLinesKept();
    void missingFileStillOpens();

private:
    std::unique_ptr<HelpWindow> open(HelpKind kind, const QString& folder = dataFolder());
    static QString dataFolder() { return qEnvironmentVariable("TELVIO_DATA_DIR"); }

    AppState state_;
    PromptRecorder prompts_;
    ScriptedDialogs dialogs_;
    QString pdf_;
    std::unique_ptr<QTemporaryDir> out_;
};

static QString collapsed(const QString& text) {
    return QString(text).simplified();
}

void HelpWindowTest::init() {
    state_ = AppState();
    prompts_ = PromptRecorder();
    dialogs_ = ScriptedDialogs();
    out_ = std::make_unique<QTemporaryDir>();
    QVERIFY(out_->isValid());
    pdf_ = out_->filePath("help.pdf");
}

std::unique_ptr<HelpWindow> HelpWindowTest::open(HelpKind kind, const QString& folder) {
    auto window = std::make_unique<HelpWindow>(kind, state_, prompts_, dialogs_, folder);
    window->show();
    return window;
}

void HelpWindowTest::opensOnFirstTopic_data() {
    QTest::addColumn<HelpKind>("kind");
    QTest::addColumn<QString>("name");
    QTest::addColumn<QString>("caption");
    QTest::addColumn<QString>("printLabel");
    QTest::newRow("general") << HelpKind::General << "frmHelp"
                             << "  Help  (General)"
                             << "Print  help  file";
    QTest::newRow("other") << HelpKind::Other << "frmK5Help"
                           << "  Help  (Other)"
                           << "Print  help file";
}

void HelpWindowTest::opensOnFirstTopic() {
    QFETCH(HelpKind, kind);
    QFETCH(QString, name);
    QFETCH(QString, caption);
    QFETCH(QString, printLabel);
    auto w = open(kind);
    const int count = HelpFile::topicCount(kind);
    QCOMPARE(w->objectName(), name);
    QCOMPARE(w->windowTitle(), caption);
    QCOMPARE(state_.helpTopics.size(), count);
    QCOMPARE(w->topicLabel(count - 2)->text(), printLabel);
    QCOMPARE(w->topicLabel(count - 1)->text(), QStringLiteral("Exit  help"));
    QCOMPARE(w->findChild<QLabel*>("lblHelpTopic_0"), w->topicLabel(0));
    QCOMPARE(w->findChild<QLabel*>("Label20") != nullptr, kind == HelpKind::General);
    QCOMPARE(w->selectedTopic(), 0);
    QCOMPARE(w->shownTopic(), 0);
    for (int i = 0; i < count; ++i)
        QCOMPARE(w->arrow(i)->isVisible(), i == 0);
    QCOMPARE(w->textArea()->toPlainText(),
             QString(state_.helpTopics.at(0)).replace(QLatin1String("\r\n"), QLatin1String("\n")));
    QVERIFY(w->textArea()->font().fixedPitch());
    QVERIFY(w->printPicture() && !w->printPicture()->pixmap().isNull());
}

void HelpWindowTest::keysMoveAndWrap_data() {
    QTest::addColumn<HelpKind>("kind");
    QTest::addColumn<QList<int>>("keys");
    QTest::addColumn<int>("expected");
    QTest::newRow("general: up from the first wraps to exit")
        << HelpKind::General << QList<int>{Qt::Key_Up} << 12;
    QTest::newRow("general: down from exit wraps to the first")
        << HelpKind::General << QList<int>{Qt::Key_Up, Qt::Key_Down} << 0;
    QTest::newRow("general: tab acts as down")
        << HelpKind::General << QList<int>{Qt::Key_Tab, Qt::Key_Tab} << 2;
    QTest::newRow("general: tab on exit wraps")
        << HelpKind::General << QList<int>{Qt::Key_Up, Qt::Key_Tab} << 0;
    QTest::newRow("other: up from the first wraps to exit")
        << HelpKind::Other << QList<int>{Qt::Key_Up} << 7;
    QTest::newRow("other: eight downs come round")
        << HelpKind::Other << QList<int>(8, Qt::Key_Down) << 0;
    QTest::newRow("other: tab then up")
        << HelpKind::Other << QList<int>{Qt::Key_Tab, Qt::Key_Up} << 0;
}

void HelpWindowTest::keysMoveAndWrap() {
    QFETCH(HelpKind, kind);
    QFETCH(QList<int>, keys);
    QFETCH(int, expected);
    auto w = open(kind);
    // Keys reach the window both through its text area and directly.
    for (int i = 0; i < keys.size(); ++i) {
        QWidget* target = i % 2 == 0 ? static_cast<QWidget*>(w->textArea()) : w.get();
        QTest::keyClick(target, static_cast<Qt::Key>(keys.at(i)));
    }
    QCOMPARE(w->selectedTopic(), expected);
    QCOMPARE(w->shownTopic(), expected);
    for (int i = 0; i < HelpFile::topicCount(kind); ++i)
        QCOMPARE(w->arrow(i)->isVisible(), i == expected);
    QVERIFY(w->isVisible());
    QCOMPARE(dialogs_.printDialogs, 0);
}

void HelpWindowTest::clickShowsTopicButKeepsKeyPosition() {
    auto w = open(HelpKind::General);
    QTest::keyClick(w->textArea(), Qt::Key_Down); // keys reach topic 1
    QTest::mouseClick(w->topicLabel(6), Qt::LeftButton);
    QCOMPARE(w->shownTopic(), 6);
    QCOMPARE(w->selectedTopic(), 1);
    QVERIFY(w->arrow(6)->isVisible());
    QVERIFY(!w->arrow(1)->isVisible());
    QVERIFY(w->textArea()->toPlainText().startsWith(QLatin1String("GLP Data")));
    QTest::keyClick(w->textArea(), Qt::Key_Down);
    QCOMPARE(w->selectedTopic(), 2);
    QCOMPARE(w->shownTopic(), 2);
}

void HelpWindowTest::enterOnTopicDoesNothing() {
    auto w = open(HelpKind::General);
    QTest::keyClick(w->textArea(), Qt::Key_Down);
    const QString shown = w->textArea()->toPlainText();
    QTest::keyClick(w->textArea(), Qt::Key_Return);
    QTest::keyClick(w.get(), Qt::Key_Enter, Qt::KeypadModifier);
    QVERIFY(w->isVisible());
    QCOMPARE(dialogs_.printDialogs, 0);
    QCOMPARE(w->textArea()->toPlainText(), shown);
    // Enter must not have been typed into the text either.
    QCOMPARE(w->selectedTopic(), 1);
}

void HelpWindowTest::enterOnPrintPrintsWholeFile_data() {
    QTest::addColumn<HelpKind>("kind");
    QTest::addColumn<int>("printed");
    QTest::newRow("general prints 11 topics") << HelpKind::General << 11;
    QTest::newRow("other prints 6 topics") << HelpKind::Other << 6;
}

void HelpWindowTest::enterOnPrintPrintsWholeFile() {
    QFETCH(HelpKind, kind);
    QFETCH(int, printed);
    auto w = open(kind);
    QTest::keyClick(w->textArea(), Qt::Key_Up);
    QTest::keyClick(w->textArea(), Qt::Key_Up);
    QCOMPARE(w->selectedTopic(), printed);
    const QString shown = w->textArea()->toPlainText();
    const QStringList topics = state_.helpTopics;

    dialogs_.printToPdf(pdf_);
    QTest::keyClick(w->textArea(), Qt::Key_Return);
    QCOMPARE(dialogs_.printDialogs, 1);
    QVERIFY(QFile::exists(pdf_));
    QVERIFY2(prompts_.shown.isEmpty(), qPrintable(prompts_.texts().join('|')));

    const QString text = printedText(pdf_);
    QCOMPARE(text, collapsed(HelpFile::composePrintText(topics, printed)));
    QVERIFY(text.startsWith(collapsed(topics.at(0))));
    QVERIFY(text.contains(collapsed(topics.at(printed - 1))));
    QVERIFY(!text.contains(collapsed(topics.at(printed + 1)))); // the exit topic is left out
    QVERIFY2(pdfFonts(pdf_).contains("LiberationMono") || pdfFonts(pdf_).contains("Courier"),
             qPrintable(pdfFonts(pdf_)));

    // The window stays open on the same topic with the same topics.
    QVERIFY(w->isVisible());
    QCOMPARE(w->shownTopic(), printed);
    QCOMPARE(w->textArea()->toPlainText(), shown);
    QCOMPARE(state_.helpTopics, topics);
}

void HelpWindowTest::exitCloses_data() {
    QTest::addColumn<HelpKind>("kind");
    QTest::addColumn<bool>("byClick");
    QTest::newRow("general, enter") << HelpKind::General << false;
    QTest::newRow("general, click") << HelpKind::General << true;
    QTest::newRow("other, enter") << HelpKind::Other << false;
}

void HelpWindowTest::exitCloses() {
    QFETCH(HelpKind, kind);
    QFETCH(bool, byClick);
    auto w = open(kind);
    if (byClick) {
        QTest::mouseClick(w->topicLabel(HelpFile::topicCount(kind) - 1), Qt::LeftButton);
    } else {
        QTest::keyClick(w->textArea(), Qt::Key_Up);
        QTest::keyClick(w->textArea(), Qt::Key_Return);
    }
    QVERIFY(!w->isVisible());
    QCOMPARE(dialogs_.printDialogs, 0);
}

void HelpWindowTest::clicksOnPrintLabelAndPicturePrint() {
    dialogs_.printToPdf(pdf_);
    dialogs_.printToPdf(pdf_);
    auto w = open(HelpKind::Other);
    QTest::mouseClick(w->topicLabel(3), Qt::LeftButton);
    const QString shown = w->textArea()->toPlainText();
    QTest::mouseClick(w->topicLabel(6), Qt::LeftButton);
    QCOMPARE(dialogs_.printDialogs, 1);
    QVERIFY(QFile::remove(pdf_));
    QTest::mouseClick(w->printPicture(), Qt::LeftButton);
    QCOMPARE(dialogs_.printDialogs, 2);
    QVERIFY(QFile::exists(pdf_));
    QCOMPARE(w->shownTopic(), 3);
    QCOMPARE(w->textArea()->toPlainText(), shown);
    QCOMPARE(w->selectedTopic(), 0);
    QVERIFY(w->isVisible());
}

void HelpWindowTest::printCancelledPrintsNothing() {
    dialogs_.cancelPrint();
    auto w = open(HelpKind::General);
    QTest::mouseClick(w->printPicture(), Qt::LeftButton);
    QCOMPARE(dialogs_.printDialogs, 1);
    QVERIFY(!QFile::exists(pdf_));
    QVERIFY(prompts_.shown.isEmpty());
    QVERIFY(w->isVisible());
}

void HelpWindowTest::printFailureIsReported() {
    dialogs_.printToPdf(out_->filePath("no/such/folder/help.pdf"));
    auto w = open(HelpKind::General);
    QTest::mouseClick(w->printPicture(), Qt::LeftButton);
    QCOMPARE(prompts_.shown.size(), 1);
    QCOMPARE(prompts_.shown.at(0).icon, Prompts::Icon::Information);
    QVERIFY(prompts_.shown.at(0).text.contains("no/such/folder/help.pdf"));
    QVERIFY(w->isVisible());
    // The window stays usable.
    QTest::keyClick(w->textArea(), Qt::Key_Down);
    QCOMPARE(w->shownTopic(), 1);
}

void HelpWindowTest::titleIsHeadingAndEmptyLinesKept() {
    QTemporaryDir folder;
    QFile file(folder.filePath("help.txt"));
    QVERIFY(file.open(QIODevice::WriteOnly));
    file.write("Title line\r\n\r\nBody text\r\n\r\n#\r\nSecond\r\n#\r\n");
    file.close();
    auto w = open(HelpKind::General, folder.path());
    QCOMPARE(w->textArea()->toPlainText(), QStringLiteral("Title line\n\nBody text\n\n"));
    QTextDocument* doc = w->textArea()->document();
    const QTextCharFormat title = doc->begin().begin().fragment().charFormat();
    QCOMPARE(title.fontWeight(), int(QFont::Bold));
    QVERIFY(title.fontUnderline());
    const QTextBlock body = doc->findBlockByNumber(2);
    QCOMPARE(body.text(), QStringLiteral("Body text"));
    QCOMPARE(body.begin().fragment().charFormat().fontWeight(), int(QFont::Normal));
    QVERIFY(!body.begin().fragment().charFormat().fontUnderline());

    // The heading does not leak into the next topic's body.
    QTest::keyClick(w->textArea(), Qt::Key_Down);
    QCOMPARE(w->textArea()->toPlainText(), QStringLiteral("Second\n"));
    QCOMPARE(doc->begin().begin().fragment().charFormat().fontWeight(), int(QFont::Bold));
}

void HelpWindowTest::missingFileStillOpens() {
    QTemporaryDir empty;
    auto w = open(HelpKind::Other, empty.path());
    QCOMPARE(state_.helpTopics, QStringList(8, QString()));
    QCOMPARE(w->textArea()->toPlainText(), QString());
    QTest::keyClick(w->textArea(), Qt::Key_Up);
    QCOMPARE(w->shownTopic(), 7);
    QTest::keyClick(w->textArea(), Qt::Key_Return);
    QVERIFY(!w->isVisible());
}

QTEST_MAIN(HelpWindowTest)
#include "HelpWindow_test.moc"
