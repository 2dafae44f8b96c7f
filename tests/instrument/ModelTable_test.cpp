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
    QTest::newRow("K5AC") << "K5AC"
                          << "K5AC";
    QTest::newRow("K5AC suffix") << "K5AC12"
                                 << "K5AC";
    QTest::newRow("K5ACMV beats K5AC") << "K5ACMV"
                                       << "K5ACMV";
    QTest::newRow("K5AD") << "K5AD"
                          << "K5ACMV";
    QTest::newRow("K5E") << "K5E1"
                         << "K5E";
    QTest::newRow("K5G") << "K5G"
                         << "K5G";
    QTest::newRow("K5GJ beats K5G") << "K5GJ7"
                                    << "K5GJ";
    QTest::newRow("K5AH") << "K5AHX"
                          << "K5AH";
    QTest::newRow("K5J") << "K5J"
                         << "K5J";
    QTest::newRow("lower case not normalised") << "k5ac"
                                               << "k5ac";
    QTest::newRow("unknown kept") << "K5Z9"
                                  << "K5Z9";
    QTest::newRow("empty") << ""
                           << "";
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

    QTest::newRow("K5AC") << "K5AC" << true << true << true << false << false << false << 0 << "?G";
    QTest::newRow("K5AH") << "K5AH" << true << true << true << false << false << false << 0 << "?J";
    QTest::newRow("K5AHX is not K5AH")
        << "K5AHX" << true << true << true << false << false << false << 0 << "?G";
    QTest::newRow("K51") << "K51" << false << false << false << false << false << false << 0
                         << "?G";
    QTest::newRow("K51 longer") << "K51B" << false << false << false << false << false << false << 0
                                << "?G";
    QTest::newRow("K50") << "K50" << false << true << true << false << false << false << 0 << "?G";
    QTest::newRow("K50V3") << "K50V3" << false << true << true << false << false << false << 2
                           << "?G";
    QTest::newRow("K50V3 longer") << "K50V35" << false << true << true << false << false << false
                                  << 0 << "?G";
    QTest::newRow("LXT anywhere") << "AB-LXT9" << false << true << true << false << false << false
                                  << 2 << "?G";
    QTest::newRow("LXT any case") << "lxt" << false << true << true << false << false << false << 2
                                  << "?G";
    QTest::newRow("QR32") << "QR32" << false << true << false << true << true << false << 0 << "?G";
    QTest::newRow("ZUM410") << "ZUM410" << false << true << true << true << false << false << 0
                            << "?G";
    QTest::newRow("QR32 longer") << "QR321" << false << true << true << false << false << false << 0
                                 << "?G";
    QTest::newRow("QR34 longer") << "QR34ZZ" << false << true << true << false << false << true << 0
                                 << "?G";
    QTest::newRow("qr34 lower") << "qr34" << false << true << true << false << false << false << 0
                                << "?G";
    QTest::newRow("k5 lower") << "k5ac" << false << true << true << false << false << false << 0
                              << "?G";
    QTest::newRow("empty") << "" << false << true << true << false << false << false << 0 << "?G";
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
