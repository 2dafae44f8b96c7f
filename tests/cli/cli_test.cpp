// telvio-cli run as a process against the simulated meter: what it prints, and its exit codes.
#include "ScriptedDialogs.h"
#include "WindowFixture.h"
#include "core/instrument/ModelTable.h"
#include "core/instrument/StatusReply.h"

#include <Meter.h>
#include <QElapsedTimer>
#include <QJsonDocument>
#include <QJsonObject>
#include <QProcess>
#include <QPushButton>
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
    // the same meter, as text and comma-delimited, with a conversion on; so are GLP and max/min
    // records where the meter keeps them.
    void logIsTheWindowsSavedFile() {
        for (const char* name : {"plain", "percent-log", "qr32", "k5ah", "qr34"}) {
            ScriptedDialogs dialogs;
            WindowFixture f(&dialogs);
            QVERIFY(f.startMeter(name));
            f.meter->setLogRecords(metersim::Meter::generateLog(f.meter->profile(), 30));
            f.settings.set("mS", "1");
            f.createWindow().controls().tmrDetectMeter->setInterval(1);
            f.start();
            QVERIFY(f.waitUntil([&] { return !f.state().modelCode.isEmpty(); }));
            // The window saves, then the tool, which needs the port, does the same.
            auto same = [&](QPushButton* fetch, const QString& file, const QStringList& args) {
                fetch->click();
                dialogs.answerSave(f.settings.folder() + file, file.endsWith("csv"));
                f.c().cmdSaveFile->click();
                QFile saved(f.settings.folder() + file);
                f.serial.close();
                const Run r = cli(args + QStringList{"-p", f.meter->portPath()});
                f.serial.open(f.meter->portPath(), "baud=9600 parity=N data=8 stop=1");
                return r.code == 0 && saved.open(QIODevice::ReadOnly) && saved.size() > 0 &&
                       r.out == saved.readAll();
            };
            QVERIFY(same(f.c().cmdLoggedData, "/a.txt", {"log", "--convert=mS"}));
            QCOMPARE(f.state().workspaceText.count(name == QString("qr32") ? '\r' : '\n'), 30);
            QVERIFY(same(f.c().cmdLoggedData, "/a.csv", {"log", "--csv", "--convert=mS"}));
            if (name == QString("plain"))
                QVERIFY(same(f.c().cmdGLPData, "/g.txt", {"glp"}));
            if (name == QString("qr34"))
                QVERIFY(same(f.c().cmdMaxMin, "/m.txt", {"maxmin"}));
        }
    }

    // Listening prints each line as its CR arrives (a script sees it at once), and SIGTERM ends
    // it as Stop does: "Z" to the meter, exit code 0, every line received written.
    void listenUntilTerminated() {
        metersim::Meter meter(metersim::profile("plain"));
        QVERIFY(meter.start());
        QProcess p;
        p.start(TELVIO_CLI_PATH, {"listen", "--timestamps", "-p", meter.portPath()});
        QVERIFY(QTest::qWaitFor([&] { return meter.count("?S\r") > 0; }, 5000));
        QTest::qWait(300); // the drain
        meter.sendUnsolicited("  7.00 pH\r\nERROR\r\n  7.01 pH\r\npart");
        QVERIFY(QTest::qWaitFor([&] { return p.canReadLine() && p.peek(99).count('\n') == 2; }));
        p.terminate();
        QVERIFY(p.waitForFinished(3000) && p.exitCode() == 0 &&
                meter.waitForReceived("Z", 1, 1000));
        const QList<QByteArray> lines = p.readAll().split('\n');
        QCOMPARE(lines.size(), 3);
        QCOMPARE(lines[1].mid(19), "   7.01 pH"); // after the ISO 8601 time and a space
    }

    // Timed readings: one "?D" per reading on the schedule, each laid out and numbered as the
    // window numbers its lines; the window's interval minimums apply.
    void readOnSchedule() {
        metersim::Meter meter(metersim::profile("percent-log"));
        QVERIFY(meter.start());
        QElapsedTimer took;
        took.start();
        const Run r = cli({"read", "--interval", "1", "--count", "3", "-p", meter.portPath()});
        QVERIFY(r.code == 0 && took.elapsed() >= 2000 && meter.count("?D\r") == 3);
        const QList<QByteArray> lines = r.out.split('\n');
        QVERIFY(lines.size() == 5 && lines[0].contains("Log#"));
        for (int i = 1; i <= 3; ++i)
            QCOMPARE(lines[i].mid(lines[0].indexOf("Log#"), 4),
                     QByteArray::number(i).rightJustified(4));
        const Run slow = cli({"read", "--interval", "1", "-b", "1200", "-p", meter.portPath()});
        QVERIFY(slow.code == 2 && slow.err.contains("at 1200  baud"));
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
        // A meter whose GLP block never ends cannot hold the tool.
        metersim::Meter endless(metersim::profile("plain"));
        QVERIFY(endless.start());
        endless.setRecordLines("?G", QList<QByteArray>(1200, "Std 1  12.88mS\r"));
        const Run glp = cli({"glp", "-p", endless.portPath()});
        QVERIFY(glp.code == 5 && glp.out.count('\n') == 1000);
        const Run version = cli({"--version"});
        QVERIFY(version.code == 0 && version.out.startsWith("telvio-cli 1."));
    }
};

QTEST_MAIN(CliTest)
#include "cli_test.moc"
