// telvio-cli run as a process against the simulated meter: what it prints, and its exit codes.
#include "ScriptedDialogs.h"
#include "WindowFixture.h"
#include "core/instrument/ModelTable.h"
#include "core/instrument/StatusReply.h"

#include <Meter.h>
#include <QJsonDocument>
#include <QJsonObject>
#include <QProcess>
#include <QTest>

namespace {
struct Run {
    int code;
    QByteArray out, err;
};
Run cli(const QStringList& args) {
    QProcess p;
    p.start(TELVIO_CLI_PATH, args);
    if (!p.waitForFinished(20000))
        return {-1, {}, "did not finish"};
    return {p.exitCode(), p.readAllStandardOutput(), p.readAllStandardError()};
}
} // namespace

class CliTest : public QObject {
    Q_OBJECT
private slots:
    // Every profile: the status the tool prints is what the reply parser makes of the meter's
    // own replies, and the tool asked "?W" exactly where the parser says it is needed.
    void statusFollowsTheParser() {
        for (const QString& name : metersim::profileNames()) {
            metersim::Meter meter(metersim::profile(name));
            QVERIFY(meter.start());
            const Run r = cli({"status", "--json", "-p", meter.portPath(), "--wait", "2"});
            QVERIFY2(r.code == 0, qPrintable(name + ": " + r.err));
            const QJsonObject got = QJsonDocument::fromJson(r.out).object();
            StatusReply s = parseStatusReply(meter.profile().statusReply(3), QString());
            if (s.needsVersionQuery)
                parseVersionReply(meter.profile().secondStatusReply(), s);
            QCOMPARE(got["model"].toString(), s.modelCode.value_or(""));
            QCOMPARE(got["version"].toString() + "|" + got["serial"].toString(),
                     s.firmwareVersion.value_or("") + "|" + s.serialNumber.value_or(""));
            QCOMPARE(got["logged"].toInt(-1), s.hasLog ? s.numLogged.value_or(0) : -1);
            QCOMPARE(QList<bool>({got["glp"].toBool(), got["stirrer"].toBool(),
                                  got["autolog"].toBool(), got["maxmin"].toBool()}),
                     QList<bool>({s.hasGLP, s.canStir(), s.canAutoLog(),
                                  modeltable::keepsMaxMin(*s.modelCode)}));
            QCOMPARE(meter.count("?W\r"), s.needsVersionQuery ? 1 : 0);
        }
    }

    // The log the tool writes is byte for byte the file the window saves after a download from
    // the same meter, as text and comma-delimited, with a conversion on.
    void logIsTheWindowsSavedFile() {
        for (const char* name : {"plain", "percent-log", "qr32", "k5ah"}) {
            ScriptedDialogs dialogs;
            WindowFixture f(&dialogs);
            QVERIFY(f.startMeter(name));
            f.meter->setLogRecords(metersim::Meter::generateLog(f.meter->profile(), 30));
            f.settings.set("mS", "1");
            f.createWindow().controls().tmrDetectMeter->setInterval(1);
            f.start();
            QVERIFY(f.waitUntil([&] { return !f.state().modelCode.isEmpty(); }));
            f.c().cmdLoggedData->click();
            QCOMPARE(f.state().workspaceText.count(name == QString("qr32") ? '\r' : '\n'), 30);
            f.serial.close(); // the tool needs the port
            for (const char* format : {"--convert=mS", "--csv"}) {
                const bool csv = format == QString("--csv");
                const QString saved = f.settings.folder() + (csv ? "/a.csv" : "/a.txt");
                dialogs.answerSave(saved, csv);
                f.c().cmdSaveFile->click();
                QFile file(saved);
                QVERIFY(file.open(QIODevice::ReadOnly));
                const Run r = cli({"log", format, "--convert=mS", "-p", f.meter->portPath()});
                QCOMPARE(r.code, 0);
                QCOMPARE(r.out, file.readAll());
            }
        }
    }

    void exitCodes() {
        metersim::Meter silent(metersim::profile("plain"));
        QVERIFY(silent.start());
        silent.setSilent(true);
        const Run none = cli({"status", "-p", silent.portPath(), "--wait", "0.5"});
        QCOMPARE(none.code, 3);
        QVERIFY(none.err.contains("no meter answered"));
        QVERIFY(silent.count("?S\r") >= 1);
        QCOMPARE(cli({"status", "-p", "/dev/no-such-port"}).code, 4);
        // A meter that vanishes mid-download: the records that came are written, then code 5.
        metersim::Meter gone(metersim::profile("plain"));
        QVERIFY(gone.start());
        gone.setLogRecords(metersim::Meter::generateLog(gone.profile(), 20));
        gone.vanishAfterSending(7);
        const Run cut = cli({"log", "-p", gone.portPath()});
        QCOMPARE(cut.code, 5);
        QCOMPARE(cut.out.count('\n'), 7);
        for (const QStringList& bad :
             {QStringList{"fly"}, {"status", "--wait", "x"}, {"status", "-b", "0"}, {}})
            QCOMPARE(cli(bad).code, 2);
        const Run version = cli({"--version"});
        QVERIFY(version.code == 0 && version.out.startsWith("telvio-cli 1."));
    }
};

QTEST_MAIN(CliTest)
#include "cli_test.moc"
