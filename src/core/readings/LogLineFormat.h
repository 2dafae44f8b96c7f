#pragma once

#include "core/readings/LineLayout.h"

#include <QString>
#include <optional>

// Turns the meter's log records (each with its final CR) into lines of the log table.
// A record too short for its layout gives nullopt; nothing here reads past a string's end.
class LogLineFormat {
public:
    // Date and time moved from the end of the record to the front, one space, the reading.
    // Percent-format records come back unchanged (CR kept). The result carries no LF.
    static std::optional<QString> reformat(const QString& record, const LineLayout& layout);

    // A QR32 record (36 characters and CR, possibly with extra characters in front, such as a
    // line feed that followed the previous record's CR): colons in the time and "20" before
    // the two-digit year. Extra leading characters and the CR are kept.
    static std::optional<QString> qr32Record(const QString& record);

    // The same fix on a record known to start at its first character (real-time replies).
    static std::optional<QString> qr32Fixed(const QString& record, qsizetype extra);

    // Shortest record each layout can rearrange (CR included).
    static constexpr int kMinGeneral = 20;
    static constexpr int kMinGeneralShortYear = 18;
    static constexpr int kMinMarinLago = 19;
    static constexpr int kMinK5 = 12;
    static constexpr int kMinQr32 = 15;
};
