#pragma once

#include "OutputQueue.h"
#include "Profile.h"

#include <QByteArray>
#include <QHash>
#include <QList>

namespace metersim {

// The instrument's side of the protocol: takes the program's bytes one at a time and queues
// the replies. Not thread-safe; Meter calls it under its lock.
class Responder {
public:
    explicit Responder(const Profile& p);

    void onByte(char c, double now, OutputQueue& out);

    void setReply(const QByteArray& command, const QByteArray& reply);
    void queueReplies(const QByteArray& command, const QList<QByteArray>& replies);
    void setBusyCount(int n) { busyCount_ = n; }
    void setSilent(bool silent) { silent_ = silent; }
    void setReplyDelayMs(int ms) { delayMs_ = qMax(0, ms); }
    void setLogRecords(const QList<QByteArray>& records) { log_ = records; }
    void setReadingReplies(const QList<QByteArray>& replies);
    void setRecordLines(const QByteArray& command, const QList<QByteArray>& lines);
    void setVanishAfter(int records) { vanishAfter_ = records; }

    const QList<QByteArray>& logRecords() const { return log_; }
    // Next line for unsolicited printing (cycles through the readings).
    QByteArray nextPrintedLine();

private:
    enum class Transfer { None, Log, Block };

    void handleLine(const QByteArray& line, double now, OutputQueue& out);
    void answer(const QByteArray& command, double now, OutputQueue& out);
    void reply(const QByteArray& bytes, double now, OutputQueue& out);
    void startTransfer(Transfer kind, QList<QByteArray> items, double now, OutputQueue& out);
    void sendNextItem(double now, OutputQueue& out);
    void sendAllRecords(double now, OutputQueue& out);
    QList<QByteArray> blockLines(const QByteArray& command) const;

    Profile profile_;
    QList<QByteArray> log_;
    QList<QByteArray> readings_;
    int nextReading_ = 0;
    int nextPrinted_ = 0;
    QHash<QByteArray, QByteArray> replies_;
    QHash<QByteArray, QList<QByteArray>> queued_;
    QHash<QByteArray, QList<QByteArray>> blocks_;
    int busyCount_ = 0;
    bool silent_ = false;
    bool asleep_ = false;
    int delayMs_ = 0;
    int vanishAfter_ = -1;

    QByteArray line_;
    Transfer transfer_ = Transfer::None;
    QList<QByteArray> items_; // records (or block lines) and the end marker
    int sent_ = 0;
};

} // namespace metersim
