#pragma once

#include <QObject>
#include <functional>
#include <memory>

class MainWindow;
class QAction;
struct AppState;
class LogDownload;
class RealTimeRun;
class RecordDownload;
class ListenMode;

// Log download, real-time readings, GLP and max/min records, listen mode and the Stop button.
// Owns one handler class per operation and connects the buttons, menu items and timers.
class ReadingCommands : public QObject {
    Q_OBJECT
public:
    explicit ReadingCommands(MainWindow& window);
    ~ReadingCommands() override;

    // "?H" and "?P" of percent-format meters: headerText, positionText, Log# column.
    void GetHeaderAndPosition();
    // The Stop button, shared by the three continuous operations.
    void cmdStopCurrentData_Click();

    // Whether the last header scan found the Log# column of percent-format readings. When it
    // did not, real-time lines keep the meter's own log number.
    bool logColumnKnown() const { return logColumnKnown_; }

    LogDownload& logDownload() { return *log_; }
    RealTimeRun& realTime() { return *realTime_; }
    RecordDownload& records() { return *records_; }
    ListenMode& listen() { return *listen_; }

private:
    void connectControls();
    // A Display menu item runs its operation; its check mark is set by the operation, so the
    // toggle Qt makes on a click is undone first.
    void connectMenu(QAction* action, std::function<void()> run);

    MainWindow& w_;
    AppState& s_;
    std::unique_ptr<LogDownload> log_;
    std::unique_ptr<RealTimeRun> realTime_;
    std::unique_ptr<RecordDownload> records_;
    std::unique_ptr<ListenMode> listen_;
    bool logColumnKnown_ = false;
};
