#include "cli/CliLink.h"
#include "cli/Commands.h"
#include "core/instrument/ModelTable.h"

#include <QJsonDocument>
#include <QJsonObject>
#include <QTextStream>

// Model, version, serial number, number of logged readings and what the meter can do, as the
// window's status display shows them.
int Commands::status(CliLink& link, bool json) {
    const auto reply = link.queryStatus();
    if (!reply)
        return link.failure();
    const QString model = reply->modelCode.value_or(QString());
    const QList<std::pair<const char*, bool>> abilities{
        {"log", reply->hasLog},
        {"glp", reply->hasGLP},
        {"autolog", reply->canAutoLog()},
        {"stirrer", reply->canStir()},
        {"maxmin", modeltable::keepsMaxMin(model)},
        {"voltage", reply->format == StatusReply::Format::Percent && reply->reportsVoltage()}};
    QJsonObject object{{"port", link.state().portName},
                       {"model", model},
                       {"version", reply->firmwareVersion.value_or(QString())},
                       {"serial", reply->serialNumber.value_or(QString())},
                       {"batteryLow", reply->batteryLow()}};
    if (reply->hasLog)
        object.insert("logged", reply->numLogged.value_or(0));
    QStringList can;
    for (auto [name, on] : abilities) {
        object.insert(name, on);
        if (on)
            can << name;
    }
    QTextStream out(stdout);
    if (json) {
        out << QJsonDocument(object).toJson(QJsonDocument::Indented);
        return ExitCode::kDone;
    }
    out << "Model:           " << model << '\n'
        << "Version:         " << object["version"].toString() << '\n'
        << "Serial number:   " << object["serial"].toString() << '\n';
    if (reply->hasLog)
        out << "Logged readings: " << object["logged"].toInt() << '\n';
    out << "Can:             " << can.join(u' ') << '\n';
    if (reply->batteryLow())
        out << "Battery:         low\n";
    return ExitCode::kDone;
}
