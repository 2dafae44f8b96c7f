// The readings' text and timing rules without a window: log records, real-time lines, the Log#
// column, the interval entry and the reading schedule. "-" stands for "no result".
#include "core/readings/HeaderPosition.h"
#include "core/readings/IntervalRule.h"
#include "core/readings/LogLineFormat.h"
#include "core/readings/ReadingSchedule.h"
#include "core/readings/RealTimeLine.h"

#include <QtTest>

namespace {

// g general, k K5 family, m marin/lago, q QR32, percent format: p with log, n without log,
// u with log but no Log# column found.
LineLayout layout(char kind) {
    LineLayout l;
    l.isK5Family = kind == 'k';
    l.marinLago = kind == 'm';
    l.qr32 = kind == 'q';
    l.percentFormat = QByteArray("pnu").contains(kind);
    l.hasLog = kind == 'p' || kind == 'u';
    return l;
}

struct Row {
    char kind;
    int number;
    const char* in;
    const char* out;
};

// 36 characters and CR.
const char* kQr32 = "12/03/04 10.15.00  12.34 mS/cm  25.0\r";

} // namespace

class RulesTest : public QObject {
    Q_OBJECT
private slots:
    void logRecord() {
        const Row rows[] = {
            {'g', 0, "R 12/03/2004 10:15:00\r", "12/03/2004 10:15:00 R"},
            {'g', 0, "R 31/12/75 23:59:59\r", "31/12/2075  23:59:59 R"},
            {'g', 0, "R 01/01/76 00:00:00\r", "01/01/1976  00:00:00 R"},
            {'g', 0, "R 12/03/ 4 10:15:00\r", "12/03/2004  10:15:00 R"},
            {'g', 0, "R 12/03/9  10:15:00\r", "12/03/2009  10:15:00 R"},
            {'g', 0, "R 12/03/-- 10:15:00\r", "-"},
            {'g', 0, "R  12/03/2004 10:15:00\r", "12/03/2004 10:15:00 R "},
            {'g', 0, "12/03/2004 10:15:00\r", "12/03/2004 10:15:00 "},
            {'k', 0, "  1.4mS 12/03 10:15\r", "12/03 10:15   1.4mS"},
            {'m', 0, "1.4mS--12/03/2004 10:15\r", "12/03/2004 10:15 1.4mS"},
            {'p', 0, " 12/03/2004 0003 7.00\r", " 12/03/2004 0003 7.00\r"},
            {'g', 0, "2/03/2004 10:15:00\r", "-"},
            {'g', 0, "2/03/04 10:15:00\r", "-"},
            {'k', 0, "2/03 10:15\r", "-"},
            {'m', 0, "-12/03/2004 10:15\r", "-"},
            {'q', 0, kQr32, "12/03/2004 10:15:00  12.34 mS/cm  25.0\r"},
            {'q', 0, "\n12/03/04 10.15.00  12.34 mS/cm  25.0\r",
             "\n12/03/2004 10:15:00  12.34 mS/cm  25.0\r"},
            {'q', 0, "12/03/04 10.15", "-"},
        };
        for (const Row& r : rows) {
            const auto line = r.kind == 'q' ? LogLineFormat::qr32Record(r.in)
                                            : LogLineFormat::reformat(r.in, layout(r.kind));
            QCOMPARE(line.value_or("-"), QString(r.out));
        }
    }

    void realTimeLine() {
        const Row rows[] = {
            {'p', 7, "ABCDEFGHIJK0001XYZ\r", "ABCDEFGHIJK   7XYZ\r"},
            {'p', 12345, "ABCDEFGHIJK0001XYZ\r", "ABCDEFGHIJK1234XYZ\r"},
            {'p', 1234, "ABCDEFGHIJK00", "ABCDEFGHIJK12"},
            {'p', 7, "ABCDEFGHI\r", "-"},
            {'u', 7, "ABCDEFGHIJK0001\r", "ABCDEFGHIJK0001\r"},
            {'n', 7, " 7.00 pH\r", "06/12/2026 09:05:03    7  7.00 pH\r"},
            {'q', 7, kQr32, "12/03/2004 10:15:00    7.34 mS/cm  25.0\r"},
            {'g', 7, "0000  7.03pH 12/03/04 10:15:00\r", "12/03/2004  10:15:00    7  7.03pH"},
            {'k', 10, "0000 1.4mS 12/03 10:15\r", "12/03 10:15   10 1.4mS"},
            {'g', 1, "12\r", "-"},
        };
        const QDateTime now(QDate(2026, 12, 6), QTime(9, 5, 3));
        for (const Row& r : rows) {
            const RealTimeLine::Context c{layout(r.kind), r.kind != 'u', 12, 4, now};
            QCOMPARE(RealTimeLine::build(r.in, r.number, c).value_or("-"), QString(r.out));
        }
    }

    void logColumn() {
        const Row rows[] = {// header|positions
                            {0, 0, " Date Time Log# pH\r|4,2,4,7,4,12,4,17,2\r", "12,4"},
                            {0, 0, "   Date     Time    Log#   pH|4,2,4,7,4,12,4,17,2", "12,4"},
                            {0, 0, " Date Log# pH\r|3,1,4,5,3,9,2\r", "5,3"},
                            {0, 0, " Date Time pH\r|3,2,4,7,4,12,4\r", "-"},
                            {0, 0, " Date Time log# pH\r|4,2,4,7,4,12,4,17,2\r", "-"},
                            {0, 0, " Date Time Log# pH\r|4,2,4,7\r", "-"}};
        for (const Row& r : rows) {
            const QStringList in = QString(r.in).split('|');
            const auto c = HeaderPosition::findLogColumn(in[0], in[1]);
            QCOMPARE(c.found ? QString("%1,%2").arg(c.start).arg(c.width) : "-", QString(r.out));
        }
        QCOMPARE(HeaderPosition::headerFor("pH\r", false), "   Date      Time   Log# pH\r");
    }

    void interval() {
        const Row rows[] = {
            // model (LXT200 or K50), baud, entry, seconds or message
            {'L', 9600, "1", "Minimum log interval is 2 seconds for LXT200 model instrument."},
            {'K', 1200, "2", "Minimum log interval is 3 second(s) at 1200  baud"},
            {'K', 1200, "3", "3"},
            {'K', 4800, "1", "Minimum log interval is 2 second(s) at 4800  baud"},
            {'K', 9600, "2", "2"},
            {'K', 9600, "-5", "5"},
            {'K', 9600, "2.5", "Please specify log interval in whole seconds."},
            {'K', 9600, "ten", "Log interval must be numeric."},
            {'K', 9600, "3601", "Maximum  log  interval  is  3600  seconds"},
            {'K', 9600, "3600", "3600"}};
        for (const Row& r : rows) {
            const auto c = IntervalRule::check(r.in, r.number, r.kind == 'L' ? "LXT200" : "K50");
            QCOMPARE(c.accepted ? QString::number(c.seconds) : c.message, QString(r.out));
        }
    }

    void schedule() {
        using K = ReadingSchedule::Next::Kind;
        const auto next = [](double due, double now) {
            const auto n = ReadingSchedule::next(due, now);
            return QList<int>({int(n.kind), n.ms});
        };
        QCOMPARE(next(120, 60), QList<int>({int(K::Long), 60000}));
        QCOMPARE(next(120, 60.001), QList<int>({int(K::Short), 59999}));
        QCOMPARE(next(10, 10), QList<int>({int(K::Now), 0}));
        QCOMPARE(next(10, 10.002), QList<int>({int(K::Overdue), -2}));
        // From just after a reading, with ticks a little late: 5, 4, 3, 2, 1, then it rests.
        QList<int> shown;
        for (double now = 0.02; shown.size() < 9; now += 0.003) {
            const auto c = ReadingSchedule::countdown(5, now);
            shown << c.secs;
            if (!c.tick)
                break;
            now += c.tickMs / 1000.0;
        }
        QCOMPARE(shown, QList<int>({5, 4, 3, 2, 1}));
        // Halves round to even.
        QCOMPARE(ReadingSchedule::countdown(5, 2.5).secs, 2);
        QCOMPARE(ReadingSchedule::twentieths(5, 40), 2);
    }
};

QTEST_APPLESS_MAIN(RulesTest)
#include "rules_test.moc"
