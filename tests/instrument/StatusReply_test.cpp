// The meter's status replies and the model table, as plain functions on text.
#include "core/instrument/ModelTable.h"
#include "core/instrument/StatusReply.h"

#include <QTest>

using namespace modeltable;

static QString letters(const char* names, std::initializer_list<bool> flags) {
    QString s;
    for (bool on : flags)
        s += QString(on, QChar(*names++));
    return s;
}

// Format (Unusable, Error, Plain, K5, %), model, version, serial, count ("~": not delivered, the
// caller keeps its value), then the flags: K5 family, log, GLP, auto-logging, stirrer, voltage,
// battery low, "?W" needed.
static QString summary(const char* reply, const char* held) {
    const StatusReply r = parseStatusReply(reply, held);
    return QStringList{
        QChar("UEPK%"[int(r.format)]),
        r.modelCode.value_or("~"),
        r.firmwareVersion.value_or("~"),
        r.serialNumber.value_or("~"),
        r.numLogged ? QString::number(*r.numLogged) : "~",
        letters("klgasvbw", {r.isK5Family, r.hasLog, r.hasGLP, r.canAutoLog(), r.canStir(),
                             r.reportsVoltage(), r.batteryLow(), r.needsVersionQuery})}
        .join('|');
}

class StatusReplyTest : public QObject {
    Q_OBJECT
private slots:
    void replies() {
        // A K5 reply's count is the first digit run from the third character on; a plain reply's
        // is the four characters before the last; capability letters count in any case.
        const char* rows[][3] = {
            {"K5AC 0012 +m\r", "", "K|K5AC|||12|klas"},
            {"K5G2 0007\r", "", "K|K5G|||2|kl"},
            {"K5AH 0034 +mB 12345\r", "", "K|K5AH||12345|34|klgasb"},
            {"K50  1.05  A1234  0012\r", "", "P|K50|1.05|A1234|12|lg"},
            {"K51 V1.2 SN0001 9999\r", "", "P|K51|V1.2|SN0001|~|"},
            {"K50 +m S1 B0x1\r", "", "P|K50|+m|S1|~|lg"},
            {"K50\r", "K51", "P|~|~|~|~|"},
            {"ZUM410 0042 \r", "", "P|QR32|~|~|42|lw"},
            {"P200 2.1 S2 0042 +v%g\r", "", "%|P200|2.1|S2|42|lav"},
            {"P100 1.0 S1 +m%n\r", "", "%|P100|1.0|S1|~|as"},
            {"P100 1.0 S1 9999 v%l\r", "", "%|P100|1.0|S1|~|gv"},
            {"P100  1.0 S1 0004 +%g\r", "", "%|P100||1.0|~|la"},
            {"K5XP 1 S 5 M%\r", "", "%|K5XP|1|S|5|klgs"},
            {"K50 busy\r", "", "U|~|~|~|~|"},
            {"ERROR\r", "", "E|~|~|~|~|"},
        };
        for (auto [reply, held, expected] : rows)
            QCOMPARE(summary(reply, held), expected);

        StatusReply r;
        parseVersionReply("QR32 Ver2.1 A12345\r", r);
        QCOMPARE(*r.firmwareVersion + *r.serialNumber, "2.1A12345");
        // A short reply delivers only the fields it holds.
        StatusReply s;
        parseVersionReply("QR32VER 1.5 A1234", s);
        QVERIFY(s.firmwareVersion == "1.5" && !s.serialNumber);
        QVERIFY(parseCount(" 12 ") == 12 && !parseCount("+12") && !parseCount("2147483648"));
    }

    void modelTable() {
        const char* k5Words[] = {"K5AC1", "K5AC", "K5AD", "K5ACMV", "K5ACMV", "K5ACMV",
                                 "K5E2",  "K5E",  "K5G",  "K5G",    "K5AHX",  "K5AH",
                                 "K5GJ7", "K5GJ", "K5Z9", "K5Z9"};
        for (int i = 0; i < 16; i += 2)
            QCOMPARE(normaliseK5Code(k5Words[i]), k5Words[i + 1]);

        // What the parser does not ask: q QR32 layout, x max/min, 2 two-second minimum, d short
        // date and time.
        const char* codes[][2] = {{"QR32", "q"}, {"ZUM410", ""},  {"QR321", ""},  {"QR34ZZ", "x"},
                                  {"qr34", ""},  {"K50V3", "2"},  {"K50V35", ""}, {"ab-LXT9", "2"},
                                  {"lxt", ""},   {"marin2", "d"}, {"Marin", ""},  {"lago", "d"}};
        for (auto [c, expected] : codes)
            QCOMPARE(letters("qx2d", {usesQr32Layout(c), keepsMaxMin(c),
                                      modelMinimumIntervalSeconds(c) == 2, usesShortDateTime(c)}),
                     expected);
    }
};

QTEST_APPLESS_MAIN(StatusReplyTest)
#include "StatusReply_test.moc"
