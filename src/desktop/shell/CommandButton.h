#pragma once

#include <QPushButton>

// A command button whose caption wraps onto two lines, so the narrow buttons of the command row
// keep their full captions ("Current Data", "Enable Logging").
class CommandButton : public QPushButton {
    Q_OBJECT
public:
    CommandButton(const QString& caption, QWidget* parent);

protected:
    void paintEvent(QPaintEvent* event) override;
};
