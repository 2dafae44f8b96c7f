#include "desktop/workspace/WorkspacePrinting.h"

#include "core/Prompts.h"
#include "desktop/shell/MainWindow.h"
#include "desktop/shell/PlatformDialogs.h"

#include <QFont>
#include <QPlainTextEdit>
#include <QPrinter>
#include <QTextBlock>
#include <QTextCursor>
#include <QTextDocument>
#include <QTextDocumentFragment>

WorkspacePrinting::WorkspacePrinting(MainWindow& window) : w_(window) {}

int WorkspacePrinting::trailingCarriageReturns(const QString& text) {
    int count = 0;
    for (qsizetype i = text.size() - 1; i >= 0 && text[i] == u'\r'; --i)
        ++count;
    return count;
}

void WorkspacePrinting::removeTrailingCarriageReturns() {
    QPlainTextEdit* edit = w_.controls().RichTextBox1;
    const int count = trailingCarriageReturns(w_.state().workspaceText);
    if (count == 0 || edit->document()->isEmpty())
        return;
    QTextCursor cursor(edit->document());
    cursor.movePosition(QTextCursor::End);
    for (int i = 0; i < count && cursor.block().text().isEmpty() && cursor.position() > 0; ++i)
        cursor.deletePreviousChar();
}

void WorkspacePrinting::Print() {
    w_.StopVoltageDisplay();
    QPrinter& printer = w_.printer();
    if (!w_.dialogs().askPrinter(&w_, printer))
        return;
    removeTrailingCarriageReturns();

    const QTextCursor selection = w_.controls().RichTextBox1->textCursor();
    QTextDocument doc;
    QFont font(QStringLiteral("Courier New"));
    font.setPointSizeF(9.75);
    font.setStyleHint(QFont::TypeWriter);
    doc.setDefaultFont(font);
    doc.setPlainText(selection.hasSelection() ? selection.selection().toPlainText()
                                              : w_.controls().RichTextBox1->toPlainText());
    doc.print(&printer);
    if (printer.printerState() == QPrinter::Error) {
        const QString target =
            printer.outputFileName().isEmpty() ? printer.printerName() : printer.outputFileName();
        w_.prompts().show(QStringLiteral("The document could not be printed on %1.").arg(target),
                          Prompts::Icon::Information, Prompts::Buttons::Ok);
    }
}

void WorkspacePrinting::PrintSetup() {
    w_.StopVoltageDisplay();
    w_.dialogs().askPrinter(&w_, w_.printer());
}
