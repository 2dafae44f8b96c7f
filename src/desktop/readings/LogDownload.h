#pragma once

#include "core/readings/LogTransfer.h"

class MainWindow;
struct AppState;

// Logged Data: downloads the meter's log record by record into the log table.
class LogDownload : private LogTransfer::Listener {
public:
    explicit LogDownload(MainWindow& window);

    // cmdLoggedData and mnuLog.
    void DownloadLog();

private:
    void enterDownloadState();
    // ProgressBar1 in twentieths of numLogged; repainted only when it moves.
    void progress(long long count) override;
    // The window stays responsive (and Stop usable) between records.
    bool stopRequested() override;
    void finish();
    void failLink();

    MainWindow& w_;
    AppState& s_;
    int lastProgress_ = 0;
};
