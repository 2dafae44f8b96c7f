#include "desktop/readings/RecordDownload.h"

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

    Exchange& exchange = w_.exchange();
    {
        Exchange::Scope busy(exchange);
        exchange.FlushInput();
        if (!s_.abortRequested) {
            s_.commandText = glp ? QStringLiteral("?G\r") : QStringLiteral("?M\r");
            exchange.SerialWrite(s_.commandText);
        }
        if (s_.abortRequested) {
            showLinkError(kind);
            return;
        }
        QString text;
        // The block ends with a line beginning "END" (exactly, in capitals), "ENDS" included.
        while (s_.responseText.left(3) != QLatin1String("END")) {
            exchange.SendCommand();
            if (s_.abortRequested) {
                // The lines that came before the link failed are shown and can be saved.
                if (!text.isEmpty()) {
                    s_.workspaceText = text;
                    showBlock(kind);
                }
                showLinkError(kind);
                return;
            }
            if (replywords::unusable(s_.responseText)) {
                if (!glp)
                    w_.setMessage(QString());
                return;
            }
            exchange.SerialWrite(QStringLiteral("\n"));
            if (s_.abortRequested) {
                showLinkError(kind);
                return;
            }
            if (s_.responseText.left(3) != QLatin1String("END")) {
                QString line = s_.responseText;
                if (line.endsWith(QLatin1Char('\r')))
                    line.chop(1);
                if (!glp)
                    text += QLatin1Char(' ');
                text += line;
                text += QLatin1Char('\n');
            }
        }
        s_.workspaceText = text;
    }
    showBlock(kind);
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
