#include "desktop/link/Exchange.h"

#include "core/Prompts.h"
#include "core/link/SerialLine.h"
#include "core/settings/Clock.h"
#include "desktop/link/CommErrorDialog.h"
#include "desktop/link/Connection.h"
#include "desktop/link/CpuOverUseDialog.h"
#include "desktop/shell/MainWindow.h"

#include <QAction>
#include <QLabel>
#include <QMenu>
#include <QPlainTextEdit>
#include <QProgressBar>
#include <QPushButton>
#include <QTimer>
#include <cmath>

namespace {
const QString kCR = QStringLiteral("\r");
const QString kBusyReply = QStringLiteral("BUSY\r");

bool containsWord(const QString& text, const char* word) {
    return text.contains(QLatin1String(word), Qt::CaseInsensitive);
}
} // namespace

Exchange::Exchange(MainWindow& window) : w_(window), s_(window.state()) {}

QString Exchange::wakeUpCommand() {
    return QStringLiteral("{@").repeated(24) + QStringLiteral("?S\r");
}

bool Exchange::isBusyReply(const QString& reply) {
    return reply.isEmpty() || containsWord(reply, "BUSY") || containsWord(reply, "OK\r");
}

void Exchange::SerialWrite(const QString& text) {
    try {
        s_.ioResult = w_.serial().write(text.toLatin1());
    } catch (const std::exception&) {
        s_.abortRequested = true;
    }
}

void Exchange::ReadReply() {
    Scope busy(*this);
    try {
        Clock& clock = w_.clock();
        SerialLine& line = w_.serial();
        s_.responseText.clear();
        double lastActivity = clock.nowSeconds();
        for (;;) {
            int c = line.readByte();
            if (s_.flushing && c < 0)
                c = 5; // a failing read keeps the drain going
            if (c > 0) {
                s_.responseText.append(QChar(static_cast<char16_t>(c)));
                lastActivity = clock.nowSeconds();
                if (c == 13)
                    break;
                // A meter that never ends its line must not hold the program: a reply this long
                // is cut here and the rest is read as the next line.
                if (s_.responseText.size() >= kMaxReplyLength)
                    break;
                continue;
            }
            const double remaining = lastActivity + s_.readTimeoutSec - clock.nowSeconds();
            if (remaining < 0)
                break;
            line.waitForByte(static_cast<int>(std::ceil(remaining * 1000.0)));
        }
        if (s_.responseText == kCR || s_.responseText == QStringLiteral("\n"))
            s_.responseText = kBusyReply;
    } catch (const std::exception&) {
        s_.abortRequested = true;
    }
}

Exchange::Drain Exchange::FlushInput() {
    Scope busy(*this);
    s_.responseText = QStringLiteral("\n");
    s_.readTimeoutSec = 0.15;
    s_.flushing = true;
    int count = 0;
    for (;;) {
        if (s_.responseText.isEmpty()) {
            s_.flushing = false;
            s_.readTimeoutSec = 1.5;
            return Drain::Quiet;
        }
        SerialWrite(QStringLiteral("\n"));
        if (s_.abortRequested)
            return Drain::Failed;
        ReadReply();
        if (s_.abortRequested)
            return Drain::Failed;
        if (++count > 40) {
            s_.abortRequested = true;
            return Drain::KeptSending;
        }
    }
}

double Exchange::replyWindowSeconds() const {
    const QString message = w_.controls().lblMessage->text();
    if (message.left(16) == QLatin1String("Device  detected") ||
        message.left(8) == QLatin1String("Shutting"))
        return 12.0;
    return 2.0;
}

void Exchange::SendCommand() {
    Scope busy(*this);
    Clock& clock = w_.clock();
    s_.readTimeoutSec = 2.0;
    ReadReply();
    if (s_.abortRequested)
        return;
    s_.commandStartTime = clock.nowSeconds();
    const double window = replyWindowSeconds();
    while (clock.nowSeconds() <= s_.commandStartTime + window && isBusyReply(s_.responseText)) {
        s_.commandResent = true;
        SerialWrite(s_.commandText);
        if (s_.abortRequested)
            return;
        ReadReply();
        if (s_.abortRequested)
            return;
    }
    if (clock.nowSeconds() > s_.commandStartTime + window) {
        ShowBusyMessage();
        if (s_.abortRequested)
            return;
    }
    if (s_.responseText.isEmpty()) {
        ShowNoResponseMessage();
        return;
    }
    const MainControls& c = w_.controls();
    if (!s_.commandText.contains(QLatin1String("?S")) && containsWord(s_.responseText, "ERROR")) {
        w_.setMessage(QString());
        c.ProgressBar1->hide();
        w_.prompts().show(
            QStringLiteral(" This function is not available with your firmware version."),
            Prompts::Icon::Critical, Prompts::Buttons::Ok);
    }
    if (containsWord(s_.responseText, "EXIT")) {
        w_.setMessage(QString());
        c.ProgressBar1->hide();
        w_.prompts().show(QStringLiteral("User has terminated this process."),
                          Prompts::Icon::Critical, Prompts::Buttons::Ok);
    }
    if (containsWord(s_.responseText, "OK\r"))
        s_.responseText = kBusyReply;
}

void Exchange::ShowBusyMessage() {
    const auto answer = w_.prompts().show(
        QStringLiteral(
            "Instrument  is  busy  with  other  processes.\r\n\r\nPlease  ensure  meter  is  "
            "operating  in  normal  display  mode  before  selecting  'Retry'."),
        Prompts::Icon::Exclamation, Prompts::Buttons::RetryCancel);
    FlushInput();
    if (answer == Prompts::Answer::Retry) {
        SerialWrite(s_.commandText);
        s_.commandResent = true;
        SendCommand();
    } else {
        s_.responseText = kBusyReply;
        ResetLink();
    }
}

void Exchange::ShowNoResponseMessage() {
    const auto answer =
        w_.prompts().show(QStringLiteral("No response from meter !"), Prompts::Icon::Exclamation,
                          Prompts::Buttons::RetryCancel);
    if (answer == Prompts::Answer::Retry) {
        FlushInput();
        SerialWrite(s_.commandText);
        s_.commandResent = true;
        SendCommand();
    } else {
        ResetLink();
    }
}

bool Exchange::ExchangeCommand(const QString& command) {
    Scope busy(*this);
    FlushInput();
    s_.commandText = command + kCR;
    SerialWrite(s_.commandText);
    SendCommand();
    return !s_.abortRequested;
}

void Exchange::ResetLink() {
    const MainControls& c = w_.controls();
    try {
        s_.ioResult = w_.serial().close();
    } catch (const std::exception&) {
        // Closing a port that has gone is as good as closing it.
    }
    c.tmrDetectMeter->stop();
    s_.modelCode.clear();
    s_.firmwareVersion.clear();
    s_.serialNumber.clear();
    s_.numLogged = 0;
    s_.runActive = false;

    c.cmdHelp->setEnabled(true);
    c.cmdOpenFile->setEnabled(true);
    c.cmdSaveFile->setEnabled(false);
    c.cmdCurrentData->setEnabled(false);
    c.cmdCurrentData->show();
    c.cmdStopCurrentData->hide();
    for (QPushButton* b : {c.cmdLoggedData, c.cmdGLPData, c.cmdEnableLogging, c.cmdStartStirring,
                           c.cmdStopStirring, c.cmdDisableLogging, c.cmdEraseLog, c.cmdListen})
        b->setEnabled(false);
    c.mnuDetectMeter->setEnabled(true);
    c.mnuDisplay->setEnabled(false);
    c.mnuEraseLog->setVisible(false);
    c.mnuFile->setEnabled(true);
    c.mnuSetup->setEnabled(true);
    c.mnuHelp->setEnabled(true);
    c.mnuSave->setEnabled(false);

    for (QLabel* l : {c.lblModelData, c.lblVersionData, c.lblSerialData, c.lblNumLogData})
        l->clear();
    c.lblHeader->hide();
    w_.setMessage(QString());
    c.ProgressBar1->hide();
    w_.setEnabled(true);
    w_.repaint();

    if (c.mnuRealTime->isChecked()) {
        // The real-time table stays whole in the workspace; only the view is brought up to date
        // and the newest line put in view.
        if (c.RichTextBox1->toPlainText() != s_.workspaceText)
            c.RichTextBox1->setPlainText(s_.workspaceText);
        c.RichTextBox1->moveCursor(QTextCursor::End);
    }
}

void Exchange::ShowCommError() {
    if (commErrorOpen_)
        return;
    commErrorOpen_ = true;
    const MainControls& c = w_.controls();
    w_.setMessage(QString());
    c.ProgressBar1->hide();
    CommErrorDialog::Choice choice = CommErrorDialog::Choice::Cancel;
    {
        CommErrorDialog dialog(&w_);
        dialog.exec();
        choice = dialog.choice();
    }
    commErrorOpen_ = false;
    s_.abortRequested = false;
    switch (choice) {
    case CommErrorDialog::Choice::Retry:
        ResetLink();
        w_.connection().ConnectMeter();
        break;
    case CommErrorDialog::Choice::Setup:
        ResetLink();
        w_.connection().ShowCommsPortDialog();
        break;
    case CommErrorDialog::Choice::Cancel:
        c.mnuDetectMeter->setEnabled(true);
        ResetLink();
        break;
    }
}

void Exchange::ShowCpuOverUse() {
    w_.setMessage(QString());
    CpuOverUseDialog dialog(&w_);
    dialog.exec();
}
