#pragma once

#include <QDialog>

class MainWindow;
class QLineEdit;

// The find dialog. It is not modal, but the main window is disabled while it is up; it is
// created once and afterwards only shown and hidden, so it keeps its search text. It has no
// parent widget (a disabled parent would disable it too); it stays above the main window as
// its transient window.
class FindDialog : public QDialog {
    Q_OBJECT
public:
    explicit FindDialog(MainWindow& window);

    // The Find menu item: search from the caret, prefill the selected text, show.
    void start();

private:
    void findNext();
    void dismiss();

    MainWindow& w_;
    QLineEdit* text1_ = nullptr;
};
