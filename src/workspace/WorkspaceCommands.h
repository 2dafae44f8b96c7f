#pragma once

#include <QObject>

class MainWindow;

// Workspace text rules, Edit menu and find, data format, save and open, printing, layout.
class WorkspaceCommands : public QObject {
    Q_OBJECT
public:
    explicit WorkspaceCommands(MainWindow& window);

    // The save routine (Save button, Save menu item, the "Yes" of the save prompt).
    void SaveWorkspace();
    // Converts workspaceText as the data-format settings say and shows it in the workspace.
    void ApplyDataConversions();
    // The data-format dialog (also shown by the setup wizard).
    void ShowFormatDialog();

private:
    MainWindow& w_;
};
