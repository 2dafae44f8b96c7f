#pragma once

#include <QString>

namespace metersim {

// A pseudo-terminal pair. The meter reads and writes the master side; the program under test
// opens the slave path as its serial port.
class Pty {
public:
    Pty() = default;
    ~Pty();
    Pty(const Pty&) = delete;
    Pty& operator=(const Pty&) = delete;

    // Opens the pair: raw slave (no CR translation, no echo), non-blocking master.
    bool open(QString* error);
    int master() const { return master_; }
    QString slavePath() const { return slavePath_; }
    bool isOpen() const { return master_ >= 0; }
    // Bytes written to the master that the slave side has not read yet.
    int unreadBySlave() const;
    // The device disappears: the master goes, which hangs the slave up for every holder.
    void closeMaster();
    void close();

private:
    int master_ = -1;
    // Held for the meter's lifetime: without a slave holder poll() on the master reports
    // hang-up continuously.
    int slave_ = -1;
    QString slavePath_;
};

} // namespace metersim
