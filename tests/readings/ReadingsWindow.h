#pragma once

// Helpers shared by the readings window tests (header only: each test is its own program).

#include "readings/ReadingCommands.h"
#include "support/DialogDriver.h"
#include "support/WindowFixture.h"

#include <QAction>
#include <QLabel>
#include <QLineEdit>
#include <QMenu>
#include <QPlainTextEdit>
#include <QProgressBar>
#include <QPushButton>
#include <QTest>
#include <QTimer>

namespace readingstest {

// Everything the meter received after the first occurrence of marker.
inline QByteArray receivedAfter(const metersim::Meter& meter, const QByteArray& marker) {
    const QByteArray all = meter.received();
    const qsizetype at = all.indexOf(marker);
    return at < 0 ? QByteArray() : all.mid(at + marker.size());
}

// The workspace lines (workspaceText split at LF, the empty piece after the last LF dropped).
inline QStringList lines(const QString& text) {
    QStringList l = text.split(QLatin1Char('\n'));
    if (!l.isEmpty() && l.constLast().isEmpty())
        l.removeLast();
    return l;
}

// Clicks once the condition holds (checked every 5 ms while the operation pumps events).
inline void clickWhen(QAbstractButton* button, std::function<bool()> condition) {
    auto* timer = new QTimer(button);
    timer->setInterval(5);
    QObject::connect(timer, &QTimer::timeout, button, [timer, button, condition] {
        if (!condition())
            return;
        timer->stop();
        timer->deleteLater();
        button->click();
    });
    timer->start();
}

// The state a window is in when no continuous operation runs.
inline bool commandsBack(WindowFixture& fx) {
    const MainControls& c = fx.c();
    return c.cmdStopCurrentData->isHidden() && c.cmdCurrentData->isVisible() &&
           c.cmdCurrentData->isEnabled() && c.mnuDisplay->isEnabled() && !fx.state().runActive;
}

// Presses Current Data and answers the interval dialog with entry.
inline void startRealTime(WindowFixture& fx, const QString& entry) {
    DialogDriver::whenModal(QStringLiteral("frmRealTimeInterval"), [entry](QWidget* d) {
        d->findChild<QLineEdit*>(QStringLiteral("txtLogInterval"))->setText(entry);
        DialogDriver::click(d, QStringLiteral("cmdOK"));
    });
    fx.c().cmdCurrentData->click();
}

} // namespace readingstest
