// What the program keeps from one use to the next (settings file, file dialogs, printer), and
// the room the column header gets above the workspace.
#include "DialogDriver.h"
#include "ScriptedDialogs.h"
#include "WindowFixture.h"
#include "help/HelpCommands.h"
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

class SettingsDialogsLayoutTest : public QObject {
    Q_OBJECT
private slots:
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
