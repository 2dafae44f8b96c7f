#include "core/link/CommandExchange.h"

#include "core/Prompts.h"
#include "core/link/SerialLine.h"
#include "core/settings/AppState.h"
#include "core/settings/Clock.h"

#include <cmath>

namespace {
const QString kCR = QStringLiteral("\r");
const QString kBusyReply = QStringLiteral("BUSY\r");

bool containsWord(const QString& text, const char* word) {
    return text.contains(QLatin1String(word), Qt::CaseInsensitive);
}
} // namespace

CommandExchange::CommandExchange(AppState& state, SerialLine& line, Clock& clock, Prompts& prompts,
                                 LinkHost& host)
    : s_(state), line_(line), clock_(clock), prompts_(prompts), host_(host) {}

QString CommandExchange::wakeUpCommand() {
    return QStringLiteral("{@").repeated(24) + QStringLiteral("?S\r");
}

bool CommandExchange::isBusyReply(const QString& reply) {
    return reply.isEmpty() || containsWord(reply, "BUSY") || containsWord(reply, "OK\r");
}

void CommandExchange::SerialWrite(const QString& text) {
    try {
        s_.ioResult = line_.write(text.toLatin1());
    } catch (const std::exception&) {
        s_.abortRequested = true;
    }
}

void CommandExchange::ReadReply() {
    Scope busy(*this);
    try {
        s_.responseText.clear();
        double lastActivity = clock_.nowSeconds();
        for (;;) {
            int c = line_.readByte();
            if (s_.flushing && c < 0)
                c = 5; // a failing read keeps the drain going
            if (c > 0) {
                s_.responseText.append(QChar(static_cast<char16_t>(c)));
                lastActivity = clock_.nowSeconds();
                if (c == 13)
                    break;
                // A meter that never ends its line must not hold the program: a reply this long
                // is cut here and the rest is read as the next line.
                if (s_.responseText.size() >= kMaxReplyLength)
                    break;
                continue;
            }
            const double remaining = lastActivity + s_.readTimeoutSec - clock_.nowSeconds();
            if (remaining < 0)
                break;
            line_.waitForByte(static_cast<int>(std::ceil(remaining * 1000.0)));
        }
        if (s_.responseText == kCR || s_.responseText == QStringLiteral("\n"))
            s_.responseText = kBusyReply;
    } catch (const std::exception&) {
        s_.abortRequested = true;
    }
}

CommandExchange::Drain CommandExchange::FlushInput() {
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

void CommandExchange::SendCommand() {
    Scope busy(*this);
    s_.readTimeoutSec = 2.0;
    ReadReply();
    if (s_.abortRequested)
        return;
    s_.commandStartTime = clock_.nowSeconds();
    const double window = host_.replyWindowSeconds();
    while (clock_.nowSeconds() <= s_.commandStartTime + window && isBusyReply(s_.responseText)) {
        s_.commandResent = true;
        SerialWrite(s_.commandText);
        if (s_.abortRequested)
            return;
        ReadReply();
        if (s_.abortRequested)
            return;
    }
    if (clock_.nowSeconds() > s_.commandStartTime + window) {
        ShowBusyMessage();
        if (s_.abortRequested)
            return;
    }
    if (s_.responseText.isEmpty()) {
        ShowNoResponseMessage();
        return;
    }
    if (!s_.commandText.contains(QLatin1String("?S")) && containsWord(s_.responseText, "ERROR")) {
        host_.endProgress();
        prompts_.show(QStringLiteral(" This function is not available with your firmware version."),
                      Prompts::Icon::Critical, Prompts::Buttons::Ok);
    }
    if (containsWord(s_.responseText, "EXIT")) {
        host_.endProgress();
        prompts_.show(QStringLiteral("User has terminated this process."), Prompts::Icon::Critical,
                      Prompts::Buttons::Ok);
    }
    if (containsWord(s_.responseText, "OK\r"))
        s_.responseText = kBusyReply;
}

void CommandExchange::ShowBusyMessage() {
    const auto answer = prompts_.show(
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

void CommandExchange::ShowNoResponseMessage() {
    const auto answer = prompts_.show(QStringLiteral("No response from meter !"),
                                      Prompts::Icon::Exclamation, Prompts::Buttons::RetryCancel);
    if (answer == Prompts::Answer::Retry) {
        FlushInput();
        SerialWrite(s_.commandText);
        s_.commandResent = true;
        SendCommand();
    } else {
        ResetLink();
    }
}

bool CommandExchange::ExchangeCommand(const QString& command) {
    Scope busy(*this);
    FlushInput();
    s_.commandText = command + kCR;
    SerialWrite(s_.commandText);
    SendCommand();
    return !s_.abortRequested;
}

void CommandExchange::ResetLink() {
    try {
        s_.ioResult = line_.close();
    } catch (const std::exception&) {
        // Closing a port that has gone is as good as closing it.
    }
    s_.modelCode.clear();
    s_.firmwareVersion.clear();
    s_.serialNumber.clear();
    s_.numLogged = 0;
    s_.runActive = false;
    host_.linkReset();
}
