#include "Profile.h"

#include "RecordFormat.h"

#include <stdexcept>

namespace metersim {

namespace {

const QList<QByteArray> kGlpLines = {
    "GLP  Calibration  01/03/2004 07:30\r",
    "Std 1   12.88mS  25.0C  slope  98.7%\r",
    "Std 2  1*413mS  25.0C  slope  99.1%\r",
};

const QList<QByteArray> kMaxMinLines = {
    "MAX   1.999mS  25.0C  01/03/2004 10:15\r",
    "MIN   0.101mS  24.8C  01/03/2004 08:00\r",
};

Profile plainProfile(const QString& name, const QByteArray& model, const QByteArray& version,
                     const QByteArray& serial) {
    Profile p;
    p.name = name;
    p.format = StatusFormat::Plain;
    p.layout = LogLayout::FourDigitYear;
    p.model = model;
    p.version = version;
    p.serial = serial;
    p.glpLines = kGlpLines;
    return p;
}

Profile k5Profile(const QString& name, const QByteArray& model, const QByteArray& caps) {
    Profile p;
    p.name = name;
    p.format = StatusFormat::K5;
    p.layout = LogLayout::K5;
    p.model = model;
    p.capabilities = caps;
    return p;
}

// Logged count with at least four digits.
QByteArray count4(int n) {
    return QByteArray::number(qMax(0, n)).rightJustified(4, '0');
}

} // namespace

QStringList profileNames() {
    return {"plain", "k50",  "k50v3",       "lxt",           "k51",  "k5ac",   "k5acmv", "k5ad",
            "k5gj",  "k5ah", "percent-log", "percent-nolog", "qr32", "zum410", "qr34"};
}

Profile profile(const QString& name) {
    if (name == "plain")
        return plainProfile(name, "CD200", "V1.21", "012345");
    if (name == "k50") {
        Profile p = plainProfile(name, "K50", "V2.10", "023456");
        p.layout = LogLayout::TwoDigitYear;
        return p;
    }
    if (name == "k50v3")
        return plainProfile(name, "K50V3", "V3.00", "034567");
    if (name == "lxt")
        return plainProfile(name, "LXT200", "V1.05", "045678");
    if (name == "k51") {
        Profile p = plainProfile(name, "K51", "V1.00", "056789");
        p.hasLog = false;
        p.glpLines.clear();
        return p;
    }
    if (name == "k5ac")
        return k5Profile(name, "K5AC", "+m");
    if (name == "k5acmv")
        return k5Profile(name, "K5ACMV", "+m");
    if (name == "k5ad")
        return k5Profile(name, "K5AD", "+");
    if (name == "k5gj")
        return k5Profile(name, "K5GJ", "+m");
    if (name == "k5ah") {
        Profile p = k5Profile(name, "K5AH", "+m");
        p.serial = "51234";
        p.glpLines = kGlpLines;
        return p;
    }
    if (name == "percent-log" || name == "percent-nolog") {
        const bool log = name == "percent-log";
        Profile p;
        p.name = name;
        p.format = StatusFormat::Percent;
        p.layout = log ? LogLayout::Percent : LogLayout::None;
        p.model = log ? "CP600" : "CP500";
        p.version = log ? "V2.01" : "V1.10";
        p.serial = log ? "067890" : "078901";
        p.capabilities = log ? "+mv" : "v";
        p.recordsLetter = log ? 'g' : 'n';
        p.hasLog = log;
        return p;
    }
    if (name == "qr32" || name == "zum410") {
        Profile p;
        p.name = name;
        p.format = StatusFormat::Qr32;
        p.layout = LogLayout::Qr32;
        p.model = name == "qr32" ? "QR32" : "ZUM410";
        p.version = "2.1";
        p.serial = "A12345";
        return p;
    }
    if (name == "qr34") {
        Profile p = plainProfile(name, "QR34A", "V1.40", "089012");
        p.maxMinLines = kMaxMinLines;
        return p;
    }
    throw std::invalid_argument("unknown meter profile: " + name.toStdString());
}

QByteArray Profile::statusReply(int numLogged) const {
    QByteArray caps = capabilities;
    if (lowBattery)
        caps += 'B';
    switch (format) {
    case StatusFormat::Plain: {
        QByteArray s = model + ' ' + version + ' ' + serial;
        // The count is the last four characters: a bigger log shows 9999, as a full display would.
        if (hasLog)
            s += ' ' + count4(qMin(numLogged, 9999));
        return s + '\r';
    }
    case StatusFormat::K5: {
        QByteArray s = model + ' ' + count4(numLogged) + ' ' + caps;
        if (!serial.isEmpty())
            s += ' ' + serial;
        return s + '\r';
    }
    case StatusFormat::Percent: {
        QByteArray s = model + ' ' + version + ' ' + serial + ' ';
        if (hasLog)
            s += count4(numLogged) + ' ';
        return s + caps + '%' + recordsLetter + '\r';
    }
    case StatusFormat::Qr32:
        return model + ' ' + count4(numLogged) + " \r";
    }
    return "ERROR\r";
}

QByteArray Profile::secondStatusReply() const {
    // "QR32 Ver" fills characters 1-8, so the version lands on 9-11 and the serial on 13-18.
    return "QR32 Ver" + version.leftJustified(3, ' ', true) + ' ' +
           serial.leftJustified(6, ' ', true) + '\r';
}

QByteArray Profile::headerReply() const {
    return format == StatusFormat::Percent ? RecordFormat::percentHeader(hasLog) : QByteArray();
}

QByteArray Profile::positionsReply() const {
    return format == StatusFormat::Percent ? RecordFormat::percentPositions(hasLog) : QByteArray();
}

} // namespace metersim
