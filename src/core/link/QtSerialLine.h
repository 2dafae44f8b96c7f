#pragma once

#include "core/link/SerialLine.h"

#include <QSerialPort>

// The serial line on QSerialPort. Waiting is QSerialPort::waitForReadyRead, which blocks in the
// operating system, so an exchange costs almost no processor time.
class QtSerialLine : public SerialLine {
    Q_OBJECT
public:
    explicit QtSerialLine(QObject* parent = nullptr);
    ~QtSerialLine() override;

    qint32 open(const QString& devicePath, const QString& mode) override;
    qint32 close() override;
    qint32 write(const QByteArray& bytes) override;
    int readByte() override;
    qint32 setOption(int operation, qint32 value) override;
    bool waitForByte(int msecs) override;
    bool isOpen() const override;

    QSerialPort::SerialPortError lastOpenError() const { return lastOpenError_; }

private:
    void requireOpen(const char* what);
    void checkPortError(const char* what);

    QSerialPort port_;
    QSerialPort::SerialPortError lastOpenError_ = QSerialPort::NoError;
    qint32 baud_ = 9600;
};
