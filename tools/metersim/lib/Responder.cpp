#include "Responder.h"

#include "RecordFormat.h"

namespace metersim {

namespace {
// Longest command line kept; the wake-up command is 51 bytes.
constexpr qsizetype kMaxLine = 4096;
constexpr int kReadingCycle = 20;
} // namespace

Responder::Responder(const Profile& p) : profile_(p) {
    if (p.hasLog)
        log_ = RecordFormat::records(p, p.defaultLogSize);
    readings_ = RecordFormat::records(p, kReadingCycle);
}

void Responder::setReply(const QByteArray& command, const QByteArray& reply) {
    replies_.insert(command, reply);
}

void Responder::queueReplies(const QByteArray& command, const QList<QByteArray>& replies) {
    queued_[command] += replies;
}

void Responder::setReadingReplies(const QList<QByteArray>& replies) {
    readings_ = replies.isEmpty() ? RecordFormat::records(profile_, kReadingCycle) : replies;
    nextReading_ = 0;
}

void Responder::setRecordLines(const QByteArray& command, const QList<QByteArray>& lines) {
    blocks_.insert(command, lines);
}

QByteArray Responder::nextPrintedLine() {
    if (readings_.isEmpty())
        return QByteArray("\r");
    return readings_.at(nextPrinted_++ % readings_.size());
}

void Responder::onByte(char c, double now, OutputQueue& out) {
    if (c == '\n') {
        // A line feed acknowledges a block line; otherwise it is the program draining the line.
        if (transfer_ == Transfer::Block && line_.isEmpty() && !silent_)
            sendNextItem(now, out);
        return;
    }
    if (line_.isEmpty()) {
        if (c == 'A') {
            if (transfer_ == Transfer::Log && !silent_)
                sendNextItem(now, out);
            return;
        }
        if (c == 'Z') {
            transfer_ = Transfer::None;
            out.clear();
            return;
        }
    }
    if (c == '\r') {
        const QByteArray line = line_;
        line_.clear();
        handleLine(line, now, out);
        return;
    }
    if (line_.size() < kMaxLine)
        line_ += c;
}

void Responder::handleLine(const QByteArray& line, double now, OutputQueue& out) {
    if (line.isEmpty())
        return;
    const bool wakeUp = line.contains("{@");
    const qsizetype n = line.size();
    const QByteArray command = n >= 2 && line.at(n - 2) == '?' ? line.right(2) : line;
    if (asleep_) {
        if (!wakeUp || command != "?S")
            return;
        asleep_ = false;
    }
    if (silent_)
        return;
    transfer_ = Transfer::None;
    if (busyCount_ > 0) {
        --busyCount_;
        reply("BUSY\r", now, out);
        return;
    }
    auto queued = queued_.find(command);
    if (queued != queued_.end() && !queued->isEmpty()) {
        reply(queued->takeFirst(), now, out);
        return;
    }
    auto fixed = replies_.constFind(command);
    if (fixed != replies_.constEnd()) {
        reply(*fixed, now, out);
        return;
    }
    answer(command, now, out);
}

void Responder::answer(const QByteArray& command, double now, OutputQueue& out) {
    const bool percent = profile_.format == StatusFormat::Percent;
    const bool qr32 = profile_.format == StatusFormat::Qr32;
    if (command == "?S") {
        reply(profile_.statusReply(int(log_.size())), now, out);
    } else if (command == "?W" && qr32) {
        reply(profile_.secondStatusReply(), now, out);
    } else if (command == "?L" && profile_.hasLog && !qr32) {
        QList<QByteArray> items = log_;
        items.append("ENDS\r");
        startTransfer(Transfer::Log, items, now, out);
    } else if (command == "?R" && qr32) {
        sendAllRecords(now, out);
    } else if (command == "?D") {
        if (!readings_.isEmpty())
            reply(readings_.at(nextReading_++ % readings_.size()), now, out);
    } else if (command == "?H" && percent) {
        reply(profile_.headerReply(), now, out);
    } else if (command == "?P" && percent) {
        reply(profile_.positionsReply(), now, out);
    } else if ((command == "?G" || command == "?M") && !blockLines(command).isEmpty()) {
        QList<QByteArray> items = blockLines(command);
        if (!items.constLast().startsWith("END"))
            items.append("END\r");
        startTransfer(Transfer::Block, items, now, out);
    } else if (command == "?G" || command == "?J") {
        reply("LOG START\r", now, out);
    } else if (command == "?F") {
        reply("LOG STOP\r", now, out);
    } else if (command == "?M") {
        reply(profile_.blowOnStir ? "BLOW\r" : "SON\r", now, out);
    } else if (command == "?N") {
        reply("SOFF\r", now, out);
    } else if (command == "?K") {
        reply("SSD\r", now, out);
        asleep_ = true;
    } else if (command == "?E") {
        log_.clear();
        reply("ERASED\r", now, out);
    } else if (command == "?V") {
        reply(profile_.voltageReply, now, out);
    } else {
        reply("ERROR\r", now, out);
    }
}

QList<QByteArray> Responder::blockLines(const QByteArray& command) const {
    auto it = blocks_.constFind(command);
    if (it != blocks_.constEnd())
        return *it;
    return command == "?G" ? profile_.glpLines : profile_.maxMinLines;
}

void Responder::reply(const QByteArray& bytes, double now, OutputQueue& out) {
    out.push(bytes, now + delayMs_ / 1000.0);
}

void Responder::startTransfer(Transfer kind, QList<QByteArray> items, double now,
                              OutputQueue& out) {
    transfer_ = kind;
    items_ = std::move(items);
    sent_ = 0;
    sendNextItem(now, out);
}

void Responder::sendNextItem(double now, OutputQueue& out) {
    if (sent_ >= items_.size()) {
        // The acknowledgement of the end marker closes the transfer.
        transfer_ = Transfer::None;
        return;
    }
    if (vanishAfter_ >= 0 && sent_ >= vanishAfter_) {
        vanishAfter_ = -1;
        transfer_ = Transfer::None;
        out.pushVanish(now);
        return;
    }
    reply(items_.at(sent_++), now, out);
}

void Responder::sendAllRecords(double now, OutputQueue& out) {
    // No acknowledgements: the program reads exactly as many records as the status announced.
    const double at = now + delayMs_ / 1000.0;
    for (int i = 0; i < log_.size(); ++i) {
        if (vanishAfter_ >= 0 && i >= vanishAfter_)
            break;
        out.push(log_.at(i), at);
    }
    if (vanishAfter_ >= 0 && vanishAfter_ <= log_.size())
        out.pushVanish(at);
    vanishAfter_ = -1;
}

} // namespace metersim
