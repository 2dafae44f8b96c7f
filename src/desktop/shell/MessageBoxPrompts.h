#pragma once

#include "core/Prompts.h"

class QWidget;

// Prompts shown as QMessageBox with an empty title, over the given parent window.
class MessageBoxPrompts : public Prompts {
public:
    explicit MessageBoxPrompts(QWidget* parent = nullptr) : parent_(parent) {}
    void setParent(QWidget* parent) { parent_ = parent; }
    Answer show(const QString& text, Icon icon, Buttons buttons, bool systemModal) override;

private:
    QWidget* parent_;
};
