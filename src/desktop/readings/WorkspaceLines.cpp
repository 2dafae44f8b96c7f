#include "desktop/readings/WorkspaceLines.h"

#include "core/settings/AppState.h"

#include <QPlainTextEdit>
#include <QTextCursor>

void WorkspaceLines::append(AppState& state, QPlainTextEdit* view, const QString& text) {
    // The view turns CR LF into one line break and a lone CR into one as well. A meter's LF that
    // arrives at the front of the next line joins the CR that ended the previous one.
    const bool joinsBreak =
        text.startsWith(QLatin1Char('\n')) && state.workspaceText.endsWith(QLatin1Char('\r'));
    state.workspaceText += text;
    QTextCursor cursor(view->document());
    cursor.movePosition(QTextCursor::End);
    cursor.insertText(joinsBreak ? text.mid(1) : text);
    view->moveCursor(QTextCursor::End);
}
