#pragma once

#include <QByteArray>
#include <QObject>
#include <QString>
#include <stdexcept>

// Raised by a serial operation that cannot be carried out (port not open, port gone, write
// failed). The exchange turns it into abortRequested; nothing lets it travel further.
class SerialError : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

// The boundary to the serial line: the five operations the logic needs, plus a blocking wait
// for the next byte so that no caller ever spins. Each operation returns a result code that the
// caller stores in ioResult; only open()'s is examined (0 = open).
class SerialLine : public QObject {
    Q_OBJECT
public:
    using QObject::QObject;

    // Option numbers accepted by setOption().
    static constexpr int kOptionBufferSetup = 23; // value 1 at start-up
    static constexpr int kOptionReadBuffer = 22;  // value 50 at start-up
    static constexpr int kOptionPurge = 53;       // value 100 right before "Z" is written

    // devicePath is "\\.\" + port name (or a plain device name or path); mode is
    // "baud=9600 parity=N data=8 stop=1". Returns 0 when the port is open with those settings.
    virtual qint32 open(const QString& devicePath, const QString& mode) = 0;
    // Harmless when the port is not open.
    virtual qint32 close() = 0;
    // Sends the bytes in order, nothing added. Throws SerialError when it cannot.
    virtual qint32 write(const QByteArray& bytes) = 0;
    // Next received byte, 1..255; 0 when none is waiting (a NUL byte also reads as 0).
    // Never waits. Throws SerialError when the port is not open or has gone.
    virtual int readByte() = 0;
    virtual qint32 setOption(int operation, qint32 value) = 0;
    // Blocks (in the operating system, no spinning) until a byte is waiting or msecs pass.
    // Returns true when a byte is waiting. Throws SerialError when the port is not open or gone.
    virtual bool waitForByte(int msecs) = 0;
    virtual bool isOpen() const = 0;

signals:
    // New bytes arrived (emitted from the event loop; only listen mode connects to it).
    void bytesArrived();
    // The port reported an error that makes it unusable (e.g. the device vanished).
    void failed();
};
