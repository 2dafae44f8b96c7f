#pragma once

#include <QDialog>

// The dialog a save shows when the chosen file already exists: Append, Overwrite or Rename.
// Closing it by its frame (or Escape) leaves the choice empty, which the save treats like
// Rename.
class FileExistsDialog : public QDialog {
    Q_OBJECT
public:
    explicit FileExistsDialog(QWidget* parent);
    // "Append", "Overwrite", "Rename", or "" when closed without a choice.
    QString choice() const { return choice_; }

private:
    void choose(const QString& choice);
    QString choice_;
};
