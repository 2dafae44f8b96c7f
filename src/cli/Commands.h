#pragma once

#include <QStringList>

class CliLink;

// The subcommands of telvio-cli. Each writes its result to standard output and returns the exit
// code.
namespace Commands {

int ports(const QString& byIdFolder);
int status(CliLink& link, bool json);

} // namespace Commands
