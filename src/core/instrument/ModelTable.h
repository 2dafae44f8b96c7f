#pragma once

#include <QString>

// Everything the program knows about individual meter models, in one table (ModelTable.cpp).
// The status display, the log download and real-time readings ask these functions instead of
// comparing model codes themselves.
//
// Model codes are compared exactly, letter case included: "contains", "begins with" and equality.
namespace modeltable {

// The status reply (or a model code) belongs to the K5 family: it begins with "K5" but not with
// "K51" or "K50".
bool isK5FamilyCode(const QString& text);

// Normalises the first word of a K5-family status reply to its model code: "K5AC", "K5ACMV"
// (also for "K5AD..."), "K5E", "K5G", "K5AH", "K5J", "K5GJ". The rules are tried in order and a
// later match wins, so "K5GJ2" gives "K5GJ" although it also begins with "K5G". A word that
// matches no rule is returned unchanged.
QString normaliseK5Code(const QString& firstWord);

// Plain status replies of these models carry the number of logged readings in their second
// word, and version and serial number come from a second query "?W" ("QR32", "ZUM410").
bool usesQr32StatusLayout(const QString& modelCode);
// The code such a model is stored and treated under afterwards ("QR32").
QString qr32Code();
// The model's log records and real-time readings use the QR32 layout (modelCode is "QR32").
bool usesQr32Layout(const QString& modelCode);

// Plain-format models: whether they keep a reading log and GLP records. "K51..." keeps neither;
// "QR32" keeps a log but no GLP records; every other plain model keeps both.
bool plainKeepsLog(const QString& modelCode);
bool plainKeepsGlp(const QString& modelCode);

// K5-format models: only "K5AH" keeps GLP records and reports its serial number.
bool k5KeepsGlp(const QString& modelCode);
bool k5ReportsSerial(const QString& modelCode);

// Models that keep max/min values (code begins with "QR34"), and the code they are stored under.
bool keepsMaxMin(const QString& modelCode);
QString maxMinCode();

// The command that switches automatic logging on: "?J" for "K5AH" and for every percent-format
// meter, "?G" otherwise.
QString enableLoggingCommand(const QString& modelCode, bool percentFormat);

// Shortest real-time interval, in seconds, that the model itself needs: 2 for "K50V3" and for
// codes containing "LXT"; 0 when the model adds nothing to the baud-rate minimum.
int modelMinimumIntervalSeconds(const QString& modelCode);

// Model codes whose log records end with a 16-character date and time ("marin...", "lago...").
bool usesShortDateTime(const QString& modelCode);

// How a logged record is laid out, tested in this order: QR32, percent format, K5 family,
// 16-character date/time models, and every other meter (date and time at the end).
enum class LogLayout { Qr32, Percent, K5Family, ShortDateTime, General };
LogLayout logLayoutFor(const QString& modelCode, bool isK5Family, bool percentFormat);

// How a real-time reading line is built, tested in this order: percent format with log,
// percent format without log, QR32, every other meter (renumbered, then laid out as a log
// record of logLayoutFor).
enum class ReadingLayout { PercentWithLog, PercentWithoutLog, Qr32, General };
ReadingLayout readingLayoutFor(const QString& modelCode, bool percentFormat, bool hasLog);

} // namespace modeltable
