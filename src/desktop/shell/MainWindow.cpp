#include "desktop/shell/MainWindow.h"

#include "core/Prompts.h"
#include "core/link/SerialLine.h"
#include "core/settings/Settings.h"
#include "core/settings/Version.h"
#include "desktop/help/HelpCommands.h"
#include "desktop/instrument/InstrumentCommands.h"
#include "desktop/link/Connection.h"
#include "desktop/link/Exchange.h"
#include "desktop/readings/ReadingCommands.h"
#include "desktop/shell/Twips.h"
#include "desktop/workspace/WorkspaceCommands.h"

#include <QAction>
#include <QApplication>
#include <QCloseEvent>
#include <QLabel>
#include <QMenu>
#include <QPlainTextEdit>
#include <QPrinter>
#include <QProgressBar>
#include <QPushButton>
#include <QScreen>
#include <QStandardPaths>
#include <QTimer>

MainWindow::MainWindow(const MainWindowServices& services, QWidget* parent)
    : QMainWindow(parent), services_(services) {
    setObjectName(QStringLiteral("frmMain"));
    buildControls();
    exchange_ = std::make_unique<Exchange>(*this);
    connection_ = std::make_unique<Connection>(*this);
    instrument_ = std::make_unique<InstrumentCommands>(*this);
    readings_ = std::make_unique<ReadingCommands>(*this);
    workspace_ = std::make_unique<WorkspaceCommands>(*this);
    help_ = std::make_unique<HelpCommands>(*this);
    connect(c_.mnuExit, &QAction::triggered, this, &MainWindow::ExitProgram);
    connect(c_.mnuWizard, &QAction::triggered, this, [this] {
        StopVoltageDisplay();
        RunSetupWizard();
    });
}

MainWindow::~MainWindow() {
    // The command classes are QObject children too; release them while the window still exists.
    help_.reset();
    workspace_.reset();
    readings_.reset();
    instrument_.reset();
    connection_.reset();
    exchange_.reset();
}

void MainWindow::start() {
    setWindowTitle(
        QStringLiteral("  Telvio  v%1.%2").arg(telvio::kVersionMajor).arg(telvio::kVersionMinor));
    placeWindow();
    show();
    state_.numLogged = 0;
    dataFolder_ = Settings::EnsureDataFolder(
        QStandardPaths::writableLocation(QStandardPaths::DocumentsLocation));
    bool firstRun = false;
    Settings::LoadSettings(state_, prompts(), &firstRun);
    if (firstRun)
        RunSetupWizard();
    serial().setOption(SerialLine::kOptionBufferSetup, 1);
    serial().setOption(SerialLine::kOptionReadBuffer, 50);
    connection().ConnectMeter();
}

void MainWindow::placeWindow() {
    const QScreen* screen = this->screen() ? this->screen() : QGuiApplication::primaryScreen();
    if (!screen)
        return;
    const QRect area = screen->geometry();
    const int margin = twipsToPixels(1000);
    const int width = area.width() - twipsToPixels(3000);
    const int height = area.height() - twipsToPixels(3000);
    resize(qMax(width, 100), qMax(height, 100));
    move(area.left() + margin, area.top() + margin);
}

QString MainWindow::dataFolder() const {
    return dataFolder_;
}

void MainWindow::setMessage(const QString& text) {
    c_.lblMessage->setText(text);
    c_.lblMessage->repaint();
}

QPrinter& MainWindow::printer() {
    if (!printer_)
        printer_ = std::make_unique<QPrinter>();
    return *printer_;
}

void MainWindow::setLeftTwips(QWidget* w, int twips) {
    w->move(twipsToPixels(twips), w->y());
}

void MainWindow::setTopTwips(QWidget* w, int twips) {
    w->move(w->x(), twipsToPixels(twips));
}

void MainWindow::closeEvent(QCloseEvent* event) {
    if (exiting_) {
        event->accept();
        return;
    }
    event->ignore();
    ExitProgram();
}

void MainWindow::resizeEvent(QResizeEvent* event) {
    QMainWindow::resizeEvent(event);
    emit resized();
}

void MainWindow::ExitProgram() {
    if (exiting_)
        return;
    PromptSaveAndClear(QString());
    exiting_ = true;
    try {
        serial().close();
    } catch (const std::exception&) {
    }
    for (QTimer* t : {c_.tmrDetectMeter, c_.tmrDisplayVoltage, c_.tmrRealTime, c_.tmrLong,
                      c_.tmrDisplayInterval})
        t->stop();
    if (endProgram) {
        endProgram();
        return;
    }
    hide();
    QCoreApplication::exit(0);
}

void MainWindow::RunSetupWizard() {
    const auto answer = prompts().show(
        QStringLiteral("Welcome to Telvio setup wizard.  Would you like to continue?\r\n\r\n"),
        Prompts::Icon::Question, Prompts::Buttons::YesNo);
    if (answer != Prompts::Answer::Yes)
        return;
    workspace().ShowFormatDialog();
    connection().ShowCommsPortDialog();
    prompts().show(QStringLiteral("Telvio is configured.\r\n"), Prompts::Icon::Information,
                   Prompts::Buttons::Ok);
}

void MainWindow::StopVoltageDisplay() {
    if (!c_.tmrDisplayVoltage->isActive())
        return;
    c_.tmrDisplayVoltage->stop();
    state_.workspaceText.clear();
    c_.RichTextBox1->clear();
}

bool MainWindow::NeedsSavePrompt(const QString& mode) const {
    if (c_.RichTextBox1->document()->isEmpty() || state_.workspaceSaved)
        return false;
    const bool listen = c_.mnuListen->isChecked();
    const bool realTime = c_.mnuRealTime->isChecked();
    if (!listen && !realTime)
        return false;
    if (mode == QLatin1String("Listen") && listen)
        return false;
    if (mode == QLatin1String("RealTime") && realTime)
        return false;
    return true;
}

void MainWindow::PromptSaveAndClear(const QString& mode) {
    if (!NeedsSavePrompt(mode))
        return;
    // Listened and real-time data cannot be fetched again: a "Yes" whose save was cancelled or
    // failed asks again rather than emptying the workspace.
    for (;;) {
        const auto answer =
            prompts().show(QStringLiteral("Data will be lost!  Would you like to save now?"),
                           Prompts::Icon::Exclamation, Prompts::Buttons::YesNo);
        if (answer != Prompts::Answer::Yes) {
            c_.lblHeader->clear();
            break;
        }
        workspace().SaveWorkspace();
        if (state_.workspaceSaved)
            break;
    }
    state_.workspaceSaved = true;
    c_.RichTextBox1->clear();
}

void MainWindow::UncheckDisplayMenus() {
    for (QAction* a :
         {c_.mnuGLP, c_.mnuLog, c_.mnuRealTime, c_.mnuMaxMin, c_.mnuVoltage, c_.mnuListen})
        a->setChecked(false);
}

void MainWindow::DisableCommandsForRun() {
    for (QPushButton* b : {c_.cmdSaveFile, c_.cmdEraseLog, c_.cmdEnableLogging, c_.cmdK5On,
                           c_.cmdK5Off, c_.cmdOpenFile, c_.cmdListen, c_.cmdLoggedData, c_.cmdHelp,
                           c_.cmdPrint, c_.cmdGLPData, c_.cmdCurrentData})
        b->setEnabled(false);
    c_.cmdStopCurrentData->show();
    c_.cmdStopCurrentData->setEnabled(true);
    c_.cmdStopCurrentData->raise();
    c_.cmdStopCurrentData->setFocus();
    for (QPushButton* b :
         {c_.cmdStopStirring, c_.cmdStartStirring, c_.cmdDisableLogging, c_.cmdMaxMin})
        b->setEnabled(false);
    for (QMenu* m : {c_.mnuFile, c_.mnuEdit, c_.mnuDisplay, c_.mnuSetup, c_.mnuHelp})
        m->setEnabled(false);
}

void MainWindow::EnableCommandsAfterRun() {
    c_.cmdCurrentData->show();
    c_.cmdCurrentData->setEnabled(true);
    c_.cmdListen->show();
    c_.cmdListen->setEnabled(true);
    c_.cmdLoggedData->setEnabled(true);
    if (state_.hasLog)
        c_.cmdLoggedData->show();
    setMessage(QString());
    c_.ProgressBar1->hide();
    for (QMenu* m : {c_.mnuFile, c_.mnuDisplay, c_.mnuSetup, c_.mnuHelp})
        m->setEnabled(true);
    c_.cmdStopCurrentData->hide();
    for (QPushButton* b : {c_.cmdEraseLog, c_.cmdEnableLogging, c_.cmdDisableLogging, c_.cmdK5On,
                           c_.cmdK5Off, c_.cmdOpenFile, c_.cmdLoggedData, c_.cmdHelp, c_.cmdGLPData,
                           c_.cmdMaxMin, c_.cmdStopStirring, c_.cmdStartStirring, c_.cmdSaveFile})
        b->setEnabled(true);
    c_.mnuSave->setEnabled(true);
}
