#pragma once

#include <QString>
#include <optional>

// The meter's reply to "?S" taken apart, without any widget. Three formats exist:
//   plain    "MODEL VERSION SERIAL ... nnnnX"  (count = the four characters before the last one;
//            QR32/ZUM410: "MODEL nnnn ...", version and serial from "?W")
//   K5       "K5xx ... digits ... [serial]X"    (count = first digit run from character 3 on)
//   percent  "MODEL VERSION SERIAL [COUNT] letters%x"
// A field the reply does not deliver (its closing space is missing, it is not a number, the
// reply is too short) is left empty (std::nullopt), so the caller keeps its previous value.
struct StatusReply {
    enum class Format {
        Unusable, // empty, or contains "BUSY" or "EXIT": nothing changes
        Error,    // begins with "ERROR": the status display is reset
        Plain,
        K5,
        Percent,
    };
    Format format = Format::Unusable;

    std::optional<QString> modelCode; // normalised: K5 rules applied, "ZUM410" becomes "QR32"
    std::optional<QString> firmwareVersion;
    std::optional<QString> serialNumber;
    std::optional<QString> replyTail;
    std::optional<qint32> numLogged;
    QString capabilityText;

    bool isK5Family = false;
    bool hasLog = false;
    bool hasGLP = false;
    // QR32-layout meter: version and serial number must be fetched with "?W".
    bool needsVersionQuery = false;

    // Capability letters (a contains test, letter case ignored).
    bool canAutoLog() const { return hasLetter(u'+'); }
    bool canStir() const { return hasLetter(u'm'); }
    bool reportsVoltage() const { return hasLetter(u'v'); }
    bool batteryLow() const { return hasLetter(u'B'); }

private:
    bool hasLetter(char16_t letter) const {
        return capabilityText.contains(QChar(letter), Qt::CaseInsensitive);
    }
};

// Parses a reply to "?S" as received (with its final CR, if any). currentModelCode is the model
// code held so far: it decides the plain format's log and GLP flags when the reply's first word
// cannot be read.
StatusReply parseStatusReply(const QString& reply, const QString& currentModelCode);

// Fills version (characters 9-11) and serial number (characters 13-18) of a QR32-layout meter
// from its reply to "?W". A field whose characters are not all there is not delivered.
void parseVersionReply(const QString& reply, StatusReply& status);

// The number of a count field: decimal digits only (spaces around them allowed), within range.
std::optional<qint32> parseCount(const QString& field);
