#pragma once

#include <QDialog>

class MainWindow;
class QLabel;
class QLineEdit;
class QPushButton;

// frmRealTimeInterval: asks for the real-time interval in whole seconds and validates it.
class RealTimeIntervalDialog : public QDialog {
    Q_OBJECT
public:
    explicit RealTimeIntervalDialog(MainWindow& window);

    // The accepted interval (valid after exec() returned Accepted).
    int seconds() const { return seconds_; }

    // cmdOK: accepts a valid entry, otherwise explains and keeps the dialog open.
    void ProcessUserInput();
    void SelectIntervalText();

protected:
    void showEvent(QShowEvent* event) override;

private:
    MainWindow& w_;
    QLabel* Label1 = nullptr;
    QLineEdit* txtLogInterval = nullptr;
    QPushButton* cmdOK = nullptr;
    QPushButton* cmdCancel = nullptr;
    int seconds_ = 0;
};
