#pragma once

#include "core/settings/Clock.h"

#include <QElapsedTimer>

// The real clock: QElapsedTimer is monotonic, so waits that span midnight still end.
class SystemClock : public Clock {
public:
    SystemClock() { timer_.start(); }
    double nowSeconds() const override { return static_cast<double>(timer_.nsecsElapsed()) / 1e9; }
    QDateTime wallNow() const override { return QDateTime::currentDateTime(); }

private:
    QElapsedTimer timer_;
};
