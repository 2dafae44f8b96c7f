#include "core/instrument/ModelTable.h"

#include <iterator>

namespace modeltable {
namespace {

enum class Match { Equals, BeginsWith, Contains };

// What a model rule switches. A code collects the traits of every rule it matches.
enum Trait : unsigned {
    K5Family = 1u << 0,
    NotK5Family = 1u << 1, // overrides K5Family ("K51...", "K50...")
    NoPlainLog = 1u << 2,
    NoPlainGlp = 1u << 3,
    Qr32Status = 1u << 4, // logged count in the second word, version and serial from "?W"
    Qr32Layout = 1u << 5, // QR32 log records and real-time lines
    K5Glp = 1u << 6,
    K5Serial = 1u << 7,
    LoggingByJ = 1u << 8,
    MaxMin = 1u << 9,
    TwoSecondMinimum = 1u << 10,
    ShortDateTime = 1u << 11,
};

struct ModelRule {
    Match match;
    const char* text;
    unsigned traits;
};

// The model table. Keep every model-specific fact here.
constexpr ModelRule kModelRules[] = {
    {Match::BeginsWith, "K5", K5Family},
    {Match::BeginsWith, "K51", NotK5Family | NoPlainLog | NoPlainGlp},
    {Match::BeginsWith, "K50", NotK5Family},
    {Match::Equals, "K50V3", TwoSecondMinimum},
    {Match::Contains, "LXT", TwoSecondMinimum},
    {Match::Equals, "QR32", Qr32Status | Qr32Layout | NoPlainGlp},
    {Match::Equals, "ZUM410", Qr32Status},
    {Match::BeginsWith, "QR34", MaxMin},
    {Match::Equals, "K5AH", K5Glp | K5Serial | LoggingByJ},
    {Match::BeginsWith, "marin", ShortDateTime},
    {Match::BeginsWith, "lago", ShortDateTime},
};

struct K5Rule {
    const char* prefix;
    const char* code;
};

// First words of K5-format replies; tried in order, the last match wins.
constexpr K5Rule kK5Rules[] = {
    {"K5AC", "K5AC"}, {"K5AD", "K5ACMV"}, {"K5ACMV", "K5ACMV"}, {"K5E", "K5E"},
    {"K5G", "K5G"},   {"K5AH", "K5AH"},   {"K5J", "K5J"},       {"K5GJ", "K5GJ"},
};

bool matches(const ModelRule& rule, const QString& code) {
    const QString text = QString::fromLatin1(rule.text);
    switch (rule.match) {
    case Match::Equals:
        return code == text;
    case Match::BeginsWith:
        return code.startsWith(text);
    case Match::Contains:
        return code.contains(text);
    }
    return false;
}

unsigned traitsOf(const QString& code) {
    unsigned traits = 0;
    for (const ModelRule& rule : kModelRules) {
        if (matches(rule, code))
            traits |= rule.traits;
    }
    if (traits & NotK5Family)
        traits &= ~unsigned(K5Family);
    return traits;
}

bool has(const QString& code, Trait trait) {
    return (traitsOf(code) & trait) != 0;
}

} // namespace

bool isK5FamilyCode(const QString& text) {
    return has(text, K5Family);
}

QString normaliseK5Code(const QString& firstWord) {
    QString code = firstWord;
    for (const K5Rule& rule : kK5Rules) {
        if (firstWord.startsWith(QString::fromLatin1(rule.prefix)))
            code = QString::fromLatin1(rule.code);
    }
    return code;
}

bool usesQr32StatusLayout(const QString& modelCode) {
    return has(modelCode, Qr32Status);
}
QString qr32Code() {
    return QStringLiteral("QR32");
}
bool usesQr32Layout(const QString& modelCode) {
    return has(modelCode, Qr32Layout);
}

bool plainKeepsLog(const QString& modelCode) {
    return !has(modelCode, NoPlainLog);
}
bool plainKeepsGlp(const QString& modelCode) {
    return !has(modelCode, NoPlainGlp);
}

bool k5KeepsGlp(const QString& modelCode) {
    return has(modelCode, K5Glp);
}
bool k5ReportsSerial(const QString& modelCode) {
    return has(modelCode, K5Serial);
}

bool keepsMaxMin(const QString& modelCode) {
    return has(modelCode, MaxMin);
}
QString maxMinCode() {
    return QStringLiteral("QR34");
}

QString enableLoggingCommand(const QString& modelCode, bool percentFormat) {
    return (percentFormat || has(modelCode, LoggingByJ)) ? QStringLiteral("?J")
                                                         : QStringLiteral("?G");
}

int modelMinimumIntervalSeconds(const QString& modelCode) {
    return has(modelCode, TwoSecondMinimum) ? 2 : 0;
}

bool usesShortDateTime(const QString& modelCode) {
    return has(modelCode, ShortDateTime);
}

LogLayout logLayoutFor(const QString& modelCode, bool isK5Family, bool percentFormat) {
    if (usesQr32Layout(modelCode))
        return LogLayout::Qr32;
    if (percentFormat)
        return LogLayout::Percent;
    if (isK5Family)
        return LogLayout::K5Family;
    if (usesShortDateTime(modelCode))
        return LogLayout::ShortDateTime;
    return LogLayout::General;
}

ReadingLayout readingLayoutFor(const QString& modelCode, bool percentFormat, bool hasLog) {
    if (percentFormat)
        return hasLog ? ReadingLayout::PercentWithLog : ReadingLayout::PercentWithoutLog;
    if (usesQr32Layout(modelCode))
        return ReadingLayout::Qr32;
    return ReadingLayout::General;
}

} // namespace modeltable
