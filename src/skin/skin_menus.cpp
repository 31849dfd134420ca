// Painters of menus, toolbars, window tabs and flat boxes.
#include "skin/rect_math.h"
#include "skin/skin.h"

namespace kickvane::skin {

using rect_math::moved;

namespace {

constexpr Margins kMargins3{3, 3, 3, 3};
constexpr Colour kPaleBlue = rgb(191, 208, 237);
constexpr Colour kPressedBlue = rgb(160, 187, 228);
constexpr Colour kEdgeBlue = rgb(49, 106, 197);
constexpr Colour kTabStrip = rgb(191, 219, 255);
constexpr Colour kCream = rgb(247, 246, 238);
constexpr Colour kCreamEdge = rgb(172, 168, 153);

// The frame of the toolbar button pictures for a look; a flat button has none.
std::optional<int> toolbarFrame(ToolbarLook look) {
    switch (look) {
        case ToolbarLook::Flat:
            return std::nullopt;
        case ToolbarLook::Hot:
            return kToolbarHot;
        case ToolbarLook::Pressed:
            return kToolbarPressed;
        case ToolbarLook::Checked:
            return kToolbarChecked;
        case ToolbarLook::CheckedHot:
            return kToolbarCheckedHot;
        case ToolbarLook::Raised:
            return kToolbarRaised;
    }
    return std::nullopt;
}

// The three looks of a mark box and its mark: normal, hot, disabled.
std::optional<int> markBoxFrame(MenuLook look) {
    switch (look) {
        case MenuLook::Normal:
            return 0;
        case MenuLook::Hot:
            return 1;
        case MenuLook::Disabled:
            return 2;
        default:
            return std::nullopt;
    }
}

}  // namespace

void Skin::paintMenu(Surface& dc, MenuPart part, MenuLook look, const Rect& box) const {
    const auto band = [&] {
        const long long w = static_cast<long long>(box.right) - box.left;
        const long long h = static_cast<long long>(box.bottom) - box.top;
        if (w > 0 && h > 0 && rect_math::fitsInt(w) && rect_math::fitsInt(h)) {
            (void)dc.copy(pictures_.menuBand, Piece{0, 0, 28, 2},
                          Piece{box.left, box.top, static_cast<int>(w), static_cast<int>(h)});
        }
    };
    const auto highlight = [&] {
        if (look == MenuLook::Hot) {
            (void)nine(dc, pictures_.menuItem, 2, 0, kMargins3, box);
        } else if (look == MenuLook::Disabled) {
            (void)nine(dc, pictures_.menuMarkBox, 3, 2, kMargins3, box);
        }
    };
    // The tick and the bullet, and their disabled looks.
    const auto markCell = [&](bool tick) {
        return (tick ? 0 : 1) + (look == MenuLook::Disabled ? 2 : 0);
    };
    const auto boxedMark = [&](bool tick) {
        const auto frame = markBoxFrame(look);
        if (!frame) {
            return;
        }
        (void)nine(dc, pictures_.menuMarkBox, 3, *frame, kMargins3, box);
        if (const auto inner = moved(box, 2, 2, -2, -2)) {
            (void)nine(dc, pictures_.menuMarks, 4, markCell(tick), kMargins3, *inner);
        }
    };
    switch (part) {
        case MenuPart::BarItem:
            if (look == MenuLook::Hot) {
                (void)nine(dc, pictures_.toolbarButton, 5, kToolbarHot, kMargins3, box);
            } else if (look == MenuLook::Open) {
                (void)nine(dc, pictures_.menuItem, 2, 1, kMargins3, box);
            }
            return;
        case MenuPart::ItemHighlight:
            highlight();
            return;
        case MenuPart::Band:
            band();
            return;
        case MenuPart::MarkBox:
            if (const auto frame = markBoxFrame(look)) {
                (void)nine(dc, pictures_.menuMarkBox, 3, *frame, kMargins3, box);
            }
            return;
        case MenuPart::Tick:
        case MenuPart::Bullet:
            if (markBoxFrame(look)) {
                (void)nine(dc, pictures_.menuMarks, 4, markCell(part == MenuPart::Tick), kMargins3,
                           box);
            }
            return;
        case MenuPart::BoxedTick:
            boxedMark(true);
            return;
        case MenuPart::BoxedBullet:
            boxedMark(false);
            return;
        case MenuPart::Button:
            if (look == MenuLook::Hot || look == MenuLook::Pressed || look == MenuLook::Checked) {
                const int frame = look == MenuLook::Hot       ? kToolbarHot
                                  : look == MenuLook::Pressed ? kToolbarPressed
                                                              : kToolbarChecked;
                (void)nine(dc, pictures_.toolbarButton, 5, frame, kMargins3, box);
            }
            return;
        case MenuPart::CheckedBarItem:
            (void)nine(dc, pictures_.toolbarButton, 5,
                       look == MenuLook::Hot ? kToolbarCheckedHot : kToolbarChecked, kMargins3,
                       box);
            return;
        case MenuPart::HighlightOverBand:
            band();
            highlight();
            return;
        case MenuPart::RaisedButton:
            (void)nine(dc, pictures_.toolbarButton, 5, kToolbarRaised, kMargins3, box);
            return;
    }
}

void Skin::paintToolbarBackground(Surface& dc, const Rect& bar) const {
    (void)nine(dc, pictures_.toolbar, 1, 0, kMargins3, bar);
}

void Skin::paintToolbarButton(Surface& dc, ToolbarButtonPart part, ToolbarLook look,
                              const Rect& item) const {
    const auto frame = toolbarFrame(look);
    if (!frame) {
        return;
    }
    switch (part) {
        case ToolbarButtonPart::Button:
            (void)nine(dc, pictures_.toolbarButton, 5, *frame, kMargins3, item);
            return;
        case ToolbarButtonPart::ButtonWithDropDown:
            // The right 11 columns hold the divider and arrow and keep their width.
            (void)nineKeyed(dc, pictures_.toolbarDropDownButton, 5, *frame, Margins{3, 3, 11, 3},
                            item);
            return;
        case ToolbarButtonPart::DropDown:
            (void)nineKeyed(dc, pictures_.toolbarDropDownArrow, 5, *frame, kMargins3, item);
            return;
    }
}

void Skin::paintToolbarComboButton(Surface& dc, ControlLook look, const Rect& item) const {
    (void)nine(dc, pictures_.comboButton, 4, static_cast<int>(look), kMargins3, item);
}

void Skin::paintToolbarPanel(Surface& dc, const Rect& item) const {
    (void)nine(dc, pictures_.tabPanel, 1, 0, kMargins3, item);
}

Status Skin::paintWindowTab(Surface& dc, WindowTabPart part, const Rect& box) const {
    const auto [l, t, r, b] = box;
    switch (part) {
        case WindowTabPart::Strip: {
            // The tab strip with a line along its foot.
            if (Status s = shapes_.fillBox(dc, l, t, r, b, kTabStrip); !s) {
                return s;
            }
            const auto foot = moved(box, 0, static_cast<long long>(b) - t - 1, 0, 0);
            if (!foot) {
                return Status::Ok();
            }
            return shapes_.fillBox(dc, foot->left, foot->top, foot->right, foot->bottom,
                                   rgb(122, 138, 163));
        }
        case WindowTabPart::ActiveTab:
        case WindowTabPart::InactiveTab: {
            // A tab in three pieces: its rounded ends keep their width, the middle stretches.
            const int frameTop = part == WindowTabPart::ActiveTab ? 0 : 21;
            const long long w = static_cast<long long>(r) - l;
            const long long h = static_cast<long long>(b) - t;
            if (w < 12 || h <= 0) {
                return Status::Ok();
            }
            if (!rect_math::fitsInt(w) || !rect_math::fitsInt(h)) {
                return Status::Fail("window tab too large");
            }
            const int hi = static_cast<int>(h);
            const Piece pieces[3][2] = {
                {{0, frameTop, 6, 21}, {l, t, 6, hi}},
                {{6, frameTop, 14, 21}, {l + 6, t, static_cast<int>(w) - 12, hi}},
                {{20, frameTop, 6, 21}, {r - 6, t, 6, hi}},
            };
            for (const auto& [from, to] : pieces) {
                if (Status s = dc.copyKeyed(pictures_.windowTabs, from, to, kMagentaKey); !s) {
                    return s;
                }
            }
            return Status::Ok();
        }
        case WindowTabPart::PageFrame:
            return paintNineInCurrentMode(dc, pictures_.windowTabFrame, Margins{4, 4, 4, 4}, box,
                                          Frame{12, 12, 0});
        case WindowTabPart::HotButton:
        case WindowTabPart::PressedButton: {
            const Colour fill = part == WindowTabPart::HotButton ? kPaleBlue : kPressedBlue;
            if (Status s = shapes_.fillBox(dc, l, t, r, b, fill); !s) {
                return s;
            }
            return shapes_.frameBox(dc, l, t, r, b, kEdgeBlue);
        }
        case WindowTabPart::Divider: {
            // Kept off the top and bottom of the tabs beside it.
            const long long top = static_cast<long long>(t) + 3;
            const long long bottom = static_cast<long long>(b) - 4;
            if (bottom < top) {
                return Status::Ok();
            }
            return shapes_.drawLine(dc, l, static_cast<int>(top), l, static_cast<int>(bottom),
                                    kSysButtonShadow, 1);
        }
    }
    return Status::Ok();
}

void Skin::paintMenuBox(Surface& dc, MenuBox part, MenuBoxLook look, const Rect& box) const {
    const auto [l, t, r, b] = box;
    const auto fill = [&](Colour c) { (void)shapes_.fillBox(dc, l, t, r, b, c); };
    const auto frame = [&](Colour c) { (void)shapes_.frameBox(dc, l, t, r, b, c); };
    const bool normal = look == MenuBoxLook::Normal;
    switch (part) {
        case MenuBox::Background:
            if (look != MenuBoxLook::Pressed) {
                fill(kSysButtonFace);
            }
            return;
        case MenuBox::Item:
            if (normal) {
                frame(kSysButtonShadow);
            } else if (look == MenuBoxLook::Hot) {
                fill(kPaleBlue);
                frame(kEdgeBlue);
            }
            return;
        case MenuBox::Margin:
            fill(normal ? kSysButtonFace : rgb(255, 255, 255));
            return;
        case MenuBox::Separator:
            (void)shapes_.drawLine(dc, l, t, r, b, kSysButtonShadow, 1);
            return;
        case MenuBox::Highlight:
            fill(normal ? kPaleBlue : kCream);
            frame(normal ? kEdgeBlue : kCreamEdge);
            return;
        case MenuBox::Button:
            if (normal) {
                fill(kCream);
                frame(kCreamEdge);
            } else {
                fill(look == MenuBoxLook::Pressed ? kPressedBlue : rgb(227, 235, 247));
                frame(kEdgeBlue);
            }
            return;
        case MenuBox::Outline:
            frame(kSysButtonShadow);
            return;
    }
}

Status Skin::paintColourPopup(Surface& dc, ColourPopupPart part, const Rect& box) const {
    const auto [l, t, r, b] = box;
    switch (part) {
        case ColourPopupPart::Background:
            return shapes_.fillBox(dc, l, t, r, b, kSysButtonFace);
        case ColourPopupPart::SelectedCell:
            if (Status s = shapes_.fillBox(dc, l, t, r, b, kPaleBlue); !s) {
                return s;
            }
            return shapes_.frameBox(dc, l, t, r, b, kEdgeBlue);
        case ColourPopupPart::Outline:
            return shapes_.frameBox(dc, l, t, r, b, kSysButtonShadow);
    }
    return Status::Ok();
}

void Skin::paintTextBoxOutline(Surface& dc, const Rect& box) const {
    (void)shapes_.frameBox(dc, box.left, box.top, box.right, box.bottom, rgb(101, 147, 207));
}

}  // namespace kickvane::skin
