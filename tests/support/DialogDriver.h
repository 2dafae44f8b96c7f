#pragma once

#include <QString>
#include <QStringList>
#include <functional>

class QWidget;

// Drives modal dialogs in window tests. whenModal() arms a poll that waits for the next modal
// widget (optionally with the given object name), runs the action on it, and records a failure
// (closing the dialog) when none appears or it is still open a while after the action.
namespace DialogDriver {

void whenModal(const QString& objectName, std::function<void(QWidget*)> action,
               int timeoutMs = 5000);
// Clicks the child button with that object name.
void click(QWidget* dialog, const QString& buttonName);
// whenModal + click.
void clickWhenModal(const QString& dialogName, const QString& buttonName, int timeoutMs = 5000);
// Failures seen by the drivers since the last call (empty when all went well).
QStringList takeFailures();

} // namespace DialogDriver
