#include "desktop/readings/RecordDownload.h"

#include "core/readings/RecordTransfer.h"
#include "core/readings/ReplyWords.h"
#include "desktop/instrument/InstrumentCommands.h"
#include "desktop/link/Exchange.h"
#include "desktop/shell/MainWindow.h"

#include <QAction>
#include <QLabel>
#include <QPlainTextEdit>
#include <QPushButton>

RecordDownload::RecordDownload(MainWindow& window) : w_(window), s_(window.state()) {}

void RecordDownload::DisplayGLP() {
    download(Kind::Glp);
}

void RecordDownload::DisplayMaxMin() {
    download(Kind::MaxMin);
}

void RecordDownload::showLinkError(Kind kind) {
    if (kind == Kind::MaxMin)
        w_.setMessage(QString());
    w_.exchange().ShowCommError();
}

void RecordDownload::download(Kind kind) {
    const MainControls& c = w_.controls();
    const bool glp = kind == Kind::Glp;
    w_.StopVoltageDisplay();
    w_.PromptSaveAndClear(QString());
    w_.instrument().QueryStatus();
    if (s_.abortRequested) {
        showLinkError(kind);
        return;
    }
    if (s_.responseText.isEmpty() || replywords::hasAny(s_.replyText, {"BUSY", "EXIT", "ERROR"}))
        return;

    if (glp) {
        c.RichTextBox1->clear();
        c.RichTextBox1->repaint();
        s_.workspaceText.clear();
        w_.setMessage(QStringLiteral("Retrieving  GLP  information ..."));
    } else {
        c.lblMessage->setText(QStringLiteral("Retrieving  Max/Min  data ..."));
        w_.repaint();
    }

    const auto result = RecordTransfer::run(
        w_.exchange(), s_, glp ? RecordTransfer::Kind::Glp : RecordTransfer::Kind::MaxMin);
    switch (result.end) {
    case RecordTransfer::End::Complete:
        s_.workspaceText = result.text;
        showBlock(kind);
        return;
    case RecordTransfer::End::ReplyFailed:
        if (!glp)
            w_.setMessage(QString());
        return;
    case RecordTransfer::End::LinkFailed:
        // The lines that came before the link failed are shown and can be saved.
        if (!result.text.isEmpty()) {
            s_.workspaceText = result.text;
            showBlock(kind);
        }
        showLinkError(kind);
        return;
    }
}

void RecordDownload::showBlock(Kind kind) {
    const MainControls& c = w_.controls();
    if (kind == Kind::Glp) {
        w_.UncheckDisplayMenus();
        c.cmdSaveFile->setEnabled(true);
        c.mnuSave->setEnabled(true);
        // The view was emptied before the download: an empty block leaves it unchanged, so
        // no change rule takes Save away again.
        if (c.RichTextBox1->toPlainText() != s_.workspaceText)
            c.RichTextBox1->setPlainText(s_.workspaceText);
        c.mnuGLP->setChecked(true);
    } else {
        c.RichTextBox1->setPlainText(s_.workspaceText);
        w_.UncheckDisplayMenus();
        c.mnuMaxMin->setChecked(true);
        c.cmdSaveFile->setEnabled(true);
        c.mnuSave->setEnabled(true);
    }
    w_.setMessage(QString());
}
