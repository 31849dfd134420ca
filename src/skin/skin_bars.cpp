// Painters of bars: progress, scroll, spin, track and status bars.
#include "skin/rect_math.h"
#include "skin/skin.h"

namespace kickvane::skin {

using rect_math::makeRect;
using rect_math::moved;

namespace {

struct ProgressFrames {
    const QImage& picture;
    Frame trough;
    Frame bar;
};

ProgressFrames progressFrames(const SkinPictures& pictures, Orientation orientation) {
    if (orientation == Orientation::Horizontal) {
        return {pictures.progress, Frame{53, 18, 0}, Frame{125, 16, 18}};
    }
    return {pictures.progressVertical, Frame{18, 53, 0}, Frame{16, 51, 53}};
}

}  // namespace

void Skin::paintProgressTrough(Surface& dc, Orientation orientation, const Rect& box) const {
    const ProgressFrames frames = progressFrames(pictures_, orientation);
    (void)paintNine(dc, frames.picture, Margins{2, 2, 2, 2}, box, frames.trough);
}

void Skin::paintProgressBar(Surface& dc, Orientation orientation, const Rect& box) const {
    const ProgressFrames frames = progressFrames(pictures_, orientation);
    if (const auto inset = moved(box, 2, 2, -2, -2)) {
        (void)paintNine(dc, frames.picture, Margins{2, 6, 2, 5}, *inset, frames.bar);
    }
}

void Skin::paintScrollButton(Surface& dc, ArrowDirection direction, ScrollButtonLook look,
                             const Rect& box) const {
    // The picture holds the buttons left, right, up, down.
    int button = 0;
    switch (direction) {
        case ArrowDirection::Left:
            button = 0;
            break;
        case ArrowDirection::Right:
            button = 1;
            break;
        case ArrowDirection::Up:
            button = 2;
            break;
        case ArrowDirection::Down:
            button = 3;
            break;
    }
    int glyphLook = kGlyphNormal;
    switch (look) {
        case ScrollButtonLook::Normal:
        case ScrollButtonLook::Hover:
            break;
        case ScrollButtonLook::Hot:
            glyphLook = kGlyphHot;
            break;
        case ScrollButtonLook::Pressed:
            glyphLook = kGlyphPressed;
            break;
        case ScrollButtonLook::Disabled:
            glyphLook = kGlyphDisabled;
            break;
    }
    const int frame = look == ScrollButtonLook::Hover ? scrollHoverFrame(button)
                                                      : scrollButtonFrame(button, glyphLook);
    (void)nine(dc, pictures_.scrollButtons, 20, frame, Margins{5, 5, 5, 5}, box);
    (void)glyph(dc, arrowCell(direction, glyphLook), box);
}

void Skin::paintScrollTrack(Surface& dc, Orientation bar, const Rect& box) const {
    // The track looks the same in every state; the thumb and buttons show the state.
    if (bar == Orientation::Vertical) {
        (void)nine(dc, pictures_.scrollButtons, 20, 8, Margins{0, 5, 0, 5}, box);
    } else {
        (void)nine(dc, pictures_.scrollButtons, 20, 3, Margins{5, 0, 5, 0}, box);
    }
}

void Skin::paintScrollThumb(Surface& dc, Orientation bar, ControlLook look, const Rect& box) const {
    const QImage& thumb = bar == Orientation::Vertical ? pictures_.scrollThumbVertical
                                                       : pictures_.scrollThumbHorizontal;
    (void)nine(dc, thumb, 4, static_cast<int>(look), Margins{5, 5, 5, 5}, box);
}

void Skin::paintSizeBox(Surface& dc, ControlLook look, const Rect& box) const {
    const auto [l, t, r, b] = box;
    switch (look) {
        case ControlLook::Normal:
            (void)shapes_.fillBox(dc, l, t, r, b, kSysButtonFace);
            (void)shapes_.frameBox(dc, l, t, r, b, kSysButtonShadow);
            return;
        case ControlLook::Pressed:
        case ControlLook::Hot: {
            const Colour fill = look == ControlLook::Pressed
                                    ? ShapeHelper::shadeColor(rgb(191, 208, 237), -20).value()
                                    : rgb(191, 208, 237);
            (void)shapes_.fillBox(dc, l, t, r, b, fill);
            (void)shapes_.frameBox(dc, l, t, r, b, rgb(49, 106, 197));
            return;
        }
        case ControlLook::Disabled:
            return;
    }
}

void Skin::paintSpinButton(Surface& dc, ArrowDirection direction, ControlLook look,
                           const Rect& box) const {
    // Each picture holds its two buttons (up then down, left then right) in the four looks.
    const bool upDown = direction == ArrowDirection::Up || direction == ArrowDirection::Down;
    const int group = direction == ArrowDirection::Down || direction == ArrowDirection::Right;
    const QImage& picture = upDown ? pictures_.spinUpDown : pictures_.spinLeftRight;
    (void)nine(dc, picture, 8, 4 * group + static_cast<int>(look), Margins{2, 2, 2, 2}, box);
    (void)glyph(dc, arrowCell(direction, static_cast<int>(look)), box);
}

void Skin::paintTrackBarChannel(Surface& dc, const Rect& box) const {
    (void)shapes_.fillBox(dc, box.left, box.top, box.right, box.bottom, kSysButtonFace);
    (void)shapes_.sunkenEdge(dc, box);
}

void Skin::paintTrackBarThumb(Surface& dc, Orientation bar, ThumbPoint point, ThumbLook look,
                              const Rect& box) const {
    // A horizontal bar carries an upright thumb, whose point lies at the top or the bottom; a
    // vertical bar a lying thumb, whose margins are the same turned on their side.
    const bool horizontal = bar == Orientation::Horizontal;
    const QImage* thumb = nullptr;
    switch (point) {
        case ThumbPoint::TopOrLeft:
            thumb = horizontal ? &pictures_.trackThumbUp : &pictures_.trackThumbLeft;
            break;
        case ThumbPoint::BottomOrRight:
            thumb = horizontal ? &pictures_.trackThumbDown : &pictures_.trackThumbRight;
            break;
        case ThumbPoint::None:
            thumb = horizontal ? &pictures_.trackThumbUpright : &pictures_.trackThumbLying;
            break;
    }
    const Margins margins = horizontal ? Margins{3, 6, 3, 10} : Margins{6, 3, 10, 3};
    (void)nineKeyed(dc, *thumb, 3, static_cast<int>(look), margins, box);
}

void Skin::paintStatusBar(Surface& dc, StatusBarPart part, const Rect& box) const {
    constexpr Margins kBarMargins{0, 3, 0, 3};
    const QImage& picture = pictures_.statusBar;
    const long long height = static_cast<long long>(box.bottom) - box.top;
    // The divider: the 3 x 22 strip at (0, 44) stretched to a column at the bar's right end.
    const auto divider = [&] {
        const auto column =
            makeRect(static_cast<long long>(box.right) - 3, box.top, box.right, box.bottom);
        if (column && height > 0 && rect_math::fitsInt(height)) {
            (void)dc.copy(picture, Piece{0, 44, 3, 22},
                          Piece{column->left, column->top, 3, static_cast<int>(height)});
        }
    };
    switch (part) {
        case StatusBarPart::Bar:
        case StatusBarPart::SimpleBar:
            // The bar in simple mode has the same parts, flat.
            (void)nine(dc, picture, 4, part == StatusBarPart::Bar ? 0 : 3, kBarMargins, box);
            divider();
            return;
        case StatusBarPart::SizeGrip:
            (void)shapes_.drawSizeGrip(dc, box);
            return;
        case StatusBarPart::Panel: {
            // A panel: the three columns of the band at y 22, the middle one stretched.
            const long long width = static_cast<long long>(box.right) - box.left;
            if (width < 2 || height <= 0 || !rect_math::fitsInt(width) ||
                !rect_math::fitsInt(height)) {
                return;
            }
            const int w = static_cast<int>(width);
            const int h = static_cast<int>(height);
            (void)dc.copy(picture, Piece{0, 22, 1, 22}, Piece{box.left, box.top, 1, h});
            (void)dc.copy(picture, Piece{1, 22, 1, 22}, Piece{box.left + 1, box.top, w - 2, h});
            (void)dc.copy(picture, Piece{2, 22, 1, 22}, Piece{box.right - 1, box.top, 1, h});
            return;
        }
        case StatusBarPart::ProgressTrough:
            paintProgressTrough(dc, Orientation::Horizontal, box);
            return;
        case StatusBarPart::ProgressBar:
            paintProgressBar(dc, Orientation::Horizontal, box);
            return;
    }
}

}  // namespace kickvane::skin
