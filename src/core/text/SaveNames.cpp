#include "core/text/SaveNames.h"

QString SaveNames::defaultName(const DisplayKind& kind) {
    // Tested in this order, a later match replacing an earlier one.
    QString name = QStringLiteral("Instrument data");
    if (kind.glp)
        name = QStringLiteral("GLP data");
    if (kind.log)
        name = QStringLiteral("Log data");
    if (kind.realTime)
        name = QStringLiteral("Current data");
    if (kind.maxMin)
        name = QStringLiteral("MaxMin data");
    if (kind.voltage)
        name = QStringLiteral("Voltage data");
    return name;
}

QStringList SaveNames::saveFilters(const DisplayKind& kind) {
    QStringList filters{QStringLiteral("Text File   (*.txt)")};
    if (kind.log || kind.realTime || kind.listen)
        filters << QStringLiteral("Comma Delimited    (*.csv)");
    return filters;
}

QStringList SaveNames::openFilters() {
    return {QStringLiteral("All Files   (*.*)")};
}

QString SaveNames::withDefaultExtension(const QString& path, int filterIndex) {
    if (path.contains(QLatin1Char('.')))
        return path;
    return path + (filterIndex == 0 ? QStringLiteral(".txt") : QStringLiteral(".csv"));
}
