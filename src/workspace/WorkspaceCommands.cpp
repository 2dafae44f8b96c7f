#include "workspace/WorkspaceCommands.h"

#include "shell/MainWindow.h"

#include <QPlainTextEdit>

WorkspaceCommands::WorkspaceCommands(MainWindow& window) : QObject(&window), w_(window) {}

void WorkspaceCommands::SaveWorkspace() {}

void WorkspaceCommands::ApplyDataConversions() {
    w_.controls().RichTextBox1->setPlainText(w_.state().workspaceText);
}

void WorkspaceCommands::ShowFormatDialog() {}
