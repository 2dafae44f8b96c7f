#pragma once

#include <QString>
#include <optional>

class MainWindow;
struct AppState;

// Logged Data: downloads the meter's log record by record into the log table.
class LogDownload {
public:
    explicit LogDownload(MainWindow& window);

    // cmdLoggedData and mnuLog.
    void DownloadLog();

private:
    enum class End {
        Complete,    // every record taken: the table is shown
        Stopped,     // Stop was pressed: it has restored the window already
        ReplyFailed, // empty, busy or exit reply: the window waits for Stop
        LinkFailed,  // the link failed or a record could not be laid out
    };

    void enterDownloadState();
    // Drains the line and writes the request; false when the link failed.
    bool sendRequest(const QString& command);
    // Reads one record into dataLine; the way the download ends when it could not.
    std::optional<End> readRecord(long long progressCount);
    End generalProtocol();
    End qr32Protocol();
    // ProgressBar1 in twentieths of numLogged; repainted only when it moves.
    void showProgress(long long count);
    void finish();
    void failLink();

    MainWindow& w_;
    AppState& s_;
    int lastProgress_ = 0;
};
