#include "skin/skin.h"

#include "skin/rect_math.h"

namespace kickvane::skin {

using rect_math::floorHalf;
using rect_math::moved;

namespace {

constexpr int kCellSize = 13;
constexpr Margins kMargins3{3, 3, 3, 3};
constexpr Colour kOutlineBlue = rgb(101, 147, 207);

// Pictures with one frame or cell per look hold them in the order of ControlLook.
int lookIndex(ControlLook look) {
    return static_cast<int>(look);
}

}  // namespace

Piece glyphPlace(const Rect& box) {
    const long long width = static_cast<long long>(box.right) - box.left;
    const long long height = static_cast<long long>(box.bottom) - box.top;
    const long long x = box.left + floorHalf(width) - 4;
    const long long y = box.top + floorHalf(height) - 4;
    // A box wider or higher than the coordinate range has no middle to speak of.
    if (!rect_math::fitsInt(width) || !rect_math::fitsInt(height) || !rect_math::fitsInt(x) ||
        !rect_math::fitsInt(y)) {
        return Piece{0, 0, 0, 0};
    }
    return Piece{static_cast<int>(x), static_cast<int>(y), 9, 9};
}

Skin::Skin() : Skin(makeSkinPictures()) {}

Skin::Skin(SkinPictures pictures)
    : pictures_(std::move(pictures)), probe_(std::make_shared<QtPointerProbe>()) {}

Status Skin::nine(Surface& dc, const QImage& picture, int count, int index, const Margins& margins,
                  const Rect& box) const {
    return paintNine(dc, picture, margins, box, frameOf(picture, count, index));
}

Status Skin::nineKeyed(Surface& dc, const QImage& picture, int count, int index,
                       const Margins& margins, const Rect& box) const {
    return paintNineKeyed(dc, picture, margins, box, frameOf(picture, count, index), kMagentaKey);
}

Status Skin::glyph(Surface& dc, int cell, const Rect& box) const {
    const Piece place = glyphPlace(box);
    if (place.isEmpty()) {
        return Status::Fail("glyph place out of range");
    }
    const int cellHeight = pictures_.arrows.height() / 20;
    return dc.copyKeyed(pictures_.arrows, Piece{0, cell * cellHeight, 9, 9}, place, kMagentaKey);
}

std::optional<bool> Skin::isUnderCursor(WindowHandle window) const {
    if (!probe_) {
        return std::nullopt;
    }
    const std::optional<WindowHandle> atCursor = probe_->windowAtCursor();
    if (!atCursor) {
        return std::nullopt;
    }
    return *atCursor != 0 && *atCursor == window;
}

Status Skin::paintCheckBox(Surface& dc, CheckState state, ControlLook look, const Rect& box) const {
    const int cell = 4 * static_cast<int>(state) + lookIndex(look);
    return dc.copy(pictures_.checkBox, Piece{0, cell * kCellSize, kCellSize, kCellSize},
                   Piece{box.left, box.top, kCellSize, kCellSize});
}

Status Skin::paintOptionButton(Surface& dc, OptionState state, ControlLook look,
                               const Rect& box) const {
    const int cell = 4 * static_cast<int>(state) + lookIndex(look);
    return dc.copyKeyed(pictures_.optionButton, Piece{0, cell * kCellSize, kCellSize, kCellSize},
                        Piece{box.left, box.top, kCellSize, kCellSize}, kMagentaKey);
}

void Skin::paintButton(Surface& dc, ButtonLook look, const Rect& box) const {
    (void)nine(dc, pictures_.button, 5, static_cast<int>(look), kMargins3, box);
}

void Skin::paintListBoxItem(Surface& dc, ItemLook look, const Rect& box,
                            std::string_view text) const {
    (void)nine(dc, pictures_.button, 5, look == ItemLook::Hot ? 1 : 0, kMargins3, box);
    if (const auto textBox = moved(box, 26, 0, 0, 0)) {
        (void)shapes_.drawText(dc, *textBox, text, kSysWindowText);
    }
}

void Skin::paintComboBox(Surface& dc, ComboPart part, const Rect& box) const {
    switch (part) {
        case ComboPart::Field:
            (void)shapes_.fillBox(dc, box.left, box.top, box.right, box.bottom, kSysWindow);
            (void)shapes_.frameBox(dc, box.left, box.top, box.right, box.bottom, kOutlineBlue);
            return;
        case ComboPart::Selection:
            (void)shapes_.fillBox(dc, box.left, box.top, box.right, box.bottom, kSysHighlight);
            return;
        case ComboPart::PushButton:
            if (const auto picture = moved(box, -2, 0, 0, -1)) {
                (void)nine(dc, pictures_.button, 5, 0, kMargins3, *picture);
            }
            return;
    }
}

void Skin::paintComboText(Surface& dc, const Rect& box, std::string_view text) const {
    if (const auto textBox = moved(box, 0, 2, -2, -2)) {
        (void)shapes_.drawText(dc, *textBox, text, kSysWindowText);
    }
}

void Skin::paintComboButton(Surface& dc, ControlLook look, const Rect& box) const {
    if (const auto picture = moved(box, -2, 0, 0, -1)) {
        (void)nine(dc, pictures_.comboButton, 4, lookIndex(look), kMargins3, *picture);
        (void)glyph(dc, chevronCell(lookIndex(look)), *picture);
    }
}

void Skin::paintTabPanel(Surface& dc, const Rect& box) const {
    (void)nine(dc, pictures_.tabPanel, 1, 0, Margins{5, 5, 5, 5}, box);
}

void Skin::paintTabHead(Surface& dc, TabLook look, const Rect& box) const {
    // Frame 3 of the heads is a disabled head, which tabs on top do not show.
    const int frames[] = {0, 1, 2, 4};
    (void)nine(dc, pictures_.tabHeads, 5, frames[static_cast<int>(look)], Margins{6, 6, 6, 6}, box);
}

void Skin::paintPropertyGrid(Surface& dc, PropertyGridPart part, const Rect& box) const {
    const auto [l, t, r, b] = box;
    switch (part) {
        case PropertyGridPart::Panel:
            (void)nine(dc, pictures_.tabPanel, 1, 0, kMargins3, box);
            return;
        case PropertyGridPart::FocusFrame:
            (void)shapes_.frameBox(dc, l, t, r, b, rgb(49, 106, 197));
            return;
        case PropertyGridPart::Cell:
            (void)shapes_.fillBox(dc, l, t, r, b, kSysWindow);
            (void)shapes_.frameBox(dc, l, t, r, b, kSysButtonFace);
            return;
        case PropertyGridPart::SelectedCell:
            (void)shapes_.fillBox(dc, l, t, r, b, kSysHighlight);
            return;
        case PropertyGridPart::CategoryRow:
            (void)shapes_.fillBox(dc, l, t, r, b, kSysButtonFace);
            return;
    }
}

void Skin::paintDate(Surface& dc, DatePart part, const Rect& box) const {
    if (part == DatePart::Field) {
        (void)nine(dc, pictures_.tabPanel, 1, 0, kMargins3, box);
    } else {
        (void)nine(dc, pictures_.button, 5, 0, kMargins3, box);
    }
}

void Skin::paintListHeader(Surface& dc, HeaderLook look, const Rect& box) const {
    // The header picture holds normal, pressed, hot, empty.
    const int frames[] = {3, 0, 2, 1};
    (void)nine(dc, pictures_.listHeaders, 5, frames[static_cast<int>(look)], kMargins3, box);
}

void Skin::paintListOutline(Surface& dc, const Rect& box) const {
    (void)shapes_.frameBox(dc, box.left, box.top, box.right, box.bottom, kOutlineBlue);
}

}  // namespace kickvane::skin
