#pragma once

#include <QString>
#include <memory>

class MainWindow;
class QPrinter;

// Print and Print Setup. The printer chosen in either dialog is kept for later printing.
class WorkspacePrinting {
public:
    explicit WorkspacePrinting(MainWindow& window);
    ~WorkspacePrinting();

    void Print();
    void PrintSetup();

    // Removes the line breaks that trailing carriage returns of the workspace text left at
    // the end of the control (the control shows each CR as a line break).
    static int trailingCarriageReturns(const QString& text);

private:
    void removeTrailingCarriageReturns();

    MainWindow& w_;
    std::unique_ptr<QPrinter> printer_;
};
