#pragma once

#include <QString>

struct AppState;
class QPlainTextEdit;

// Adds received lines to the workspace one at a time: workspaceText grows and the view gets
// only the new text, so the ten-thousandth line costs no more than the first.
class WorkspaceLines {
public:
    // Appends text to workspaceText and to the end of the view, and puts the caret (and the
    // newest line) in view. The view then shows what setting it to workspaceText would show.
    static void append(AppState& state, QPlainTextEdit* view, const QString& text);
};
