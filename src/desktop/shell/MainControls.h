#pragma once

class QAction;
class QFrame;
class QLabel;
class QMenu;
class QPlainTextEdit;
class QProgressBar;
class QPushButton;
class QTimer;

// Every control of the main window, by the name the rest of the code uses. The widgets carry
// the same object names, so tests find them with findChild.
struct MainControls {
    // Command buttons.
    QPushButton* cmdOpenFile = nullptr;
    QPushButton* cmdSaveFile = nullptr;
    QPushButton* cmdPrint = nullptr;
    QPushButton* cmdListen = nullptr;
    QPushButton* cmdCurrentData = nullptr;
    QPushButton* cmdStopCurrentData = nullptr;
    QPushButton* cmdLoggedData = nullptr;
    QPushButton* cmdEraseLog = nullptr;
    QPushButton* cmdGLPData = nullptr;
    QPushButton* cmdMaxMin = nullptr;
    QPushButton* cmdHelp = nullptr;
    QPushButton* cmdEnableLogging = nullptr;
    QPushButton* cmdDisableLogging = nullptr;
    QPushButton* cmdStartStirring = nullptr;
    QPushButton* cmdStopStirring = nullptr;
    QPushButton* cmdK5On = nullptr;
    QPushButton* cmdK5Off = nullptr;

    // Menus and their items.
    QMenu* mnuFile = nullptr;
    QAction* mnuOpen = nullptr;
    QAction* mnuSave = nullptr;
    QAction* mnuPrint = nullptr;
    QAction* mnuPrintSetUp = nullptr;
    QAction* mnuDetectMeter = nullptr;
    QAction* mnuEraseLog = nullptr;
    QAction* mnuExit = nullptr;

    QMenu* mnuEdit = nullptr;
    QAction* mnuSelectAll = nullptr;
    QAction* mnuCopy = nullptr;
    QAction* mnuClear = nullptr;
    QAction* mnuUndoClear = nullptr;
    QAction* mnuFind = nullptr;

    QMenu* mnuDisplay = nullptr;
    QAction* mnuRealTime = nullptr;
    QAction* mnuLog = nullptr;
    QAction* mnuGLP = nullptr;
    QAction* mnuVoltage = nullptr;
    QAction* mnuMaxMin = nullptr;
    QAction* mnuListen = nullptr;

    QMenu* mnuSetup = nullptr;
    QAction* mnuCommsPort = nullptr;
    QAction* mnuFormatDisplay = nullptr;
    QAction* mnuWizard = nullptr;

    QMenu* mnuHelp = nullptr;
    QAction* mnuAboutKVO = nullptr;
    QAction* mnuAboutTelvio = nullptr;
    QAction* mnuCatalog = nullptr;
    QAction* mnuHelpGeneral = nullptr;
    QAction* mnuK5help = nullptr;

    // Identity labels, status line, header, progress and workspace.
    QLabel* lblModel = nullptr;
    QLabel* lblVersion = nullptr;
    QLabel* lblSerial = nullptr;
    QLabel* lblNumLog = nullptr;
    QLabel* lblModelData = nullptr;
    QLabel* lblVersionData = nullptr;
    QLabel* lblSerialData = nullptr;
    QLabel* lblNumLogData = nullptr;
    QLabel* lblMessage = nullptr;
    QLabel* lblHeader = nullptr;
    QLabel* picKVOLogo = nullptr;
    QFrame* Line1 = nullptr;
    QProgressBar* ProgressBar1 = nullptr;
    QPlainTextEdit* RichTextBox1 = nullptr;

    // Timers (all start disabled).
    QTimer* tmrDetectMeter = nullptr;
    QTimer* tmrDisplayVoltage = nullptr;
    QTimer* tmrRealTime = nullptr;
    QTimer* tmrLong = nullptr;
    QTimer* tmrDisplayInterval = nullptr;
};
