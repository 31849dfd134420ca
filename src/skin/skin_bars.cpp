// Painters of bars: progress, scroll, spin, track and status bars.
#include "skin/rect_math.h"
#include "skin/skin.h"

namespace kickvane::skin {

using rect_math::MakeRect;
using rect_math::Moved;

void Skin::ThemeProgress(WindowHandle, Surface& dc, int plDraw, int pgWidth, int pgHeight,
                         const Rect& box) {
    const bool lying = plDraw == 0;
    const QImage& picture = lying ? pictures_.pProgress : pictures_.pProgressHor;
    const Frame trough = lying ? Frame{53, 18, 0} : Frame{18, 53, 0};
    const Frame bar = lying ? Frame{125, 16, 18} : Frame{16, 51, 53};
    // pgWidth and pgHeight are the trough's right and bottom edges.
    if (lying ? pgWidth > 0 : pgHeight > 0) {
        (void)PaintNine(dc, picture, Margins{2, 2, 2, 2},
                        Rect{box.left, box.top, pgWidth, pgHeight}, trough);
    }
    if (lying ? box.right > 0 : box.bottom > 0) {
        if (const auto inset = Moved(box, 2, 2, -2, -2)) {
            (void)PaintNine(dc, picture, Margins{2, 6, 2, 5}, *inset, bar);
        }
    }
}

void Skin::ThemeScroll(WindowHandle lhWnd, Surface& dc, const Rect& box, int ePart, int eState,
                       bool sVertical) {
    switch (ePart) {
        case 0:
        case 1: {
            const int button = (sVertical ? 2 : 0) + ePart;
            int frame = 0;
            int glyph = kGlyphNormal;
            switch (eState) {
                case 0:
                    frame = IsHot(lhWnd) ? ScrollHoverFrame(button)
                                         : ScrollButtonFrame(button, kGlyphNormal);
                    break;
                case 1:
                    frame = ScrollButtonFrame(button, kGlyphPressed);
                    glyph = kGlyphPressed;
                    break;
                case 2:
                    frame = ScrollButtonFrame(button, kGlyphHot);
                    glyph = kGlyphHot;
                    break;
                case 3:
                    frame = ScrollButtonFrame(button, kGlyphDisabled);
                    glyph = kGlyphDisabled;
                    break;
                default:
                    return;
            }
            (void)Nine(dc, pictures_.pScrollButton, 20, frame, Margins{5, 5, 5, 5}, box);
            const ArrowDirection direction =
                sVertical ? (ePart == 0 ? ArrowDirection::Up : ArrowDirection::Down)
                          : (ePart == 0 ? ArrowDirection::Left : ArrowDirection::Right);
            (void)Glyph(dc, ArrowCell(direction, glyph), box);
            return;
        }
        case 2:
        case 3:
            // The track stretches only along its length. It looks the same in every state; the
            // thumb and buttons show the state.
            if (eState < 0 || eState > 3) {
                return;
            }
            if (sVertical) {
                (void)Nine(dc, pictures_.pScrollButton, 20, 8, Margins{0, 5, 0, 5}, box);
            } else {
                (void)Nine(dc, pictures_.pScrollButton, 20, 3, Margins{5, 0, 5, 0}, box);
            }
            return;
        case 4: {
            const auto [l, t, r, b] = box;
            if (eState == 0) {
                (void)shapes_.FillBox(dc, l, t, r, b, kSysButtonFace);
                (void)shapes_.FrameBox(dc, l, t, r, b, kSysButtonShadow);
            } else if (eState == 1 || eState == 2) {
                const Colour fill = eState == 1
                                        ? ShapeHelper::ShadeColor(Rgb(191, 208, 237), -20).value()
                                        : Rgb(191, 208, 237);
                (void)shapes_.FillBox(dc, l, t, r, b, fill);
                (void)shapes_.FrameBox(dc, l, t, r, b, Rgb(49, 106, 197));
            }
            return;
        }
        case 5:
            if (eState >= 0 && eState <= 3) {
                const QImage& thumb =
                    sVertical ? pictures_.pScrollThumbHor : pictures_.pScrollThumbVer;
                (void)Nine(dc, thumb, 4, eState, Margins{5, 5, 5, 5}, box);
            }
            return;
        default:
            return;
    }
}

void Skin::ThemeSpinButton(Surface& dc, int state, int sButton, const Rect& box) {
    const QImage* picture = nullptr;
    int group = 0;
    ArrowDirection direction = ArrowDirection::Up;
    switch (sButton) {
        case 0:
            picture = &pictures_.pSpinHor, group = 0, direction = ArrowDirection::Left;
            break;
        case 1:
            picture = &pictures_.pSpinVer, group = 1, direction = ArrowDirection::Down;
            break;
        case 2:
            picture = &pictures_.pSpinVer, group = 0, direction = ArrowDirection::Up;
            break;
        case 3:
            picture = &pictures_.pSpinHor, group = 1, direction = ArrowDirection::Right;
            break;
        default:
            return;
    }
    if (state < 0 || state > 4) {
        return;
    }
    const int place = state == 4 ? 0 : state;  // normal, hot, pressed, disabled
    (void)Nine(dc, *picture, 8, 4 * group + place, Margins{2, 2, 2, 2}, box);
    (void)Glyph(dc, ArrowCell(direction, place), box);
}

void Skin::ThemeTrackbar(WindowHandle, Surface& dc, bool bEnable, bool hot, int ticks, int plDraw,
                         int cOrientation, const Rect& box) {
    if (plDraw == 0) {
        (void)shapes_.FillBox(dc, box.left, box.top, box.right, box.bottom, kSysButtonFace);
        (void)shapes_.SunkenEdge(dc, box);
        return;
    }
    if (plDraw != 1) {
        return;
    }
    // A lying bar carries an upright thumb, whose point lies at the top or the bottom; an
    // upright bar a lying thumb, whose margins are the same turned on their side.
    const bool lyingBar = cOrientation == 0;
    const QImage* thumb = nullptr;
    switch (ticks) {
        case 0:
            thumb = lyingBar ? &pictures_.pTrackBarVerTop : &pictures_.pTrackBarHorLeft;
            break;
        case 1:
            thumb = lyingBar ? &pictures_.pTrackBarVerBottom : &pictures_.pTrackBarHorRight;
            break;
        case 2:
            thumb = lyingBar ? &pictures_.pTrackBarVerBold : &pictures_.pTrackBarHorBold;
            break;
        default:
            return;
    }
    const Margins margins = lyingBar ? Margins{3, 6, 3, 10} : Margins{6, 3, 10, 3};
    const int frame = !bEnable ? 2 : hot ? 1 : 0;
    (void)NineKeyed(dc, *thumb, 3, frame, margins, box);
}

void Skin::ThemeStatusBar(WindowHandle handle, Surface& dc, int plDraw, const Rect& box) {
    constexpr Margins kBarMargins{0, 3, 0, 3};
    const QImage& picture = pictures_.pStatusBar;
    const long long height = static_cast<long long>(box.bottom) - box.top;
    // The divider: the 3 x 22 strip at (0, 44) stretched to a column at the bar's right end.
    const auto divider = [&] {
        const auto column =
            MakeRect(static_cast<long long>(box.right) - 3, box.top, box.right, box.bottom);
        if (column && height > 0 && rect_math::FitsInt(height)) {
            (void)dc.Copy(picture, Piece{0, 44, 3, 22},
                          Piece{column->left, column->top, 3, static_cast<int>(height)});
        }
    };
    switch (plDraw) {
        case 0:
        case 5:
            // 5 is the bar of a status bar in simple mode: the same parts, flat.
            (void)Nine(dc, picture, 4, plDraw == 0 ? 0 : 3, kBarMargins, box);
            divider();
            return;
        case 1:
            (void)shapes_.DrawThemePart(dc, "Status", 3, 1, box);
            return;
        case 2: {
            // A panel: the three columns of the band at y 22, the middle one stretched.
            const long long width = static_cast<long long>(box.right) - box.left;
            if (width < 2 || height <= 0 || !rect_math::FitsInt(width) ||
                !rect_math::FitsInt(height)) {
                return;
            }
            const int w = static_cast<int>(width);
            const int h = static_cast<int>(height);
            (void)dc.Copy(picture, Piece{0, 22, 1, 22}, Piece{box.left, box.top, 1, h});
            (void)dc.Copy(picture, Piece{1, 22, 1, 22}, Piece{box.left + 1, box.top, w - 2, h});
            (void)dc.Copy(picture, Piece{2, 22, 1, 22}, Piece{box.right - 1, box.top, 1, h});
            return;
        }
        case 3:
            // The progress part's trough over the box (the bar is not drawn: right edge 0).
            ThemeProgress(handle, dc, 0, box.right, box.bottom, Rect{box.left, box.top, 0, 0});
            return;
        case 4:
            // Its bar, inset in the box; box.right is where the progress has reached.
            ThemeProgress(handle, dc, 0, 0, 0, box);
            return;
        default:
            return;
    }
}

}  // namespace kickvane::skin
