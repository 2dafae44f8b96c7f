#pragma once

#include <QString>

class MainWindow;

// Print and Print Setup, on the main window's printer: the printer chosen in either dialog is
// kept for later printing.
class WorkspacePrinting {
public:
    explicit WorkspacePrinting(MainWindow& window);

    void Print();
    void PrintSetup();

    // Removes the line breaks that trailing carriage returns of the workspace text left at
    // the end of the control (the control shows each CR as a line break).
    static int trailingCarriageReturns(const QString& text);

private:
    void removeTrailingCarriageReturns();

    MainWindow& w_;
};
