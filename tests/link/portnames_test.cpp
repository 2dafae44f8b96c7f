// Port names and mode texts: what the user types or the settings hold, and what gets opened.
#include "link/PortNames.h"

#include <QTest>

class PortNamesTest : public QObject {
    Q_OBJECT

private slots:
    void platformPath_data() {
        QTest::addColumn<QString>("given");
        QTest::addColumn<QString>("opened");
#ifndef Q_OS_WIN
        QTest::newRow("device path of COM1") << "\\\\.\\COM1"
                                             << "/dev/ttyS0";
        QTest::newRow("COM12") << "COM12"
                               << "/dev/ttyS11";
        QTest::newRow("usb name") << "ttyUSB0"
                                  << "/dev/ttyUSB0";
        QTest::newRow("pty path") << "\\\\.\\/dev/pts/4"
                                  << "/dev/pts/4";
        QTest::newRow("COM0 is no COM port") << "COM0"
                                             << "/dev/COM0";
#endif
    }
    void platformPath() {
        QFETCH(QString, given);
        QFETCH(QString, opened);
        QCOMPARE(PortNames::platformPath(given), opened);
    }

    void portNumber_data() {
        QTest::addColumn<QString>("name");
        QTest::addColumn<int>("number");
        QTest::newRow("COM12") << "COM12" << 12;
        QTest::newRow("no digits") << "COMx" << 0;
        QTest::newRow("short") << "CO" << 0;
        QTest::newRow("device") << "ttyUSB0" << 0;
    }
    void portNumber() {
        QFETCH(QString, name);
        QFETCH(int, number);
        QCOMPARE(PortNames::PortNumberOf(name), number);
    }

    void usableNames_data() {
        QTest::addColumn<QString>("name");
        QTest::addColumn<bool>("usable");
        QTest::newRow("COM3") << "COM3" << true;
        QTest::newRow("COM32767") << "COM32767" << true;
        QTest::newRow("COM32768") << "COM32768" << false;
        QTest::newRow("COM0") << "COM0" << false;
        QTest::newRow("empty") << "" << false;
        QTest::newRow("blank inside") << "tty USB0" << false;
        QTest::newRow("path") << "/dev/ttyUSB0" << true;
        QTest::newRow("control char") << "tty\x01" << false;
    }
    void usableNames() {
        QFETCH(QString, name);
        QFETCH(bool, usable);
        QCOMPARE(PortNames::isUsableName(name), usable);
    }

    void modeText_data() {
        QTest::addColumn<QString>("text");
        QTest::addColumn<bool>("valid");
        QTest::addColumn<int>("baud");
        QTest::newRow("standard") << "baud=9600 parity=N data=8 stop=1" << true << 9600;
        QTest::newRow("zero baud") << "baud=0 parity=N data=8 stop=1" << false << 0;
        QTest::newRow("negative baud") << "baud=-5 parity=N data=8 stop=1" << false << 0;
        QTest::newRow("bad parity") << "baud=9600 parity=X data=8 stop=1" << false << 0;
        QTest::newRow("garbage") << "hello" << false << 0;
    }
    void modeText() {
        QFETCH(QString, text);
        QFETCH(bool, valid);
        QFETCH(int, baud);
        const auto m = PortNames::parseMode(text);
        QCOMPARE(m.valid, valid);
        if (valid)
            QCOMPARE(m.baud, baud);
    }
};

QTEST_GUILESS_MAIN(PortNamesTest)
#include "portnames_test.moc"
