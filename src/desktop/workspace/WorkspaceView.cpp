#include "desktop/workspace/WorkspaceView.h"

#include <QFont>
#include <QPlainTextEdit>

void WorkspaceView::configure(QPlainTextEdit& edit) {
    QFont font(QStringLiteral("Courier"));
    font.setPointSizeF(9.75);
    font.setStyleHint(QFont::TypeWriter);
    font.setFixedPitch(true);
    edit.setFont(font);
    edit.setReadOnly(true);
    edit.setTextInteractionFlags(Qt::TextSelectableByMouse | Qt::TextSelectableByKeyboard);
    edit.setUndoRedoEnabled(false);
    edit.setLineWrapMode(QPlainTextEdit::NoWrap);
    edit.setVerticalScrollBarPolicy(Qt::ScrollBarAlwaysOn);
    edit.setContextMenuPolicy(Qt::CustomContextMenu);
}
