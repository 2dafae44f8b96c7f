#pragma once

class MainWindow;

// Keeps the main window's workspace and status area fitted to the window on every resize.
// Lengths are twips measured on the window's outer size.
class WindowLayout {
public:
    static constexpr int kMinWidth = 10000;
    static constexpr int kMinHeight = 5000;

    explicit WindowLayout(MainWindow& window) : w_(window) {}
    void apply();

private:
    MainWindow& w_;
};
