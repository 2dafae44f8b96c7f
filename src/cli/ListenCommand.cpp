#include "cli/CliLink.h"
#include "cli/Commands.h"
#include "core/readings/ListenReader.h"

#include <QDateTime>
#include <cstdio>

// What the meter prints, a line at a time as each CR arrives, flushed at once so a script (or a
// file, if the tool is killed) has every line received. Ctrl+C or SIGTERM ends it as Stop does:
// the meter is sent "Z".
int Commands::listen(CliLink& link, bool timestamps) {
    catchInterrupts();
    AppState& s = link.state();
    if (link.exchange().FlushInput() == CommandExchange::Drain::KeptSending)
        s.abortRequested = s.flushing = false; // a meter already printing: that is the point
    ListenReader reader;
    try {
        while (!s.abortRequested && !interrupted()) {
            // A short wait, so an interrupt is seen within a fifth of a second.
            if (!link.line().waitForByte(200))
                continue;
            for (int c = link.line().readByte(); c > 0; c = link.line().readByte()) {
                const auto line = reader.take(c);
                if (!line)
                    continue;
                // The line as the window shows it, without the LF that follows the meter's CR.
                QString text = *line;
                text.remove(u'\n').remove(u'\r');
                if (timestamps)
                    text.prepend(QDateTime::currentDateTime().toString(Qt::ISODate) + u' ');
                std::fputs(text.append(u'\n').toLocal8Bit().constData(), stdout);
                std::fflush(stdout);
            }
        }
    } catch (const std::exception&) {
        s.abortRequested = true;
    }
    if (s.abortRequested) {
        complain(QStringLiteral("the link to %1 failed while listening").arg(s.portName));
        return ExitCode::kLinkFailed;
    }
    try {
        link.line().setOption(SerialLine::kOptionPurge, 100);
    } catch (const std::exception&) {
        // The "Z" below finds out whether the port is still there.
    }
    link.exchange().SerialWrite(QStringLiteral("Z"));
    return s.abortRequested ? ExitCode::kLinkFailed : ExitCode::kDone;
}
