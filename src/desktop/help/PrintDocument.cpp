#include "desktop/help/PrintDocument.h"

#include <QAbstractTextDocumentLayout>
#include <QPainter>
#include <QPrinter>
#include <QTextDocument>
#include <QTextFrame>

bool printDocument(QTextDocument& document, QPrinter& printer) {
    QPainter painter;
    if (!painter.begin(&printer))
        return false;
    // Lay the text out in the printer's own resolution, one page of the printer at a time.
    document.documentLayout()->setPaintDevice(&printer);
    QTextFrameFormat frame = document.rootFrame()->frameFormat();
    frame.setMargin(2 / 2.54 * printer.logicalDpiY());
    document.rootFrame()->setFrameFormat(frame);
    const QSizeF page(printer.width(), printer.height());
    document.setPageSize(page);

    const int pages = document.pageCount();
    for (int i = 0; i < pages; ++i) {
        if (i > 0 && !printer.newPage())
            return false;
        painter.save();
        painter.translate(0, -i * page.height());
        document.drawContents(&painter, QRectF(QPointF(0, i * page.height()), page));
        painter.restore();
    }
    return painter.end() && printer.printerState() != QPrinter::Error;
}
