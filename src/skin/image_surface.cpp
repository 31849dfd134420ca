#include "skin/image_surface.h"

#include <algorithm>
#include <limits>

#include <QCoreApplication>
#include <QGuiApplication>
#include <QPainter>
#include <QString>

namespace kickvane::skin {
namespace {

QColor toQColor(Colour colour) {
    return QColor(redOf(colour), greenOf(colour), blueOf(colour));
}

Status checkPieces(const QImage& source, const Piece& from, const Piece& to) {
    if (source.isNull()) {
        return Status::Fail("no source picture");
    }
    if (from.width < 0 || from.height < 0 || to.width < 0 || to.height < 0) {
        return Status::Fail("negative copy size");
    }
    // Compared in 64 bits: x + width may not fit an int.
    const auto right = static_cast<long long>(from.x) + from.width;
    const auto bottom = static_cast<long long>(from.y) + from.height;
    if (from.x < 0 || from.y < 0 || right > source.width() || bottom > source.height()) {
        return Status::Fail("source piece outside its picture");
    }
    const auto toRight = static_cast<long long>(to.x) + to.width;
    const auto toBottom = static_cast<long long>(to.y) + to.height;
    if (toRight > std::numeric_limits<int>::max() || toBottom > std::numeric_limits<int>::max()) {
        return Status::Fail("target piece beyond the coordinate range");
    }
    return Status::Ok();
}

QRect toQRect(const Piece& to) {
    return QRect(to.x, to.y, to.width, to.height);
}

// The part of `area` inside the picture; computed in 64 bits so that no edge can overflow.
QRect clipToImage(const QImage& target, const Rect& area) {
    const long long left = std::max<long long>(area.left, 0);
    const long long top = std::max<long long>(area.top, 0);
    const long long right = std::min<long long>(area.right, target.width());
    const long long bottom = std::min<long long>(area.bottom, target.height());
    if (right <= left || bottom <= top) {
        return QRect();
    }
    return QRect(static_cast<int>(left), static_cast<int>(top), static_cast<int>(right - left),
                 static_cast<int>(bottom - top));
}

bool touches(const QImage& target, const Piece& to) {
    const auto right = static_cast<long long>(to.x) + to.width;
    const auto bottom = static_cast<long long>(to.y) + to.height;
    return right > 0 && bottom > 0 && to.x < target.width() && to.y < target.height();
}

}  // namespace

Status ImageSurface::checkTarget() const {
    if (target_.isNull()) {
        return Status::Fail("no target picture");
    }
    return Status::Ok();
}

Status ImageSurface::checkCopy(const QImage& source, const Piece& from, const Piece& to,
                               bool& draw) const {
    if (Status s = checkTarget(); !s) {
        return s;
    }
    if (Status s = checkPieces(source, from, to); !s) {
        return s;
    }
    draw = !from.isEmpty() && !to.isEmpty() && touches(target_, to);
    return Status::Ok();
}

Status ImageSurface::copy(const QImage& source, const Piece& from, const Piece& to) {
    bool draw = false;
    if (Status s = checkCopy(source, from, to, draw); !s || !draw) {
        return s;
    }
    // Copying the piece out first keeps smooth scaling from sampling the neighbouring frames.
    const QImage piece = source.copy(from.x, from.y, from.width, from.height);
    QPainter painter(&target_);
    painter.setCompositionMode(QPainter::CompositionMode_Source);
    painter.setRenderHint(QPainter::SmoothPixmapTransform, mode_ == StretchMode::Halftone);
    painter.drawImage(toQRect(to), piece);
    return Status::Ok();
}

Status ImageSurface::copyKeyed(const QImage& source, const Piece& from, const Piece& to,
                               Colour key) {
    bool draw = false;
    if (Status s = checkCopy(source, from, to, draw); !s || !draw) {
        return s;
    }
    // The key becomes a fully transparent mask; everything else stays opaque, and nearest-pixel
    // scaling keeps the mask exact.
    QImage piece =
        source.copy(from.x, from.y, from.width, from.height).convertToFormat(QImage::Format_ARGB32);
    const QRgb keyRgb = qRgb(redOf(key), greenOf(key), blueOf(key));
    for (int y = 0; y < piece.height(); ++y) {
        auto* line = reinterpret_cast<QRgb*>(piece.scanLine(y));
        for (int x = 0; x < piece.width(); ++x) {
            line[x] = (line[x] & 0xFFFFFFu) == (keyRgb & 0xFFFFFFu) ? 0u : (line[x] | 0xFF000000u);
        }
    }
    QPainter painter(&target_);
    painter.setCompositionMode(QPainter::CompositionMode_SourceOver);
    painter.setRenderHint(QPainter::SmoothPixmapTransform, false);
    painter.drawImage(toQRect(to), piece);
    return Status::Ok();
}

Status ImageSurface::fill(const Rect& area, Colour colour) {
    if (Status s = checkTarget(); !s) {
        return s;
    }
    const QRect box = clipToImage(target_, area);
    if (box.isEmpty()) {
        return Status::Ok();
    }
    QPainter painter(&target_);
    painter.fillRect(box, toQColor(colour));
    return Status::Ok();
}

Status ImageSurface::line(int x1, int y1, int x2, int y2, Colour colour, int width) {
    if (Status s = checkTarget(); !s) {
        return s;
    }
    if (width < 1) {
        return Status::Fail("line width below one pixel");
    }
    QPainter painter(&target_);
    QPen pen(toQColor(colour));
    pen.setWidth(width);
    pen.setCapStyle(Qt::SquareCap);
    painter.setPen(pen);
    painter.drawLine(x1, y1, x2, y2);
    return Status::Ok();
}

Status ImageSurface::text(const Rect& box, std::string_view utf8, Colour colour) {
    if (Status s = checkTarget(); !s) {
        return s;
    }
    if (qobject_cast<QGuiApplication*>(QCoreApplication::instance()) == nullptr) {
        return Status::Fail("drawing text needs a running application");
    }
    if (box.right <= box.left || box.bottom <= box.top || utf8.empty()) {
        return Status::Ok();
    }
    const QRect clip = clipToImage(target_, box);
    if (clip.isEmpty()) {
        return Status::Ok();
    }
    // Laid out in the whole box (it may reach beyond the picture), drawn only where visible.
    const long long width = static_cast<long long>(box.right) - box.left;
    const long long height = static_cast<long long>(box.bottom) - box.top;
    if (width > std::numeric_limits<int>::max() || height > std::numeric_limits<int>::max()) {
        return Status::Fail("text box beyond the coordinate range");
    }
    const QRect area(box.left, box.top, static_cast<int>(width), static_cast<int>(height));
    QPainter painter(&target_);
    painter.setClipRect(clip);
    painter.setPen(toQColor(colour));
    const QString text = QString::fromUtf8(utf8.data(), static_cast<qsizetype>(utf8.size()));
    const QString shown = painter.fontMetrics().elidedText(text, Qt::ElideRight, area.width());
    painter.drawText(area, Qt::AlignLeft | Qt::AlignVCenter | Qt::TextSingleLine, shown);
    return Status::Ok();
}

}  // namespace kickvane::skin
