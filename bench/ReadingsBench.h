#pragma once

// Shared set-up of the readings benchmarks (header only; each benchmark is its own program):
// the real main window offscreen, settings in a temporary folder, a simulated meter in-process.

#include "core/Prompts.h"
#include "core/link/QtSerialLine.h"
#include "core/settings/SystemClock.h"
#include "desktop/shell/MainWindow.h"
#include "desktop/shell/PlatformDialogs.h"

#include <Meter.h>

#include <QCoreApplication>
#include <QDeadlineTimer>
#include <QDir>
#include <QElapsedTimer>
#include <QFileInfo>
#include <QSettings>
#include <QTemporaryDir>
#include <QTimer>
#include <cstdio>
#include <functional>
#include <memory>
#include <sys/resource.h>

namespace readingsbench {

// Prints every message instead of showing it, and answers with the last button.
class PrintingPrompts : public Prompts {
public:
    Answer show(const QString& text, Icon, Buttons buttons, bool) override {
        std::fprintf(stderr, "  [message] %s\n", qPrintable(text));
        ++count;
        return buttons == Buttons::YesNo         ? Answer::No
               : buttons == Buttons::RetryCancel ? Answer::Cancel
                                                 : Answer::Ok;
    }
    int count = 0;
};

class NoPlatformDialogs : public PlatformDialogs {
public:
    std::optional<SaveChoice> askSaveFile(QWidget*, const FileRequest&) override {
        return std::nullopt;
    }
    std::optional<QString> askOpenFile(QWidget*, const FileRequest&) override {
        return std::nullopt;
    }
    bool askPrinter(QWidget*, QPrinter&) override { return false; }
    bool openWithDefaultApplication(const QUrl&) override { return false; }
};

// Runs the event loop (sleeping while there is nothing to do) until condition holds, looking
// at it every 10 ms.
inline bool waitFor(const std::function<bool()>& condition, int timeoutMs) {
    QDeadlineTimer deadline(timeoutMs);
    QTimer tick;
    tick.start(10);
    while (!condition()) {
        if (deadline.hasExpired())
            return false;
        QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
    }
    return true;
}

// The event loop alone for that long.
inline void idleFor(int ms) {
    QEventLoop loop;
    QTimer::singleShot(ms, &loop, &QEventLoop::quit);
    loop.exec();
}

// Processor time (user + system) of this process in seconds.
inline double cpuSeconds() {
    rusage u{};
    getrusage(RUSAGE_SELF, &u);
    return double(u.ru_utime.tv_sec + u.ru_stime.tv_sec) +
           double(u.ru_utime.tv_usec + u.ru_stime.tv_usec) / 1e6;
}

// Processor time of the calling thread only (the program's own thread, not the meter's).
inline double threadCpuSeconds() {
    rusage u{};
    getrusage(RUSAGE_THREAD, &u);
    return double(u.ru_utime.tv_sec + u.ru_stime.tv_sec) +
           double(u.ru_utime.tv_usec + u.ru_stime.tv_usec) / 1e6;
}

inline double peakMegabytes() {
    rusage u{};
    getrusage(RUSAGE_SELF, &u);
    return double(u.ru_maxrss) / 1024.0;
}

class BenchWindow {
public:
    // Starts the meter with that profile and the window, and waits for detection.
    bool start(const QString& profile, qint32 baud = 9600) {
        QSettings::setPath(QSettings::NativeFormat, QSettings::UserScope, dir.filePath("config"));
        QSettings::setPath(QSettings::IniFormat, QSettings::UserScope, dir.filePath("config"));
        QDir(dir.path()).mkpath(QStringLiteral("home/Documents"));
        qputenv("HOME", dir.filePath("home").toLocal8Bit());
        meter = std::make_unique<metersim::Meter>(metersim::profile(profile));
        if (!meter->start())
            return false;
        QSettings settings(QStringLiteral("Telvio"), QStringLiteral("Telvio"));
        settings.setValue(QStringLiteral("Settings/COM"), meter->portPath());
        settings.setValue(QStringLiteral("Settings/Baud"), QString::number(baud));
        QSettings first(QStringLiteral("Telvio"),
                        QFileInfo(QCoreApplication::applicationFilePath()).completeBaseName());
        first.setValue(QStringLiteral("Settings/FirstRun"), QStringLiteral("False"));
        settings.sync();
        first.sync();
        window =
            std::make_unique<MainWindow>(MainWindowServices{&prompts, &clock, &serial, &dialogs});
        window->endProgram = [] {};
        window->start();
        return waitFor([this] { return !window->state().modelCode.isEmpty(); }, 10000);
    }

    ~BenchWindow() {
        window.reset();
        serial.close();
        meter.reset();
    }

    QTemporaryDir dir;
    PrintingPrompts prompts;
    SystemClock clock;
    QtSerialLine serial;
    NoPlatformDialogs dialogs;
    std::unique_ptr<metersim::Meter> meter;
    std::unique_ptr<MainWindow> window;
};

} // namespace readingsbench
