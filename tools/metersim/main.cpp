// Command-line simulated meter for the demo and the benchmarks:
//   metersim --profile NAME [--log N] [--baud B] [--link PATH] [--unsolicited-every MS]
// Prints the slave path on stdout and runs until SIGINT or SIGTERM.
#include "Meter.h"

#include <QCommandLineParser>
#include <QCoreApplication>
#include <QFile>
#include <QSocketNotifier>
#include <QTextStream>
#include <QTimer>

#include <csignal>
#include <cstdio>
#include <fcntl.h>
#include <stdexcept>
#include <unistd.h>

namespace {

int signalPipe[2] = {-1, -1};

void onSignal(int) {
    const char c = 's';
    [[maybe_unused]] const ssize_t n = ::write(signalPipe[1], &c, 1);
}

int fail(const QString& message) {
    QTextStream(stderr) << "metersim: " << message << Qt::endl;
    return 2;
}

} // namespace

int main(int argc, char* argv[]) {
    QCoreApplication app(argc, argv);
    QCoreApplication::setApplicationName("metersim");

    QCommandLineParser parser;
    parser.setApplicationDescription("Simulated meter on a pseudo-terminal.");
    parser.addHelpOption();
    const QCommandLineOption profileOpt(
        "profile", "Meter profile: " + metersim::profileNames().join(", "), "NAME");
    const QCommandLineOption logOpt("log", "Number of logged records.", "N");
    const QCommandLineOption baudOpt("baud", "Pace sent bytes at this baud rate (0 = no pacing).",
                                     "B");
    const QCommandLineOption linkOpt("link", "Create a symbolic link PATH to the slave.", "PATH");
    const QCommandLineOption everyOpt("unsolicited-every", "Print a reading every MS milliseconds.",
                                      "MS");
    parser.addOptions({profileOpt, logOpt, baudOpt, linkOpt, everyOpt});
    parser.process(app);

    metersim::Profile profile;
    try {
        profile = metersim::profile(parser.value(profileOpt));
    } catch (const std::invalid_argument&) {
        return fail("unknown profile \"" + parser.value(profileOpt) + "\"; choose one of " +
                    metersim::profileNames().join(", "));
    }
    auto number = [&](const QCommandLineOption& o, int fallback, int* out) {
        bool ok = true;
        *out = parser.isSet(o) ? parser.value(o).toInt(&ok) : fallback;
        return ok && *out >= 0;
    };
    int logSize = 0, baud = 0, every = 0;
    if (!number(logOpt, profile.defaultLogSize, &logSize) || !number(baudOpt, 0, &baud) ||
        !number(everyOpt, 0, &every))
        return fail("--log, --baud and --unsolicited-every take a whole number >= 0");

    metersim::Meter meter(profile);
    if (profile.hasLog)
        meter.setLogRecords(metersim::Meter::generateLog(profile, logSize));
    meter.setBaud(baud);
    if (!meter.start())
        return fail(meter.errorString());

    const QString link = parser.value(linkOpt);
    if (!link.isEmpty()) {
        QFile::remove(link);
        if (!QFile::link(meter.portPath(), link))
            return fail("cannot create the link " + link);
    }

    if (::pipe2(signalPipe, O_CLOEXEC) != 0)
        return fail("pipe failed");
    QSocketNotifier notifier(signalPipe[0], QSocketNotifier::Read);
    QObject::connect(&notifier, &QSocketNotifier::activated, &app, &QCoreApplication::quit);
    struct sigaction sa = {};
    sa.sa_handler = onSignal;
    sigemptyset(&sa.sa_mask);
    sigaction(SIGINT, &sa, nullptr);
    sigaction(SIGTERM, &sa, nullptr);

    const QList<QByteArray> printed = metersim::Meter::generateLog(profile, 20);
    int nextPrinted = 0;
    QTimer printer;
    if (every > 0) {
        QObject::connect(&printer, &QTimer::timeout, &app, [&] {
            meter.sendUnsolicited(printed.at(nextPrinted++ % printed.size()));
        });
        printer.start(every);
    }

    std::printf("%s\n", meter.portPath().toLocal8Bit().constData());
    std::fflush(stdout);
    const int rc = app.exec();
    if (!link.isEmpty())
        QFile::remove(link);
    return rc;
}
