#pragma once

#include <QDialog>

struct AppState;
class QRadioButton;

// The data-format dialog: three Yes/No choices for the conversions of downloaded and saved
// data. OK stores the choices in AppState (the caller then writes the settings); Cancel
// changes nothing.
class FormatDisplayDialog : public QDialog {
    Q_OBJECT
public:
    FormatDisplayDialog(AppState& state, QWidget* parent);

private:
    void storeChoices();

    AppState& state_;
    QRadioButton* yes_[3] = {};
};
