#pragma once

class MainWindow;
struct MainControls;

// Keeps the main window's workspace and status area fitted to the window on every resize.
// Lengths are twips measured on the window's outer size.
class WindowLayout {
public:
    static constexpr int kMinWidth = 10000;
    static constexpr int kMinHeight = 5000;

    explicit WindowLayout(MainWindow& window) : w_(window) {}
    void apply();

    // The column header of percent-format meters is one line of its font tall, its text at the
    // top. The workspace stands 210 twips below the header's top where the font fits in that;
    // a taller font (large fonts, high-dpi font settings) needs more room, and the workspace then
    // starts lower by the difference. fitHeader sizes the label and returns that difference in
    // pixels; placeBelowHeader also moves the workspace's top down by it, keeping its bottom.
    static int fitHeader(const MainControls& c);
    static void placeBelowHeader(const MainControls& c);

private:
    MainWindow& w_;
};
