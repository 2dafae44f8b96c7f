#include "DialogDriver.h"

#include <QAbstractButton>
#include <QApplication>
#include <QDialog>
#include <QElapsedTimer>
#include <QPointer>
#include <QTimer>
#include <memory>

namespace {
QStringList failures;

void closeStuck(QWidget* w) {
    if (auto* d = qobject_cast<QDialog*>(w))
        d->reject();
    else
        w->close();
}
} // namespace

namespace DialogDriver {

void whenModal(const QString& objectName, std::function<void(QWidget*)> action, int timeoutMs) {
    auto clock = std::make_shared<QElapsedTimer>();
    clock->start();
    auto* timer = new QTimer(qApp);
    timer->setInterval(10);
    QObject::connect(timer, &QTimer::timeout, timer, [=] {
        QWidget* modal = QApplication::activeModalWidget();
        if (modal && (objectName.isEmpty() || modal->objectName() == objectName)) {
            timer->stop();
            timer->deleteLater();
            QPointer<QWidget> guard(modal);
            action(modal);
            // Watchdog: a dialog the action should have closed must not hang the suite.
            QTimer::singleShot(3000, qApp, [guard, objectName] {
                if (guard && guard->isVisible() && QApplication::activeModalWidget() == guard) {
                    failures
                        << QStringLiteral("dialog %1 still open after its action").arg(objectName);
                    closeStuck(guard);
                }
            });
            return;
        }
        if (clock->elapsed() > timeoutMs) {
            timer->stop();
            timer->deleteLater();
            failures << QStringLiteral("no modal dialog %1 appeared").arg(objectName);
            if (modal)
                closeStuck(modal);
        }
    });
    timer->start();
}

void click(QWidget* dialog, const QString& buttonName) {
    auto* button = dialog->findChild<QAbstractButton*>(buttonName);
    if (!button) {
        failures << QStringLiteral("no button %1 in %2").arg(buttonName, dialog->objectName());
        closeStuck(dialog);
        return;
    }
    button->click();
}

void clickWhenModal(const QString& dialogName, const QString& buttonName, int timeoutMs) {
    whenModal(
        dialogName, [buttonName](QWidget* d) { click(d, buttonName); }, timeoutMs);
}

QStringList takeFailures() {
    QStringList f = failures;
    failures.clear();
    return f;
}

} // namespace DialogDriver
