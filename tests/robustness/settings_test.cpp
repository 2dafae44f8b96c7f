// Starting the program with settings another program, a user or a damaged disk left behind:
// garbage in the settings file, values of the wrong type, very long values.
#include "DialogDriver.h"
#include "ModalDismisser.h"
#include "WindowFixture.h"
#include "link/Connection.h"
#include "shell/Settings.h"

#include <QAction>
#include <QDir>
#include <QLabel>
#include <QPushButton>
#include <QRandomGenerator>
#include <QSettings>
#include <QTest>

namespace {
const QString kRetrieveError = QString::fromLatin1(Settings::kRetrieveError);

QString settingsFile() {
    QSettings s(QStringLiteral("Telvio"), QStringLiteral("Telvio"));
    return s.fileName();
}

bool writeFile(const QString& path, const QByteArray& bytes) {
    QDir().mkpath(QFileInfo(path).path());
    QFile f(path);
    return f.open(QIODevice::WriteOnly) && f.write(bytes) == bytes.size();
}
} // namespace

class SettingsStressTest : public QObject {
    Q_OBJECT

private slots:
    void cleanup() {
        const QStringList failures = DialogDriver::takeFailures();
        QVERIFY2(failures.isEmpty(), qPrintable(failures.join(u'\n')));
    }

    // Values the port line survives: the meter is still found, a broken value is reported
    // once, and the window works.
    void badValueAfterThePort_data() {
        QTest::addColumn<QString>("key");
        QTest::addColumn<QVariant>("value");
        QTest::addColumn<bool>("reported");
        QTest::newRow("interval as a map")
            << "LogInvterval" << QVariant(QVariantMap{{"a", 1}}) << true;
        QTest::newRow("asterisk as bytes")
            << "Asterisk" << QVariant(QByteArray("\x01\xff")) << true;
        QTest::newRow("interval of a million digits")
            << "LogInvterval" << QVariant(QString(1000000, QLatin1Char('9'))) << true;
        QTest::newRow("drive of a million characters")
            << "Drive" << QVariant(QString(1000000, QLatin1Char('d'))) << false;
        QTest::newRow("mS with control characters")
            << "mS" << QVariant(QStringLiteral("1\x01\x02\n[x]")) << true;
    }
    void badValueAfterThePort() {
        QFETCH(QString, key);
        QFETCH(QVariant, value);
        QFETCH(bool, reported);
        WindowFixture f;
        QVERIFY(f.startMeter(QStringLiteral("plain")));
        {
            QSettings s(QStringLiteral("Telvio"), QStringLiteral("Telvio"));
            s.setValue(QStringLiteral("Settings/") + key, value);
        }
        f.start();
        QVERIFY(f.waitUntil([&] { return !f.state().modelCode.isEmpty(); }, 8000));
        QCOMPARE(f.prompts.texts(), reported ? QStringList{kRetrieveError} : QStringList{});
        QCOMPARE(f.state().portName, f.meter->portPath());
        QVERIFY(f.c().cmdLoggedData->isEnabled());
    }

    // A settings file of noise (fixed seed, so a failure reproduces) with the port after it.
    void garbageFile_data() {
        QTest::addColumn<QByteArray>("noise");
        QRandomGenerator random(11);
        QByteArray noise(64 * 1024, '\0');
        for (char& b : noise)
            b = char(random.bounded(256));
        QTest::newRow("random bytes") << noise;
        QTest::newRow("broken sections")
            << QByteArray("[Settings\n[[]]\n=\n==\\\n\"\"\"\n[Settings]\n");
        QTest::newRow("nothing but line ends") << QByteArray(100000, '\n');
    }
    void garbageFile() {
        QFETCH(QByteArray, noise);
        WindowFixture f;
        QVERIFY(f.startMeter(QStringLiteral("plain")));
        const QByteArray port = QFile::encodeName(f.meter->portPath());
        QVERIFY(writeFile(settingsFile(),
                          noise + "\n[Settings]\nCOM=" + port + "\nBaud=9600\nLogInvterval=5\n"));
        // The store may give up on the whole file; then the stored port is lost and the
        // program falls back to COM1, which has no meter: any port dialog is cancelled.
        ModalDismisser dismiss;
        f.start();
        const bool portKept = f.state().portName == f.meter->portPath();
        if (portKept) {
            QVERIFY(f.waitUntil([&] { return !f.state().modelCode.isEmpty(); }, 8000));
            QCOMPARE(f.state().logInterval, 5.0);
        }
        QVERIFY(f.prompts.texts().size() <= 1);
        // Usable: the port can be chosen again (as the port dialog does) and the meter found.
        Settings::SetPortName(f.state(), f.meter->portPath());
        f.state().baudRate = 9600;
        f.window->connection().ConnectMeter();
        QVERIFY2(f.waitUntil([&] { return !f.state().modelCode.isEmpty(); }, 8000),
                 qPrintable(f.prompts.texts().join(u'|') + u'|' + dismiss.seen.join(u'|') + u'|' +
                            f.state().portName + u'|' + f.c().lblMessage->text()));
    }

    // A port name of a million characters: no such port; the unavailable dialog offers a way out.
    void veryLongPortName() {
        WindowFixture f;
        QVERIFY(f.startMeter(QStringLiteral("plain")));
        f.settings.set(QStringLiteral("COM"), QString(1000000, QLatin1Char('x')));
        ModalDismisser dismiss;
        f.start();
        QVERIFY(f.waitUntil([&] { return !dismiss.seen.isEmpty(); }, 5000));
        QCOMPARE(dismiss.seen, QStringList{"frmSerialPortUnavailable"}); // not "in use"
        QVERIFY(f.prompts.texts().isEmpty());
        QVERIFY(f.state().modelCode.isEmpty());
        QVERIFY(f.c().cmdOpenFile->isEnabled());
        QVERIFY(!f.c().tmrDetectMeter->isActive());
    }
};

QTEST_MAIN(SettingsStressTest)
#include "settings_test.moc"
