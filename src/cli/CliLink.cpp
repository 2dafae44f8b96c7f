#include "cli/CliLink.h"

#include "core/instrument/StatusQuery.h"
#include "core/link/PortNames.h"

#include <QFileInfo>
#include <QThread>
#include <csignal>
#include <cstdio>

namespace {
volatile std::sig_atomic_t interruptSeen = 0;
void onInterrupt(int) {
    interruptSeen = 1;
}
} // namespace

void catchInterrupts() {
    std::signal(SIGINT, onInterrupt);
    std::signal(SIGTERM, onInterrupt);
}

bool interrupted() {
    return interruptSeen != 0;
}

void complain(const QString& text) {
    // One line, the message's own spacing kept.
    QString line = text.trimmed();
    line.replace(QStringLiteral("\r\n"), QStringLiteral(" "))
        .replace(u'\r', u' ')
        .replace(u'\n', u' ');
    std::fprintf(stderr, "telvio-cli: %s\n", line.toLocal8Bit().constData());
    std::fflush(stderr);
}

CliLink::CliLink() : exchange_(state_, line_, clock_, *this, *this) {}

Prompts::Answer CliLink::show(const QString& text, Icon, Buttons buttons, bool) {
    complain(text);
    if (text.contains(QLatin1String("firmware")) || text.contains(QLatin1String("terminated")))
        meterError_ = true;
    return declined(buttons);
}

int CliLink::open() {
    const QString mode = QStringLiteral("baud=%1 parity=N data=8 stop=1").arg(state_.baudRate);
    qint32 result = -1;
    try {
        result = line_.open(state_.portDevicePath, mode);
    } catch (const std::exception&) {
    }
    if (result == 0)
        return ExitCode::kDone;
    const QFileInfo device(PortNames::platformPath(state_.portDevicePath));
    const auto error = line_.lastOpenError();
    if (error == QSerialPort::DeviceNotFoundError || !device.exists())
        complain(QStringLiteral("serial port %1 does not exist").arg(state_.portName));
    else if (!device.isReadable() || !device.isWritable())
        complain(QStringLiteral("serial port %1 is not permitted to this user; add your user to "
                                "the dialout group, then log in again")
                     .arg(state_.portName));
    else if (error == QSerialPort::PermissionError || error == QSerialPort::OpenError)
        complain(QStringLiteral("serial port %1 is in use").arg(state_.portName));
    else
        complain(QStringLiteral("serial port %1 cannot be opened at %2 baud")
                     .arg(state_.portName)
                     .arg(state_.baudRate));
    return ExitCode::kPort;
}

std::optional<StatusReply> CliLink::queryStatus() {
    auto reply = StatusQuery::query(exchange_, state_);
    detecting_ = false;
    if (!reply) {
        complain(
            QStringLiteral("the link to %1 failed during the status query").arg(state_.portName));
        return std::nullopt;
    }
    if (reply->format == StatusReply::Format::Unusable ||
        reply->format == StatusReply::Format::Error) {
        meterError_ = reply->format == StatusReply::Format::Error;
        complain(QStringLiteral("the meter answered the status query with \"%1\"")
                     .arg(state_.replyText.trimmed()));
        return std::nullopt;
    }
    return reply;
}

void CliLink::adopt(const StatusReply& reply) {
    if (reply.modelCode)
        state_.modelCode = *reply.modelCode;
    state_.percentFormat = reply.format == StatusReply::Format::Percent;
    state_.isK5Family = reply.isK5Family || reply.format == StatusReply::Format::K5;
    state_.hasLog = reply.hasLog || reply.format == StatusReply::Format::K5;
    state_.hasGLP = reply.hasGLP;
    state_.numLogged = state_.hasLog ? reply.numLogged.value_or(0) : 0;
}

int CliLink::detect(double waitSeconds) {
    const double end = clock_.nowSeconds() + waitSeconds;
    for (;;) {
        const double started = clock_.nowSeconds();
        if (StatusQuery::poll(exchange_, state_)) {
            detecting_ = true; // a meter just woken up may stay busy for a while
            return ExitCode::kDone;
        }
        if (state_.abortRequested) {
            complain(QStringLiteral("the link to %1 failed").arg(state_.portName));
            return ExitCode::kLinkFailed;
        }
        if (clock_.nowSeconds() >= end) {
            complain(QStringLiteral("no meter answered on %1 within %2 s")
                         .arg(state_.portName)
                         .arg(waitSeconds));
            return ExitCode::kNoMeter;
        }
        const double rest = qMin(0.6 - (clock_.nowSeconds() - started), end - clock_.nowSeconds());
        if (rest > 0)
            QThread::msleep(static_cast<unsigned long>(rest * 1000));
    }
}
