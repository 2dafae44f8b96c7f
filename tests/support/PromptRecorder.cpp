#include "PromptRecorder.h"

Prompts::Answer PromptRecorder::show(const QString& text, Icon icon, Buttons buttons,
                                     bool systemModal) {
    const Shown s{text, icon, buttons, systemModal};
    shown.append(s);
    if (onShow)
        onShow(s);
    if (!script_.isEmpty())
        return script_.dequeue();
    return declined(buttons);
}

QStringList PromptRecorder::texts() const {
    QStringList list;
    for (const Shown& s : shown)
        list << s.text;
    return list;
}
