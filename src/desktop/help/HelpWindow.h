#pragma once

#include "core/text/HelpFile.h"

#include <QDialog>
#include <QList>

struct AppState;
class Prompts;
class PlatformDialogs;
class QLabel;
class QPrinter;
class QTextEdit;

// The help windows: frmHelp (general help, 13 topics) and frmK5Help (the commands of other
// meters, 8 topics). A column of topic labels with an arrow beside the shown one, the topic text
// with its title as a heading, and a printer picture. The last two labels print the help file and
// close the window.
//
// Controls carry object names for tests: "lblHelpTopic_<i>", "imgArrow_<i>", "RichTextBox1",
// "imgPrint" and, in the general window, "Label20".
class HelpWindow : public QDialog {
    Q_OBJECT
public:
    HelpWindow(HelpKind kind, AppState& state, Prompts& prompts, PlatformDialogs& dialogs,
               const QString& folder, QWidget* parent = nullptr);

    // Reads the window's help file into the shared topic list.
    void LoadHelpFile();
    // Shows topic `index` and moves the arrow to it.
    void HelpSelect(int index);
    // Prints every topic except the print and exit ones, through the print dialog.
    void PrintHelpFile();
    // The printer chosen in Print Setup; without one, each print starts from a new printer.
    void usePrinter(QPrinter* printer) { printer_ = printer; }

    HelpKind kind() const { return kind_; }
    int selectedTopic() const { return selectedTopic_; }
    int shownTopic() const { return shownTopic_; }
    QLabel* topicLabel(int index) const { return labels_.value(index); }
    QLabel* arrow(int index) const { return arrows_.value(index); }
    QTextEdit* textArea() const { return text_; }
    QLabel* printPicture() const { return print_; }

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void buildControls();
    QWidget* buildTopicColumn();
    bool handleKey(int key);
    void moveSelection(int step);
    void runLabel(int index);

    HelpKind kind_;
    AppState& state_;
    Prompts& prompts_;
    PlatformDialogs& dialogs_;
    QString folder_;
    QList<QLabel*> labels_;
    QList<QLabel*> arrows_;
    QTextEdit* text_ = nullptr;
    QLabel* print_ = nullptr;
    QPrinter* printer_ = nullptr;
    int selectedTopic_ = 0; // moved by the keys only
    int shownTopic_ = 0;
};
