#pragma once

// Wall-clock and CPU time of the calling thread, both in milliseconds. On a busy machine the
// CPU time shows what the code itself costs; the wall time shows what a user would wait.
#include <QElapsedTimer>
#include <algorithm>
#include <ctime>
#include <vector>

class BenchTimer {
public:
    BenchTimer() { restart(); }
    void restart() {
        wall_.start();
        cpu0_ = cpuMs();
    }
    double wallMs() const { return static_cast<double>(wall_.nsecsElapsed()) / 1e6; }
    double cpuElapsedMs() const { return cpuMs() - cpu0_; }

    static double cpuMs() {
        timespec ts{};
        clock_gettime(CLOCK_THREAD_CPUTIME_ID, &ts);
        return static_cast<double>(ts.tv_sec) * 1e3 + static_cast<double>(ts.tv_nsec) / 1e6;
    }

private:
    QElapsedTimer wall_;
    double cpu0_ = 0;
};

// Median of repeated runs.
struct Samples {
    std::vector<double> wall;
    std::vector<double> cpu;
    void add(const BenchTimer& t) {
        wall.push_back(t.wallMs());
        cpu.push_back(t.cpuElapsedMs());
    }
    static double median(std::vector<double> v) {
        std::sort(v.begin(), v.end());
        return v.empty() ? 0 : v[v.size() / 2];
    }
    double wallMedian() const { return median(wall); }
    double cpuMedian() const { return median(cpu); }
};
