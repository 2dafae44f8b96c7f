#pragma once

#include "Profile.h"

#include <QByteArray>
#include <QList>
#include <QString>

#include <atomic>
#include <chrono>
#include <condition_variable>
#include <memory>
#include <mutex>
#include <thread>

namespace metersim {

class OutputQueue;
class Pty;
class Responder;

// One received byte and when it arrived (seconds on a steady clock since start()).
struct ReceivedByte {
    double t;
    char byte;
};

// A simulated instrument on a pseudo-terminal. The program under test opens portPath() as its
// serial port. The protocol runs on a worker thread that blocks in poll(); every method here
// may be called from any thread while it runs.
//
// Built-in behaviour: "?S" (also behind the wake-up prefix) answers the profile's status with
// the current log size; "?W", "?H", "?P" where the profile has them; "?L" sends one record per
// "A" and then "ENDS" CR; "?R" (QR32 layout) sends every record without acknowledgement;
// "?D" cycles through the reading replies; "?G"/"?M" send their block one line per LF, then
// "END" CR, where the profile (or setRecordLines) has such a block, otherwise "?G"/"?J" answer
// "LOG START", "?M" "SON" (or "BLOW"); "?F" "LOG STOP"; "?N" "SOFF"; "?K" "SSD" and then
// silence until the next wake-up command; "?E" "ERASED" and an empty log; "?V" the voltage;
// "Z" ends a transfer; a lone LF or "A" outside a transfer is ignored; anything else "ERROR".
// A new meter holds Profile::defaultLogSize generated records when the profile has a log.
class Meter {
public:
    explicit Meter(const Profile& p);
    // Stops the thread and closes the pty.
    ~Meter();
    Meter(const Meter&) = delete;
    Meter& operator=(const Meter&) = delete;

    // Opens the pty and starts the worker; false (with errorString()) on failure.
    bool start();
    // Slave path, e.g. "/dev/pts/4".
    QString portPath() const;
    QString errorString() const;
    const Profile& profile() const { return profile_; }

    // --- replies
    // Fixed reply for a command ("?S", "?D", ...; no CR), full bytes as sent. Replaces the
    // built-in behaviour of that command; an empty reply means no answer.
    void setReply(const QByteArray& command, const QByteArray& reply);
    // One-shot replies, used in turn before the normal one.
    void queueReplies(const QByteArray& command, const QList<QByteArray>& replies);
    // The next n commands are answered "BUSY" CR (each re-send counts).
    void setBusyCount(int n);
    // Answer nothing at all (bytes are still recorded).
    void setSilent(bool silent);
    // Every reply goes out this late.
    void setReplyDelayMs(int ms);
    // 0 = no pacing; otherwise each byte sent takes 10/baud seconds.
    void setBaud(int baud);

    // --- logs and data
    // Records for "?L"/"?R", each ending with CR. The status count follows the log.
    void setLogRecords(const QList<QByteArray>& records);
    QList<QByteArray> logRecords() const;
    // n records in the profile's layout (a mix of "mS", "ppK" and asterisk decimal marks).
    // For a profile without dated readings (percent without log) these are "?D" readings.
    static QList<QByteArray> generateLog(const Profile& p, int n);
    // "?D" replies in turn (an empty list restores the profile's generated readings).
    void setReadingReplies(const QList<QByteArray>& replies);
    // Block lines of "?G" or "?M"; the meter adds "END" CR unless the last line begins "END".
    void setRecordLines(const QByteArray& command, const QList<QByteArray>& lines);

    // --- unsolicited sending and faults
    // Written now (paced if a baud rate is set).
    void sendUnsolicited(const QByteArray& bytes);
    // Reading lines one after another without pause, until stopped.
    void startEndlessSending();
    void stopEndlessSending();
    // The port disappears: the master closes, the program's port errors and cannot reopen.
    void vanish();
    // In the next "?L", "?R", "?G" or "?M" transfer: vanish after this many records have gone.
    void vanishAfterSending(int records);
    bool hasVanished() const;

    // --- what the meter received
    QByteArray received() const;
    QList<ReceivedByte> receivedWithTimes() const;
    void clearReceived();
    // Non-overlapping occurrences of pattern in received().
    int count(const QByteArray& pattern) const;
    // Blocks until pattern has been received at least times times, or timeoutMs pass.
    bool waitForReceived(const QByteArray& pattern, int times, int timeoutMs) const;
    // When each occurrence of command (e.g. "?D\r") was complete (time of its last byte).
    QList<double> commandTimes(const QByteArray& command) const;

private:
    double now() const;
    void wake();
    void run();
    void readInput();
    void checkVanishMarker();
    int countLocked(const QByteArray& pattern) const;

    const Profile profile_;
    std::unique_ptr<Pty> pty_;
    std::unique_ptr<Responder> responder_;
    std::unique_ptr<OutputQueue> out_;
    std::thread worker_;
    int wakeRead_ = -1;
    int wakeWrite_ = -1;
    std::atomic<bool> stop_{false};
    std::chrono::steady_clock::time_point startTime_;

    mutable std::mutex mutex_;
    mutable std::condition_variable receivedChanged_;
    QByteArray received_;
    QList<double> receivedTimes_;
    QString error_;
    bool endless_ = false;
    bool vanishNow_ = false;
    bool vanished_ = false;
    double drainSince_ = -1; // when a due vanish marker started waiting for the program to read
    double emptySince_ = -1; // since when the program has had nothing left to read
};

} // namespace metersim
