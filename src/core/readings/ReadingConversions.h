#pragma once

#include <QString>
#include <optional>

// The unit and asterisk conversions applied to the whole workspace once a download ends.
// Every edit replaces characters in place: the text never changes length, and converting text
// that was already converted changes nothing more (converted units carry their new name).
//
// A unit is looked for from the fifth character on; its value field is the six characters
// before it, or the four or five there are when it stands fifth or sixth, and ends at a line
// break: only the characters after the last CR or LF among them belong to it. A rendering
// longer than the field overwrites what stands before it on the same line; when it would reach
// past the start of the text or over a line break, the field is left as it was (the unit is
// still renamed), so no line is ever damaged.
struct ReadingConversions {
    bool msToUs = false;    // "mS" -> "uS", value times 1000
    bool ppkToPpm = false;  // "ppK" -> "ppM", value times 1000
    bool asterisks = false; // every "*" -> "." (runs last)

    // The conversions the settings switch on (only 1 means yes).
    static ReadingConversions fromSettings(qint16 msToUs, qint16 ppkToPpm, qint16 asterisks) {
        return {msToUs == 1, ppkToPpm == 1, asterisks == 1};
    }

    QString apply(const QString& text) const;

    // The replacement for one value field (the characters before a unit): nullopt when the
    // field is not a number, "+OVR" when the product is above 999999, otherwise the product
    // rendered shortest, with "*" as the decimal mark when the field used one.
    static std::optional<QString> convertValueField(QStringView field);
    // Shortest decimal text of a single-precision value with at most seven significant
    // digits, no exponent, no trailing zeros or trailing point.
    static QString renderSingle(float value);

private:
    static void convertUnit(QString& s, const QString& unit, const QString& replacement);
};
