#include "OutputQueue.h"

#include <algorithm>
#include <cerrno>
#include <unistd.h>

namespace metersim {

void OutputQueue::push(const QByteArray& bytes, double notBefore) {
    if (!bytes.isEmpty())
        chunks_.push_back({bytes, notBefore, false});
}

void OutputQueue::pushVanish(double notBefore) {
    chunks_.push_back({{}, notBefore, true});
}

void OutputQueue::clear() {
    chunks_.clear();
    offset_ = 0;
}

double OutputQueue::waitTime(double now) const {
    if (chunks_.empty())
        return -1;
    double due = chunks_.front().notBefore;
    if (baud_ > 0 && !chunks_.front().vanish)
        due = std::max(due, nextByteAt_);
    return std::max(0.0, due - now);
}

bool OutputQueue::vanishDue(double now) const {
    return !chunks_.empty() && chunks_.front().vanish && chunks_.front().notBefore <= now;
}

OutputQueue::Step OutputQueue::writeTo(int fd, double now) {
    bool wrote = false;
    while (!chunks_.empty()) {
        Chunk& c = chunks_.front();
        if (c.notBefore > now)
            break;
        if (c.vanish)
            return Step::Vanish;
        if (baud_ > 0 && nextByteAt_ > now)
            break;
        const qsizetype remaining = c.bytes.size() - offset_;
        const qsizetype want = baud_ > 0 ? 1 : remaining;
        const ssize_t n = ::write(fd, c.bytes.constData() + offset_, size_t(want));
        if (n < 0) {
            if (errno == EINTR)
                continue;
            if (errno == EAGAIN || errno == EWOULDBLOCK)
                return wrote ? Step::Wrote : Step::Blocked;
            return Step::Failed;
        }
        wrote = true;
        offset_ += n;
        if (baud_ > 0) {
            // Keep the average rate exact, but do not let an idle line bank time.
            nextByteAt_ = std::max(nextByteAt_, now - 0.001) + 10.0 / baud_;
        }
        if (offset_ >= c.bytes.size()) {
            chunks_.pop_front();
            offset_ = 0;
        }
    }
    return wrote ? Step::Wrote : Step::Idle;
}

} // namespace metersim
