#include "desktop/readings/ReadingCommands.h"

#include "core/instrument/StatusQuery.h"

#include "core/link/SerialLine.h"
#include "core/settings/Settings.h"
#include "desktop/link/Exchange.h"
#include "desktop/readings/ListenMode.h"
#include "desktop/readings/LogDownload.h"
#include "desktop/readings/RealTimeRun.h"
#include "desktop/readings/RecordDownload.h"
#include "desktop/shell/MainWindow.h"
#include "desktop/workspace/WorkspaceCommands.h"

#include <QAction>
#include <QLabel>
#include <QPushButton>
#include <QTimer>

ReadingCommands::ReadingCommands(MainWindow& window)
    : QObject(&window), w_(window), s_(window.state()), log_(std::make_unique<LogDownload>(window)),
      realTime_(std::make_unique<RealTimeRun>(window, *this)),
      records_(std::make_unique<RecordDownload>(window)),
      listen_(std::make_unique<ListenMode>(window)) {
    connectControls();
}

ReadingCommands::~ReadingCommands() = default;

void ReadingCommands::connectMenu(QAction* action, std::function<void()> run) {
    connect(action, &QAction::triggered, this, [action, run](bool checked) {
        if (action->isCheckable())
            action->setChecked(!checked);
        run();
    });
}

void ReadingCommands::connectControls() {
    const MainControls& c = w_.controls();
    connect(c.cmdLoggedData, &QPushButton::clicked, this, [this] { log_->DownloadLog(); });
    connectMenu(c.mnuLog, [this] { log_->DownloadLog(); });
    connect(c.cmdCurrentData, &QPushButton::clicked, this,
            [this] { realTime_->cmdCurrentData_Click(); });
    connectMenu(c.mnuRealTime, [this] { realTime_->cmdCurrentData_Click(); });
    connect(c.cmdGLPData, &QPushButton::clicked, this, [this] { records_->DisplayGLP(); });
    connectMenu(c.mnuGLP, [this] { records_->DisplayGLP(); });
    connect(c.cmdMaxMin, &QPushButton::clicked, this, [this] {
        w_.controls().lblHeader->clear();
        records_->DisplayMaxMin();
    });
    connectMenu(c.mnuMaxMin, [this] {
        w_.StopVoltageDisplay();
        w_.controls().lblHeader->clear();
        records_->DisplayMaxMin();
    });
    connect(c.cmdListen, &QPushButton::clicked, this, [this] { listen_->ListenForData(); });
    connectMenu(c.mnuListen, [this] { listen_->ListenForData(); });
    connect(c.cmdStopCurrentData, &QPushButton::clicked, this,
            &ReadingCommands::cmdStopCurrentData_Click);

    connect(c.tmrRealTime, &QTimer::timeout, this, [this] { realTime_->tmrRealTime_Timer(); });
    connect(c.tmrLong, &QTimer::timeout, this, [this] { realTime_->tmrLong_Timer(); });
    connect(c.tmrDisplayInterval, &QTimer::timeout, this,
            [this] { realTime_->tmrDisplayInterval_Timer(); });
}

void ReadingCommands::GetHeaderAndPosition() {
    StatusQuery::headerAndPositions(w_.exchange(), s_, logColumnKnown_);
}

void ReadingCommands::cmdStopCurrentData_Click() {
    const MainControls& c = w_.controls();
    c.tmrRealTime->stop();
    c.tmrLong->stop();
    c.tmrDisplayInterval->stop();
    s_.runActive = false;
    // Nothing more is taken once Stop is pressed; a line without its CR is dropped.
    const bool listening = listen_->isListening();
    listen_->stopListening();
    if (c.mnuLog->isChecked() || c.mnuListen->isChecked()) {
        s_.stopRequested = true;
        try {
            w_.serial().setOption(SerialLine::kOptionPurge, 100);
        } catch (const std::exception&) {
            // The "Z" below finds out whether the port is still there.
        }
        w_.exchange().SerialWrite(QStringLiteral("Z"));
    }
    MainWindow::setLeftTwips(c.cmdStopCurrentData, 3390);
    w_.EnableCommandsAfterRun();
    w_.workspace().ApplyDataConversions();
    if (c.mnuRealTime->isChecked())
        Settings::SaveSettings(s_, w_.prompts());
    if (listening)
        listen_->afterStop();
    // "Z" could not be written: the port has gone.
    if (s_.abortRequested)
        w_.exchange().ShowCommError();
}
