// Listening to a meter that is already printing faster than the drain's quiet time.
#include "ReadingsWindow.h"

#include "readings/ListenMode.h"

#include <QApplication>
#include <atomic>
#include <thread>

using namespace readingstest;

class ListenBusyMeterTest : public QObject {
    Q_OBJECT
private slots:
    void printingMeterIsListenedTo() {
        WindowFixture fx;
        QVERIFY(fx.startDetected(QStringLiteral("plain")));
        std::atomic<int> sent{0};
        std::jthread meter([&](std::stop_token stop) {
            for (; !stop.stop_requested();
                 std::this_thread::sleep_for(std::chrono::milliseconds(50)))
                fx.meter->sendUnsolicited(QByteArray::number(++sent) + " 7.00pH\r");
        });
        bool linkDialog = false;
        QTimer::singleShot(4000, fx.window.get(), [&] {
            if (QWidget* d = QApplication::activeModalWidget())
                linkDialog = d->close();
        });
        fx.c().cmdListen->click();
        QVERIFY(fx.waitUntil([&] { return fx.state().workspaceText.count(u'\r') >= 5; }, 4000));
        meter.request_stop();
        meter.join();
        const int last = sent;
        QVERIFY(fx.waitUntil([&] {
            return fx.state().workspaceText.endsWith(QString::number(last) +
                                                     QStringLiteral(" 7.00pH\r"));
        }));
        fx.c().cmdStopCurrentData->click();
        QVERIFY(!linkDialog);
        QVERIFY(!fx.state().abortRequested);
        QVERIFY(commandsBack(fx));
        QVERIFY(fx.meter->waitForReceived("Z", 1, 2000));
        // Every line after the drain is there, in order.
        QStringList got = fx.state().workspaceText.split(u'\r', Qt::SkipEmptyParts);
        for (int i = 1; i < got.size(); ++i)
            QCOMPARE(got[i].section(u' ', 0, 0).toInt(),
                     got[i - 1].section(u' ', 0, 0).toInt() + 1);
    }
};

QTEST_MAIN(ListenBusyMeterTest)
#include "ListenBusyMeter_test.moc"
