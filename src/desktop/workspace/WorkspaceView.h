#pragma once

class QPlainTextEdit;

// How the workspace control is set up for its job: a fixed-pitch view of workspaceText.
class WorkspaceView {
public:
    // "Courier" 9.75 points, lines not wrapped (columns stay columns); read-only, so what is shown
    // is what a save writes; no undo history (the Edit menu has its own one-level Undo Clear, and
    // appended readings would otherwise pile up history); the vertical scroll bar always shown, so
    // the viewport keeps its width when text arrives and long texts are not laid out again line by
    // line.
    static void configure(QPlainTextEdit& edit);
};
