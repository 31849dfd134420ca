// Painters of menus, toolbars, window tabs and flat boxes.
#include <cmath>
#include <optional>

#include "skin/rect_math.h"
#include "skin/skin.h"

namespace kickvane::skin {

using rect_math::MakeRect;
using rect_math::Moved;

namespace {

constexpr Margins kMargins3{3, 3, 3, 3};
constexpr Colour kPaleBlue = Rgb(191, 208, 237);
constexpr Colour kEdgeBlue = Rgb(49, 106, 197);
constexpr Colour kTabStrip = Rgb(191, 219, 255);

// A floating coordinate as a whole pixel, rounded to nearest (halves to even); nullopt when it
// is no number or lies outside the 32-bit range.
std::optional<int> ToPixel(double value) {
    if (!std::isfinite(value)) {
        return std::nullopt;
    }
    const double rounded = std::nearbyint(value);
    if (rounded < -2147483648.0 || rounded > 2147483647.0) {
        return std::nullopt;
    }
    return static_cast<int>(rounded);
}

// Toolbar button states to frames of pToolbarButton and its drop-down pictures.
std::optional<int> ToolbarFrame(int tbStatus) {
    switch (tbStatus) {
        case 1:
            return kToolbarHot;
        case 2:
            return kToolbarPressed;
        case 3:
            return kToolbarChecked;
        case 4:
            return kToolbarCheckedHot;
        case 5:
            return kToolbarRaised;
        default:
            return std::nullopt;
    }
}

}  // namespace

void Skin::ThemeCommandBarMenu(WindowHandle, Surface& dc, int plDraw, int state, const Rect& box) {
    const auto leftBand = [&] {
        const long long w = static_cast<long long>(box.right) - box.left;
        const long long h = static_cast<long long>(box.bottom) - box.top;
        if (w > 0 && h > 0 && rect_math::FitsInt(w) && rect_math::FitsInt(h)) {
            (void)dc.Copy(pictures_.pMenuLeft, Piece{0, 0, 28, 2},
                          Piece{box.left, box.top, static_cast<int>(w), static_cast<int>(h)});
        }
    };
    const auto highlight = [&] {
        if (state == 1) {
            (void)Nine(dc, pictures_.pMenuItem, 2, 0, kMargins3, box);
        } else if (state == 2) {
            (void)Nine(dc, pictures_.pMenuCheckBorder, 3, 2, kMargins3, box);
        }
    };
    // A mark (tick or bullet) in its box, inset by 2 pixels.
    const auto boxedMark = [&](int normalCell) {
        if (state < 0 || state > 2) {
            return;
        }
        (void)Nine(dc, pictures_.pMenuCheckBorder, 3, state, kMargins3, box);
        if (const auto inner = Moved(box, 2, 2, -2, -2)) {
            (void)Nine(dc, pictures_.pMenuCheck, 4, state == 2 ? normalCell + 2 : normalCell,
                       kMargins3, *inner);
        }
    };
    switch (plDraw) {
        case 0:  // menu bar item
            if (state == 1) {
                (void)Nine(dc, pictures_.pToolbarButton, 5, kToolbarHot, kMargins3, box);
            } else if (state == 2) {
                (void)Nine(dc, pictures_.pMenuItem, 2, 1, kMargins3, box);
            }
            return;
        case 1:  // popup item highlight; State 2 is a disabled item under the cursor
            highlight();
            return;
        case 2:
            leftBand();
            return;
        case 3:
            if (state >= 0 && state <= 2) {
                (void)Nine(dc, pictures_.pMenuCheckBorder, 3, state, kMargins3, box);
            }
            return;
        case 4:
        case 5:
            if (state >= 0 && state <= 2) {
                const int cell = (plDraw == 4 ? 0 : 1) + (state == 2 ? 2 : 0);
                (void)Nine(dc, pictures_.pMenuCheck, 4, cell, kMargins3, box);
            }
            return;
        case 6:
            boxedMark(0);
            return;
        case 7:
            boxedMark(1);
            return;
        case 8:  // a button inside a menu, such as its chevron
            if (state >= 0 && state <= 2) {
                const int frames[] = {kToolbarHot, kToolbarPressed, kToolbarChecked};
                (void)Nine(dc, pictures_.pToolbarButton, 5, frames[state], kMargins3, box);
            }
            return;
        case 9:  // a checked menu bar item, hot with State 1
            (void)Nine(dc, pictures_.pToolbarButton, 5,
                       state == 1 ? kToolbarCheckedHot : kToolbarChecked, kMargins3, box);
            return;
        case 10:  // a popup item whose highlight covers the left band
            leftBand();
            highlight();
            return;
        case 11:  // a raised button in a menu
            (void)Nine(dc, pictures_.pToolbarButton, 5, kToolbarRaised, kMargins3, box);
            return;
        default:
            return;
    }
}

void Skin::ThemeUniToolbar(WindowHandle, Surface& dc, int plDraw, int, int itemLeft, int itemTop,
                           int itemWidth, int itemHeight, int tbStatus, int tbWidth, int tbHeight) {
    if (plDraw == 0) {
        (void)Nine(dc, pictures_.pToolbar, 1, 0, kMargins3, Rect{0, 0, tbWidth, tbHeight});
        return;
    }
    // Item width and height are the item's right and bottom edges.
    const auto item =
        MakeRect(itemLeft, static_cast<long long>(itemTop) + 2, itemWidth, itemHeight);
    if (!item) {
        return;
    }
    switch (plDraw) {
        case 1:
            if (const auto frame = ToolbarFrame(tbStatus)) {
                (void)Nine(dc, pictures_.pToolbarButton, 5, *frame, kMargins3, *item);
            }
            return;
        case 2:
            // The right 11 columns hold the divider and arrow and keep their width.
            if (const auto frame = ToolbarFrame(tbStatus)) {
                (void)NineKeyed(dc, pictures_.pToolbarButtonDropDown, 5, *frame,
                                Margins{3, 3, 11, 3}, *item);
            }
            return;
        case 3:
            if (const auto frame = ToolbarFrame(tbStatus)) {
                (void)NineKeyed(dc, pictures_.pToolbarButtonDropDownRight, 5, *frame, kMargins3,
                                *item);
            }
            return;
        case 4: {
            const int frame = tbStatus == 2 ? 1 : tbStatus == 3 ? 2 : tbStatus == 4 ? 3 : 0;
            (void)Nine(dc, pictures_.pCombobox, 4, frame, kMargins3, *item);
            return;
        }
        case 5:
            (void)Nine(dc, pictures_.pTab, 1, 0, kMargins3, *item);
            return;
        default:
            return;
    }
}

Status Skin::ThemeMDITab(WindowHandle, Surface& dc, int plDraw, float x, float y, float x1,
                         float y1, int& lReturn) {
    if (plDraw == 7) {
        lReturn = 15;
        return Status::Ok();
    }
    if (plDraw == 8) {
        lReturn = 5;
        return Status::Ok();
    }
    const auto l = ToPixel(x), t = ToPixel(y), r = ToPixel(x1), b = ToPixel(y1);
    if (!l || !t || !r || !b) {
        return Status::Fail("window tab coordinates are no whole-pixel values");
    }
    const Rect box{*l, *t, *r, *b};
    switch (plDraw) {
        case 1: {
            // The tab strip with a line along its foot.
            if (Status s = shapes_.FillBox(dc, *l, *t, *r, *b, kTabStrip); !s) {
                return s;
            }
            const auto foot = Moved(box, 0, static_cast<long long>(*b) - *t - 1, 0, 0);
            if (!foot) {
                return Status::Ok();
            }
            return shapes_.FillBox(dc, foot->left, foot->top, foot->right, foot->bottom,
                                   Rgb(122, 138, 163));
        }
        case 2:
        case 5: {
            // A tab in three pieces: its rounded ends keep their width, the middle stretches.
            const int frameTop = plDraw == 2 ? 0 : 21;
            const long long w = static_cast<long long>(*r) - *l;
            const long long h = static_cast<long long>(*b) - *t;
            if (w < 12 || h <= 0) {
                return Status::Ok();
            }
            if (!rect_math::FitsInt(w) || !rect_math::FitsInt(h)) {
                return Status::Fail("window tab too large");
            }
            const int hi = static_cast<int>(h);
            const Piece pieces[3][2] = {
                {{0, frameTop, 6, 21}, {*l, *t, 6, hi}},
                {{6, frameTop, 14, 21}, {*l + 6, *t, static_cast<int>(w) - 12, hi}},
                {{20, frameTop, 6, 21}, {*r - 6, *t, 6, hi}},
            };
            for (const auto& [from, to] : pieces) {
                if (Status s = dc.CopyKeyed(pictures_.pMDITab, from, to, kMagentaKey); !s) {
                    return s;
                }
            }
            return Status::Ok();
        }
        case 6:
            return PaintNineInCurrentMode(dc, pictures_.pMDITabFrame, Margins{4, 4, 4, 4}, box,
                                          Frame{12, 12, 0});
        case 10:
        case 11: {
            const Colour fill = plDraw == 10 ? kPaleBlue : Rgb(160, 187, 228);
            if (Status s = shapes_.FillBox(dc, *l, *t, *r, *b, fill); !s) {
                return s;
            }
            return shapes_.FrameBox(dc, *l, *t, *r, *b, kEdgeBlue);
        }
        case 12: {
            // A divider between two inactive tabs, kept off their top and bottom.
            const long long top = static_cast<long long>(*t) + 3;
            const long long bottom = static_cast<long long>(*b) - 4;
            if (bottom < top) {
                return Status::Ok();
            }
            return shapes_.DrawLine(dc, *l, static_cast<int>(top), *l, static_cast<int>(bottom),
                                    kSysButtonShadow, 1);
        }
        default:
            return Status::Ok();
    }
}

void Skin::ThemeMenus(WindowHandle, Surface& dc, int plDraw, int state, int mnLeft, int mnTop,
                      int mnRight, double mnBottom) {
    const auto bottom = ToPixel(mnBottom);
    if (!bottom) {
        return;
    }
    const int l = mnLeft, t = mnTop, r = mnRight, b = *bottom;
    const auto fill = [&](Colour c) { (void)shapes_.FillBox(dc, l, t, r, b, c); };
    const auto frame = [&](Colour c) { (void)shapes_.FrameBox(dc, l, t, r, b, c); };
    const Colour kCream = Rgb(247, 246, 238);
    const Colour kCreamEdge = Rgb(172, 168, 153);
    switch (plDraw) {
        case 0:
            if (state == 0 || state == 1) {
                fill(kSysButtonFace);
            }
            return;
        case 1:
            if (state == 0) {
                frame(kSysButtonShadow);
            } else if (state == 1) {
                fill(kPaleBlue);
                frame(kEdgeBlue);
            }
            return;
        case 2:
            fill(state == 0 ? kSysButtonFace : Rgb(255, 255, 255));
            return;
        case 3:
            (void)shapes_.DrawLine(dc, l, t, r, b, kSysButtonShadow, 1);
            return;
        case 4:
            fill(state == 0 ? kPaleBlue : kCream);
            frame(state == 0 ? kEdgeBlue : kCreamEdge);
            return;
        case 5:
            if (state == 0) {
                fill(kCream);
                frame(kCreamEdge);
            } else if (state == 1 || state == 2) {
                fill(state == 1 ? Rgb(160, 187, 228) : Rgb(227, 235, 247));
                frame(kEdgeBlue);
            }
            return;
        case 6:
            frame(kSysButtonShadow);
            return;
        default:
            return;
    }
}

Status Skin::ThemePopupColor(WindowHandle, Surface& dc, int plDraw, const Rect& box) {
    const auto [l, t, r, b] = box;
    switch (plDraw) {
        case 0:
            return shapes_.FillBox(dc, l, t, r, b, kSysButtonFace);
        case 1:
        case 2:
            if (Status s = shapes_.FillBox(dc, l, t, r, b, kPaleBlue); !s) {
                return s;
            }
            return shapes_.FrameBox(dc, l, t, r, b, kEdgeBlue);
        case 3:
            return shapes_.FrameBox(dc, l, t, r, b, kSysButtonShadow);
        default:
            return Status::Ok();
    }
}

void Skin::DrawTextbox(WindowHandle, Surface& dc, int bState, int x, int y, int width, int height) {
    if (bState == 0 || bState == 1) {
        (void)shapes_.FrameBox(dc, x, y, width, height, 13603685);
    }
}

}  // namespace kickvane::skin
