#include "core/readings/ReadingSchedule.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace {

// Round to the nearest integer, halves to even, clamped to int.
int roundEven(double x) {
    if (std::isnan(x))
        return 0;
    const double r = std::nearbyint(x); // default rounding mode: to nearest, ties to even
    if (r >= std::numeric_limits<int>::max())
        return std::numeric_limits<int>::max();
    if (r <= std::numeric_limits<int>::min())
        return std::numeric_limits<int>::min();
    return int(r);
}

} // namespace

ReadingSchedule::Next ReadingSchedule::next(double due, double now) {
    Next n;
    n.ms = roundEven((due - now) * 1000.0);
    if (n.ms < 0)
        n.kind = Next::Kind::Overdue;
    else if (n.ms == 0)
        n.kind = Next::Kind::Now;
    else if (n.ms < kShortLimitMs)
        n.kind = Next::Kind::Short;
    else
        n.kind = Next::Kind::Long;
    return n;
}

ReadingSchedule::Countdown ReadingSchedule::countdown(double due, double now) {
    Countdown c;
    c.secs = roundEven(due - now);
    if (c.secs != 1) {
        const double tickAt = due - c.secs + 1;
        c.tick = true;
        c.tickMs = std::max(0, roundEven((tickAt - now) * 1000.0));
    }
    return c;
}

int ReadingSchedule::twentieths(long long count, long long total) {
    if (total <= 0)
        return 20;
    return roundEven(double(count) / double(total) * 20.0);
}
