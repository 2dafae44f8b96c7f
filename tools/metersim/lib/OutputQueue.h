#pragma once

#include <QByteArray>
#include <deque>

namespace metersim {

// Bytes waiting to go out to the program, in order. Each chunk may carry an earliest sending
// time (a late reply); with a baud rate set, bytes leave one at a time, 10 bit times apart, as
// a real serial line would pace them. A chunk can also be a marker that makes the port vanish
// once everything before it has gone out.
class OutputQueue {
public:
    enum class Step {
        Idle,    // nothing due now
        Wrote,   // some bytes went out
        Blocked, // the pty buffer is full: wait for POLLOUT
        Vanish,  // the vanish marker is due
        Failed,  // write failed for another reason
    };

    void push(const QByteArray& bytes, double notBefore);
    void pushVanish(double notBefore);
    void clear();
    bool isEmpty() const { return chunks_.empty(); }
    void setBaud(int baud) { baud_ = baud; }

    // Seconds until the next byte may go out: 0 when one is due now, negative when none waits.
    double waitTime(double now) const;
    // The vanish marker is at the front and due.
    bool vanishDue(double now) const;
    // Writes whatever is due now to the non-blocking descriptor fd.
    Step writeTo(int fd, double now);

private:
    struct Chunk {
        QByteArray bytes;
        double notBefore = 0;
        bool vanish = false;
    };
    std::deque<Chunk> chunks_;
    qsizetype offset_ = 0; // bytes of the front chunk already written
    int baud_ = 0;
    double nextByteAt_ = 0;
};

} // namespace metersim
