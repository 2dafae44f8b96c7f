#include "cli/CliLink.h"
#include "cli/Commands.h"
#include "core/instrument/StatusQuery.h"
#include "core/readings/LogTransfer.h"
#include "core/readings/ReadingConversions.h"
#include "core/readings/ReadingSchedule.h"
#include "core/text/SavedText.h"

#include <cstdio>
#include <unistd.h>

namespace {

// A progress bar on standard error, only when a person watches it.
class ProgressBar : public LogTransfer::Listener {
public:
    explicit ProgressBar(long long total) : total_(total), shown_(::isatty(STDERR_FILENO)) {}
    ~ProgressBar() override {
        if (shown_ && last_ >= 0)
            std::fputs("\n", stderr);
    }
    void progress(long long count) override {
        const int twentieths = ReadingSchedule::twentieths(count, total_);
        if (!shown_ || twentieths == last_ || twentieths > 20)
            return;
        last_ = twentieths;
        std::fprintf(stderr, "\r[%-20s] %lld/%lld", QByteArray(twentieths, '#').constData(), count,
                     total_);
        std::fflush(stderr);
    }
    bool stopRequested() override { return false; }

private:
    long long total_;
    bool shown_;
    int last_ = -1;
};

} // namespace

// The log table as the window would save it after a download: records laid out by the line
// rules, the chosen conversions applied, as plain text (column header first where the meter has
// one) or comma-delimited. What arrived before a failure is written out before the exit.
int Commands::log(CliLink& link, const LogOptions& options) {
    const auto reply = link.queryStatus();
    if (!reply)
        return link.failure();
    AppState& s = link.state();
    link.adopt(*reply);
    if (s.numLogged == 0) {
        complain(QStringLiteral("no logged readings"));
        return Commands::writeOut(options.output, QString()) ? ExitCode::kDone
                                                             : ExitCode::kLinkFailed;
    }
    bool logColumnKnown = false;
    if (s.percentFormat)
        StatusQuery::headerAndPositions(link.exchange(), s, logColumnKnown);
    const QString header = s.percentFormat ? s.headerText : QString();
    s.workspaceText.clear();
    ProgressBar bar(s.numLogged);
    const LogTransfer::End end = LogTransfer(link.exchange(), s, bar).run();
    const QString text = options.conversions.apply(s.workspaceText);
    const bool written = Commands::writeOut(
        options.output, SavedText::contents(text, options.commaDelimited,
                                            options.conversions.asterisks, false, header));
    if (end != LogTransfer::End::Complete) {
        complain(QStringLiteral("the download ended early; the records received are written"));
        return link.failure();
    }
    return written ? ExitCode::kDone : ExitCode::kLinkFailed;
}
