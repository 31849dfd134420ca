#include "skin/pictures.h"

#include <algorithm>
#include <cmath>
#include <optional>
#include <vector>

#include <QPainter>
#include <QPainterPath>
#include <QPolygon>

#include "skin/surface.h"

namespace kickvane::skin {
namespace {

// ---- Palette: a soft blue-grey theme ---------------------------------------------------------

const QColor kFace(236, 239, 244);        // dialog background, behind rounded corners
const QColor kTrackBg(226, 231, 238);     // scroll bar track
const QColor kMenuBg(250, 251, 253);      // menu background
const QColor kToolbarMid(238, 242, 247);  // toolbar background halfway down
const QColor kMagenta(255, 0, 255);
const QColor kWhite(255, 255, 255);
const QColor kBorder(112, 128, 152);
const QColor kAccent(74, 128, 204);
const QColor kAccentDark(56, 96, 156);
const QColor kDisabledBorder(190, 197, 207);
const QColor kDisabledFace(244, 245, 247);
const QColor kTick(42, 128, 72);

struct Corners {
    int tl = 0;
    int tr = 0;
    int bl = 0;
    int br = 0;
};
Corners roundCorners(int r) {
    return Corners{r, r, r, r};
}

struct BoxStyle {
    QColor border;
    QColor from;                          // gradient start (top or left)
    QColor to;                            // gradient end
    std::optional<QColor> glow;           // one-pixel line just inside the border
    Qt::Orientation axis = Qt::Vertical;  // Vertical: the gradient runs down
};

QColor mix(const QColor& a, const QColor& b, double t) {
    t = std::clamp(t, 0.0, 1.0);
    return QColor::fromRgbF(static_cast<float>(a.redF() + (b.redF() - a.redF()) * t),
                            static_cast<float>(a.greenF() + (b.greenF() - a.greenF()) * t),
                            static_cast<float>(a.blueF() + (b.blueF() - a.blueF()) * t));
}

QImage canvas(int width, int height, const QColor& fill) {
    QImage image(width, height, QImage::Format_RGB32);
    image.fill(fill);
    return image;
}

// Signed distance of the pixel centre (px, py) from the edge of a rounded box of size w x h at
// the origin; negative inside.
double boxDistance(double px, double py, double w, double h, const Corners& c) {
    const double cx = px - w / 2;
    const double cy = py - h / 2;
    const int radius = cx < 0 ? (cy < 0 ? c.tl : c.bl) : (cy < 0 ? c.tr : c.br);
    const double qx = std::abs(cx) - (w / 2 - radius);
    const double qy = std::abs(cy) - (h / 2 - radius);
    const double outside = std::hypot(std::max(qx, 0.0), std::max(qy, 0.0));
    return outside + std::min(std::max(qx, qy), 0.0) - radius;
}

// Paints a rounded box into `area` of `image`. Pixels outside the box become `outside`; keyed
// boxes get hard edges so that no pixel is a blend of the key.
void paintBox(QImage& image, const QRect& area, const BoxStyle& style, const Corners& corners,
              const QColor& outside, bool keyed) {
    const double w = area.width();
    const double h = area.height();
    for (int y = 0; y < area.height(); ++y) {
        for (int x = 0; x < area.width(); ++x) {
            const double d = boxDistance(x + 0.5, y + 0.5, w, h, corners);
            const double along =
                style.axis == Qt::Vertical ? y / std::max(1.0, h - 1) : x / std::max(1.0, w - 1);
            QColor colour = mix(style.from, style.to, along);
            if (d > -1.0) {
                colour = style.border;
            } else if (d > -2.0 && style.glow) {
                colour = mix(colour, *style.glow, 0.7);
            }
            if (keyed) {
                colour = d < 0 ? colour : outside;
            } else {
                colour = mix(outside, colour, 0.5 - d);
            }
            image.setPixelColor(area.x() + x, area.y() + y, colour);
        }
    }
}

// The common look of a push button in a state, on an axis.
BoxStyle buttonStyle(int state, Qt::Orientation axis = Qt::Vertical) {
    switch (state) {
        case kGlyphHot:
            return {kAccent, kWhite, QColor(218, 232, 251), QColor(182, 210, 246), axis};
        case kGlyphPressed:
            return {kAccentDark, QColor(190, 204, 226), QColor(226, 233, 243), std::nullopt, axis};
        case kGlyphDisabled:
            return {kDisabledBorder, kDisabledFace, QColor(236, 239, 243), std::nullopt, axis};
        default:
            return {kBorder, kWhite, QColor(212, 221, 235), kWhite, axis};
    }
}

QRect frameRect(int width, int height, int index) {
    return QRect(0, index * height, width, height);
}

// ---- Glyphs ---------------------------------------------------------------------------------

QColor glyphColour(int state) {
    switch (state) {
        case kGlyphHot:
            return QColor(40, 92, 170);
        case kGlyphPressed:
            return QColor(24, 44, 76);
        case kGlyphDisabled:
            return QColor(168, 175, 186);
        default:
            return QColor(60, 74, 96);
    }
}

// A solid triangle of 4 rows (widths 1, 3, 5, 7) in a 9 x 9 cell, pointing `direction`.
void paintArrow(QImage& image, int top, ArrowDirection direction, const QColor& colour) {
    for (int row = 0; row < 4; ++row) {
        for (int k = -row; k <= row; ++k) {
            int x = 0;
            int y = 0;
            switch (direction) {
                case ArrowDirection::Up:
                    x = 4 + k, y = 3 + row;
                    break;
                case ArrowDirection::Down:
                    x = 4 + k, y = 5 - row;
                    break;
                case ArrowDirection::Left:
                    x = 3 + row, y = 4 + k;
                    break;
                case ArrowDirection::Right:
                    x = 5 - row, y = 4 + k;
                    break;
            }
            image.setPixelColor(x, top + y, colour);
        }
    }
}

// A two-pixel-thick "v" for the drop-down button of a combo box.
void paintChevron(QImage& image, int top, const QColor& colour) {
    for (int i = 0; i < 4; ++i) {
        for (int t = 0; t < 2; ++t) {
            image.setPixelColor(1 + i, top + 2 + i + t, colour);
            image.setPixelColor(7 - i, top + 2 + i + t, colour);
        }
    }
    image.setPixelColor(4, top + 6, colour);
}

void paintTick(QImage& image, const QRect& cell, const QColor& colour, double scale) {
    QPainter painter(&image);
    painter.setRenderHint(QPainter::Antialiasing, true);
    QPen pen(colour, 1.8 * scale, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin);
    painter.setPen(pen);
    const QPointF o = cell.topLeft();
    const QPointF points[] = {o + QPointF(3.2, 6.6) * scale, o + QPointF(5.4, 8.8) * scale,
                              o + QPointF(9.8, 4.0) * scale};
    painter.drawPolyline(points, 3);
}

void paintDot(QImage& image, const QRect& cell, const QColor& colour, double radius) {
    QPainter painter(&image);
    painter.setRenderHint(QPainter::Antialiasing, true);
    painter.setPen(Qt::NoPen);
    painter.setBrush(colour);
    painter.drawEllipse(QRectF(cell).center(), radius, radius);
}

// ---- The pictures ---------------------------------------------------------------------------

QImage makeButton() {
    QImage image = canvas(43, 330, kFace);
    const int states[] = {kGlyphNormal, kGlyphHot, kGlyphPressed, kGlyphDisabled, kGlyphNormal};
    for (int i = 0; i < 5; ++i) {
        BoxStyle style = buttonStyle(states[i]);
        if (i == 4) {  // default button: the accent ring shows it takes Enter
            style.border = kAccentDark;
            style.glow = QColor(128, 170, 232);
        }
        paintBox(image, frameRect(43, 66, i), style, roundCorners(3), kFace, false);
    }
    return image;
}

// A 13 x 13 box whose inside is sunk: darker at the top.
BoxStyle checkBoxStyle(int state) {
    switch (state) {
        case kGlyphHot:
            return {kAccent, QColor(214, 228, 248), kWhite, QColor(250, 214, 140), Qt::Vertical};
        case kGlyphPressed:
            return {kAccentDark, QColor(188, 202, 224), QColor(232, 237, 245), std::nullopt,
                    Qt::Vertical};
        case kGlyphDisabled:
            return {kDisabledBorder, kDisabledFace, kDisabledFace, std::nullopt, Qt::Vertical};
        default:
            return {kBorder, QColor(222, 229, 239), kWhite, std::nullopt, Qt::Vertical};
    }
}

QColor markColour(int state) {
    return state == kGlyphDisabled ? glyphColour(state) : kTick;
}

QImage makeCheck() {
    QImage image = canvas(13, 156, kFace);
    for (int i = 0; i < 12; ++i) {
        const int state = i % 4;
        const QRect cell = frameRect(13, 13, i);
        paintBox(image, cell, checkBoxStyle(state), roundCorners(1), kFace, false);
        if (i / 4 == 1) {
            paintTick(image, cell, markColour(state), 1.0);
        } else if (i / 4 == 2) {
            QPainter(&image).fillRect(cell.adjusted(4, 4, -4, -4), markColour(state));
        }
    }
    return image;
}

QImage makeOption() {
    QImage image = canvas(13, 104, kMagenta);
    for (int i = 0; i < 8; ++i) {
        const int state = i % 4;
        const QRect cell = frameRect(13, 13, i);
        paintBox(image, cell, checkBoxStyle(state), roundCorners(6), kMagenta, true);
        if (i >= 4) {
            paintDot(image, cell, markColour(state), 2.3);
        }
    }
    return image;
}

BoxStyle troughStyle(Qt::Orientation axis) {
    return {QColor(130, 144, 166), QColor(222, 228, 237), kWhite, std::nullopt, axis};
}

// The progress bar: a glossy blue strip, lighter at its top (left when upright).
void paintBar(QImage& image, const QRect& area, Qt::Orientation axis) {
    const int length = axis == Qt::Vertical ? area.height() : area.width();
    for (int y = 0; y < area.height(); ++y) {
        for (int x = 0; x < area.width(); ++x) {
            const int across = axis == Qt::Vertical ? y : x;
            const int along = axis == Qt::Vertical ? x : y;
            const int alongSize = axis == Qt::Vertical ? area.width() : area.height();
            const double t = along / std::max(1.0, alongSize - 1.0);
            QColor colour = t < 0.4
                                ? mix(QColor(182, 214, 252), QColor(118, 168, 234), t / 0.4)
                                : mix(QColor(84, 140, 220), QColor(120, 172, 238), (t - 0.4) / 0.6);
            if (across < 1 || across >= length - 1 || along == 0 || along == alongSize - 1) {
                colour = mix(colour, QColor(48, 90, 160), 0.6);
            }
            image.setPixelColor(area.x() + x, area.y() + y, colour);
        }
    }
}

QImage makeProgress() {
    QImage image = canvas(125, 34, kFace);
    paintBox(image, QRect(0, 0, 53, 18), troughStyle(Qt::Vertical), roundCorners(2), kFace, false);
    paintBar(image, QRect(0, 18, 125, 16), Qt::Horizontal);
    return image;
}

QImage makeProgressUpright() {
    QImage image = canvas(18, 104, kFace);
    paintBox(image, QRect(0, 0, 18, 53), troughStyle(Qt::Horizontal), roundCorners(2), kFace,
             false);
    paintBar(image, QRect(0, 53, 16, 51), Qt::Vertical);
    return image;
}

QImage makeArrows() {
    QImage image = canvas(9, 180, kMagenta);
    for (int direction = 0; direction < 4; ++direction) {
        for (int state = 0; state < 4; ++state) {
            const int cell = arrowCell(static_cast<ArrowDirection>(direction), state);
            paintArrow(image, cell * 9, static_cast<ArrowDirection>(direction), glyphColour(state));
        }
    }
    for (int state = 0; state < 4; ++state) {
        paintChevron(image, chevronCell(state) * 9, glyphColour(state));
    }
    return image;
}

// Buttons of the lying bar have their gradient down the button; upright ones across it.
QImage makeScrollButtons() {
    QImage image = canvas(17, 340, kTrackBg);
    for (int button = 0; button < 4; ++button) {
        const Qt::Orientation axis = button < 2 ? Qt::Vertical : Qt::Horizontal;
        for (int state = 0; state < 4; ++state) {
            paintBox(image, frameRect(17, 17, scrollButtonFrame(button, state)),
                     buttonStyle(state, axis), roundCorners(2), kTrackBg, false);
        }
        const BoxStyle hover{QColor(146, 166, 198), kWhite, QColor(226, 234, 246), kWhite, axis};
        paintBox(image, frameRect(17, 17, scrollHoverFrame(button)), hover, roundCorners(2),
                 kTrackBg, false);
    }
    return image;
}

QImage makeScrollThumb(int width, int height, Qt::Orientation axis) {
    QImage image = canvas(width, height * 4, kTrackBg);
    for (int state = 0; state < 4; ++state) {
        BoxStyle style = buttonStyle(state, axis);
        if (state == kGlyphNormal) {
            style.from = QColor(246, 249, 253);
            style.to = QColor(200, 213, 232);
        }
        paintBox(image, frameRect(width, height, state), style, roundCorners(3), kTrackBg, false);
    }
    return image;
}

// Spin buttons: each pair rounds only its outer corners.
QImage makeSpin(int width, int height, bool upright) {
    QImage image = canvas(width, height * 8, kWhite);
    for (int group = 0; group < 2; ++group) {
        Corners corners;
        if (upright) {
            corners = group == 0 ? Corners{2, 2, 0, 0} : Corners{0, 0, 2, 2};
        } else {
            corners = group == 0 ? Corners{2, 0, 2, 0} : Corners{0, 2, 0, 2};
        }
        for (int state = 0; state < 4; ++state) {
            paintBox(image, frameRect(width, height, 4 * group + state),
                     buttonStyle(state, upright ? Qt::Vertical : Qt::Horizontal), corners, kWhite,
                     false);
        }
    }
    return image;
}

// Track bar thumbs: a rounded body with a pointed end, on magenta. `tip` is the side the point
// faces (or none for the plain "bold" thumb).
enum class Tip { None, Up, Down, Left, Right };

QImage makeThumb(int width, int frameHeight, Tip tip) {
    QImage image = canvas(width, frameHeight * 3, kMagenta);
    const bool lying = tip == Tip::Left || tip == Tip::Right || (tip == Tip::None && width > 20);
    const BoxStyle styles[] = {
        {QColor(72, 96, 136), kWhite, QColor(200, 214, 234), std::nullopt,
         lying ? Qt::Vertical : Qt::Horizontal},
        {kAccent, kWhite, QColor(214, 230, 252), std::nullopt,
         lying ? Qt::Vertical : Qt::Horizontal},
        {QColor(170, 178, 190), QColor(244, 245, 247), QColor(232, 235, 240), std::nullopt,
         lying ? Qt::Vertical : Qt::Horizontal},
    };
    for (int frame = 0; frame < 3; ++frame) {
        const int top = frame * frameHeight;
        const int w = width;
        const int h = frameHeight;
        // The outline, in pixel corners of the frame.
        QPolygon outline;
        switch (tip) {
            case Tip::None:
                outline << QPoint(0, 0) << QPoint(w - 1, 0) << QPoint(w - 1, h - 1)
                        << QPoint(0, h - 1);
                break;
            case Tip::Down:
                outline << QPoint(0, 0) << QPoint(w - 1, 0) << QPoint(w - 1, h - 1 - w / 2)
                        << QPoint(w / 2, h - 1) << QPoint(0, h - 1 - w / 2);
                break;
            case Tip::Up:
                outline << QPoint(w / 2, 0) << QPoint(w - 1, w / 2) << QPoint(w - 1, h - 1)
                        << QPoint(0, h - 1) << QPoint(0, w / 2);
                break;
            case Tip::Left:
                outline << QPoint(h / 2, 0) << QPoint(w - 1, 0) << QPoint(w - 1, h - 1)
                        << QPoint(h / 2, h - 1) << QPoint(0, h / 2);
                break;
            case Tip::Right:
                outline << QPoint(0, 0) << QPoint(w - 1 - h / 2, 0) << QPoint(w - 1, h / 2)
                        << QPoint(w - 1 - h / 2, h - 1) << QPoint(0, h - 1);
                break;
        }
        outline.translate(0, top);
        const BoxStyle& style = styles[frame];
        QLinearGradient gradient(0, top, style.axis == Qt::Horizontal ? w : 0,
                                 style.axis == Qt::Horizontal ? top : top + h);
        gradient.setColorAt(0, style.from);
        gradient.setColorAt(1, style.to);
        QPainter painter(&image);
        painter.setRenderHint(QPainter::Antialiasing, false);
        painter.setPen(QPen(style.border, 1));
        painter.setBrush(gradient);
        painter.drawPolygon(outline);
        painter.end();
        // Round the square corners of the body by keying their outermost pixel.
        if (tip != Tip::Up && tip != Tip::Left) {
            image.setPixelColor(0, top, kMagenta);
        }
        if (tip != Tip::Up && tip != Tip::Right) {
            image.setPixelColor(w - 1, top, kMagenta);
        }
        if (tip != Tip::Down && tip != Tip::Left) {
            image.setPixelColor(0, top + h - 1, kMagenta);
        }
        if (tip != Tip::Down && tip != Tip::Right) {
            image.setPixelColor(w - 1, top + h - 1, kMagenta);
        }
    }
    return image;
}

QImage makeTabPanel() {
    QImage image = canvas(80, 92, kFace);
    const BoxStyle style{QColor(145, 157, 176), kWhite, QColor(242, 245, 250), std::nullopt,
                         Qt::Vertical};
    paintBox(image, image.rect(), style, roundCorners(2), kFace, false);
    return image;
}

QImage makeTabHeads() {
    QImage image = canvas(57, 120, kFace);
    const QColor edge(145, 157, 176);
    const BoxStyle styles[] = {
        {edge, kWhite, QColor(222, 229, 239), kWhite, Qt::Vertical},                  // normal
        {edge, kWhite, QColor(232, 240, 252), kWhite, Qt::Vertical},                  // hot
        {edge, kWhite, kWhite, std::nullopt, Qt::Vertical},                           // selected
        {kDisabledBorder, kDisabledFace, kDisabledFace, std::nullopt, Qt::Vertical},  // disabled
        {edge, kWhite, kWhite, std::nullopt, Qt::Vertical},                           // focused
    };
    const QColor topLines[] = {QColor(), QColor(250, 190, 90), kAccent, QColor(),
                               QColor(240, 160, 50)};
    for (int i = 0; i < 5; ++i) {
        const QRect frame = frameRect(57, 24, i);
        paintBox(image, frame, styles[i], Corners{3, 3, 0, 0}, kFace, false);
        if (topLines[i].isValid()) {
            QPainter painter(&image);
            painter.fillRect(QRect(frame.x() + 2, frame.y() + 1, 53, 2), topLines[i]);
        }
        if (i == 2 || i == 4) {
            // A selected head opens into its panel: no line along its bottom.
            QPainter painter(&image);
            painter.fillRect(QRect(frame.x() + 1, frame.bottom(), 55, 1), kWhite);
        }
    }
    return image;
}

QImage makeWindowTabs() {
    QImage image = canvas(26, 42, kMagenta);
    const BoxStyle active{QColor(122, 138, 163), kWhite, QColor(240, 245, 252), std::nullopt,
                          Qt::Vertical};
    const BoxStyle inactive{QColor(150, 164, 186), QColor(222, 230, 242), QColor(204, 214, 230),
                            std::nullopt, Qt::Vertical};
    paintBox(image, frameRect(26, 21, 0), active, Corners{4, 4, 0, 0}, kMagenta, true);
    paintBox(image, frameRect(26, 21, 1), inactive, Corners{4, 4, 0, 0}, kMagenta, true);
    // The active tab joins the page below it.
    QPainter(&image).fillRect(QRect(1, 20, 24, 1), QColor(240, 245, 252));
    return image;
}

QImage makeWindowTabFrame() {
    QImage image = canvas(12, 12, kWhite);
    QPainter painter(&image);
    painter.fillRect(image.rect(), QColor(122, 138, 163));
    painter.fillRect(image.rect().adjusted(1, 1, -1, -1), QColor(191, 219, 255));
    painter.fillRect(image.rect().adjusted(3, 3, -3, -3), QColor(150, 170, 200));
    painter.fillRect(image.rect().adjusted(4, 4, -4, -4), kWhite);
    return image;
}

QImage makeComboButton() {
    QImage image = canvas(15, 76, kWhite);
    for (int state = 0; state < 4; ++state) {
        paintBox(image, frameRect(15, 19, state), buttonStyle(state), roundCorners(2), kWhite,
                 false);
    }
    return image;
}

QImage makeListHeaders() {
    QImage image = canvas(17, 105, kWhite);
    const QColor bottoms[] = {QColor(214, 219, 227), QColor(190, 198, 210), QColor(250, 190, 90),
                              QColor(214, 219, 227), kAccent};
    const QColor tops[] = {kWhite, QColor(216, 222, 232), kWhite, kWhite, QColor(240, 244, 251)};
    const QColor ends[] = {QColor(235, 238, 244), QColor(222, 227, 235), QColor(242, 246, 252),
                           QColor(235, 238, 244), QColor(226, 234, 246)};
    for (int i = 0; i < 5; ++i) {
        const QRect frame = frameRect(17, 21, i);
        for (int y = 0; y < 21; ++y) {
            for (int x = 0; x < 17; ++x) {
                QColor colour = mix(tops[i], ends[i], y / 17.0);
                if (y >= 18) {
                    colour = mix(bottoms[i], ends[i], (y - 18) * 0.35);
                } else if (i != 3 && x == 15 && y >= 3 && y < 17) {
                    colour = QColor(196, 204, 216);  // divider between headers
                } else if (i != 3 && x == 16 && y >= 3 && y < 17) {
                    colour = kWhite;
                }
                image.setPixelColor(x, frame.y() + y, colour);
            }
        }
    }
    return image;
}

QImage makeStatusBar() {
    QImage image = canvas(3, 88, kFace);
    for (int y = 0; y < 22; ++y) {
        for (int x = 0; x < 3; ++x) {
            // Band 0: the bar. Band 1: a panel, shadow left and light right. Band 2: a divider
            // groove. Band 3: the bar in simple mode, flat.
            QColor bar = y == 0   ? QColor(160, 172, 190)
                         : y == 1 ? kWhite
                                  : mix(QColor(240, 243, 247), QColor(222, 227, 235), y / 21.0);
            image.setPixelColor(x, y, bar);
            const QColor panelColumns[] = {QColor(176, 186, 202), QColor(244, 246, 249), kWhite};
            image.setPixelColor(x, 22 + y, panelColumns[x]);
            const double fade = std::min({1.0, y / 4.0, (21 - y) / 4.0});
            const QColor groove[] = {kFace, QColor(160, 172, 190), kWhite};
            image.setPixelColor(x, 44 + y, mix(kFace, groove[x], fade));
            image.setPixelColor(x, 66 + y, y == 0 ? QColor(160, 172, 190) : kFace);
        }
    }
    return image;
}

QImage makeToolbar() {
    QImage image = canvas(34, 85, kFace);
    const BoxStyle style{QColor(186, 196, 212), QColor(252, 253, 254), QColor(220, 228, 239),
                         kWhite, Qt::Vertical};
    paintBox(image, image.rect(), style, roundCorners(3), kFace, false);
    return image;
}

void paintToolbarFrames(QImage& image, int width, const QColor& outside, bool keyed) {
    const BoxStyle styles[] = {
        {QColor(110, 150, 210), kWhite, QColor(218, 232, 252), std::nullopt, Qt::Vertical},
        {kAccentDark, QColor(190, 208, 236), QColor(218, 229, 246), std::nullopt, Qt::Vertical},
        {QColor(110, 150, 210), QColor(226, 236, 250), QColor(226, 236, 250), std::nullopt,
         Qt::Vertical},
        {kAccent, QColor(206, 224, 250), QColor(236, 244, 255), std::nullopt, Qt::Vertical},
        buttonStyle(kGlyphNormal),
    };
    for (int i = 0; i < 5; ++i) {
        paintBox(image, frameRect(width, 22, i), styles[i], roundCorners(2), outside, keyed);
    }
}

// The drop-down part: a divider at its left and a small arrow in its middle.
void paintDropPart(QImage& image, int left) {
    for (int i = 0; i < 5; ++i) {
        const int top = i * 22;
        for (int y = 4; y < 18; ++y) {
            image.setPixelColor(left, top + y, mix(image.pixelColor(left, top + y), kBorder, 0.5));
        }
        for (int row = 0; row < 3; ++row) {
            for (int k = -(2 - row); k <= 2 - row; ++k) {
                image.setPixelColor(left + 5 + k, top + 10 + row, glyphColour(kGlyphNormal));
            }
        }
    }
}

QImage makeToolbarButton() {
    // Shared with the menu bar, which draws it without the key: corners blend into the toolbar.
    QImage image = canvas(23, 110, kToolbarMid);
    paintToolbarFrames(image, 23, kToolbarMid, false);
    return image;
}

QImage makeToolbarDropDown() {
    QImage image = canvas(23, 110, kMagenta);
    paintToolbarFrames(image, 23, kMagenta, true);
    paintDropPart(image, 12);
    return image;
}

QImage makeToolbarDropDownRight() {
    QImage image = canvas(11, 110, kMagenta);
    paintToolbarFrames(image, 11, kMagenta, true);
    paintDropPart(image, 0);
    return image;
}

QImage makeMenuItem() {
    QImage image = canvas(23, 44, kMenuBg);
    const BoxStyle highlight{QColor(110, 150, 210), QColor(220, 232, 250), QColor(200, 218, 246),
                             std::nullopt, Qt::Vertical};
    const BoxStyle open{QColor(145, 157, 176), kWhite, QColor(240, 243, 248), std::nullopt,
                        Qt::Vertical};
    paintBox(image, frameRect(23, 22, 0), highlight, roundCorners(2), kMenuBg, false);
    paintBox(image, frameRect(23, 22, 1), open, Corners{2, 2, 0, 0}, kFace, false);
    return image;
}

QImage makeMenuLeft() {
    QImage image = canvas(28, 2, kWhite);
    for (int x = 0; x < 28; ++x) {
        const QColor colour = mix(kWhite, QColor(216, 224, 237), x / 27.0);
        image.setPixelColor(x, 0, colour);
        image.setPixelColor(x, 1, colour);
    }
    return image;
}

const QColor kMarkBack(226, 236, 250);

QImage makeMenuCheck() {
    QImage image = canvas(16, 64, kMarkBack);
    paintTick(image, frameRect(16, 16, 0), glyphColour(kGlyphPressed), 1.25);
    paintDot(image, frameRect(16, 16, 1), glyphColour(kGlyphPressed), 3.0);
    paintTick(image, frameRect(16, 16, 2), glyphColour(kGlyphDisabled), 1.25);
    paintDot(image, frameRect(16, 16, 3), glyphColour(kGlyphDisabled), 3.0);
    return image;
}

QImage makeMenuCheckBorder() {
    QImage image = canvas(20, 60, kMenuBg);
    const BoxStyle styles[] = {
        {QColor(110, 150, 210), kMarkBack, kMarkBack, std::nullopt, Qt::Vertical},
        {kAccentDark, kMarkBack, kMarkBack, std::nullopt, Qt::Vertical},
        {kDisabledBorder, kDisabledFace, kDisabledFace, std::nullopt, Qt::Vertical},
    };
    for (int i = 0; i < 3; ++i) {
        paintBox(image, frameRect(20, 20, i), styles[i], roundCorners(2), kMenuBg, false);
    }
    return image;
}

}  // namespace

SkinPictures makeSkinPictures() {
    SkinPictures p;
    p.button = makeButton();
    p.checkBox = makeCheck();
    p.optionButton = makeOption();
    p.progress = makeProgress();
    p.progressVertical = makeProgressUpright();
    p.arrows = makeArrows();
    p.scrollButtons = makeScrollButtons();
    p.scrollThumbVertical = makeScrollThumb(21, 17, Qt::Horizontal);
    p.scrollThumbHorizontal = makeScrollThumb(17, 22, Qt::Vertical);
    p.spinLeftRight = makeSpin(10, 17, false);
    p.spinUpDown = makeSpin(17, 10, true);
    p.trackThumbLying = makeThumb(21, 15, Tip::None);
    p.trackThumbLeft = makeThumb(21, 11, Tip::Left);
    p.trackThumbRight = makeThumb(21, 11, Tip::Right);
    p.trackThumbUpright = makeThumb(15, 21, Tip::None);
    p.trackThumbUp = makeThumb(11, 21, Tip::Up);
    p.trackThumbDown = makeThumb(11, 21, Tip::Down);
    p.tabPanel = makeTabPanel();
    p.tabHeads = makeTabHeads();
    p.windowTabs = makeWindowTabs();
    p.windowTabFrame = makeWindowTabFrame();
    p.comboButton = makeComboButton();
    p.listHeaders = makeListHeaders();
    p.statusBar = makeStatusBar();
    p.toolbar = makeToolbar();
    p.toolbarButton = makeToolbarButton();
    p.toolbarDropDownButton = makeToolbarDropDown();
    p.toolbarDropDownArrow = makeToolbarDropDownRight();
    p.menuItem = makeMenuItem();
    p.menuBand = makeMenuLeft();
    p.menuMarks = makeMenuCheck();
    p.menuMarkBox = makeMenuCheckBorder();
    return p;
}

std::array<NamedPicture, 32> listPictures(const SkinPictures& p) {
    return {{
        {"pButton", &p.button, 43, 330, false},
        {"pCheck", &p.checkBox, 13, 156, false},
        {"pOption", &p.optionButton, 13, 104, true},
        {"pProgress", &p.progress, 125, 34, false},
        {"pProgressHor", &p.progressVertical, 18, 104, false},
        {"pArrow", &p.arrows, 9, 180, true},
        {"pScrollButton", &p.scrollButtons, 17, 340, false},
        {"pScrollThumbHor", &p.scrollThumbVertical, 21, 68, false},
        {"pScrollThumbVer", &p.scrollThumbHorizontal, 17, 88, false},
        {"pSpinHor", &p.spinLeftRight, 10, 136, false},
        {"pSpinVer", &p.spinUpDown, 17, 80, false},
        {"pTrackBarHorBold", &p.trackThumbLying, 21, 45, true},
        {"pTrackBarHorLeft", &p.trackThumbLeft, 21, 33, true},
        {"pTrackBarHorRight", &p.trackThumbRight, 21, 33, true},
        {"pTrackBarVerBold", &p.trackThumbUpright, 15, 63, true},
        {"pTrackBarVerTop", &p.trackThumbUp, 11, 63, true},
        {"pTrackBarVerBottom", &p.trackThumbDown, 11, 63, true},
        {"pTab", &p.tabPanel, 80, 92, false},
        {"pTabTop", &p.tabHeads, 57, 120, false},
        {"pMDITab", &p.windowTabs, 26, 42, true},
        {"pMDITabFrame", &p.windowTabFrame, 12, 12, false},
        {"pCombobox", &p.comboButton, 15, 76, false},
        {"pListView", &p.listHeaders, 17, 105, false},
        {"pStatusBar", &p.statusBar, 3, 88, false},
        {"pToolbar", &p.toolbar, 34, 85, false},
        {"pToolbarButton", &p.toolbarButton, 23, 110, false},
        {"pToolbarButtonDropDown", &p.toolbarDropDownButton, 23, 110, true},
        {"pToolbarButtonDropDownRight", &p.toolbarDropDownArrow, 11, 110, true},
        {"pMenuItem", &p.menuItem, 23, 44, false},
        {"pMenuLeft", &p.menuBand, 28, 2, false},
        {"pMenuCheck", &p.menuMarks, 16, 64, false},
        {"pMenuCheckBorder", &p.menuMarkBox, 20, 60, false},
    }};
}

}  // namespace kickvane::skin
