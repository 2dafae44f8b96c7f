// Opening the port, the detection polls and the port dialogs, against real pseudo-terminals.
#include "DialogDriver.h"
#include "WindowFixture.h"
#include "link/CommsPortDialog.h"
#include "link/Connection.h"
#include "link/PortProbe.h"

#include <QAction>
#include <QComboBox>
#include <QLabel>
#include <QSerialPort>
#include <QTest>

class ConnectionTest : public QObject {
    Q_OBJECT

    std::unique_ptr<WindowFixture> f;

    QString dialogMessage(QWidget* d) {
        return d->findChild<QLabel*>(QStringLiteral("lblMessage"))->text();
    }

private slots:
    void init() { f = std::make_unique<WindowFixture>(); }
    void cleanup() {
        f.reset();
        QVERIFY2(DialogDriver::takeFailures().isEmpty(), "a dialog was not driven as expected");
    }

    void searchesThenStopsAtTheFirstReply() {
        QVERIFY(f->startMeter(QStringLiteral("plain"), 19200));
        f->meter->setSilent(true);
        f->start();
        const QString port = f->meter->portPath();
        QCOMPARE(f->c().lblMessage->text(), QStringLiteral("Searching  for  meter  on  ") + port +
                                                QStringLiteral("  at  19200  baud ..."));
        QVERIFY(f->waitUntil([this] { return f->meter->count("{@{@") > 0; }, 3000));
        QVERIFY(f->waitUntil([this] { return f->meter->count("?S\r") >= 3; }, 4000));
        QVERIFY(f->c().tmrDetectMeter->isActive());
        const QByteArray wakeUp = QByteArray("{@").repeated(24) + "?S\r";
        QVERIFY(f->meter->received().startsWith(wakeUp));
        f->meter->setSilent(false);
        QVERIFY(f->waitUntil([this] { return !f->c().tmrDetectMeter->isActive(); }, 3000));
        const int polls = f->meter->count(wakeUp);
        QTest::qWait(1500);
        QCOMPARE(f->meter->count(wakeUp), polls);
        QVERIFY(!f->c().mnuDetectMeter->isEnabled());
    }

    void detectMeterReconnects() {
        QVERIFY(f->startMeter(QStringLiteral("plain")));
        f->start();
        QVERIFY(f->waitUntil([this] { return !f->c().tmrDetectMeter->isActive(); }, 5000));
        f->c().mnuDetectMeter->setEnabled(true);
        f->meter->clearReceived();
        f->c().mnuDetectMeter->trigger();
        QVERIFY(f->serial.isOpen());
        QVERIFY(f->waitUntil([this] { return f->meter->count("{@{@") > 0; }, 3000));
    }

    void missingPortShowsUnavailable() {
        f->settings.set(QStringLiteral("COM"), QStringLiteral("/dev/telvio-missing"));
        f->createWindow();
        DialogDriver::whenModal(QStringLiteral("frmSerialPortUnavailable"), [this](QWidget* d) {
            QCOMPARE(dialogMessage(d),
                     QStringLiteral("Serial port /dev/telvio-missing cannot be found.  "
                                    "Please go to setup and select an alternative serial port."));
            QCOMPARE(f->c().lblMessage->text(), QString());
            DialogDriver::click(d, QStringLiteral("cmdCancel"));
        });
        f->start();
        QVERIFY(f->c().mnuDetectMeter->isEnabled());
        QVERIFY(!f->serial.isOpen());
    }

    void retryConnectsAgain() {
        f->settings.set(QStringLiteral("COM"), QStringLiteral("/dev/telvio-missing"));
        f->createWindow();
        int shown = 0;
        std::function<void(QWidget*)> answer = [&](QWidget* d) {
            ++shown;
            if (shown == 1) {
                DialogDriver::whenModal(QStringLiteral("frmSerialPortUnavailable"), answer);
                DialogDriver::click(d, QStringLiteral("cmdRetry"));
            } else {
                DialogDriver::click(d, QStringLiteral("cmdCancel"));
            }
        };
        DialogDriver::whenModal(QStringLiteral("frmSerialPortUnavailable"), answer);
        f->start();
        QCOMPARE(shown, 2);
    }

    void heldPortIsListedAndInUse() {
        QVERIFY(f->startMeter(QStringLiteral("plain")));
        const QString port = f->meter->portPath();
        QSerialPort holder(port);
        QVERIFY(holder.open(QIODevice::ReadWrite));
        QCOMPARE(PortProbe::probe(port), PortProbe::Outcome::InUse);
        QVERIFY(PortProbe::comPortExists(port));
        f->createWindow();
        DialogDriver::whenModal(QStringLiteral("frmSerialPortInUse"), [&](QWidget* d) {
            QVERIFY(dialogMessage(d).startsWith(QStringLiteral("Serial port ") + port +
                                                QStringLiteral(" is in use.")));
            DialogDriver::click(d, QStringLiteral("cmdCancel"));
        });
        f->start();
        QVERIFY(f->c().mnuDetectMeter->isEnabled());
    }

    void portListSelection() {
        QVERIFY(f->startMeter(QStringLiteral("plain")));
        const QString port = f->meter->portPath();
        {
            CommsPortDialog present(port, 9600, f->prompts, nullptr);
            auto* com = present.findChild<QComboBox*>(QStringLiteral("cboCom"));
            QCOMPARE(com->currentText(), port);
            auto* baud = present.findChild<QComboBox*>(QStringLiteral("cboBaud"));
            QCOMPARE(baud->count(), 5);
            QCOMPARE(baud->currentText(), QStringLiteral("9600"));
        }
        {
            CommsPortDialog absent(QStringLiteral("/dev/telvio-missing"), 4800, f->prompts,
                                   nullptr);
            auto* com = absent.findChild<QComboBox*>(QStringLiteral("cboCom"));
            QCOMPARE(com->findText(QStringLiteral("/dev/telvio-missing")), -1);
            QCOMPARE(com->currentIndex(), com->count() > 0 ? 0 : -1);
        }
        f->meter->vanish();
        QVERIFY(!PortProbe::comPortExists(QStringLiteral("/dev/telvio-missing")));
    }

    void okSavesBeforeConnecting() {
        f->createWindow();
        f->state().portName = QStringLiteral("COM1");
        DialogDriver::whenModal(QStringLiteral("frmCommsPort"), [](QWidget* d) {
            d->findChild<QComboBox*>(QStringLiteral("cboCom"))
                ->setEditText(QStringLiteral("/dev/telvio-missing"));
            d->findChild<QComboBox*>(QStringLiteral("cboBaud"))
                ->setEditText(QStringLiteral("4800"));
            DialogDriver::click(d, QStringLiteral("cmdOK"));
        });
        QString savedPort, savedBaud;
        DialogDriver::whenModal(QStringLiteral("frmSerialPortUnavailable"), [&](QWidget* d) {
            savedPort = f->settings.value(QStringLiteral("COM"));
            savedBaud = f->settings.value(QStringLiteral("Baud"));
            DialogDriver::click(d, QStringLiteral("cmdCancel"));
        });
        f->window->connection().ShowCommsPortDialog();
        QCOMPARE(savedPort, QStringLiteral("/dev/telvio-missing"));
        QCOMPARE(savedBaud, QStringLiteral("4800"));
        QCOMPARE(f->state().portDevicePath, QStringLiteral("\\\\.\\/dev/telvio-missing"));
    }

    void typedTextThatIsNotUsableKeepsTheDialogOpen_data() {
        QTest::addColumn<QString>("port");
        QTest::addColumn<QString>("baud");
        QTest::newRow("letters for speed") << "COM1"
                                           << "fast";
        QTest::newRow("fraction speed") << "COM1"
                                        << "9600.5";
        QTest::newRow("port number too big") << "COM99999"
                                             << "9600";
        QTest::newRow("empty port") << ""
                                    << "9600";
    }
    void typedTextThatIsNotUsableKeepsTheDialogOpen() {
        QFETCH(QString, port);
        QFETCH(QString, baud);
        f->createWindow();
        f->state().portName = QStringLiteral("COM1");
        f->state().baudRate = 9600;
        bool stillOpen = false;
        DialogDriver::whenModal(QStringLiteral("frmCommsPort"), [&](QWidget* d) {
            d->findChild<QComboBox*>(QStringLiteral("cboCom"))->setEditText(port);
            d->findChild<QComboBox*>(QStringLiteral("cboBaud"))->setEditText(baud);
            DialogDriver::click(d, QStringLiteral("cmdOK"));
            stillOpen = d->isVisible();
            DialogDriver::click(d, QStringLiteral("cmdCancel"));
        });
        f->window->connection().ShowCommsPortDialog();
        QVERIFY(stillOpen);
        QCOMPARE(f->prompts.shown.size(), 1);
        QCOMPARE(f->state().portName, QStringLiteral("COM1"));
        QVERIFY(!f->settings.contains(QStringLiteral("COM")));
    }
};

QTEST_MAIN(ConnectionTest)
#include "connection_test.moc"
