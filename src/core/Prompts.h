#pragma once

#include <QString>

// The seam for every message box the program shows. The title is always empty.
// The real implementation shows a QMessageBox; tests answer from a script and keep the texts.
class Prompts {
public:
    enum class Icon { None, Information, Exclamation, Critical, Question };
    enum class Buttons { Ok, YesNo, RetryCancel };
    enum class Answer { Ok, Yes, No, Retry, Cancel };

    virtual ~Prompts() = default;
    // systemModal: the box stays above every window of the program (and of the desktop where
    // the platform allows it).
    virtual Answer show(const QString& text, Icon icon, Buttons buttons,
                        bool systemModal = false) = 0;

    // The answer of someone who declines: OK, No or Cancel.
    static Answer declined(Buttons buttons) {
        switch (buttons) {
        case Buttons::YesNo:
            return Answer::No;
        case Buttons::RetryCancel:
            return Answer::Cancel;
        case Buttons::Ok:
            break;
        }
        return Answer::Ok;
    }
};
