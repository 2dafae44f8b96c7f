#include "instrument/StatusReply.h"

#include <QRandomGenerator>
#include <QTest>

using Format = StatusReply::Format;
Q_DECLARE_METATYPE(StatusReply::Format)

namespace {
// "~" in a table stands for "not delivered: the caller keeps its previous value".
const QString keep = QStringLiteral("~");
constexpr int keepCount = -1;

QString shown(const std::optional<QString>& field) {
    return field.value_or(keep);
}
int shown(const std::optional<qint32>& count) {
    return count.value_or(keepCount);
}
QString latin1(const char* bytes) {
    return QString::fromLatin1(bytes);
}
} // namespace

class StatusReplyTest : public QObject {
    Q_OBJECT
private slots:
    void fields_data();
    void fields();
    void flags_data();
    void flags();
    void versionReply_data();
    void versionReply();
    void count_data();
    void count();
    void randomReplies();
};

void StatusReplyTest::fields_data() {
    QTest::addColumn<QString>("reply");
    QTest::addColumn<QString>("current");
    QTest::addColumn<Format>("format");
    QTest::addColumn<QString>("model");
    QTest::addColumn<QString>("version");
    QTest::addColumn<QString>("serial");
    QTest::addColumn<int>("logged");
    QTest::addColumn<QString>("capabilities");
    auto row = [](const char* tag, const QString& reply, const QString& current, Format format,
                  const QString& model, const QString& version, const QString& serial, int logged,
                  const QString& capabilities) {
        QTest::newRow(tag) << reply << current << format << model << version << serial << logged
                           << capabilities;
    };

    // K5 family: count = first digit run from the third character on.
    row("K5AC count and letters", "K5AC 0012 +m\r", "", Format::K5, "K5AC", "", "", 12,
        "K5AC 0012 +m\r");
    row("K5ACMV word", "K5ACMVX 0001\r", "", Format::K5, "K5ACMV", "", "", 1, "K5ACMVX 0001\r");
    row("K5GJ beats K5G", "K5GJX 0005\r", "", Format::K5, "K5GJ", "", "", 5, "K5GJX 0005\r");
    row("K5AD shown as K5ACMV", "K5ADX 0007\r", "", Format::K5, "K5ACMV", "", "", 7,
        "K5ADX 0007\r");
    // The count is the first digit run, even one inside the model word.
    row("digit in model word", "K5G2 0007\r", "", Format::K5, "K5G", "", "", 2, "K5G2 0007\r");
    row("K5 unknown word kept", "K5XYZ 3\r", "", Format::K5, "K5XYZ", "", "", 3, "K5XYZ 3\r");
    row("K5AH serial", "K5AH 0034 +m 12345\r", "", Format::K5, "K5AH", "", "12345", 34,
        "K5AH 0034 +m 12345\r");
    row("K5 without CR", "K5AC 0012 +m", "", Format::K5, "K5AC", "", "", 12, "K5AC 0012 +m");
    row("K5 no digits", "K5AC +m\r", "", Format::K5, "K5AC", "", "", keepCount, "K5AC +m\r");
    row("K5 count overflow", "K5AC 99999999999 \r", "", Format::K5, "K5AC", "", "", keepCount,
        "K5AC 99999999999 \r");
    row("K5 no space keeps model", "K5\r", "K5G", Format::K5, keep, "", "", keepCount, "K5\r");
    row("K5AH too short for serial", "K5AH\r", "K5AH", Format::K5, keep, "", "", keepCount,
        "K5AH\r");

    // Plain: count = four characters before the last one.
    row("plain K50", "K50 1.05 A1234 0012\r", "", Format::Plain, "K50", "1.05", "A1234", 12, "");
    row("plain two spaces", "K50  1.05  A1234  0012\r", "", Format::Plain, "K50", "1.05", "A1234",
        12, "");
    row("plain K51 no count", "K51 V1.2 SN0001 9999\r", "", Format::Plain, "K51", "V1.2", "SN0001",
        keepCount, "");
    row("plain count not a number", "K50 1.0 S1 00x2\r", "", Format::Plain, "K50", "1.0", "S1",
        keepCount, "");
    row("plain serial ended by CR", "K51 1.0 S1\r", "", Format::Plain, "K51", "1.0", "S1",
        keepCount, "");
    row("plain serial without space", "K51 1.0 S1", "", Format::Plain, "K51", "1.0", keep,
        keepCount, "");
    row("plain too short", "K50\r", "OLD", Format::Plain, keep, keep, keep, keepCount, "");
    row("plain QR34 word", "QR34X 2.0 S77 0005\r", "", Format::Plain, "QR34X", "2.0", "S77", 5, "");
    row("ZUM410 second word", "ZUM410 0042 \r", "", Format::Plain, "QR32", keep, keep, 42, "");
    row("QR32 second word", "QR32 0100 xyz\r", "", Format::Plain, "QR32", keep, keep, 100, "");
    row("QR32 second word unclosed", "QR32 0100\r", "", Format::Plain, "QR32", keep, keep,
        keepCount, "");
    row("high bytes",
        latin1("K50 \xe9\xff"
               "1 S\x80 0012\r"),
        "", Format::Plain, "K50",
        latin1("\xe9\xff"
               "1"),
        latin1("S\x80"), 12, "");
    row("control characters", latin1("K50 1.0\t\x01 S1 0012\r"), "", Format::Plain, "K50",
        latin1("1.0\t\x01"), "S1", 12, "");

    // Percent: exactly one space between fields, then letters, "%", one letter.
    row("percent with log", "P200 2.1 S2 0042 +v%g\r", "", Format::Percent, "P200", "2.1", "S2", 42,
        "+v");
    row("percent n: no count", "P100 1.0 S1 +m%n\r", "", Format::Percent, "P100", "1.0", "S1",
        keepCount, "+m");
    row("percent l: no count", "P100 1.0 S1 9999 v%l\r", "", Format::Percent, "P100", "1.0", "S1",
        keepCount, "9999 v");
    row("percent two spaces", "P100  1.0 S1 0004 +%g\r", "", Format::Percent, "P100", "", "1.0",
        keepCount, "0004 +");
    row("percent truncated", "P1%g", "OLD", Format::Percent, keep, keep, keep, keepCount, "P1");
    row("percent sign first", "%n\r", "", Format::Percent, keep, keep, keep, keepCount, "");
    row("percent only in a field", "P1 1% S1 0003\r", "", Format::Percent, "P1", "1%", "S1",
        keepCount, "");

    // Unusable and error replies change nothing.
    row("busy", "BUSY\r", "", Format::Unusable, keep, keep, keep, keepCount, "");
    row("busy any case", "K50 busy\r", "", Format::Unusable, keep, keep, keep, keepCount, "");
    row("exit", "EXIT\r", "", Format::Unusable, keep, keep, keep, keepCount, "");
    row("empty", "", "", Format::Unusable, keep, keep, keep, keepCount, "");
    row("error", "ERROR\r", "", Format::Error, keep, keep, keep, keepCount, "");
}

void StatusReplyTest::fields() {
    QFETCH(QString, reply);
    QFETCH(QString, current);
    const StatusReply r = parseStatusReply(reply, current);
    QTEST(r.format, "format");
    QTEST(shown(r.modelCode), "model");
    QTEST(shown(r.firmwareVersion), "version");
    QTEST(shown(r.serialNumber), "serial");
    QTEST(shown(r.numLogged), "logged");
    QTEST(r.capabilityText, "capabilities");
}

void StatusReplyTest::flags_data() {
    QTest::addColumn<QString>("reply");
    QTest::addColumn<QString>("current");
    QTest::addColumn<bool>("k5");
    QTest::addColumn<bool>("log");
    QTest::addColumn<bool>("glp");
    QTest::addColumn<bool>("autoLog");
    QTest::addColumn<bool>("stir");
    QTest::addColumn<bool>("voltage");
    QTest::addColumn<bool>("batteryLow");
    QTest::addColumn<bool>("versionQuery");
    // Flags in column order: k5, log, glp, autoLog, stir, voltage, batteryLow, versionQuery.
    auto row = [](const char* tag, const QString& reply, const QString& current,
                  const char* flags) {
        auto& data = QTest::newRow(tag) << reply << current;
        for (int i = 0; i < 8; ++i)
            data << (flags[i] == '1');
    };

    row("K5AC", "K5AC 0012 +m\r", "", "11011000");
    row("K5AH", "K5AH 0034 + 12345\r", "", "11110000");
    row("K5AH low battery", "K5AH 0034 +B 12345\r", "", "11110010");
    // Letters match in either case, anywhere in a K5 reply.
    row("K5ACMV stirrer by case", "K5ACMV 0003\r", "", "11001100");
    row("K5 no space uses held model", "K5\r", "K5AH", "11100000");
    row("K51 plain", "K51 V1 S1 0001\r", "", "00000000");
    row("K50 plain", "K50 V1 S1 0001\r", "", "01100000");
    row("plain letters ignored", "K50 +m S1 B001\r", "", "01100000");
    row("QR32", "QR32 0001 \r", "", "01000001");
    row("ZUM410", "ZUM410 0042 \r", "", "01000001");
    row("unreadable plain held K51", "AB\r", "K51", "00000000");
    row("percent n", "P1 1 S +m%n\r", "", "00011000");
    row("percent g", "P1 1 S 5 v%g\r", "", "01000100");
    row("percent l", "P1 1 S Vb%l\r", "", "00100110");
    row("percent upper N is neither", "P1 1 S 5 %N\r", "", "01100000");
    row("percent K5 family", "K5XP 1 S 5 M%\r", "", "11101000");
    row("percent K50 not family", "K50P 1 S 5 %g\r", "", "01000000");
}

void StatusReplyTest::flags() {
    QFETCH(QString, reply);
    QFETCH(QString, current);
    const StatusReply r = parseStatusReply(reply, current);
    QTEST(r.isK5Family, "k5");
    QTEST(r.hasLog, "log");
    QTEST(r.hasGLP, "glp");
    QTEST(r.canAutoLog(), "autoLog");
    QTEST(r.canStir(), "stir");
    QTEST(r.reportsVoltage(), "voltage");
    QTEST(r.batteryLow(), "batteryLow");
    QTEST(r.needsVersionQuery, "versionQuery");
}

void StatusReplyTest::versionReply_data() {
    QTest::addColumn<QString>("reply");
    QTest::addColumn<QString>("version");
    QTest::addColumn<QString>("serial");
    auto row = [](const char* tag, const QString& reply, const QString& version,
                  const QString& serial) { QTest::newRow(tag) << reply << version << serial; };
    row("full", "QR32VER 1.5 A12345\r", "1.5", "A12345");
    row("exactly 18", "QR32VER 1.5 A12345", "1.5", "A12345");
    row("17 characters", "QR32VER 1.5 A1234", "", "");
    row("empty", "", "", "");
    row("high bytes",
        latin1("\xff\xff\xff\xff\xff\xff\xff\xff\xe9\x01"
               "2 "
               "\x80\x81\x82\x83\x84\x85\r"),
        latin1("\xe9\x01"
               "2"),
        latin1("\x80\x81\x82\x83\x84\x85"));
}

void StatusReplyTest::versionReply() {
    QFETCH(QString, reply);
    StatusReply r = parseStatusReply("ZUM410 0042 \r", "");
    parseVersionReply(reply, r);
    QTEST(shown(r.firmwareVersion), "version");
    QTEST(shown(r.serialNumber), "serial");
}

void StatusReplyTest::count_data() {
    QTest::addColumn<QString>("field");
    QTest::addColumn<int>("value");
    QTest::newRow("leading zeros") << "0042" << 42;
    QTest::newRow("padded") << "  12" << 12;
    QTest::newRow("zero") << "0000" << 0;
    QTest::newRow("empty") << "" << keepCount;
    QTest::newRow("spaces") << "    " << keepCount;
    QTest::newRow("letter") << "00x2" << keepCount;
    QTest::newRow("sign") << "-012" << keepCount;
    QTest::newRow("plus") << "+012" << keepCount;
    QTest::newRow("inner space") << "0 12" << keepCount;
    QTest::newRow("superscript") << latin1("\xb2\xb3") << keepCount;
    QTest::newRow("overflow") << "99999999999" << keepCount;
    QTest::newRow("largest") << "2147483647" << 2147483647;
}

void StatusReplyTest::count() {
    QFETCH(QString, field);
    QTEST(shown(parseCount(field)), "value");
}

void StatusReplyTest::randomReplies() {
    // Replies glued from pieces that steer the parser down every path, plus any byte: the
    // parser must neither crash nor deliver a field that breaks the reply's own rules.
    const QStringList pieces = {"K5",  "K51", "K50", "AH", "QR32", "ZUM410", "QR34", " ", " ",
                                "%",   "n",   "l",   "g",  "\r",   "0042",   "+",    "m", "B",
                                "ERR", "OR",  "9",   "v",  "\n",   "\t",     "\x01"};
    QRandomGenerator random(20261206);
    for (int i = 0; i < 20000; ++i) {
        QString reply;
        const int parts = random.bounded(12);
        for (int p = 0; p < parts; ++p) {
            if (random.bounded(4) == 0)
                reply += QChar(char16_t(1 + random.bounded(255)));
            else
                reply += pieces[random.bounded(pieces.size())];
        }
        StatusReply r = parseStatusReply(reply, random.bounded(2) ? "QR32" : "K5AH");
        if (r.needsVersionQuery)
            parseVersionReply(reply, r);
        QVERIFY2(!r.numLogged || *r.numLogged >= 0, qPrintable(reply));
        QVERIFY2(r.capabilityText.size() <= reply.size(), qPrintable(reply));
        if (r.format == Format::Percent || r.format == Format::Plain)
            QVERIFY2(!r.modelCode || !r.modelCode->contains(u' '), qPrintable(reply));
    }
}

QTEST_APPLESS_MAIN(StatusReplyTest)
#include "StatusReply_test.moc"
