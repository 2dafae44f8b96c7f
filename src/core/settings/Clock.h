#pragma once

#include <QDateTime>

// Time behind a seam: a monotonic clock for time-outs and schedules (never jumps at midnight or
// when the wall clock is set), and the wall clock for dates printed into lines.
// Tests substitute a clock they can move forward without waiting.
class Clock {
public:
    virtual ~Clock() = default;
    virtual double nowSeconds() const = 0; // monotonic, arbitrary zero
    virtual QDateTime wallNow() const = 0; // local date and time
};
