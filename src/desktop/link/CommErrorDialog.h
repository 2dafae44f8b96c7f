#pragma once

#include <QDialog>

// frmCommError: what went wrong on the line, and Setup, Retry or Cancel.
class CommErrorDialog : public QDialog {
    Q_OBJECT
public:
    enum class Choice { Setup, Retry, Cancel };
    explicit CommErrorDialog(QWidget* parent);
    Choice choice() const { return choice_; }

private:
    Choice choice_ = Choice::Cancel; // closing by the frame counts as Cancel
};
