// CPU share of the program while it waits: the detect polling against a meter that never
// answers, and a listen run with no data. The main window runs offscreen against the simulated
// meter; only the user-interface thread is measured (the meter's own thread is not the program).
#include "core/Prompts.h"
#include "core/link/QtSerialLine.h"
#include "core/settings/SystemClock.h"
#include "desktop/shell/MainWindow.h"
#include "desktop/shell/PlatformDialogs.h"

#include "ReadingsBench.h"

#include <Meter.h>
#include <QAction>
#include <QApplication>
#include <QDir>
#include <QElapsedTimer>
#include <QPushButton>
#include <QSettings>
#include <QTemporaryDir>
#include <QTimer>
#include <cstdio>
#include <ctime>

namespace {

double threadCpuSeconds() {
    timespec ts{};
    clock_gettime(CLOCK_THREAD_CPUTIME_ID, &ts);
    return double(ts.tv_sec) + double(ts.tv_nsec) / 1e9;
}

// Lets the window run for `seconds` and returns the share of one core it used, in percent.
double cpuShare(double seconds) {
    const double cpu0 = threadCpuSeconds();
    QElapsedTimer wall;
    wall.start();
    QEventLoop loop;
    QTimer::singleShot(int(seconds * 1000), &loop, &QEventLoop::quit);
    loop.exec();
    return 100.0 * (threadCpuSeconds() - cpu0) / (double(wall.nsecsElapsed()) / 1e9);
}

void waitFor(const std::function<bool()>& condition, int timeoutMs) {
    QElapsedTimer t;
    t.start();
    while (!condition() && t.elapsed() < timeoutMs)
        QCoreApplication::processEvents(QEventLoop::AllEvents, 50);
}

} // namespace

int main(int argc, char** argv) {
    qputenv("QT_QPA_PLATFORM", "offscreen");
    QApplication app(argc, argv);
    const double seconds = argc > 1 ? QString::fromLocal8Bit(argv[1]).toDouble() : 10.0;

    QTemporaryDir dir;
    QSettings::setPath(QSettings::NativeFormat, QSettings::UserScope, dir.filePath("config"));
    qputenv("HOME", dir.path().toLocal8Bit());
    metersim::Meter meter(metersim::profile(QStringLiteral("percent-log")));
    if (!meter.start()) {
        std::fprintf(stderr, "meter: %s\n", qPrintable(meter.errorString()));
        return 1;
    }
    {
        QSettings s(QStringLiteral("Telvio"), QStringLiteral("Telvio"));
        s.setValue("Settings/COM", meter.portPath());
        s.setValue("Settings/Baud", "9600");
        QSettings first(QStringLiteral("Telvio"), QCoreApplication::applicationName());
        first.setValue("Settings/FirstRun", "False");
    }

    readingsbench::PrintingPrompts prompts;
    SystemClock clock;
    QtSerialLine serial;
    readingsbench::NoPlatformDialogs dialogs;
    MainWindow window({&prompts, &clock, &serial, &dialogs});
    window.endProgram = [] {};

    // A meter that never answers: the window polls with the wake-up command every 600 ms.
    meter.setSilent(true);
    window.start();
    const double detect = cpuShare(seconds);
    std::printf("detect polling, silent meter, %.0f s: %.3f %% of one core\n", seconds, detect);
    std::printf("RESULT detect_polling_cpu %.3f %% 1\n", detect);

    meter.setSilent(false);
    waitFor([&] { return !window.controls().tmrDetectMeter->isActive(); }, 5000);
    QPushButton* listen = window.controls().cmdListen;
    if (!listen || !listen->isEnabled() || !listen->isVisible()) {
        std::printf("listen mode not available (meter detected: %s)\n",
                    window.controls().tmrDetectMeter->isActive() ? "no" : "yes");
        return 0;
    }
    listen->click();
    waitFor([&] { return window.controls().mnuListen->isChecked(); }, 2000);
    if (!window.controls().mnuListen->isChecked()) {
        std::printf("listen mode did not start\n");
        return 0;
    }
    const double idle = cpuShare(seconds);
    std::printf("listen mode, no data, %.0f s: %.3f %% of one core\n", seconds, idle);
    std::printf("RESULT listen_idle_cpu %.3f %% 1\n", idle);
    window.controls().cmdStopCurrentData->click();
    return 0;
}
