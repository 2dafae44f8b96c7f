#pragma once

#include <QString>
#include <optional>

// Splits what a meter prints by itself into lines: a line ends with its CR (or when it reaches
// kMaxLineLength, so a meter that never sends CR cannot grow it further). Lines holding "ENDS",
// "BUSY", "EXIT" or "ERROR" are not readings and are left out.
class ListenReader {
public:
    static constexpr int kMaxLineLength = 4096;

    // Takes one received byte (1..255). Returns the line it completed, when that line is kept.
    std::optional<QString> take(int byte);
    // The last line completed, kept or not.
    const QString& lastLine() const { return last_; }
    // Drops a line without its CR yet.
    void clear() { line_.clear(); }

private:
    QString line_;
    QString last_;
};
