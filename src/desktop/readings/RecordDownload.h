#pragma once

class MainWindow;
struct AppState;

// GLP and max/min records: a block of lines, each acknowledged with LF, ended by "END".
class RecordDownload {
public:
    explicit RecordDownload(MainWindow& window);

    void DisplayGLP();    // "?G"
    void DisplayMaxMin(); // "?M"

private:
    enum class Kind { Glp, MaxMin };
    void download(Kind kind);
    // The link failed: max/min clears the status line first.
    void showLinkError(Kind kind);
    // The finish of a download: the block in the view, its check mark, Save enabled.
    void showBlock(Kind kind);

    MainWindow& w_;
    AppState& s_;
};
