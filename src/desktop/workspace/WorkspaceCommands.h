#pragma once

#include <QObject>
#include <memory>

class MainWindow;
class FindDialog;
class WorkspaceFiles;
class WorkspacePrinting;
class WindowLayout;
class QPoint;

// The workspace: its text rules, the Edit menu and find, the data-format dialog, save and
// open, printing and the main window's layout. Connects itself to the controls it serves.
class WorkspaceCommands : public QObject {
    Q_OBJECT
public:
    explicit WorkspaceCommands(MainWindow& window);
    ~WorkspaceCommands() override;

    // The save routine (Save button, Save menu item, the "Yes" of the save prompt).
    void SaveWorkspace();
    // Converts workspaceText as the data-format settings say and shows it in the workspace.
    void ApplyDataConversions();
    // The data-format dialog, modal; OK stores the settings. Also used by the setup wizard.
    void ShowFormatDialog();
    void OpenFileIntoWorkspace();
    void Print();
    void PrintSetup();

    void Clear();
    void UndoClear();
    void SelectAll();
    void Copy();
    void Find();

private:
    void onTextChanged();
    void onSelectionChanged();
    void onContextMenu(const QPoint& pos);
    void connectControls();

    MainWindow& w_;
    std::unique_ptr<WorkspaceFiles> files_;
    std::unique_ptr<WorkspacePrinting> printing_;
    std::unique_ptr<WindowLayout> layout_;
    std::unique_ptr<FindDialog> find_;
};
