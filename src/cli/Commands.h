#pragma once

#include "core/readings/ReadingConversions.h"

#include <QStringList>

class CliLink;

struct LogOptions {
    ReadingConversions conversions;
    bool commaDelimited = false;
    QString output; // empty or "-": standard output
};

// The subcommands of telvio-cli. Each writes its result to standard output and returns the exit
// code.
namespace Commands {

int ports(const QString& byIdFolder);
int status(CliLink& link, bool json);
int log(CliLink& link, const LogOptions& options);
int listen(CliLink& link, bool timestamps);
// count 0: until interrupted.
int read(CliLink& link, int intervalSeconds, int count);
// "glp" or "maxmin".
int records(CliLink& link, bool glp, const LogOptions& options);
// Writes text to the file (replaced whole) or, for "" and "-", to standard output; false after
// saying why it could not.
bool writeOut(const QString& path, const QString& text);

} // namespace Commands
