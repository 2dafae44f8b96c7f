#include "core/readings/IntervalRule.h"

#include "core/instrument/ModelTable.h"

#include <QLocale>
#include <algorithm>
#include <cmath>

int IntervalRule::minimumForBaud(qint32 baudRate) {
    switch (baudRate) {
    case 300:
        return 5;
    case 1200:
        return 3;
    case 4800:
        return 2;
    default:
        return 1;
    }
}

int IntervalRule::minimumSeconds(qint32 baudRate, const QString& modelCode) {
    return std::max(minimumForBaud(baudRate), modeltable::modelMinimumIntervalSeconds(modelCode));
}

IntervalRule::Result IntervalRule::check(const QString& entry, qint32 baudRate,
                                         const QString& modelCode) {
    Result r;
    bool ok = false;
    const double value = QLocale::c().toDouble(entry.trimmed(), &ok);
    if (!ok || !std::isfinite(value)) {
        r.message = QStringLiteral("Log interval must be numeric.");
        return r;
    }
    const double v = std::fabs(value);
    if (v != std::floor(v)) {
        r.message = QStringLiteral("Please specify log interval in whole seconds.");
        return r;
    }
    const int baudMinimum = minimumForBaud(baudRate);
    const int minimum = minimumSeconds(baudRate, modelCode);
    if (v > kMaximumSeconds) {
        r.message = QStringLiteral("Maximum  log  interval  is  3600  seconds");
        return r;
    }
    if (v < minimum) {
        if (minimum > baudMinimum)
            r.message = QStringLiteral("Minimum log interval is 2 seconds for ") + modelCode +
                        QStringLiteral(" model instrument.");
        else
            r.message = QStringLiteral("Minimum log interval is ") + QString::number(baudMinimum) +
                        QStringLiteral(" second(s) at ") + QString::number(baudRate) +
                        QStringLiteral("  baud");
        return r;
    }
    r.accepted = true;
    r.seconds = int(v);
    return r;
}
