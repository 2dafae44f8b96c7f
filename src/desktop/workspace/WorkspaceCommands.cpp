#include "desktop/workspace/WorkspaceCommands.h"

#include "core/readings/ReadingConversions.h"
#include "core/settings/Settings.h"
#include "desktop/shell/MainWindow.h"
#include "desktop/workspace/FindDialog.h"
#include "desktop/workspace/FormatDisplayDialog.h"
#include "desktop/workspace/WindowLayout.h"
#include "desktop/workspace/WorkspaceFiles.h"
#include "desktop/workspace/WorkspacePrinting.h"
#include "desktop/workspace/WorkspaceView.h"

#include <QAction>
#include <QApplication>
#include <QClipboard>
#include <QLabel>
#include <QMenu>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QTextCursor>
#include <QTextDocumentFragment>
#include <QTimer>

WorkspaceCommands::WorkspaceCommands(MainWindow& window)
    : QObject(&window), w_(window), files_(std::make_unique<WorkspaceFiles>(window)),
      printing_(std::make_unique<WorkspacePrinting>(window)),
      layout_(std::make_unique<WindowLayout>(window)) {
    WorkspaceView::configure(*w_.controls().RichTextBox1);
    connectControls();
}

WorkspaceCommands::~WorkspaceCommands() = default;

void WorkspaceCommands::connectControls() {
    const MainControls& c = w_.controls();
    connect(c.RichTextBox1, &QPlainTextEdit::textChanged, this, &WorkspaceCommands::onTextChanged);
    connect(c.RichTextBox1, &QPlainTextEdit::selectionChanged, this,
            &WorkspaceCommands::onSelectionChanged);
    connect(c.RichTextBox1, &QWidget::customContextMenuRequested, this,
            &WorkspaceCommands::onContextMenu);

    connect(c.mnuSelectAll, &QAction::triggered, this, &WorkspaceCommands::SelectAll);
    connect(c.mnuCopy, &QAction::triggered, this, &WorkspaceCommands::Copy);
    connect(c.mnuClear, &QAction::triggered, this, &WorkspaceCommands::Clear);
    connect(c.mnuUndoClear, &QAction::triggered, this, &WorkspaceCommands::UndoClear);
    connect(c.mnuFind, &QAction::triggered, this, &WorkspaceCommands::Find);

    connect(c.mnuOpen, &QAction::triggered, this, &WorkspaceCommands::OpenFileIntoWorkspace);
    connect(c.cmdOpenFile, &QPushButton::clicked, this, &WorkspaceCommands::OpenFileIntoWorkspace);
    connect(c.mnuSave, &QAction::triggered, this, &WorkspaceCommands::SaveWorkspace);
    connect(c.cmdSaveFile, &QPushButton::clicked, this, &WorkspaceCommands::SaveWorkspace);
    connect(c.mnuPrint, &QAction::triggered, this, &WorkspaceCommands::Print);
    connect(c.cmdPrint, &QPushButton::clicked, this, &WorkspaceCommands::Print);
    connect(c.mnuPrintSetUp, &QAction::triggered, this, &WorkspaceCommands::PrintSetup);
    connect(c.mnuFormatDisplay, &QAction::triggered, this, [this] {
        w_.StopVoltageDisplay();
        ShowFormatDialog();
    });

    connect(&w_, &MainWindow::resized, this, [this] { layout_->apply(); });
}

void WorkspaceCommands::SaveWorkspace() {
    files_->SaveWorkspace();
}
void WorkspaceCommands::OpenFileIntoWorkspace() {
    files_->OpenFileIntoWorkspace();
}
void WorkspaceCommands::Print() {
    printing_->Print();
}
void WorkspaceCommands::PrintSetup() {
    printing_->PrintSetup();
}

void WorkspaceCommands::ApplyDataConversions() {
    AppState& s = w_.state();
    s.workspaceText =
        ReadingConversions::fromSettings(s.convertMsToUs, s.convertPpkToPpm, s.convertAsterisks)
            .apply(s.workspaceText);
    w_.controls().RichTextBox1->setPlainText(s.workspaceText);
}

void WorkspaceCommands::ShowFormatDialog() {
    FormatDisplayDialog dialog(w_.state(), &w_);
    if (dialog.exec() == QDialog::Accepted)
        Settings::SaveSettings(w_.state(), w_.prompts());
}

// Save, Print and the Edit items follow whether the workspace holds text; while a continuous
// run fills it, the run's own enabling rules apply. Any change ends the chance to undo a Clear.
void WorkspaceCommands::onTextChanged() {
    const MainControls& c = w_.controls();
    if (c.RichTextBox1->document()->isEmpty()) {
        for (QAction* a : {c.mnuSelectAll, c.mnuClear, c.mnuFind, c.mnuPrint, c.mnuSave})
            a->setEnabled(false);
        c.cmdPrint->setEnabled(false);
        c.cmdSaveFile->setEnabled(false);
        c.lblHeader->clear();
    } else if (!w_.state().runActive) {
        c.cmdSaveFile->setEnabled(true);
        c.cmdPrint->setEnabled(true);
        c.mnuEdit->setEnabled(true);
        for (QAction* a : {c.mnuSave, c.mnuPrint, c.mnuFind, c.mnuSelectAll, c.mnuClear})
            a->setEnabled(true);
    }
    c.mnuUndoClear->setEnabled(false);
}

void WorkspaceCommands::onSelectionChanged() {
    const MainControls& c = w_.controls();
    const QTextCursor cursor = c.RichTextBox1->textCursor();
    c.mnuCopy->setEnabled(cursor.hasSelection());
    const int length = c.RichTextBox1->document()->characterCount() - 1;
    const bool wholeText = cursor.selectionStart() == 0 && cursor.selectionEnd() == length;
    c.mnuSelectAll->setEnabled(!wholeText);
}

void WorkspaceCommands::onContextMenu(const QPoint& pos) {
    const MainControls& c = w_.controls();
    if (!c.mnuEdit->isEnabled() || c.tmrRealTime->isActive() || c.tmrDisplayInterval->isActive() ||
        c.mnuVoltage->isChecked())
        return;
    c.mnuEdit->popup(c.RichTextBox1->viewport()->mapToGlobal(pos));
}

void WorkspaceCommands::Clear() {
    const MainControls& c = w_.controls();
    AppState& s = w_.state();
    c.tmrDisplayVoltage->stop();
    if (c.tmrRealTime->isActive())
        return;
    w_.PromptSaveAndClear(QString());
    w_.UncheckDisplayMenus();
    s.undoHeader = c.lblHeader->text();
    c.lblHeader->clear();
    s.undoText = s.workspaceText;
    s.workspaceText.clear();
    c.RichTextBox1->setPlainText(s.workspaceText);
    c.mnuUndoClear->setEnabled(true);
}

void WorkspaceCommands::UndoClear() {
    const MainControls& c = w_.controls();
    AppState& s = w_.state();
    c.lblHeader->setText(s.undoHeader);
    s.workspaceText = s.undoText;
    c.RichTextBox1->setPlainText(s.workspaceText);
    // One level only, also when the text did not change.
    c.mnuUndoClear->setEnabled(false);
}

void WorkspaceCommands::SelectAll() {
    if (!w_.controls().tmrRealTime->isActive())
        w_.controls().RichTextBox1->selectAll();
}

void WorkspaceCommands::Copy() {
    QClipboard* clipboard = QApplication::clipboard();
    clipboard->clear();
    clipboard->setText(w_.controls().RichTextBox1->textCursor().selection().toPlainText());
}

void WorkspaceCommands::Find() {
    if (!find_)
        find_ = std::make_unique<FindDialog>(w_);
    find_->start();
}
