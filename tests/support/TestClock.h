#pragma once

#include "core/settings/SystemClock.h"

// The real clock plus an offset a test can move forward, so waits still end (time passes) while
// long intervals and midnight are reached without sleeping.
class TestClock : public Clock {
public:
    double nowSeconds() const override { return real_.nowSeconds() + offset_; }
    QDateTime wallNow() const override {
        return real_.wallNow().addMSecs(qint64(offset_ * 1000)).addSecs(wallShift_);
    }
    void advance(double seconds) { offset_ += seconds; }
    // Shifts only the wall clock (e.g. to a moment before midnight).
    void setWallShift(qint64 seconds) { wallShift_ = seconds; }

private:
    SystemClock real_;
    double offset_ = 0;
    qint64 wallShift_ = 0;
};
