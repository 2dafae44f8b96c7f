#include "cli/CliLink.h"
#include "cli/Commands.h"
#include "core/readings/RecordTransfer.h"
#include "core/text/SavedText.h"

// GLP or max/min records as the window saves them: GLP data exactly as received, max/min with
// the asterisk setting applied. What arrived before a failure is written out first.
int Commands::records(CliLink& link, bool glp, const LogOptions& options) {
    const auto reply = link.queryStatus();
    if (!reply)
        return link.failure();
    const auto result =
        RecordTransfer::run(link.exchange(), link.state(),
                            glp ? RecordTransfer::Kind::Glp : RecordTransfer::Kind::MaxMin);
    const bool written = writeOut(
        options.output,
        SavedText::contents(result.text, false, options.conversions.asterisks, glp, QString()));
    if (result.end != RecordTransfer::End::Complete) {
        complain(QStringLiteral("the records ended early; the lines received are written"));
        return link.failure();
    }
    return written ? ExitCode::kDone : ExitCode::kLinkFailed;
}
