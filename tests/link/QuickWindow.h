#pragma once

#include "DialogDriver.h"
#include "WindowFixture.h"
#include "desktop/instrument/InstrumentCommands.h"

#include <QAction>
#include <QLabel>
#include <QMenu>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QTest>

// The window fixture on a serial line that lets the test clock jump over the rest of a time-out
// once the line has been quiet for a moment, so drains and silent meters cost milliseconds.
struct QuickWindow : WindowFixture {
    struct Line : QtSerialLine {
        TestClock& clock;
        // How long the meter seems to take over each command, and over each byte it sends.
        double secondsPerWrite = 0, secondsPerRead = 0;
        // Real wait for a drain's or a detection poll's time-out (0.15 s or less).
        int patienceMs = 20;
        explicit Line(TestClock& c) : clock(c) {}
        qint32 write(const QByteArray& bytes) override {
            clock.advance(secondsPerWrite);
            return QtSerialLine::write(bytes);
        }
        int readByte() override {
            clock.advance(secondsPerRead);
            return QtSerialLine::readByte();
        }
        bool waitForByte(int ms) override {
            const int real = std::min(ms, ms > 150 ? 300 : patienceMs);
            const bool byte = QtSerialLine::waitForByte(real);
            clock.advance(byte ? 0 : (ms - real) / 1000.0);
            return byte;
        }
    } line{clock};

    // The window goes while the line it uses is still there.
    ~QuickWindow() { window.reset(); }
    // The window on this line, started; detection polls then follow each other at once.
    void begin() {
        window = std::make_unique<MainWindow>(MainWindowServices{&prompts, &clock, &line, dialogs});
        window->endProgram = [] {};
        window->start();
        c().tmrDetectMeter->setInterval(1);
    }
    void query() { window->instrument().QueryStatus(); }
    bool open(const QString& profile) {
        return startMeter(profile) &&
               (begin(), waitUntil([this] { return !state().modelCode.isEmpty(); }));
    }
};
