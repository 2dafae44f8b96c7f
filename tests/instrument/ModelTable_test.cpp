#include "instrument/ModelTable.h"

#include <QTest>

using namespace modeltable;
Q_DECLARE_METATYPE(modeltable::LogLayout)
Q_DECLARE_METATYPE(modeltable::ReadingLayout)

class ModelTableTest : public QObject {
    Q_OBJECT
private slots:
    void k5Normalisation_data();
    void k5Normalisation();
    void modelFacts_data();
    void modelFacts();
    void logLayout_data();
    void logLayout();
    void readingLayout_data();
    void readingLayout();
};

void ModelTableTest::k5Normalisation_data() {
    QTest::addColumn<QString>("word");
    QTest::addColumn<QString>("code");
    auto row = [](const char* tag, const char* word, const char* code) {
        QTest::newRow(tag) << QString(word) << QString(code);
    };
    row("K5AC", "K5AC", "K5AC");
    row("K5AC suffix", "K5AC12", "K5AC");
    row("K5ACMV beats K5AC", "K5ACMV", "K5ACMV");
    row("K5AD", "K5AD", "K5ACMV");
    row("K5E", "K5E1", "K5E");
    row("K5G", "K5G", "K5G");
    row("K5GJ beats K5G", "K5GJ7", "K5GJ");
    row("K5AH", "K5AHX", "K5AH");
    row("K5J", "K5J", "K5J");
    row("lower case not normalised", "k5ac", "k5ac");
    row("unknown kept", "K5Z9", "K5Z9");
    row("empty", "", "");
}

void ModelTableTest::k5Normalisation() {
    QFETCH(QString, word);
    QTEST(normaliseK5Code(word), "code");
}

void ModelTableTest::modelFacts_data() {
    QTest::addColumn<QString>("code");
    QTest::addColumn<bool>("k5");
    QTest::addColumn<bool>("plainLog");
    QTest::addColumn<bool>("plainGlp");
    QTest::addColumn<bool>("qr32Status");
    QTest::addColumn<bool>("qr32Layout");
    QTest::addColumn<bool>("maxMin");
    QTest::addColumn<int>("minimum");
    QTest::addColumn<QString>("enableLoggingPlain");

    // Flags in column order: k5, plainLog, plainGlp, qr32Status, qr32Layout, maxMin.
    auto row = [](const char* tag, const char* code, const char* flags, int minimum,
                  const char* enableLogging) {
        auto& data = QTest::newRow(tag) << QString(code);
        for (int i = 0; i < 6; ++i)
            data << (flags[i] == '1');
        data << minimum << QString(enableLogging);
    };
    row("K5AC", "K5AC", "111000", 0, "?G");
    row("K5AH", "K5AH", "111000", 0, "?J");
    row("K5AHX is not K5AH", "K5AHX", "111000", 0, "?G");
    row("K51", "K51", "000000", 0, "?G");
    row("K51 longer", "K51B", "000000", 0, "?G");
    row("K50", "K50", "011000", 0, "?G");
    row("K50V3", "K50V3", "011000", 2, "?G");
    row("K50V3 longer", "K50V35", "011000", 0, "?G");
    row("LXT anywhere", "AB-LXT9", "011000", 2, "?G");
    row("LXT any case", "lxt", "011000", 2, "?G");
    row("QR32", "QR32", "010110", 0, "?G");
    row("ZUM410", "ZUM410", "011100", 0, "?G");
    row("QR32 longer", "QR321", "011000", 0, "?G");
    row("QR34 longer", "QR34ZZ", "011001", 0, "?G");
    row("qr34 lower", "qr34", "011000", 0, "?G");
    row("k5 lower", "k5ac", "011000", 0, "?G");
    row("empty", "", "011000", 0, "?G");
}

void ModelTableTest::modelFacts() {
    QFETCH(QString, code);
    QTEST(isK5FamilyCode(code), "k5");
    QTEST(plainKeepsLog(code), "plainLog");
    QTEST(plainKeepsGlp(code), "plainGlp");
    QTEST(usesQr32StatusLayout(code), "qr32Status");
    QTEST(usesQr32Layout(code), "qr32Layout");
    QTEST(keepsMaxMin(code), "maxMin");
    QTEST(modelMinimumIntervalSeconds(code), "minimum");
    QTEST(enableLoggingCommand(code, false), "enableLoggingPlain");
    // Percent-format meters always switch logging on with "?J".
    QCOMPARE(enableLoggingCommand(code, true), QStringLiteral("?J"));
    QCOMPARE(k5KeepsGlp(code), code == "K5AH");
    QCOMPARE(k5ReportsSerial(code), code == "K5AH");
}

void ModelTableTest::logLayout_data() {
    QTest::addColumn<QString>("code");
    QTest::addColumn<bool>("k5");
    QTest::addColumn<bool>("percent");
    QTest::addColumn<LogLayout>("layout");
    QTest::newRow("QR32 before percent") << "QR32" << false << true << LogLayout::Qr32;
    QTest::newRow("percent before K5") << "K5AC" << true << true << LogLayout::Percent;
    QTest::newRow("K5 before marin") << "marinK5" << true << false << LogLayout::K5Family;
    QTest::newRow("marin") << "marin2" << false << false << LogLayout::ShortDateTime;
    QTest::newRow("lago") << "lago" << false << false << LogLayout::ShortDateTime;
    QTest::newRow("Marin is exact") << "Marin" << false << false << LogLayout::General;
    QTest::newRow("general") << "K50" << false << false << LogLayout::General;
}

void ModelTableTest::logLayout() {
    QFETCH(QString, code);
    QFETCH(bool, k5);
    QFETCH(bool, percent);
    QTEST(logLayoutFor(code, k5, percent), "layout");
}

void ModelTableTest::readingLayout_data() {
    QTest::addColumn<QString>("code");
    QTest::addColumn<bool>("percent");
    QTest::addColumn<bool>("log");
    QTest::addColumn<ReadingLayout>("layout");
    QTest::newRow("percent before QR32") << "QR32" << true << true << ReadingLayout::PercentWithLog;
    QTest::newRow("percent without log")
        << "P1" << true << false << ReadingLayout::PercentWithoutLog;
    QTest::newRow("QR32") << "QR32" << false << true << ReadingLayout::Qr32;
    QTest::newRow("general") << "K5AC" << false << true << ReadingLayout::General;
}

void ModelTableTest::readingLayout() {
    QFETCH(QString, code);
    QFETCH(bool, percent);
    QFETCH(bool, log);
    QTEST(readingLayoutFor(code, percent, log), "layout");
}

QTEST_APPLESS_MAIN(ModelTableTest)
#include "ModelTable_test.moc"
