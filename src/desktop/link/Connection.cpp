#include "desktop/link/Connection.h"

#include "core/instrument/StatusQuery.h"

#include "core/link/PortProbe.h"
#include "core/link/SerialLine.h"
#include "core/settings/Settings.h"
#include "desktop/instrument/InstrumentCommands.h"
#include "desktop/link/CommsPortDialog.h"
#include "desktop/link/Exchange.h"
#include "desktop/link/PortErrorDialog.h"
#include "desktop/shell/MainWindow.h"

#include <QAction>
#include <QLabel>
#include <QTimer>

Connection::Connection(MainWindow& window) : QObject(&window), w_(window), s_(window.state()) {
    const MainControls& c = w_.controls();
    connect(c.tmrDetectMeter, &QTimer::timeout, this, &Connection::tmrDetectMeter_Timer);
    connect(c.mnuDetectMeter, &QAction::triggered, this, &Connection::ConnectMeter);
    connect(c.mnuCommsPort, &QAction::triggered, this, [this] {
        w_.StopVoltageDisplay();
        ShowCommsPortDialog();
    });
}

void Connection::ConnectMeter() {
    const MainControls& c = w_.controls();
    c.tmrDetectMeter->stop();
    try {
        s_.ioResult = w_.serial().close();
    } catch (const std::exception&) {
    }
    c.mnuDetectMeter->setEnabled(false);
    w_.setMessage(QStringLiteral("Searching  for  meter  on  ") + s_.portName +
                  QStringLiteral("  at  ") + QString::number(s_.baudRate) +
                  QStringLiteral("  baud ..."));
    const bool exists = PortProbe::comPortExists(s_.portName);
    const QString mode = QStringLiteral("baud=") + QString::number(s_.baudRate) +
                         QStringLiteral(" parity=N data=8 stop=1");
    try {
        s_.ioResult = w_.serial().open(s_.portDevicePath, mode);
    } catch (const std::exception&) {
        s_.ioResult = -1;
    }
    if (s_.ioResult != 0) {
        w_.setMessage(QString());
        const auto kind =
            exists ? PortErrorDialog::Kind::InUse : PortErrorDialog::Kind::Unavailable;
        PortErrorDialog::Choice choice = PortErrorDialog::Choice::Cancel;
        {
            PortErrorDialog dialog(kind, s_.portName, &w_);
            dialog.exec();
            choice = dialog.choice();
        }
        switch (choice) {
        case PortErrorDialog::Choice::Retry:
            ConnectMeter();
            break;
        case PortErrorDialog::Choice::Setup:
            ShowCommsPortDialog();
            break;
        case PortErrorDialog::Choice::Cancel:
            c.mnuDetectMeter->setEnabled(true);
            break;
        }
        return;
    }
    c.tmrDetectMeter->start();
}

void Connection::ShowCommsPortDialog() {
    QString port;
    qint32 baud = 0;
    {
        CommsPortDialog dialog(s_.portName, s_.baudRate, w_.prompts(), &w_);
        if (dialog.exec() != QDialog::Accepted)
            return;
        port = dialog.chosenPort();
        baud = dialog.chosenBaud();
    }
    Settings::SetPortName(s_, port);
    s_.baudRate = baud;
    // Saved before connecting, so a failed attempt still keeps the new port and speed.
    Settings::SaveSettings(s_, w_.prompts());
    ConnectMeter();
}

void Connection::tmrDetectMeter_Timer() {
    Exchange& exchange = w_.exchange();
    if (exchange.inProgress())
        return; // a dialog of an earlier exchange is still up; poll again at the next tick
    const MainControls& c = w_.controls();
    if (!StatusQuery::poll(exchange, s_)) {
        if (s_.abortRequested) {
            c.tmrDetectMeter->stop();
            exchange.ShowCommError();
        }
        return;
    }
    w_.setMessage(QStringLiteral("Device  detected  on  ") + s_.portName + QStringLiteral(" ..."));
    c.tmrDetectMeter->stop();
    w_.instrument().QueryStatus();
    w_.setMessage(QString());
    if (s_.abortRequested)
        exchange.ShowCommError();
}
