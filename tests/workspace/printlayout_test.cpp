// Printing the workspace to a PDF file through the print seam, and the main window's layout.
#include "WorkspaceWindow.h"
#include "shell/Twips.h"
#include "workspace/WorkspaceCommands.h"

#include <QFrame>
#include <QProgressBar>
#include <QPushButton>
#include <QTemporaryDir>
#include <QTest>
#include <QTextCursor>

namespace {
QString pdfFonts(const QString& pdf) {
    QProcess run;
    run.start(QStringLiteral("pdffonts"), {pdf});
    run.waitForFinished(20000);
    return QString::fromUtf8(run.readAllStandardOutput());
}
const QString kText = QStringLiteral("Line one   7.00 pH\nLine two   8.00 pH\nLine three\n");
} // namespace

class PrintLayoutTest : public QObject {
    Q_OBJECT

    std::unique_ptr<WorkspaceWindow> ws;
    std::unique_ptr<QTemporaryDir> dir;
    QString pdf() { return dir->filePath(QStringLiteral("out.pdf")); }
    const MainControls& c() { return ws->c(); }
    void resizeTo(int w, int h) {
        ws->w->resize(w, h);
        QCoreApplication::processEvents();
    }
    int H() { return pixelsToTwips(ws->w->frameGeometry().height()); }
    int W() { return pixelsToTwips(ws->w->frameGeometry().width()); }

private slots:
    void init() {
        ws = std::make_unique<WorkspaceWindow>();
        dir = std::make_unique<QTemporaryDir>();
    }
    void cleanup() {
        ws.reset();
        dir.reset();
    }

    void printsAllInCourierNew() {
        ws->fill(kText, c().mnuLog);
        ws->dialogs.printToPdf(pdf());
        c().cmdPrint->click();
        const QString printed = printedText(pdf());
        QVERIFY2(printed.startsWith(collapsed(kText)), qPrintable(printed));
        QVERIFY(pdfFonts(pdf()).contains(QLatin1String("LiberationMono")) ||
                pdfFonts(pdf()).contains(QLatin1String("Courier")));
        QVERIFY(ws->f->prompts.shown.isEmpty());
    }

    void printsOnlySelection() {
        ws->fill(kText, c().mnuLog);
        QTextCursor cur = ws->edit()->textCursor();
        cur.setPosition(5);
        cur.setPosition(24, QTextCursor::KeepAnchor);
        ws->edit()->setTextCursor(cur);
        ws->dialogs.printToPdf(pdf());
        c().mnuPrint->trigger();
        const QString printed = printedText(pdf());
        QVERIFY2(printed.startsWith(QLatin1String("one 7.00 pH Line")), qPrintable(printed));
        QVERIFY(!printed.contains(QLatin1String("two")));
        QVERIFY(!printed.contains(QLatin1String("three")));
    }

    void cancelPrintsNothing() {
        ws->fill(kText, c().mnuLog);
        ws->dialogs.cancelPrint();
        c().cmdPrint->click();
        QCOMPARE(ws->dialogs.printDialogs, 1);
        QVERIFY(!QFile::exists(pdf()));
        QVERIFY(ws->f->prompts.shown.isEmpty());
    }

    void trailingCarriageReturnsLeaveTheControl() {
        const QString text = QStringLiteral("a\r\nb\r\r");
        ws->fill(text, c().mnuLog);
        QCOMPARE(ws->edit()->toPlainText(), QStringLiteral("a\nb\n\n"));
        ws->dialogs.printToPdf(pdf());
        c().cmdPrint->click();
        QCOMPARE(ws->edit()->toPlainText(), QStringLiteral("a\nb"));
        QCOMPARE(ws->state().workspaceText, text);
        QVERIFY(QFile::exists(pdf()));
    }

    void printerFailureIsReported() {
        ws->fill(kText, c().mnuLog);
        ws->dialogs.printToPdf(dir->filePath(QStringLiteral("missing/folder/out.pdf")));
        c().cmdPrint->click();
        QCOMPARE(ws->f->prompts.shown.size(), 1);
        QCOMPARE(ws->f->prompts.shown.first().icon, Prompts::Icon::Information);
        QVERIFY(ws->f->prompts.shown.first().text.contains(QLatin1String("missing/folder")));
    }

    void printStopsVoltageDisplay() {
        ws->fill(QStringLiteral("9.1 V\n"), c().mnuVoltage);
        c().tmrDisplayVoltage->start(100000);
        ws->dialogs.cancelPrint();
        ws->w->workspace().Print();
        QVERIFY(!c().tmrDisplayVoltage->isActive());
        QVERIFY(ws->edit()->toPlainText().isEmpty());
    }

    void printSetupOnlyChoosesPrinter() {
        ws->fill(kText, c().mnuLog);
        ws->dialogs.printToPdf(pdf());
        c().mnuPrintSetUp->trigger();
        ws->dialogs.cancelPrint();
        c().mnuPrintSetUp->trigger();
        QCOMPARE(ws->dialogs.printDialogs, 2);
        QVERIFY(!QFile::exists(pdf()));
        QVERIFY(ws->f->prompts.shown.isEmpty());
    }

    void workspaceFollowsWindow_data() {
        QTest::addColumn<bool>("k5");
        QTest::addColumn<bool>("percent");
        QTest::addColumn<bool>("stir");
        QTest::addColumn<int>("less");
        QTest::newRow("plain") << false << false << false << 2510;
        QTest::newRow("K5 family") << true << false << false << 3530;
        QTest::newRow("percent") << false << true << false << 2850;
        QTest::newRow("percent with stirrer") << false << true << true << 3870;
        QTest::newRow("K5 and percent") << true << true << false << 3870;
    }
    void workspaceFollowsWindow() {
        QFETCH(bool, k5);
        QFETCH(bool, percent);
        QFETCH(bool, stir);
        QFETCH(int, less);
        ws->state().isK5Family = k5;
        ws->state().percentFormat = percent;
        ws->state().canStir = stir;
        resizeTo(880, 690);
        QCOMPARE(ws->edit()->width(), twipsToPixels(W() - 60));
        QCOMPARE(ws->edit()->height(), twipsToPixels(H() - less));
        const std::initializer_list<QWidget*> statusLabels{
            c().lblModel,  c().lblVersion, c().lblModelData,  c().lblVersionData,
            c().lblSerial, c().lblNumLog,  c().lblSerialData, c().lblNumLogData};
        for (QWidget* label : statusLabels)
            QCOMPARE(label->y(), twipsToPixels(H() - 1050));
        QCOMPARE(c().lblMessage->y(), twipsToPixels(H() - 1360));
        QCOMPARE(c().ProgressBar1->y(), twipsToPixels(H() - 1360));
        QCOMPARE(c().picKVOLogo->x(), twipsToPixels(W() - 1150));
        QCOMPARE(c().Line1->geometry().right() + 1, twipsToPixels(W()));
        QVERIFY(qAbs(c().Line1->geometry().center().y() - twipsToPixels(H() - 1050)) <= 1);
    }

    void k5WorkspaceIsShorter() {
        resizeTo(900, 700);
        const int plain = ws->edit()->height();
        ws->state().isK5Family = true;
        resizeTo(900, 701);
        resizeTo(900, 700);
        QVERIFY(qAbs(plain - ws->edit()->height() - twipsToPixels(1020)) <= 1);
    }

    void snapsToMinimumSize() {
        resizeTo(300, 200);
        QCOMPARE(W(), 10005); // 10000 twips, rounded to whole pixels
        QCOMPARE(H(), 4995);
        QCOMPARE(ws->edit()->width(), twipsToPixels(W() - 60));
        resizeTo(800, 200);
        QCOMPARE(ws->w->width(), 800);
        QCOMPARE(H(), 4995);
    }

    void minimiseAndRestoreKeepLayout() {
        resizeTo(900, 700);
        const QRect edit = ws->edit()->geometry();
        const QRect model = c().lblModel->geometry();
        const QRect logo = c().picKVOLogo->geometry();
        ws->w->showMinimized();
        QCoreApplication::processEvents();
        ws->w->showNormal();
        QCoreApplication::processEvents();
        QCOMPARE(ws->w->size(), QSize(900, 700));
        QCOMPARE(ws->edit()->geometry(), edit);
        QCOMPARE(c().lblModel->geometry(), model);
        QCOMPARE(c().picKVOLogo->geometry(), logo);
    }
};

QTEST_MAIN(PrintLayoutTest)
#include "printlayout_test.moc"
