// Builds the controls of the main window: menus, command buttons, status area, workspace, timers.
#include "desktop/shell/CommandButton.h"
#include "desktop/shell/MainWindow.h"
#include "desktop/shell/Twips.h"

#include <QAction>
#include <QFrame>
#include <QLabel>
#include <QMenu>
#include <QMenuBar>
#include <QPlainTextEdit>
#include <QProgressBar>
#include <QTimer>

namespace {
constexpr int kButtonWidth = 840;  // twips
constexpr int kButtonHeight = 900; // twips
constexpr int kRowOneTop = 60;
constexpr int kRowTwoTop = 1080;

QAction* addItem(QMenu* menu, const char* name, const char* caption,
                 const char* shortcut = nullptr) {
    auto* action = menu->addAction(QString::fromLatin1(caption));
    action->setObjectName(QString::fromLatin1(name));
    if (shortcut)
        action->setShortcut(QKeySequence(QString::fromLatin1(shortcut)));
    return action;
}

QMenu* addMenu(QMenuBar* bar, const char* name, const char* caption) {
    auto* menu = bar->addMenu(QString::fromLatin1(caption));
    menu->setObjectName(QString::fromLatin1(name));
    menu->menuAction()->setObjectName(QString::fromLatin1(name) + QStringLiteral("Action"));
    return menu;
}

QLabel* addLabel(QWidget* parent, const char* name, const char* caption, int leftTwips,
                 int widthTwips) {
    auto* label = new QLabel(QString::fromLatin1(caption), parent);
    label->setObjectName(QString::fromLatin1(name));
    label->setGeometry(twipsToPixels(leftTwips), 0, twipsToPixels(widthTwips), twipsToPixels(285));
    return label;
}
} // namespace

void MainWindow::buildControls() {
    auto* central = new QWidget(this);
    central->setObjectName(QStringLiteral("frmMainClient"));
    setCentralWidget(central);
    buildMenus();
    buildButtons();
    buildStatusArea();

    auto makeTimer = [this](QTimer*& timer, const char* name, int interval, Qt::TimerType type) {
        timer = new QTimer(this);
        timer->setObjectName(QString::fromLatin1(name));
        timer->setInterval(interval);
        timer->setTimerType(type);
    };
    makeTimer(c_.tmrDetectMeter, "tmrDetectMeter", 600, Qt::CoarseTimer);
    makeTimer(c_.tmrDisplayVoltage, "tmrDisplayVoltage", 2000, Qt::CoarseTimer);
    makeTimer(c_.tmrRealTime, "tmrRealTime", 1000, Qt::PreciseTimer);
    makeTimer(c_.tmrLong, "tmrLong", 58000, Qt::PreciseTimer);
    makeTimer(c_.tmrDisplayInterval, "tmrDisplayInterval", 1000, Qt::PreciseTimer);
}

void MainWindow::buildMenus() {
    QMenuBar* bar = menuBar();
    c_.mnuFile = addMenu(bar, "mnuFile", "&File");
    c_.mnuOpen = addItem(c_.mnuFile, "mnuOpen", "&Open", "Ctrl+O");
    c_.mnuSave = addItem(c_.mnuFile, "mnuSave", "&Save", "Ctrl+S");
    c_.mnuFile->addSeparator();
    c_.mnuPrint = addItem(c_.mnuFile, "mnuPrint", "&Print", "Ctrl+P");
    c_.mnuPrintSetUp = addItem(c_.mnuFile, "mnuPrintSetUp", "Print  Set&up");
    c_.mnuFile->addSeparator();
    c_.mnuDetectMeter = addItem(c_.mnuFile, "mnuDetectMeter", "&Detect  Meter");
    c_.mnuEraseLog = addItem(c_.mnuFile, "mnuEraseLog", "&EraseLog", "Ctrl+E");
    c_.mnuFile->addSeparator();
    c_.mnuExit = addItem(c_.mnuFile, "mnuExit", "E&xit", "Ctrl+X");
    c_.mnuSave->setEnabled(false);
    c_.mnuPrint->setEnabled(false);
    c_.mnuDetectMeter->setEnabled(false);
    c_.mnuEraseLog->setEnabled(false);

    c_.mnuEdit = addMenu(bar, "mnuEdit", "&Edit");
    c_.mnuSelectAll = addItem(c_.mnuEdit, "mnuSelectAll", "&Select  All", "Ctrl+A");
    c_.mnuEdit->addSeparator();
    c_.mnuCopy = addItem(c_.mnuEdit, "mnuCopy", "&Copy", "Ctrl+C");
    c_.mnuClear = addItem(c_.mnuEdit, "mnuClear", "Clea&r");
    c_.mnuUndoClear = addItem(c_.mnuEdit, "mnuUndoClear", "&Undo  Clear ", "Ctrl+Z");
    c_.mnuEdit->addSeparator();
    c_.mnuFind = addItem(c_.mnuEdit, "mnuFind", "&Find", "Ctrl+F");
    for (QAction* a : {c_.mnuSelectAll, c_.mnuCopy, c_.mnuClear, c_.mnuUndoClear, c_.mnuFind})
        a->setEnabled(false);
    c_.mnuEdit->setEnabled(false);

    c_.mnuDisplay = addMenu(bar, "mnuDisplay", " &Display");
    c_.mnuRealTime = addItem(c_.mnuDisplay, "mnuRealTime", "&Current ", "Ctrl+R");
    c_.mnuLog = addItem(c_.mnuDisplay, "mnuLog", "&Log", "Ctrl+L");
    c_.mnuGLP = addItem(c_.mnuDisplay, "mnuGLP", "&GLP", "Ctrl+G");
    c_.mnuVoltage = addItem(c_.mnuDisplay, "mnuVoltage", "&Voltage", "Ctrl+V");
    c_.mnuMaxMin = addItem(c_.mnuDisplay, "mnuMaxMin", "&Max / Min", "Ctrl+M");
    c_.mnuListen = addItem(c_.mnuDisplay, "mnuListen", "Li&sten");
    for (QAction* a :
         {c_.mnuRealTime, c_.mnuLog, c_.mnuGLP, c_.mnuVoltage, c_.mnuMaxMin, c_.mnuListen})
        a->setCheckable(true);
    c_.mnuVoltage->setVisible(false);
    c_.mnuMaxMin->setVisible(false);
    c_.mnuDisplay->setEnabled(false);

    c_.mnuSetup = addMenu(bar, "mnuSetup", " &Setup");
    c_.mnuCommsPort = addItem(c_.mnuSetup, "mnuCommsPort", "&Serial  Port");
    c_.mnuFormatDisplay = addItem(c_.mnuSetup, "mnuFormatDisplay", "&Data  Format");
    c_.mnuWizard = addItem(c_.mnuSetup, "mnuWizard", "&Wizard");

    c_.mnuHelp = addMenu(bar, "mnuHelp", " &Help");
    c_.mnuAboutKVO = addItem(c_.mnuHelp, "mnuAboutKVO", "About  &KVO");
    c_.mnuAboutTelvio = addItem(c_.mnuHelp, "mnuAboutTelvio", "About  &Telvio");
    c_.mnuHelp->addSeparator();
    c_.mnuCatalog = addItem(c_.mnuHelp, "mnuCatalog", "&Browse  Catalogue");
    c_.mnuHelp->addSeparator();
    c_.mnuHelpGeneral = addItem(c_.mnuHelp, "mnuHelpGeneral", "&Help  (General)", "Ctrl+H");
    c_.mnuK5help = addItem(c_.mnuHelp, "mnuK5help", "Help  (Other)");
}

void MainWindow::buildButtons() {
    QWidget* client = centralWidget();
    auto make = [client](QPushButton*& button, const char* name, const char* caption, int left,
                         int top, const char* tip = nullptr) {
        button = new CommandButton(QString::fromLatin1(caption), client);
        button->setObjectName(QString::fromLatin1(name));
        button->setGeometry(twipsToPixels(left), twipsToPixels(top), twipsToPixels(kButtonWidth),
                            twipsToPixels(kButtonHeight));
        button->setFocusPolicy(Qt::StrongFocus);
        if (tip)
            button->setToolTip(QString::fromLatin1(tip));
    };
    make(c_.cmdOpenFile, "cmdOpenFile", "Open", 30, kRowOneTop, "Open file for display");
    make(c_.cmdSaveFile, "cmdSaveFile", "Save", 870, kRowOneTop,
         "Save information displayed in workspace");
    make(c_.cmdPrint, "cmdPrint", "Print", 1710, kRowOneTop,
         "Print information displayed in workspace");
    make(c_.cmdListen, "cmdListen", "Listen", 2550, kRowOneTop);
    make(c_.cmdCurrentData, "cmdCurrentData", "Current Data", 3390, kRowOneTop);
    make(c_.cmdStopCurrentData, "cmdStopCurrentData", "Stop", 3390, kRowOneTop);
    make(c_.cmdLoggedData, "cmdLoggedData", "Logged Data", 4230, kRowOneTop);
    make(c_.cmdEraseLog, "cmdEraseLog", "Erase Log", 5070, kRowOneTop,
         "Erases  log  residing  in  instrument's  memory");
    make(c_.cmdGLPData, "cmdGLPData", "GLP  Data", 5910, kRowOneTop);
    make(c_.cmdMaxMin, "cmdMaxMin", "Max / Min", 6750, kRowOneTop);
    make(c_.cmdHelp, "cmdHelp", "Help", 7590, kRowOneTop, "Display help file");
    make(c_.cmdEnableLogging, "cmdEnableLogging", "Enable Logging", 30, kRowTwoTop,
         "Enables  automatic  data  logging  on  instrument");
    make(c_.cmdDisableLogging, "cmdDisableLogging", "Disable Logging", 870, kRowTwoTop,
         "Disables  automatic  data  logging  on  instrument");
    make(c_.cmdStartStirring, "cmdStartStirring", "Start Stirring", 2550, kRowTwoTop,
         "Enables  external  stirrer  on  instrument");
    make(c_.cmdStopStirring, "cmdStopStirring", "Stop Stirring", 3390, kRowTwoTop,
         "Disables  external  stirrer  on  instrument");
    make(c_.cmdK5On, "cmdK5On", "Power On", 5070, kRowTwoTop, "Switches  instrument on");
    make(c_.cmdK5Off, "cmdK5Off", "Power Off", 5910, kRowTwoTop, "Switches  instrument off");

    for (QPushButton* b : {c_.cmdSaveFile, c_.cmdPrint, c_.cmdListen, c_.cmdCurrentData,
                           c_.cmdLoggedData, c_.cmdEraseLog, c_.cmdGLPData})
        b->setEnabled(false);
    for (QPushButton* b :
         {c_.cmdStopCurrentData, c_.cmdMaxMin, c_.cmdEnableLogging, c_.cmdDisableLogging,
          c_.cmdStartStirring, c_.cmdStopStirring, c_.cmdK5On, c_.cmdK5Off})
        b->hide();
}

void MainWindow::buildStatusArea() {
    QWidget* client = centralWidget();
    QFont courier(QStringLiteral("Courier"));
    courier.setStyleHint(QFont::Monospace);
    courier.setFixedPitch(true);
    courier.setPointSizeF(9.75);

    c_.lblHeader = addLabel(client, "lblHeader", "", 30, 9000);
    c_.lblHeader->setFont(courier);
    c_.lblHeader->move(twipsToPixels(30), twipsToPixels(1210));
    c_.lblHeader->hide();

    c_.RichTextBox1 = new QPlainTextEdit(client);
    c_.RichTextBox1->setObjectName(QStringLiteral("RichTextBox1"));
    c_.RichTextBox1->setFont(courier);
    c_.RichTextBox1->setLineWrapMode(QPlainTextEdit::NoWrap);
    c_.RichTextBox1->setReadOnly(true); // workspaceText is the record; the view only shows it
    c_.RichTextBox1->setUndoRedoEnabled(false);
    c_.RichTextBox1->setContextMenuPolicy(Qt::NoContextMenu);
    c_.RichTextBox1->setGeometry(twipsToPixels(0), twipsToPixels(1080), twipsToPixels(9000),
                                 twipsToPixels(3000));

    c_.lblMessage = addLabel(client, "lblMessage", "", 30, 6000);
    c_.ProgressBar1 = new QProgressBar(client);
    c_.ProgressBar1->setObjectName(QStringLiteral("ProgressBar1"));
    c_.ProgressBar1->setRange(0, 20);
    c_.ProgressBar1->setTextVisible(false);
    c_.ProgressBar1->setGeometry(twipsToPixels(6200), 0, twipsToPixels(3000), twipsToPixels(255));
    c_.ProgressBar1->hide();

    c_.Line1 = new QFrame(client);
    c_.Line1->setObjectName(QStringLiteral("Line1"));
    c_.Line1->setFrameShape(QFrame::HLine);
    c_.Line1->setFrameShadow(QFrame::Sunken);

    c_.lblModel = addLabel(client, "lblModel", "Model:", 30, 700);
    c_.lblModelData = addLabel(client, "lblModelData", "", 750, 1500);
    c_.lblVersion = addLabel(client, "lblVersion", "Version:", 2300, 800);
    c_.lblVersionData = addLabel(client, "lblVersionData", "", 3120, 1100);
    c_.lblSerial = addLabel(client, "lblSerial", "Serial:", 4300, 700);
    c_.lblSerialData = addLabel(client, "lblSerialData", "", 5020, 1200);
    c_.lblNumLog = addLabel(client, "lblNumLog", "Logged  Readings:", 6300, 1900);
    c_.lblNumLogData = addLabel(client, "lblNumLogData", "", 8220, 900);

    c_.picKVOLogo = new QLabel(QStringLiteral("KVO"), client);
    c_.picKVOLogo->setObjectName(QStringLiteral("picKVOLogo"));
    c_.picKVOLogo->setAlignment(Qt::AlignCenter);
    QFont logoFont = font();
    logoFont.setBold(true);
    logoFont.setItalic(true);
    logoFont.setPointSize(18);
    c_.picKVOLogo->setFont(logoFont);
    c_.picKVOLogo->setStyleSheet(QStringLiteral("color: #1f4e8c;"));
    c_.picKVOLogo->setGeometry(0, twipsToPixels(kRowOneTop), twipsToPixels(1080),
                               twipsToPixels(kButtonHeight));
}
