// Settings in a temporary store: defaults of a fresh account, broken values, exact write-back.
#include "PromptRecorder.h"
#include "TestSettings.h"
#include "shell/AppState.h"
#include "shell/Settings.h"

#include <QDir>
#include <QTest>

class SettingsTest : public QObject {
    Q_OBJECT

private slots:
    void freshAccountDefaults() {
        TestSettings store;
        store.clearFirstRun();
        AppState s;
        PromptRecorder prompts;
        bool firstRun = false;
        QVERIFY(Settings::LoadSettings(s, prompts, &firstRun));
        QCOMPARE(s.portName, QStringLiteral("COM1"));
        QCOMPARE(s.portDevicePath, QStringLiteral("\\\\.\\COM1"));
        QCOMPARE(s.baudRate, 9600);
        QCOMPARE(s.logInterval, 1.0);
        QCOMPARE(s.convertAsterisks, qint16(0));
        QCOMPARE(s.convertMsToUs, qint16(0));
        QCOMPARE(s.convertPpkToPpm, qint16(0));
        QCOMPARE(s.catalogDrive, QStringLiteral("d:"));
        QVERIFY(firstRun);
        QVERIFY(prompts.shown.isEmpty());
        // The next start is not a first run.
        AppState again;
        QVERIFY(Settings::LoadSettings(again, prompts, &firstRun));
        QVERIFY(!firstRun);
        QCOMPARE(store.firstRunValue(), QStringLiteral("False"));
    }

    void brokenBaudStopsTheLoad() {
        TestSettings store;
        store.clearFirstRun();
        store.set(QStringLiteral("COM"), QStringLiteral("COM4"));
        store.set(QStringLiteral("Baud"), QStringLiteral("abc"));
        AppState s;
        PromptRecorder prompts;
        bool firstRun = true;
        QVERIFY(!Settings::LoadSettings(s, prompts, &firstRun));
        QCOMPARE(prompts.texts(), QStringList{QStringLiteral(
                                      "An error occured while retrieving program settings.")});
        QCOMPARE(prompts.shown.first().icon, Prompts::Icon::Information);
        QCOMPARE(s.portName, QStringLiteral("COM4"));
        QCOMPARE(s.baudRate, 0);
        QCOMPARE(s.catalogDrive, QString());
        QVERIFY(!firstRun);
        QCOMPARE(store.firstRunValue(), QString()); // the first-run check was not made
    }

    void badValuesNeverCrash_data() {
        QTest::addColumn<QString>("key");
        QTest::addColumn<QString>("value");
        QTest::addColumn<bool>("loads");
        auto row = [](const char* tag, const char* key, const QString& value, bool loads) {
            QTest::newRow(tag) << QString(key) << value << loads;
        };
        row("empty baud", "Baud", "", false);
        row("huge baud", "Baud", "99999999999999", false);
        row("negative baud", "Baud", "-5", true);
        row("infinite interval", "LogInvterval", "1e999", false);
        row("text interval", "LogInvterval", "soon", false);
        row("16-bit overflow", "Asterisk", "70000", false);
        row("long drive", "Drive", QString(100000, QLatin1Char('x')), true);
        row("blanks around", "Baud", " 19200 ", true);
    }
    void badValuesNeverCrash() {
        QFETCH(QString, key);
        QFETCH(QString, value);
        QFETCH(bool, loads);
        TestSettings store;
        store.markFirstRunDone();
        store.set(key, value);
        AppState s;
        PromptRecorder prompts;
        QCOMPARE(Settings::LoadSettings(s, prompts), loads);
        QCOMPARE(prompts.shown.size(), loads ? 0 : 1);
    }

    void writesBackWhatItRead_data() {
        QTest::addColumn<QString>("baud");
        QTest::addColumn<QString>("interval");
        auto row = [](const char* tag, const char* baud, const char* interval) {
            QTest::newRow(tag) << QString(baud) << QString(interval);
        };
        row("defaults", "9600", "1");
        row("half second", "19200", "0.5");
        row("thirty", "1200", "30");
        row("hour", "38400", "3600");
    }
    void writesBackWhatItRead() {
        QFETCH(QString, baud);
        QFETCH(QString, interval);
        TestSettings store;
        store.markFirstRunDone();
        store.set(QStringLiteral("Baud"), baud);
        store.set(QStringLiteral("LogInvterval"), interval);
        store.set(QStringLiteral("Asterisk"), QStringLiteral("1"));
        store.set(QStringLiteral("Drive"), QStringLiteral("e:"));
        AppState s;
        PromptRecorder prompts;
        QVERIFY(Settings::LoadSettings(s, prompts));
        QVERIFY(Settings::SaveSettings(s, prompts));
        QCOMPARE(store.value(QStringLiteral("Baud")), baud);
        QCOMPARE(store.value(QStringLiteral("LogInvterval")), interval);
        QCOMPARE(store.value(QStringLiteral("Asterisk")), QStringLiteral("1"));
        QCOMPARE(store.value(QStringLiteral("mS")), QStringLiteral("0"));
        QCOMPARE(store.value(QStringLiteral("COM")), QStringLiteral("COM1"));
        QCOMPARE(store.value(QStringLiteral("Drive")), QStringLiteral("e:"));
        QVERIFY(!store.contains(QStringLiteral("LogInterval")));
    }

    void setPortName() {
        AppState s;
        Settings::SetPortName(s, QStringLiteral("COM12"));
        QCOMPARE(s.portName, QStringLiteral("COM12"));
        QCOMPARE(s.portDevicePath, QStringLiteral("\\\\.\\COM12"));
    }

    void dataFolderAndFileExists() {
        TestSettings store;
        const QString docs = store.folder() + QStringLiteral("/docs");
        const QString folder = Settings::EnsureDataFolder(docs);
        QCOMPARE(folder, docs + QStringLiteral("/Telvio"));
        QVERIFY(QDir(folder).exists());
        QCOMPARE(Settings::EnsureDataFolder(docs), folder); // again: nothing fails
        QVERIFY(!Settings::FileExists(folder));             // a directory is not a file
        QFile file(folder + QStringLiteral("/a.txt"));
        QVERIFY(file.open(QIODevice::WriteOnly));
        file.close();
        QVERIFY(Settings::FileExists(folder + QStringLiteral("/a.txt")));
        QVERIFY(!Settings::FileExists(folder + QStringLiteral("/b.txt")));
    }
};

QTEST_GUILESS_MAIN(SettingsTest)
#include "settings_test.moc"
