#pragma once

#include <QByteArray>
#include <QList>
#include <QString>
#include <QStringList>

namespace metersim {

// How the meter words its "?S" reply.
enum class StatusFormat {
    Plain,   // "MODEL VERSION SERIAL nnnn" CR (the count only when the meter logs)
    K5,      // "K5AC 0042 +m" CR; K5AH adds a 5-character serial before the CR
    Percent, // "MODEL VERSION SERIAL [nnnn ]caps%x" CR, single spaces
    Qr32,    // "QR32 nnnn " CR; version and serial come from "?W"
};

// How a logged record (and a "?D" reading) is laid out.
enum class LogLayout {
    None,          // percent-format readings without date or log number
    FourDigitYear, // reading, then "dd/mm/yyyy hh:mm:ss", CR
    TwoDigitYear,  // reading, then "dd/mm/yy hh:mm:ss", CR
    K5,            // reading, then "dd/mm hh:mm", CR
    Percent,       // columns described by the "?H" header and the "?P" positions
    Qr32,          // 36 characters and CR: "dd/mm/yy hh.mm.ss" then a 19-character reading
};

// Everything that makes one simulated instrument model differ from another.
struct Profile {
    QString name;
    StatusFormat format = StatusFormat::Plain;
    LogLayout layout = LogLayout::FourDigitYear;
    QByteArray model;         // first word of the status reply
    QByteArray version;       // firmware version (plain, percent, "?W")
    QByteArray serial;        // serial number (plain, percent, K5AH, "?W")
    QByteArray capabilities;  // letters such as "+", "m", "v" (K5 and percent formats)
    char recordsLetter = 'b'; // percent format: letter after "%" (n, g, l or anything else)
    bool hasLog = true;
    bool lowBattery = false; // adds "B" to the capability letters
    bool blowOnStir = false; // "?M" answers "BLOW" CR instead of "SON" CR
    QByteArray voltageReply = "  6.3V\r";
    QList<QByteArray> glpLines; // "?G" block without the END line; empty: "?G" enables logging
    QList<QByteArray>
        maxMinLines;        // "?M" block without the END line; empty: "?M" starts the stirrer
    int defaultLogSize = 3; // records a new meter holds (when it has a log)

    // Status reply for a log holding numLogged records.
    QByteArray statusReply(int numLogged) const;
    // Reply to "?W" (QR32 layout: version at characters 9-11, serial at 13-18).
    QByteArray secondStatusReply() const;
    // Replies to "?H" and "?P" (percent format; empty otherwise).
    QByteArray headerReply() const;
    QByteArray positionsReply() const;
};

// Names accepted by profile(), with their status replies for a log of 42 records:
//   plain          "CD200 V1.21 012345 0042"      four-digit-year records, GLP block
//   k50            "K50 V2.10 023456 0042"        two-digit-year records, GLP block
//   k50v3, lxt     "K50V3 V3.00 034567 0042", "LXT200 V1.05 045678 0042"
//   k51            "K51 V1.00 056789"             no log, no GLP (readings still dated)
//   k5ac, k5acmv   "K5AC 0042 +m", "K5ACMV 0042 +m"   K5 records ("dd/mm hh:mm" at the end)
//   k5ad, k5gj     "K5AD 0042 +", "K5GJ 0042 +m"
//   k5ah           "K5AH 0042 +m 51234"           serial before the CR, GLP block
//   percent-log    "CP600 V2.01 067890 0042 +mv%g" columns Date Time Log# pH Cond
//   percent-nolog  "CP500 V1.10 078901 v%n"       readings pH Cond, no log
//   qr32, zum410   "QR32 0042 ", "ZUM410 0042 "   "?W" = "QR32 Ver2.1 A12345", "?R" records
//   qr34           "QR34A V1.40 089012 0042"      GLP block and "?M" max/min block
// Every reply ends with CR.
QStringList profileNames();
// The named profile; throws std::invalid_argument for an unknown name.
Profile profile(const QString& name);

} // namespace metersim
