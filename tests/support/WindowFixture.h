#pragma once

#include "NoDialogs.h"
#include "PromptRecorder.h"
#include "TestClock.h"
#include "TestSettings.h"
#include "core/link/QtSerialLine.h"
#include "desktop/shell/MainControls.h"
#include "desktop/shell/MainWindow.h"

#include <Meter.h>
#include <QTimer>
#include <functional>
#include <memory>

// The real main window, offscreen, with a simulated meter on a pseudo-terminal, settings in a
// temporary folder and a prompt recorder. One per test function keeps tests independent.
class WindowFixture {
public:
    explicit WindowFixture(PlatformDialogs* dialogs = nullptr);
    ~WindowFixture();

    // Starts a simulated meter with that profile and points the settings at its port.
    bool startMeter(const QString& profile, qint32 baud = 9600);
    // Builds the window without starting it.
    MainWindow& createWindow();
    // Runs the window's start-up sequence.
    void start();
    bool waitUntil(const std::function<bool()>& condition, int timeoutMs = 5000);

    AppState& state() { return window->state(); }
    const MainControls& c() { return window->controls(); }

    TestSettings settings;
    PromptRecorder prompts;
    TestClock clock;
    QtSerialLine serial;
    NoDialogs noDialogs;
    PlatformDialogs* dialogs;
    std::unique_ptr<metersim::Meter> meter;
    std::unique_ptr<MainWindow> window;
    bool exited = false;
};
