#include "desktop/help/HelpIcons.h"

#include <QPainter>
#include <QPainterPath>
#include <QPolygonF>

namespace HelpIcons {

QPixmap arrow() {
    QPixmap pix(18, 14);
    pix.fill(Qt::transparent);
    QPainter p(&pix);
    p.setRenderHint(QPainter::Antialiasing);
    p.setPen(Qt::NoPen);
    p.setBrush(QColor(0, 96, 160));
    p.drawRect(QRectF(1, 5, 9, 4));
    p.drawPolygon(QPolygonF{QPointF(9, 1), QPointF(17, 7), QPointF(9, 13)});
    return pix;
}

QPixmap printer() {
    QPixmap pix(40, 36);
    pix.fill(Qt::transparent);
    QPainter p(&pix);
    p.setRenderHint(QPainter::Antialiasing);
    p.setPen(QPen(QColor(40, 40, 40), 1.5));
    // Paper going in at the top.
    p.setBrush(Qt::white);
    p.drawRect(QRectF(11, 2, 18, 13));
    // Body.
    p.setBrush(QColor(170, 170, 176));
    QPainterPath body;
    body.addRoundedRect(QRectF(3, 13, 34, 14), 3, 3);
    p.drawPath(body);
    // Printed sheet coming out at the front, with a few lines of text.
    p.setBrush(Qt::white);
    p.drawRect(QRectF(9, 22, 22, 12));
    p.setPen(QPen(QColor(90, 90, 90), 1));
    for (int y = 26; y <= 31; y += 2)
        p.drawLine(QPointF(12, y), QPointF(28, y));
    // Power light.
    p.setPen(Qt::NoPen);
    p.setBrush(QColor(40, 170, 60));
    p.drawEllipse(QRectF(31, 16, 3, 3));
    return pix;
}

} // namespace HelpIcons
