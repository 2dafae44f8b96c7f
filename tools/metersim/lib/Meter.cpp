#include "Meter.h"

#include "OutputQueue.h"
#include "Pty.h"
#include "RecordFormat.h"
#include "Responder.h"

#include <cerrno>
#include <cmath>
#include <fcntl.h>
#include <poll.h>
#include <unistd.h>

namespace metersim {

namespace {
// While a vanish waits for the program to read what went before it.
constexpr double kDrainPoll = 0.005;
constexpr double kDrainQuiet = 0.02;
constexpr double kDrainLimit = 2.0;
} // namespace

Meter::Meter(const Profile& p)
    : profile_(p), pty_(std::make_unique<Pty>()), responder_(std::make_unique<Responder>(p)),
      out_(std::make_unique<OutputQueue>()), startTime_(std::chrono::steady_clock::now()) {}

Meter::~Meter() {
    stop_ = true;
    wake();
    if (worker_.joinable())
        worker_.join();
    pty_->close();
    if (wakeRead_ >= 0)
        ::close(wakeRead_);
    if (wakeWrite_ >= 0)
        ::close(wakeWrite_);
}

bool Meter::start() {
    std::lock_guard lock(mutex_);
    if (worker_.joinable()) {
        error_ = "meter already started";
        return false;
    }
    if (!pty_->open(&error_))
        return false;
    int fds[2];
    if (::pipe2(fds, O_CLOEXEC | O_NONBLOCK) != 0) {
        error_ = "pipe failed";
        pty_->close();
        return false;
    }
    wakeRead_ = fds[0];
    wakeWrite_ = fds[1];
    startTime_ = std::chrono::steady_clock::now();
    worker_ = std::thread(&Meter::run, this);
    return true;
}

QString Meter::portPath() const {
    std::lock_guard lock(mutex_);
    return pty_->slavePath();
}

QString Meter::errorString() const {
    std::lock_guard lock(mutex_);
    return error_;
}

double Meter::now() const {
    return std::chrono::duration<double>(std::chrono::steady_clock::now() - startTime_).count();
}

void Meter::wake() {
    if (wakeWrite_ >= 0) {
        const char c = 'w';
        // A full pipe already guarantees a wake-up.
        [[maybe_unused]] const ssize_t n = ::write(wakeWrite_, &c, 1);
    }
}

void Meter::setReply(const QByteArray& command, const QByteArray& reply) {
    std::lock_guard lock(mutex_);
    responder_->setReply(command, reply);
}

void Meter::queueReplies(const QByteArray& command, const QList<QByteArray>& replies) {
    std::lock_guard lock(mutex_);
    responder_->queueReplies(command, replies);
}

void Meter::setBusyCount(int n) {
    std::lock_guard lock(mutex_);
    responder_->setBusyCount(n);
}

void Meter::setSilent(bool silent) {
    std::lock_guard lock(mutex_);
    responder_->setSilent(silent);
}

void Meter::setReplyDelayMs(int ms) {
    std::lock_guard lock(mutex_);
    responder_->setReplyDelayMs(ms);
}

void Meter::setBaud(int baud) {
    std::lock_guard lock(mutex_);
    out_->setBaud(qMax(0, baud));
}

void Meter::setLogRecords(const QList<QByteArray>& records) {
    std::lock_guard lock(mutex_);
    responder_->setLogRecords(records);
}

QList<QByteArray> Meter::logRecords() const {
    std::lock_guard lock(mutex_);
    return responder_->logRecords();
}

QList<QByteArray> Meter::generateLog(const Profile& p, int n) {
    return RecordFormat::records(p, n);
}

void Meter::setReadingReplies(const QList<QByteArray>& replies) {
    std::lock_guard lock(mutex_);
    responder_->setReadingReplies(replies);
}

void Meter::setRecordLines(const QByteArray& command, const QList<QByteArray>& lines) {
    std::lock_guard lock(mutex_);
    responder_->setRecordLines(command, lines);
}

void Meter::sendUnsolicited(const QByteArray& bytes) {
    {
        std::lock_guard lock(mutex_);
        out_->push(bytes, now());
    }
    wake();
}

void Meter::startEndlessSending() {
    {
        std::lock_guard lock(mutex_);
        endless_ = true;
    }
    wake();
}

void Meter::stopEndlessSending() {
    std::lock_guard lock(mutex_);
    endless_ = false;
}

void Meter::vanish() {
    {
        std::lock_guard lock(mutex_);
        vanishNow_ = true;
    }
    wake();
    // Return only once the port is gone, so a caller can rely on it.
    std::unique_lock lock(mutex_);
    receivedChanged_.wait_for(lock, std::chrono::seconds(5),
                              [this] { return vanished_ || !worker_.joinable(); });
}

void Meter::vanishAfterSending(int records) {
    std::lock_guard lock(mutex_);
    responder_->setVanishAfter(qMax(0, records));
}

bool Meter::hasVanished() const {
    std::lock_guard lock(mutex_);
    return vanished_;
}

QByteArray Meter::received() const {
    std::lock_guard lock(mutex_);
    return received_;
}

QList<ReceivedByte> Meter::receivedWithTimes() const {
    std::lock_guard lock(mutex_);
    QList<ReceivedByte> out;
    out.reserve(received_.size());
    for (qsizetype i = 0; i < received_.size(); ++i)
        out.append({receivedTimes_.at(i), received_.at(i)});
    return out;
}

void Meter::clearReceived() {
    std::lock_guard lock(mutex_);
    received_.clear();
    receivedTimes_.clear();
}

int Meter::countLocked(const QByteArray& pattern) const {
    if (pattern.isEmpty())
        return 0;
    int n = 0;
    qsizetype from = 0;
    while ((from = received_.indexOf(pattern, from)) >= 0) {
        ++n;
        from += pattern.size();
    }
    return n;
}

int Meter::count(const QByteArray& pattern) const {
    std::lock_guard lock(mutex_);
    return countLocked(pattern);
}

bool Meter::waitForReceived(const QByteArray& pattern, int times, int timeoutMs) const {
    std::unique_lock lock(mutex_);
    return receivedChanged_.wait_for(lock, std::chrono::milliseconds(timeoutMs),
                                     [&] { return countLocked(pattern) >= times; });
}

QList<double> Meter::commandTimes(const QByteArray& command) const {
    std::lock_guard lock(mutex_);
    QList<double> out;
    if (command.isEmpty())
        return out;
    qsizetype from = 0;
    while ((from = received_.indexOf(command, from)) >= 0) {
        out.append(receivedTimes_.at(from + command.size() - 1));
        from += command.size();
    }
    return out;
}

void Meter::readInput() {
    char buf[4096];
    for (;;) {
        const ssize_t n = ::read(pty_->master(), buf, sizeof buf);
        if (n < 0 && errno == EINTR)
            continue;
        if (n <= 0)
            return;
        std::lock_guard lock(mutex_);
        const double t = now();
        for (ssize_t i = 0; i < n; ++i) {
            received_.append(buf[i]);
            receivedTimes_.append(t);
            responder_->onByte(buf[i], t, *out_);
        }
        receivedChanged_.notify_all();
        if (n < ssize_t(sizeof buf))
            return;
    }
}

void Meter::run() {
    while (!stop_) {
        pollfd fds[2] = {{wakeRead_, POLLIN, 0}, {-1, 0, 0}};
        double wait = -1;
        {
            std::unique_lock lock(mutex_);
            checkVanishMarker();
            if (vanishNow_ && !vanished_) {
                out_->clear();
                pty_->closeMaster();
                vanished_ = true;
                receivedChanged_.notify_all();
            }
            if (!vanished_) {
                if (endless_ && out_->isEmpty())
                    out_->push(responder_->nextPrintedLine(), now());
                fds[1] = {pty_->master(), POLLIN, 0};
                if (drainSince_ >= 0) {
                    wait = kDrainPoll;
                } else {
                    wait = out_->waitTime(now());
                    if (wait == 0)
                        fds[1].events |= POLLOUT;
                }
            }
        }
        timespec ts{};
        timespec* timeout = nullptr;
        if (wait > 0) {
            ts.tv_sec = time_t(wait);
            ts.tv_nsec = long((wait - std::floor(wait)) * 1e9);
            timeout = &ts;
        }
        const int r = ::ppoll(fds, fds[1].fd >= 0 ? 2 : 1, timeout, nullptr);
        if (r < 0 && errno != EINTR)
            break;
        if (fds[0].revents & POLLIN) {
            char drain[64];
            while (::read(wakeRead_, drain, sizeof drain) > 0) {
            }
        }
        if (fds[1].fd < 0)
            continue;
        if (fds[1].revents & POLLIN)
            readInput();
        std::lock_guard lock(mutex_);
        if (!vanished_ && drainSince_ < 0)
            out_->writeTo(pty_->master(), now());
    }
}

void Meter::checkVanishMarker() {
    // Closing the master discards what the program has not read yet, so a vanish in the middle
    // of a transfer waits (briefly) until the records before it have been taken. The kernel
    // hands written bytes to the slave asynchronously: only a queue found empty for a while
    // means the program has them.
    if (vanished_ || !out_->vanishDue(now())) {
        drainSince_ = -1;
        emptySince_ = -1;
        return;
    }
    const double t = now();
    if (drainSince_ < 0)
        drainSince_ = t;
    if (pty_->unreadBySlave() > 0)
        emptySince_ = -1;
    else if (emptySince_ < 0)
        emptySince_ = t;
    if ((emptySince_ >= 0 && t - emptySince_ >= kDrainQuiet) || t - drainSince_ > kDrainLimit) {
        vanishNow_ = true;
        drainSince_ = -1;
        emptySince_ = -1;
    }
}

} // namespace metersim
