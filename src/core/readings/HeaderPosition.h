#pragma once

#include <QString>

// The column header and Log# column of percent-format meters, from their "?H" and "?P" replies.
class HeaderPosition {
public:
    // Heads the 25 characters put in front of real-time lines of meters without a log.
    static QString noLogPrefix() { return QStringLiteral("   Date      Time   Log# "); }

    // The header shown above the table for a "?H" reply.
    static QString headerFor(const QString& reply, bool hasLog) {
        return hasLog ? reply : noLogPrefix() + reply;
    }

    struct LogColumn {
        bool found = false;
        int start = 0; // 1-based position in a reading line
        int width = 0;
    };

    // The header's columns are counted up to the one holding "Log", letter case included
    // (k columns); the position reply is a count followed by a start,width pair per column, so
    // the Log# column's start is the field after 2k - 1 commas and its width the field after
    // that. A header without "Log" or a reply with too few fields gives found = false.
    static LogColumn findLogColumn(const QString& header, const QString& position);
};
