#pragma once

#include <QColor>
#include <QImage>

namespace kickvane::skin::testing {

// A picture of one colour, to draw on or to compare with.
inline QImage filled(int width, int height, const QColor& colour) {
    QImage image(width, height, QImage::Format_RGB32);
    image.fill(colour);
    return image;
}

}  // namespace kickvane::skin::testing
