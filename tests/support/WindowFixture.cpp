#include "WindowFixture.h"

#include <QTest>
#include <QTimer>

WindowFixture::WindowFixture(PlatformDialogs* d) : dialogs(d ? d : &noDialogs) {
    settings.markFirstRunDone();
}

WindowFixture::~WindowFixture() {
    if (window)
        window->endProgram = [] {};
    window.reset();
    serial.close();
    meter.reset();
}

bool WindowFixture::startMeter(const QString& profile, qint32 baud) {
    meter = std::make_unique<metersim::Meter>(metersim::profile(profile));
    if (!meter->start())
        return false;
    settings.set(QStringLiteral("COM"), meter->portPath());
    settings.set(QStringLiteral("Baud"), QString::number(baud));
    return true;
}

MainWindow& WindowFixture::createWindow() {
    window = std::make_unique<MainWindow>(MainWindowServices{&prompts, &clock, &serial, dialogs});
    window->endProgram = [this] { exited = true; };
    return *window;
}

void WindowFixture::start() {
    if (!window)
        createWindow();
    window->start();
}

bool WindowFixture::waitUntil(const std::function<bool()>& condition, int timeoutMs) {
    return QTest::qWaitFor(condition, timeoutMs);
}
