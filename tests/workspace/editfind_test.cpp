// The workspace's Edit menu, change and selection rules, find dialog, data-format dialog and
// the conversions applied when a download ends, through the main window.
#include "DialogDriver.h"
#include "WorkspaceWindow.h"
#include "workspace/WorkspaceCommands.h"

#include <QApplication>
#include <QClipboard>
#include <QContextMenuEvent>
#include <QDialog>
#include <QGroupBox>
#include <QLineEdit>
#include <QMenu>
#include <QPushButton>
#include <QRadioButton>
#include <QTest>
#include <QTextCursor>
#include <QTimer>

class EditFindTest : public QObject {
    Q_OBJECT

    std::unique_ptr<WorkspaceWindow> ws;
    const MainControls& c() { return ws->c(); }
    QDialog* findDialog() {
        for (QWidget* top : QApplication::topLevelWidgets())
            if (top->objectName() == QLatin1String("frmFind"))
                return qobject_cast<QDialog*>(top);
        return nullptr;
    }
    QLineEdit* findText() { return findDialog()->findChild<QLineEdit*>(QStringLiteral("Text1")); }
    void pressFind() { findDialog()->findChild<QPushButton*>(QStringLiteral("cmdFind"))->click(); }
    QPair<int, int> selection() {
        const QTextCursor cur = ws->edit()->textCursor();
        return {cur.selectionStart(), cur.selectionEnd() - cur.selectionStart()};
    }
    void placeCaret(int pos) { select(pos, pos); }
    void select(int from, int to) {
        QTextCursor cur = ws->edit()->textCursor();
        cur.setPosition(from);
        cur.setPosition(to, QTextCursor::KeepAnchor);
        ws->edit()->setTextCursor(cur);
    }
    bool contextMenuShows() {
        QContextMenuEvent event(QContextMenuEvent::Mouse, QPoint(10, 10),
                                ws->edit()->viewport()->mapToGlobal(QPoint(10, 10)));
        QApplication::sendEvent(ws->edit()->viewport(), &event);
        const bool shown = c().mnuEdit->isVisible();
        c().mnuEdit->hide();
        return shown;
    }

private slots:
    void init() { ws = std::make_unique<WorkspaceWindow>(); }
    void cleanup() {
        const QStringList failures = DialogDriver::takeFailures();
        if (findDialog())
            findDialog()->hide();
        ws.reset();
        QVERIFY2(failures.isEmpty(), qPrintable(failures.join(u'\n')));
    }

    void textDecidesCommands() {
        const QList<QObject*> followers{c().cmdSaveFile, c().mnuSave, c().cmdPrint,
                                        c().mnuPrint,    c().mnuFind, c().mnuSelectAll,
                                        c().mnuClear};
        auto enabled = [](QObject* o) { return o->property("enabled").toBool(); };
        ws->fill(QStringLiteral("7.00 pH\n"), c().mnuLog, QStringLiteral("Header"));
        for (QObject* o : followers)
            QVERIFY2(enabled(o), qPrintable(o->objectName()));
        QVERIFY(c().mnuEdit->isEnabled());

        ws->edit()->setPlainText(QString());
        for (QObject* o : followers)
            QVERIFY2(!enabled(o) || o == c().mnuEdit, qPrintable(o->objectName()));
        QVERIFY(c().lblHeader->text().isEmpty());

        // While a run fills the workspace, the run's own rules decide.
        ws->state().runActive = true;
        ws->edit()->setPlainText(QStringLiteral("line\n"));
        QVERIFY(!c().cmdSaveFile->isEnabled());
        QVERIFY(!c().mnuClear->isEnabled());
    }

    void clearAndUndo() {
        ws->fill(QStringLiteral("a\nb\n"), c().mnuLog, QStringLiteral("Header"));
        c().mnuClear->trigger();
        QVERIFY(ws->edit()->toPlainText().isEmpty());
        QVERIFY(ws->state().workspaceText.isEmpty());
        QVERIFY(c().lblHeader->text().isEmpty());
        QVERIFY(!c().mnuLog->isChecked());
        QVERIFY(c().mnuUndoClear->isEnabled());

        c().mnuUndoClear->trigger();
        QCOMPARE(ws->state().workspaceText, QStringLiteral("a\nb\n"));
        QCOMPARE(ws->edit()->toPlainText(), QStringLiteral("a\nb\n"));
        QCOMPARE(c().lblHeader->text(), QStringLiteral("Header"));
        QVERIFY(!c().mnuUndoClear->isEnabled());
        QVERIFY(!c().mnuLog->isChecked()); // the display kind does not come back
    }

    void clearEmptyThenUndo() {
        ws->w->workspace().Clear(); // the menu item is disabled while the workspace is empty
        QVERIFY(c().mnuUndoClear->isEnabled());
        c().mnuUndoClear->trigger();
        QVERIFY(ws->state().workspaceText.isEmpty());
        QVERIFY(c().lblHeader->text().isEmpty());
        QVERIFY(!c().mnuUndoClear->isEnabled());
    }

    void newDataEndsUndo() {
        ws->fill(QStringLiteral("old\n"), c().mnuLog);
        c().mnuClear->trigger();
        ws->fill(QStringLiteral("new\n"), c().mnuGLP);
        QVERIFY(!c().mnuUndoClear->isEnabled());
    }

    void clearRefusedDuringRealTime() {
        ws->fill(QStringLiteral("12:00:00 7.00\n"), c().mnuRealTime);
        c().tmrDisplayVoltage->start(100000);
        c().tmrRealTime->start(100000);
        c().mnuClear->trigger();
        QVERIFY(!c().tmrDisplayVoltage->isActive());
        QCOMPARE(ws->edit()->toPlainText(), QStringLiteral("12:00:00 7.00\n"));
        c().mnuSelectAll->trigger();
        QVERIFY(!ws->edit()->textCursor().hasSelection());
        c().tmrRealTime->stop();
    }

    void clearOffersToSaveRealTimeData() {
        ws->fill(QStringLiteral("12:00:00 7.00\n"), c().mnuRealTime);
        ws->f->prompts.answerNext(Prompts::Answer::No);
        c().mnuClear->trigger();
        QCOMPARE(ws->f->prompts.texts(),
                 QStringList{"Data will be lost!  Would you like to save now?"});
        QCOMPARE(ws->state().undoText, QStringLiteral("12:00:00 7.00\n"));
    }

    void selectionRules() {
        ws->fill(QStringLiteral("abc\ndef\n"), c().mnuLog);
        QVERIFY(!c().mnuCopy->isEnabled());
        QVERIFY(c().mnuSelectAll->isEnabled());
        c().mnuSelectAll->trigger();
        QVERIFY(!c().mnuSelectAll->isEnabled());
        QVERIFY(c().mnuCopy->isEnabled());
        select(1, 5);
        QVERIFY(c().mnuSelectAll->isEnabled());
        QVERIFY(c().mnuCopy->isEnabled());
        c().mnuCopy->trigger();
        QCOMPARE(QApplication::clipboard()->text(), QStringLiteral("bc\nd"));
        placeCaret(2);
        QVERIFY(!c().mnuCopy->isEnabled());
    }

    void contextMenuConditions() {
        ws->fill(QStringLiteral("abc\n"), c().mnuLog);
        QVERIFY(contextMenuShows());
        c().tmrDisplayInterval->start(100000);
        QVERIFY(!contextMenuShows());
        c().tmrDisplayInterval->stop();
        c().tmrRealTime->start(100000);
        QVERIFY(!contextMenuShows());
        c().tmrRealTime->stop();
        ws->fill(QStringLiteral("9.1 V\n"), c().mnuVoltage);
        QVERIFY(!contextMenuShows());
        ws->fill(QStringLiteral("abc\n"), c().mnuLog);
        c().mnuEdit->setEnabled(false);
        QVERIFY(!contextMenuShows());
    }

    void findFromCaretWrapsAndOverlaps() {
        ws->fill(QStringLiteral("Abc aab\naaa ABC\n"), c().mnuLog);
        placeCaret(0);
        c().mnuFind->trigger();
        QVERIFY(findDialog() && findDialog()->isVisible());
        QVERIFY(!findDialog()->isModal());
        QVERIFY(!ws->w->isEnabled());
        QVERIFY(findDialog()->isEnabled());
        findText()->setText(QStringLiteral("abc"));
        pressFind(); // from position 2: the capitals on the second line
        QCOMPARE(selection(), qMakePair(12, 3));
        pressFind(); // wraps to position 1
        QCOMPARE(selection(), qMakePair(0, 3));
        QCOMPARE(findText()->selectedText(), QStringLiteral("abc"));

        findText()->setText(QStringLiteral("aa"));
        QTest::keyClick(findText(), Qt::Key_Return); // Enter acts as Find
        QCOMPARE(selection(), qMakePair(4, 2));
        QTest::keyClick(findText(), Qt::Key_Return);
        QCOMPARE(selection(), qMakePair(8, 2));
        pressFind(); // overlapping match
        QCOMPARE(selection(), qMakePair(9, 2));
        QVERIFY(findDialog()->isVisible());
        QVERIFY(ws->f->prompts.shown.isEmpty());
    }

    void findTakesSelectionAndKeepsTextWhenClosed() {
        ws->fill(QStringLiteral("one two one\n"), c().mnuLog);
        select(4, 7);
        c().mnuFind->trigger();
        QCOMPARE(findText()->text(), QStringLiteral("two"));
        QCOMPARE(findText()->selectedText(), QStringLiteral("two"));
        findText()->setText(QStringLiteral("one"));
        pressFind(); // from the selection start + 2, past the first "one"
        QCOMPARE(selection(), qMakePair(8, 3));

        findDialog()->close(); // by the frame: only hidden
        QVERIFY(!findDialog()->isVisible());
        QVERIFY(ws->w->isEnabled());
        placeCaret(0);
        c().mnuFind->trigger();
        QCOMPARE(findText()->text(), QStringLiteral("one"));
        findDialog()->findChild<QPushButton*>(QStringLiteral("cmdCancel"))->click();
        QVERIFY(!findDialog()->isVisible());
        QVERIFY(ws->w->isEnabled());
    }

    void findNotFoundReturnsToWindow() {
        ws->fill(QStringLiteral("abc\n"), c().mnuLog);
        c().mnuFind->trigger();
        findText()->setText(QStringLiteral("xyz"));
        bool enabledDuringMessage = false;
        ws->f->prompts.onShow = [&](const PromptRecorder::Shown&) {
            enabledDuringMessage = findDialog()->isVisible();
        };
        pressFind();
        QCOMPARE(ws->f->prompts.texts(), QStringList{"Search  text  not  found."});
        QCOMPARE(ws->f->prompts.shown.first().icon, Prompts::Icon::Exclamation);
        QVERIFY(enabledDuringMessage);
        QVERIFY(!findDialog()->isVisible());
        QVERIFY(ws->w->isEnabled());
    }

    void findEmptyTextDoesNothing() {
        ws->fill(QStringLiteral("abc\n"), c().mnuLog);
        c().mnuFind->trigger();
        findText()->clear();
        pressFind();
        QVERIFY(findDialog()->isVisible());
        QVERIFY(ws->f->prompts.shown.isEmpty());
        QVERIFY(!ws->edit()->textCursor().hasSelection());
    }

    void findSelectsRightTextAfterCrLf() {
        ws->fill(QStringLiteral("ab\r\ncd\r\nxy\n"), c().mnuLog);
        placeCaret(0);
        c().mnuFind->trigger();
        findText()->setText(QStringLiteral("XY"));
        pressFind();
        QCOMPARE(ws->edit()->textCursor().selectedText(), QStringLiteral("xy"));
        findText()->setText(QStringLiteral("cd"));
        pressFind();
        QCOMPARE(ws->edit()->textCursor().selectedText(), QStringLiteral("cd"));
    }

    void formatDialogStoresSettings_data() {
        QTest::addColumn<QString>("button");
        QTest::addColumn<bool>("stored");
        QTest::newRow("ok") << "cmdOK" << true;
        QTest::newRow("cancel") << "cmdCancel" << false;
    }
    void formatDialogStoresSettings() {
        QFETCH(QString, button);
        QFETCH(bool, stored);
        ws->state().portName = QStringLiteral("COM3");
        ws->state().baudRate = 9600;
        ws->state().logInterval = 1;
        ws->state().catalogDrive = QStringLiteral("d:");
        ws->state().convertAsterisks = 1;
        ws->state().convertMsToUs = 7; // only 1 means Yes
        ws->state().convertPpkToPpm = 0;
        QStringList seen;
        DialogDriver::whenModal(QStringLiteral("frmFormatDisplay"), [&](QWidget* d) {
            seen << d->windowTitle();
            for (QGroupBox* box : d->findChildren<QGroupBox*>())
                seen << box->title();
            for (int i = 1; i <= 6; ++i) {
                auto* option = d->findChild<QRadioButton*>(QStringLiteral("Option%1").arg(i));
                seen << option->text() + (option->isChecked() ? "*" : "");
            }
            d->findChild<QRadioButton*>(QStringLiteral("Option2"))->setChecked(true);
            d->findChild<QRadioButton*>(QStringLiteral("Option3"))->setChecked(true);
            d->findChild<QRadioButton*>(QStringLiteral("Option5"))->setChecked(true);
            DialogDriver::click(d, button);
        });
        c().mnuFormatDisplay->trigger();
        QCOMPARE(seen, (QStringList{"  Data  Conversions", "Convert  asterisks  to  decimal  point",
                                    "Convert  mS/cm  to  uS/cm", "Convert  ppK  to  ppM", "Yes*",
                                    "No", "Yes", "No*", "Yes", "No*"}));
        if (stored) {
            QCOMPARE(ws->state().convertAsterisks, qint16(0));
            QCOMPARE(ws->state().convertMsToUs, qint16(1));
            QCOMPARE(ws->state().convertPpkToPpm, qint16(1));
            QCOMPARE(ws->f->settings.value(QStringLiteral("Asterisk")), QStringLiteral("0"));
            QCOMPARE(ws->f->settings.value(QStringLiteral("mS")), QStringLiteral("1"));
            QCOMPARE(ws->f->settings.value(QStringLiteral("ppK")), QStringLiteral("1"));
            QCOMPARE(ws->f->settings.value(QStringLiteral("COM")), QStringLiteral("COM3"));
        } else {
            QCOMPARE(ws->state().convertAsterisks, qint16(1));
            QCOMPARE(ws->state().convertMsToUs, qint16(7));
            QVERIFY(!ws->f->settings.contains(QStringLiteral("mS")));
        }
    }

    void formatDialogStopsVoltageDisplay() {
        ws->fill(QStringLiteral("9.1 V\n"), c().mnuVoltage);
        c().tmrDisplayVoltage->start(100000);
        DialogDriver::clickWhenModal(QStringLiteral("frmFormatDisplay"),
                                     QStringLiteral("cmdCancel"));
        c().mnuFormatDisplay->trigger();
        QVERIFY(!c().tmrDisplayVoltage->isActive());
        QVERIFY(ws->state().workspaceText.isEmpty());
    }

    void applyDataConversions_data() {
        QTest::addColumn<int>("ms");
        QTest::addColumn<int>("asterisk");
        QTest::addColumn<QString>("expected");
        QTest::newRow("none") << 0 << 0 << "ab1*2345mS\n";
        QTest::newRow("units") << 1 << 0 << "ab1234*5uS\n";
        QTest::newRow("units and asterisks") << 1 << 1 << "ab1234.5uS\n";
    }
    void applyDataConversions() {
        QFETCH(int, ms);
        QFETCH(int, asterisk);
        QFETCH(QString, expected);
        ws->state().convertMsToUs = static_cast<qint16>(ms);
        ws->state().convertAsterisks = static_cast<qint16>(asterisk);
        ws->edit()->setPlainText(QStringLiteral("stale"));
        ws->state().workspaceText = QStringLiteral("ab1*2345mS\n");
        ws->w->workspace().ApplyDataConversions();
        QCOMPARE(ws->state().workspaceText, expected);
        QCOMPARE(ws->edit()->toPlainText(), expected);
        ws->w->workspace().ApplyDataConversions();
        QCOMPARE(ws->state().workspaceText, expected);
    }
};

QTEST_MAIN(EditFindTest)
#include "editfind_test.moc"
