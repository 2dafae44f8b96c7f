#pragma once

#include <QAbstractButton>
#include <QApplication>
#include <QDialog>
#include <QStringList>
#include <QTimer>

// Closes every modal dialog that comes up while it lives, by its Cancel button (or by
// rejecting it), and keeps their object names. Fault scenarios do not know in advance which
// dialog a fault leads to (frmCommError, a port dialog, none), only that the window must be
// usable afterwards.
class ModalDismisser {
public:
    explicit ModalDismisser(const QString& button = QStringLiteral("cmdCancel")) {
        timer_.setInterval(20);
        QObject::connect(&timer_, &QTimer::timeout, [this, button] {
            QWidget* modal = QApplication::activeModalWidget();
            if (!modal || !modal->isVisible())
                return;
            seen << modal->objectName();
            if (auto* b = modal->findChild<QAbstractButton*>(button))
                b->click();
            else if (auto* d = qobject_cast<QDialog*>(modal))
                d->reject();
            else
                modal->close();
        });
        timer_.start();
    }

    QStringList seen;

private:
    QTimer timer_;
};
