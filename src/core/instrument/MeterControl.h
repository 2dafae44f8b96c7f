#pragma once

#include <QString>

class CommandExchange;
struct AppState;

// The meter's side of the control commands: what confirms each one, the power-off sequence and
// the battery voltage line. The replies are left in the state's responseText.
namespace MeterControl {

// A reply a command can act on: not empty, not busy, not ended at the meter, not rejected.
bool isUsable(const QString& reply);
// Confirmations: stirrer on ("SON"; "BLOW" when the battery is too low for it), stirrer off
// ("SOFF"), logging on ("LOG START"), logging off ("LOG STOP"), power off ("SSD"), log erased
// ("ERASED"). Prefixes are exact; the logging words are found anywhere, in any letter case.
bool stirrerStarted(const QString& reply);
bool batteryTooLow(const QString& reply);
bool stirrerStopped(const QString& reply);
bool loggingStarted(const QString& reply);
bool loggingStopped(const QString& reply);
bool poweredOff(const QString& reply);
bool logErased(const QString& reply);

// Wakes the meter, drains its status reply (with a half-second pause for a meter that is slow to
// wake), then "?K" and its reply. False when the link failed (abortRequested is set).
bool powerOff(CommandExchange& exchange, AppState& state);

// "Meter Battery Voltage = " and the reply to "?V" without its surrounding spaces.
QString voltageLine(const QString& reply);

} // namespace MeterControl
