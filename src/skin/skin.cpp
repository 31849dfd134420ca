#include "skin/skin.h"

#include "skin/rect_math.h"

namespace kickvane::skin {

using rect_math::FloorHalf;
using rect_math::Moved;

namespace {

constexpr int kCellSize = 13;
constexpr Margins kMargins3{3, 3, 3, 3};
constexpr Colour kOutlineBlue = 13603685;  // red 101, green 147, blue 207

}  // namespace

Piece GlyphPlace(const Rect& box) {
    const long long x = box.left + FloorHalf(static_cast<long long>(box.right) - box.left) - 4;
    const long long y = box.top + FloorHalf(static_cast<long long>(box.bottom) - box.top) - 4;
    if (!rect_math::FitsInt(x) || !rect_math::FitsInt(y)) {
        return Piece{0, 0, 0, 0};
    }
    return Piece{static_cast<int>(x), static_cast<int>(y), 9, 9};
}

Skin::Skin() : Skin(MakeSkinPictures()) {}

Skin::Skin(SkinPictures pictures)
    : pictures_(std::move(pictures)), probe_(std::make_shared<QtPointerProbe>()) {}

Status Skin::Nine(Surface& dc, const QImage& picture, int count, int index, const Margins& margins,
                  const Rect& box) const {
    return PaintNine(dc, picture, margins, box, FrameOf(picture, count, index));
}

Status Skin::NineKeyed(Surface& dc, const QImage& picture, int count, int index,
                       const Margins& margins, const Rect& box) const {
    return PaintNineKeyed(dc, picture, margins, box, FrameOf(picture, count, index), kMagentaKey);
}

Status Skin::Glyph(Surface& dc, int cell, const Rect& box) const {
    const Piece place = GlyphPlace(box);
    if (place.IsEmpty()) {
        return Status::Fail("glyph place out of range");
    }
    const int cellHeight = pictures_.pArrow.height() / 20;
    return dc.CopyKeyed(pictures_.pArrow, Piece{0, cell * cellHeight, 9, 9}, place, kMagentaKey);
}

bool Skin::IsHot(WindowHandle window) const {
    bool over = false;
    // A cursor that cannot be read shows the plain look.
    return MDMouseOver(window, over).ok() && over;
}

std::string Skin::WindowText(WindowHandle window) const {
    return readText_ ? readText_(window) : std::string();
}

Status Skin::MDMouseOver(WindowHandle handleWindow, bool& over) const {
    over = false;
    if (!probe_) {
        return Status::Fail("no way to find the window under the cursor");
    }
    WindowHandle atCursor = 0;
    if (Status s = probe_->WindowAtCursor(atCursor); !s) {
        return s;
    }
    over = atCursor != 0 && atCursor == handleWindow;
    return Status::Ok();
}

Status Skin::ThemeCheck(WindowHandle, Surface& dc, int state, int plDraw, const Rect& box) {
    if (plDraw != 0) {
        return Status::Ok();
    }
    if (state < 1 || state > 12) {
        return Status::Fail("check box state out of range");
    }
    return dc.Copy(pictures_.pCheck, Piece{0, (state - 1) * kCellSize, kCellSize, kCellSize},
                   Piece{box.left, box.top, kCellSize, kCellSize});
}

Status Skin::ThemeOption(WindowHandle, Surface& dc, int state, int plDraw, const Rect& box) {
    if (plDraw != 0 && plDraw != 1) {
        return Status::Ok();
    }
    if (state < 1 || state > 8) {
        return Status::Fail("option button state out of range");
    }
    return dc.CopyKeyed(pictures_.pOption, Piece{0, (state - 1) * kCellSize, kCellSize, kCellSize},
                        Piece{box.left, box.top, kCellSize, kCellSize}, kMagentaKey);
}

void Skin::ThemeButton(WindowHandle, Surface& dc, int state, bool, bool, const Rect& box) {
    const int frame = state >= 1 && state <= 5 ? state - 1 : 0;
    (void)Nine(dc, pictures_.pButton, 5, frame, kMargins3, box);
}

void Skin::ThemeListbox(WindowHandle hwnd, Surface& dc, int plDraw, const Rect& box) {
    if (plDraw != 1 && plDraw != 2) {
        return;
    }
    (void)Nine(dc, pictures_.pButton, 5, plDraw == 2 ? 1 : 0, kMargins3, box);
    if (const auto textBox = Moved(box, 26, 0, 0, 0)) {
        (void)shapes_.DrawText(dc, *textBox, WindowText(hwnd), kSysWindowText);
    }
}

void Skin::ThemeCombobox(WindowHandle hwnd, Surface& dc, int state, int plDraw, const Rect& box) {
    const auto picture = Moved(box, -2, 0, 0, -1);
    switch (plDraw) {
        case 0:
            if (state == 0) {
                (void)shapes_.FillBox(dc, box.left, box.top, box.right, box.bottom, kSysWindow);
                (void)shapes_.FrameBox(dc, box.left, box.top, box.right, box.bottom, kOutlineBlue);
            } else if (state == 1) {
                (void)shapes_.FillBox(dc, box.left, box.top, box.right, box.bottom, kSysHighlight);
            } else if (state == 2) {
                if (const auto textBox = Moved(box, 0, 2, -2, -2)) {
                    (void)shapes_.DrawText(dc, *textBox, WindowText(hwnd), kSysWindowText);
                }
            }
            return;
        case 1: {
            if (!picture) {
                return;
            }
            int frame = 0;
            switch (state) {
                case 2:
                    frame = 1;
                    break;
                case 3:
                    frame = 2;
                    break;
                case 4:
                    frame = 3;
                    break;
                default:
                    frame = 0;
                    break;
            }
            (void)Nine(dc, pictures_.pCombobox, 4, frame, kMargins3, *picture);
            (void)Glyph(dc, ChevronCell(frame), *picture);
            return;
        }
        case 2:
            if (state == 0 && picture) {
                (void)Nine(dc, pictures_.pButton, 5, 0, kMargins3, *picture);
            }
            return;
        default:
            return;
    }
}

void Skin::ThemeTab(WindowHandle, Surface& dc, int plDraw, int state, const Rect& box,
                    int sPosition) {
    if (sPosition != 0) {
        return;
    }
    if (plDraw == 0) {
        (void)Nine(dc, pictures_.pTab, 1, 0, Margins{5, 5, 5, 5}, box);
    } else if (plDraw == 1) {
        const int frame = state == 1 ? 1 : state == 2 ? 2 : state == 3 ? 4 : 0;
        (void)Nine(dc, pictures_.pTabTop, 5, frame, Margins{6, 6, 6, 6}, box);
    }
}

void Skin::ThemePropertyGrid(WindowHandle, Surface& dc, int state, int plDraw, const Rect& box) {
    const auto [l, t, r, b] = box;
    if (plDraw == 1 && state == 0) {
        (void)Nine(dc, pictures_.pTab, 1, 0, kMargins3, box);
    } else if (plDraw == 1 && state == 1) {
        (void)shapes_.FrameBox(dc, l, t, r, b, Rgb(49, 106, 197));
    } else if (plDraw == 0) {
        if (state == 0) {
            (void)shapes_.FillBox(dc, l, t, r, b, kSysWindow);
            (void)shapes_.FrameBox(dc, l, t, r, b, kSysButtonFace);
        } else if (state == 1) {
            (void)shapes_.FillBox(dc, l, t, r, b, kSysHighlight);
        } else {
            (void)shapes_.FillBox(dc, l, t, r, b, kSysButtonFace);
        }
    }
}

void Skin::ThemeDate(WindowHandle, Surface& dc, int state, int plDraw, const Rect& box) {
    if (state != 0) {
        return;
    }
    if (plDraw == 1) {
        (void)Nine(dc, pictures_.pTab, 1, 0, kMargins3, box);
    } else if (plDraw == 2) {
        (void)Nine(dc, pictures_.pButton, 5, 0, kMargins3, box);
    }
}

void Skin::DrawListview(WindowHandle, Surface& dc, int plDraw, int state, const Rect& box) {
    if (plDraw == 0) {
        const int frame = state == 0 ? 3 : state == 2 ? 2 : state == 3 ? 1 : 0;
        (void)Nine(dc, pictures_.pListView, 5, frame, kMargins3, box);
    } else if (plDraw == 1) {
        (void)Nine(dc, pictures_.pListView, 5, 0, kMargins3, box);
    } else if (plDraw == 2) {
        (void)shapes_.FrameBox(dc, box.left, box.top, box.right, box.bottom, kOutlineBlue);
    }
}

}  // namespace kickvane::skin
