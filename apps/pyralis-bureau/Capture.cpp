#include "Capture.h"

#include <QFont>
#include <QImage>
#include <QPainter>
#include <QPixmap>
#include <QWidget>

namespace pyr::bureau {

bool SaveCapture(QWidget& window, const QString& path) {
    const QPixmap inside = window.grab();
    const int titleHeight = window.fontMetrics().height() + 12;
    QImage picture(inside.width(), inside.height() + titleHeight, QImage::Format_ARGB32);
    picture.fill(QColor(60, 63, 70));
    QPainter painter(&picture);
    QFont font = window.font();
    font.setBold(true);
    painter.setFont(font);
    painter.setPen(Qt::white);
    painter.drawText(QRect(10, 0, inside.width() - 20, titleHeight), Qt::AlignVCenter | Qt::AlignLeft,
                     window.windowTitle());
    painter.drawPixmap(0, titleHeight, inside);
    painter.end();
    return picture.save(path, "PNG");
}

} // namespace pyr::bureau
