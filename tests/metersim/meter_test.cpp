// What the simulated meter must get right for the window tests to mean anything: every profile
// answers in a format the program's own rules read, and the meter paces its bytes at a chosen
// baud rate and records every byte it received, with its time.
#include "Meter.h"
#include "RecordFormat.h"
#include "core/instrument/StatusReply.h"
#include "core/readings/HeaderPosition.h"
#include "core/readings/LogLineFormat.h"
#include "core/readings/RealTimeLine.h"

#include <QElapsedTimer>
#include <QSerialPort>
#include <QtTest>

using metersim::Meter;
using metersim::RecordFormat;

namespace {

// Writes bytes to the meter and reads its CR-ended reply.
QByteArray ask(QSerialPort& port, const QByteArray& bytes) {
    port.write(bytes);
    QByteArray reply;
    while (!reply.endsWith('\r') && port.waitForReadyRead(1000))
        reply += port.readAll();
    return reply;
}

} // namespace

class MeterTest : public QObject {
    Q_OBJECT
private slots:
    void profilesAnswerTheirFormats() {
        for (const QString& name : metersim::profileNames()) {
            Meter meter(metersim::profile(name));
            QVERIFY(meter.start());
            QSerialPort port(meter.portPath());
            QVERIFY(port.open(QIODevice::ReadWrite));
            const StatusReply status = parseStatusReply(ask(port, "?S\r"), QString());
            AppState s;
            s.modelCode = status.modelCode.value_or("");
            s.percentFormat = status.format == StatusReply::Format::Percent;
            s.hasLog = status.hasLog;
            s.isK5Family = status.isK5Family;
            QVERIFY2(!s.modelCode.isEmpty() && s.hasLog == meter.profile().hasLog,
                     qPrintable(name));
            QCOMPARE(status.numLogged.value_or(3), 3);
            const LineLayout layout = LineLayout::fromState(s);
            const auto column = HeaderPosition::findLogColumn(ask(port, "?H\r"), ask(port, "?P\r"));
            const RealTimeLine::Context context{layout, column.found, column.start, column.width,
                                                QDateTime::currentDateTime()};
            const QString reading = ask(port, "?D\r");
            QVERIFY2(RealTimeLine::build(reading, 7, context).value_or("").contains("   7"),
                     qPrintable(reading));
            // The first record and the 10,000th, days later.
            for (const QString record : {RecordFormat::record(meter.profile(), 0),
                                         RecordFormat::record(meter.profile(), 9999)}) {
                const auto line = layout.qr32 ? LogLineFormat::qr32Record(record)
                                              : LogLineFormat::reformat(record, layout);
                QVERIFY2(line && (layout.percentFormat ||
                                  line->contains(QRegularExpression("^0[18]/03[ /]"))),
                         qPrintable(record));
            }
        }
    }

    void pacesAndRecordsBytes() {
        Meter meter(metersim::profile("plain"));
        QVERIFY(meter.start());
        meter.setBaud(2400);
        QSerialPort port(meter.portPath());
        QVERIFY(port.open(QIODevice::ReadWrite));
        QElapsedTimer timer;
        timer.start();
        // 24 bytes of 10 bits at 2400 baud take 100 ms.
        QCOMPARE(ask(port, "\xfe?S\r"), "CD200 V1.21 012345 0003\r");
        QVERIFY(timer.elapsed() >= 90);
        ask(port, "?D\r");
        QCOMPARE(meter.received(), "\xfe?S\r?D\r");
        const QList<double> s = meter.commandTimes("?S\r"), d = meter.commandTimes("?D\r");
        QVERIFY(s.size() == 1 && d.size() == 1 && d[0] - s[0] >= 0.09);
    }
};

QTEST_GUILESS_MAIN(MeterTest)
#include "meter_test.moc"
