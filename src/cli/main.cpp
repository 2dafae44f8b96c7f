// telvio-cli: the meter work of Telvio from a terminal, a script or a scheduled job.
#include "cli/CliLink.h"
#include "cli/Commands.h"
#include "core/settings/Settings.h"
#include "core/settings/Version.h"

#include <QCommandLineParser>
#include <QCoreApplication>
#include <QTextStream>

namespace {

const char* const kAbout =
    R"(Talks to a conductivity, dissolved-solids or pH meter on a serial port.

Commands:
  ports    list the serial ports: path, stable name, adapter
  status   detect the meter and show model, version, serial number, logged readings
           and what it can do
  log      download the logged readings and write the log table as the desktop program
           saves it: plain text, or comma-delimited with --csv
  glp      the meter's GLP (calibration) records
  maxmin   the meter's max/min records
  listen   print what the meter prints, a line as each arrives, until Ctrl+C
  read     timed readings, one line each: --interval S (1 to 3600), --count N (default:
           until Ctrl+C)

Port and speed come from --port and --baud, else from the settings the desktop program keeps.
Every command that talks to the meter first wakes it up, for at most --wait seconds.

Exit codes:
  0  done
  2  bad usage
  3  no meter answered
  4  port missing, in use or not permitted
  5  the link failed during the transfer
  6  the meter reported an error)";

int usage(const QString& text) {
    complain(text + QStringLiteral(" (see telvio-cli --help)"));
    return ExitCode::kUsage;
}

} // namespace

int main(int argc, char* argv[]) {
    QCoreApplication app(argc, argv);
    QCoreApplication::setApplicationName(QStringLiteral("telvio-cli"));
    QCoreApplication::setApplicationVersion(
        QStringLiteral("%1.%2").arg(telvio::kVersionMajor).arg(telvio::kVersionMinor));

    QCommandLineParser parser;
    parser.setApplicationDescription(QString::fromLatin1(kAbout));
    const QCommandLineOption port({"p", "port"}, "Serial port (COM3, ttyUSB0, /dev/...).", "port");
    const QCommandLineOption baud({"b", "baud"}, "Speed the meter is set to.", "baud");
    const QCommandLineOption wait("wait", "Seconds to wait for the meter (default 5).", "seconds",
                                  "5");
    const QCommandLineOption json("json", "status: machine-readable output.");
    const QCommandLineOption csv("csv", "log: comma-delimited output.");
    const QCommandLineOption convert(
        "convert", "log: conversions, any of mS,ppK,asterisk, or none (default: the settings).",
        "list");
    const QCommandLineOption output({"o", "output"}, "log, glp, maxmin: write to this file.",
                                    "file");
    const QCommandLineOption stamps("timestamps",
                                    "listen: local time (ISO 8601) before each line.");
    const QCommandLineOption interval("interval", "read: seconds between readings.", "S");
    const QCommandLineOption count("count", "read: end after N readings.", "N", "0");
    const QCommandLineOption byId("by-id", "ports: folder of stable port names.", "folder",
                                  "/dev/serial/by-id");
    parser.addOptions(
        {port, baud, wait, json, csv, convert, output, stamps, interval, count, byId});
    parser.addPositionalArgument("command", "ports, status, log, glp, maxmin, listen or read");
    parser.addHelpOption();
    parser.addVersionOption();
    if (!parser.parse(QCoreApplication::arguments()))
        return usage(parser.errorText());
    if (parser.isSet("help")) {
        QTextStream(stdout) << parser.helpText();
        return ExitCode::kDone;
    }
    if (parser.isSet("version")) {
        QTextStream(stdout) << "telvio-cli " << QCoreApplication::applicationVersion() << '\n';
        return ExitCode::kDone;
    }
    const QStringList args = parser.positionalArguments();
    if (args.size() != 1)
        return usage(QStringLiteral("give one command"));
    const QString command = args.first();
    if (command == QLatin1String("ports"))
        return Commands::ports(parser.value(byId));
    const QStringList meterCommands{"status", "log", "glp", "maxmin", "listen", "read"};
    if (!meterCommands.contains(command))
        return usage(QStringLiteral("unknown command \"%1\"").arg(command));

    bool ok = true;
    const double waitSeconds = parser.value(wait).toDouble(&ok);
    if (!ok || waitSeconds < 0 || waitSeconds > 3600)
        return usage(QStringLiteral("--wait takes 0 to 3600 seconds"));
    CliLink link;
    AppState& state = link.state();
    Settings::LoadSettings(state, link.prompts());
    if (parser.isSet(port))
        Settings::SetPortName(state, parser.value(port));
    if (parser.isSet(baud)) {
        state.baudRate = parser.value(baud).toInt(&ok);
        if (!ok || state.baudRate <= 0)
            return usage(QStringLiteral("--baud takes a positive whole number"));
    }
    LogOptions log;
    log.conversions = ReadingConversions::fromSettings(state.convertMsToUs, state.convertPpkToPpm,
                                                       state.convertAsterisks);
    if (parser.isSet(convert)) {
        const QStringList words = parser.value(convert).split(u',', Qt::SkipEmptyParts);
        const QStringList known{"mS", "ppK", "asterisk", "none"};
        for (const QString& word : words)
            if (!known.contains(word))
                return usage(QStringLiteral("--convert takes mS, ppK, asterisk or none"));
        log.conversions = {words.contains("mS"), words.contains("ppK"), words.contains("asterisk")};
    }
    log.commaDelimited = parser.isSet(csv);
    const int seconds = parser.value(interval).toInt(&ok);
    if (command == QLatin1String("read") && (!ok || seconds < 1 || seconds > 3600))
        return usage(QStringLiteral("read takes --interval 1 to 3600 (whole seconds)"));
    const int readings = parser.value(count).toInt(&ok);
    if (!ok || readings < 0)
        return usage(QStringLiteral("--count takes a whole number"));
    log.output = parser.value(output);

    if (const int opened = link.open(); opened != ExitCode::kDone)
        return opened;
    if (const int found = link.detect(waitSeconds); found != ExitCode::kDone)
        return found;
    if (command == QLatin1String("log"))
        return Commands::log(link, log);
    if (command == QLatin1String("read"))
        return Commands::read(link, seconds, readings);
    if (command == QLatin1String("listen"))
        return Commands::listen(link, parser.isSet(stamps));
    if (command != QLatin1String("status"))
        return Commands::records(link, command == QLatin1String("glp"), log);
    return Commands::status(link, parser.isSet(json));
}
