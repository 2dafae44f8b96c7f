#pragma once

#include "core/Prompts.h"

#include <QList>
#include <QQueue>
#include <QString>
#include <QStringList>
#include <functional>

// A Prompts that answers from a script and keeps every message shown.
// Without a scripted answer it presses the last button: OK, No or Cancel.
class PromptRecorder : public Prompts {
public:
    struct Shown {
        QString text;
        Icon icon;
        Buttons buttons;
        bool systemModal;
    };

    Answer show(const QString& text, Icon icon, Buttons buttons, bool systemModal) override;

    void answerNext(Answer answer) { script_.enqueue(answer); }
    // Called while the message is "up" (inside the exchange), before it is answered.
    std::function<void(const Shown&)> onShow;

    QList<Shown> shown;
    QStringList texts() const;
    bool saw(const QString& text) const { return texts().contains(text); }
    void clear() { shown.clear(); }

private:
    QQueue<Answer> script_;
};
