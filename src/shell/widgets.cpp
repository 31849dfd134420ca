#include "shell/widgets.h"

#include <QMouseEvent>
#include <QPainter>
#include <QPixmapCache>

namespace kickvane::shell {

bool LoadPicture(QPixmap& pixmap, const QString& file) {
    // The same few skin pictures are drawn on every tab switch and by all four panels: decode
    // each file once and share it.
    QPixmap loaded;
    if (!QPixmapCache::find(file, &loaded)) {
        if (!loaded.load(file)) {
            return false;
        }
        QPixmapCache::insert(file, loaded);
    }
    pixmap = loaded;
    return true;
}

void ClickableLabel::mouseReleaseEvent(QMouseEvent* event) {
    if (event->button() == Qt::LeftButton && rect().contains(event->position().toPoint())) {
        emit clicked();
    }
    QLabel::mouseReleaseEvent(event);
}

bool PictureBox::setPictureFile(const QString& file) {
    if (!LoadPicture(picture_, file)) {
        return false;
    }
    pictureFile_ = file;
    update();
    return true;
}

void PictureBox::setBackground(const QColor& colour) {
    background_ = colour;
    update();
}

void PictureBox::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    painter.fillRect(rect(), background_);
    if (!picture_.isNull()) {
        painter.drawPixmap(0, 0, picture_);
    }
}

void PictureBox::mouseReleaseEvent(QMouseEvent* event) {
    if (event->button() == Qt::LeftButton && rect().contains(event->position().toPoint())) {
        emit clicked();
    }
    QWidget::mouseReleaseEvent(event);
}

TabHead::TabHead(const QString& caption, QWidget* parent) : PictureBox(parent), caption_(caption) {
    setCursor(Qt::PointingHandCursor);
}

void TabHead::paintEvent(QPaintEvent* event) {
    PictureBox::paintEvent(event);
    QPainter painter(this);
    QFont font = painter.font();
    font.setBold(true);
    painter.setFont(font);
    // The caption stays readable on light and dark tab pictures alike.
    painter.setPen(QColor(255, 255, 255, 200));
    painter.drawText(rect().translated(1, 1), Qt::AlignCenter, caption_);
    painter.setPen(QColor(0x20, 0x30, 0x40));
    painter.drawText(rect(), Qt::AlignCenter, caption_);
}

}  // namespace kickvane::shell
