#pragma once

#include "core/link/CommandExchange.h"

class MainWindow;

// The window's side of the command exchange: the reply window read from the status line, the
// progress display, the unconnected state after a link reset, and the link dialogs.
class Exchange : public CommandExchange, private LinkHost {
public:
    explicit Exchange(MainWindow& window);

    // The communication-error dialog frmCommError, modal over the main window. Does nothing
    // when one is already open (a timer tick inside its event loop must not stack another).
    void ShowCommError();
    // The processor-overuse dialog frmCPUOverUse, modal over the main window.
    void ShowCpuOverUse();

    // True while an exchange or a link dialog runs; timer ticks that find it set do nothing.
    bool inProgress() const { return CommandExchange::inProgress() || commErrorOpen_; }

private:
    double replyWindowSeconds() const override;
    void endProgress() override;
    void linkReset() override;

    MainWindow& w_;
    bool commErrorOpen_ = false;
};
