#include "desktop/workspace/FindDialog.h"

#include "core/Prompts.h"
#include "core/text/FindText.h"
#include "desktop/shell/MainWindow.h"

#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QTextCursor>
#include <QTextDocumentFragment>
#include <QVBoxLayout>
#include <QWindow>

FindDialog::FindDialog(MainWindow& window) : QDialog(nullptr), w_(window) {
    setObjectName(QStringLiteral("frmFind"));
    setWindowTitle(QStringLiteral(" Find"));
    setModal(false);

    auto* label = new QLabel(QStringLiteral("Search  text :"), this);
    label->setObjectName(QStringLiteral("Label1"));
    text1_ = new QLineEdit(this);
    text1_->setObjectName(QStringLiteral("Text1"));
    // Enter in the text box presses the default button, Find.
    auto* find = new QPushButton(QStringLiteral("Find"), this);
    find->setObjectName(QStringLiteral("cmdFind"));
    find->setDefault(true);
    auto* cancel = new QPushButton(QStringLiteral("Cancel"), this);
    cancel->setObjectName(QStringLiteral("cmdCancel"));
    cancel->setAutoDefault(false);

    auto* row = new QHBoxLayout;
    row->addWidget(label);
    row->addWidget(text1_, 1);
    auto* buttons = new QVBoxLayout;
    buttons->addWidget(find);
    buttons->addWidget(cancel);
    auto* layout = new QHBoxLayout(this);
    layout->addLayout(row, 1);
    layout->addLayout(buttons);
    resize(420, sizeHint().height());

    connect(find, &QPushButton::clicked, this, &FindDialog::findNext);
    connect(cancel, &QPushButton::clicked, this, &QDialog::reject);
    // Cancel, Escape and the window frame all end here; the dialog is only hidden.
    connect(this, &QDialog::rejected, this, &FindDialog::dismiss);
}

void FindDialog::start() {
    AppState& s = w_.state();
    const QTextCursor cursor = w_.controls().RichTextBox1->textCursor();
    s.findStart = static_cast<qint32>(
        qMax<qsizetype>(1, FindText::textIndex(s.workspaceText, cursor.selectionStart()) + 2));
    w_.setEnabled(false);
    if (cursor.hasSelection()) {
        const QString selected = cursor.selection().toPlainText();
        text1_->setText(selected);
        s.findTextLength = static_cast<int>(selected.size());
    }
    if (!windowHandle())
        create();
    if (windowHandle() && w_.windowHandle())
        windowHandle()->setTransientParent(w_.windowHandle());
    show();
    raise();
    activateWindow();
    text1_->setFocus();
    text1_->setSelection(0, s.findTextLength);
}

void FindDialog::findNext() {
    AppState& s = w_.state();
    const QString search = text1_->text();
    s.findTextLength = static_cast<int>(search.size());
    if (search.isEmpty()) {
        text1_->setFocus();
        text1_->deselect();
        return;
    }
    const qsizetype p = FindText::find(s.workspaceText, search, s.findStart);
    if (p == 0) {
        // The message box must not belong to a disabled window; it is modal itself, so the
        // main window stays out of reach until the message is closed.
        w_.setEnabled(true);
        w_.prompts().show(QStringLiteral("Search  text  not  found."), Prompts::Icon::Exclamation,
                          Prompts::Buttons::Ok);
        reject();
        return;
    }
    QPlainTextEdit* edit = w_.controls().RichTextBox1;
    QTextCursor cursor = edit->textCursor();
    cursor.setPosition(static_cast<int>(FindText::documentPosition(s.workspaceText, p - 1)));
    cursor.setPosition(
        static_cast<int>(FindText::documentPosition(s.workspaceText, p - 1 + search.size())),
        QTextCursor::KeepAnchor);
    edit->setTextCursor(cursor);
    s.findStart = static_cast<qint32>(p + 1);
    text1_->setFocus();
    text1_->selectAll();
}

void FindDialog::dismiss() {
    w_.setEnabled(true);
    w_.activateWindow();
    w_.setFocus();
    hide();
}
