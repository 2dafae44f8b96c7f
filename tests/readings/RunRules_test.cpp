// Real-time interval validation and the schedule arithmetic.
#include "readings/IntervalRule.h"
#include "readings/ReadingSchedule.h"

#include <QtTest>

using Kind = ReadingSchedule::Next::Kind;
Q_DECLARE_METATYPE(Kind)

class RunRulesTest : public QObject {
    Q_OBJECT
private slots:
    void interval_data();
    void interval();
    void next_data();
    void next();
    void dueFromRunStart();
    void countdown_data();
    void countdown();
    void countdownFiveToOne();
    void twentieths_data();
    void twentieths();
};

void RunRulesTest::interval_data() {
    QTest::addColumn<QString>("entry");
    QTest::addColumn<int>("baud");
    QTest::addColumn<QString>("model");
    QTest::addColumn<int>("seconds"); // 0 = rejected
    QTest::addColumn<QString>("message");

    const QString numeric = QStringLiteral("Log interval must be numeric.");
    const QString whole = QStringLiteral("Please specify log interval in whole seconds.");
    const QString maximum = QStringLiteral("Maximum  log  interval  is  3600  seconds");
    QTest::newRow("2 at 1200") << "2" << 1200 << "K50" << 0
                               << "Minimum log interval is 3 second(s) at 1200  baud";
    QTest::newRow("3 at 1200") << "3" << 1200 << "K50" << 3 << QString();
    QTest::newRow("2 at 9600") << "2" << 9600 << "K50" << 2 << QString();
    QTest::newRow("1 at 4800") << "1" << 4800 << "K50" << 0
                               << "Minimum log interval is 2 second(s) at 4800  baud";
    QTest::newRow("4 at 300") << "4" << 300 << "K50" << 0
                              << "Minimum log interval is 5 second(s) at 300  baud";
    QTest::newRow("0 at 9600") << "0" << 9600 << "K50" << 0
                               << "Minimum log interval is 1 second(s) at 9600  baud";
    QTest::newRow("-5") << "-5" << 9600 << "K50" << 5 << QString();
    QTest::newRow("2.5") << "2.5" << 9600 << "K50" << 0 << whole;
    QTest::newRow("-2.5") << "-2.5" << 9600 << "K50" << 0 << whole;
    QTest::newRow("7.0") << "7.0" << 9600 << "K50" << 7 << QString();
    QTest::newRow("blanks around") << " 7 " << 9600 << "K50" << 7 << QString();
    QTest::newRow("exponent") << "1e3" << 9600 << "K50" << 1000 << QString();
    QTest::newRow("letters") << "abc" << 9600 << "K50" << 0 << numeric;
    QTest::newRow("digits and letters") << "12s" << 9600 << "K50" << 0 << numeric;
    QTest::newRow("empty") << "" << 9600 << "K50" << 0 << numeric;
    QTest::newRow("inf") << "inf" << 9600 << "K50" << 0 << numeric;
    QTest::newRow("nan") << "nan" << 9600 << "K50" << 0 << numeric;
    QTest::newRow("3601") << "3601" << 9600 << "K50" << 0 << maximum;
    QTest::newRow("-3601") << "-3601" << 9600 << "K50" << 0 << maximum;
    QTest::newRow("3600") << "3600" << 9600 << "K50" << 3600 << QString();
    QTest::newRow("LXT model, 1 s") << "1" << 9600 << "LXT20" << 0
                                    << "Minimum log interval is 2 seconds for LXT20 model "
                                       "instrument.";
    QTest::newRow("lxt in lower case") << "1" << 9600 << "pLxt" << 0
                                       << "Minimum log interval is 2 seconds for pLxt model "
                                          "instrument.";
    QTest::newRow("LXT model, 2 s") << "2" << 9600 << "LXT20" << 2 << QString();
    QTest::newRow("K50V3, 1 s") << "1" << 19200 << "K50V3" << 0
                                << "Minimum log interval is 2 seconds for K50V3 model "
                                   "instrument.";
    QTest::newRow("K50V31 is another model") << "1" << 19200 << "K50V31" << 1 << QString();
    QTest::newRow("LXT at 1200: the line is slower still")
        << "2" << 1200 << "LXT" << 0 << "Minimum log interval is 3 second(s) at 1200  baud";
}

void RunRulesTest::interval() {
    QFETCH(QString, entry);
    QFETCH(int, baud);
    QFETCH(QString, model);
    QFETCH(int, seconds);
    QFETCH(QString, message);
    const auto r = IntervalRule::check(entry, baud, model);
    QCOMPARE(r.accepted, seconds > 0);
    QCOMPARE(r.seconds, seconds);
    QCOMPARE(r.message, message);
}

void RunRulesTest::next_data() {
    QTest::addColumn<double>("due");
    QTest::addColumn<double>("now");
    QTest::addColumn<Kind>("kind");
    QTest::addColumn<int>("ms");

    QTest::newRow("120 s away") << 120.0 << 0.0 << Kind::Long << 120000;
    QTest::newRow("62 s away") << 120.0 << 58.0 << Kind::Long << 62000;
    QTest::newRow("exactly 60 s") << 120.0 << 60.0 << Kind::Long << 60000;
    QTest::newRow("just under 60 s") << 120.0 << 60.001 << Kind::Short << 59999;
    QTest::newRow("4 s away") << 120.0 << 116.0 << Kind::Short << 4000;
    QTest::newRow("1 ms away") << 10.0 << 9.999 << Kind::Short << 1;
    QTest::newRow("due now") << 10.0 << 10.0 << Kind::Now << 0;
    QTest::newRow("less than half a ms late") << 10.0 << 10.0004 << Kind::Now << 0;
    QTest::newRow("overdue") << 10.0 << 10.002 << Kind::Overdue << -2;
    QTest::newRow("far overdue") << 10.0 << 25.0 << Kind::Overdue << -15000;
}

void RunRulesTest::next() {
    QFETCH(double, due);
    QFETCH(double, now);
    QFETCH(Kind, kind);
    QFETCH(int, ms);
    const auto n = ReadingSchedule::next(due, now);
    QCOMPARE(n.kind, kind);
    QCOMPARE(n.ms, ms);
}

void RunRulesTest::dueFromRunStart() {
    // A reading that came late does not move the next one: due times depend only on the start.
    QCOMPARE(ReadingSchedule::dueTime(100.0, 3, 120.0), 460.0);
    const double start = 86395.0; // five seconds before a midnight on a seconds-of-day clock
    const auto n = ReadingSchedule::next(ReadingSchedule::dueTime(start, 2, 5.0), start + 5.7);
    QCOMPARE(n.kind, Kind::Short);
    QCOMPARE(n.ms, 4300);
}

void RunRulesTest::countdown_data() {
    QTest::addColumn<double>("now");
    QTest::addColumn<int>("secs");
    QTest::addColumn<bool>("tick");
    QTest::addColumn<int>("tickMs");
    // due = 5 throughout
    QTest::newRow("just after the reading") << 0.01 << 5 << true << 990;
    QTest::newRow("4 left") << 1.0 << 4 << true << 1000;
    QTest::newRow("half: to even, down") << 2.5 << 2 << true << 1500;
    QTest::newRow("half: to even, up") << 3.5 << 2 << true << 500;
    QTest::newRow("1 left: rests") << 4.0 << 1 << false << 0;
    QTest::newRow("late: 0 left") << 5.2 << 0 << true << 800;
}

void RunRulesTest::countdown() {
    QFETCH(double, now);
    QFETCH(int, secs);
    QFETCH(bool, tick);
    QFETCH(int, tickMs);
    const auto c = ReadingSchedule::countdown(5.0, now);
    QCOMPARE(c.secs, secs);
    QCOMPARE(c.tick, tick);
    QCOMPARE(c.tickMs, tickMs);
}

void RunRulesTest::countdownFiveToOne() {
    // Following the ticks from just after a reading shows 5, 4, 3, 2, 1 and then rests.
    const double due = 5.0;
    double now = 0.02;
    QList<int> shown;
    for (int guard = 0; guard < 10; ++guard) {
        const auto c = ReadingSchedule::countdown(due, now);
        shown << c.secs;
        if (!c.tick)
            break;
        now += c.tickMs / 1000.0 + 0.003; // timers fire a little late
    }
    QCOMPARE(shown, (QList<int>{5, 4, 3, 2, 1}));
}

void RunRulesTest::twentieths_data() {
    QTest::addColumn<int>("count");
    QTest::addColumn<int>("total");
    QTest::addColumn<int>("p");
    QTest::newRow("start") << 0 << 40 << 0;
    QTest::newRow("0.5 to even") << 1 << 40 << 0;
    QTest::newRow("1.5 to even") << 3 << 40 << 2;
    QTest::newRow("2.5 to even") << 5 << 40 << 2;
    QTest::newRow("17.5 to even") << 7 << 8 << 18;
    QTest::newRow("all") << 40 << 40 << 20;
    QTest::newRow("more than announced") << 41 << 40 << 20;
    QTest::newRow("three records, first") << 1 << 3 << 7;
}

void RunRulesTest::twentieths() {
    QFETCH(int, count);
    QFETCH(int, total);
    QFETCH(int, p);
    QCOMPARE(ReadingSchedule::twentieths(count, total), p);
}

QTEST_APPLESS_MAIN(RunRulesTest)
#include "RunRules_test.moc"
