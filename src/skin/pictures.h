#pragma once

#include <array>

#include <QImage>

namespace kickvane::skin {

// The skin: one picture per kind of control part. Frames and cells are stacked from the top down.
// Pictures marked "keyed" use magenta (kMagentaKey) where the target shows through.
struct SkinPictures {
    QImage pButton;                      // 43 x 330: normal, hot, pressed, disabled, default
    QImage pCheck;                       // 13 x 156: unticked, ticked, mixed; each normal, hot,
                                         //           pressed, disabled
    QImage pOption;                      // 13 x 104, keyed: unset, set; each as pCheck
    QImage pProgress;                    // 125 x 34: trough 53 x 18, bar 125 x 16 below it
    QImage pProgressHor;                 // 18 x 104: upright trough 18 x 53, bar 16 x 51 below
    QImage pArrow;                       // 9 x 180, keyed: see ArrowCell
    QImage pScrollButton;                // 17 x 340: see ScrollButtonFrame
    QImage pScrollThumbHor;              // 21 x 68: upright thumb; normal, hot, pressed, disabled
    QImage pScrollThumbVer;              // 17 x 88: lying thumb; as above
    QImage pSpinHor;                     // 10 x 136: left then right button, 4 states each
    QImage pSpinVer;                     // 17 x 80: up then down button, 4 states each
    QImage pTrackBarHorBold;             // 21 x 45, keyed: lying thumb; normal, hot, disabled
    QImage pTrackBarHorLeft;             // 21 x 33, keyed: lying thumb pointing left
    QImage pTrackBarHorRight;            // 21 x 33, keyed: lying thumb pointing right
    QImage pTrackBarVerBold;             // 15 x 63, keyed: upright thumb
    QImage pTrackBarVerTop;              // 11 x 63, keyed: upright thumb pointing up
    QImage pTrackBarVerBottom;           // 11 x 63, keyed: upright thumb pointing down
    QImage pTab;                         // 80 x 92: tab panel
    QImage pTabTop;                      // 57 x 120: tab heads normal, hot, selected, disabled,
                                         //           selected with focus
    QImage pMDITab;                      // 26 x 42, keyed: window tab active, inactive
    QImage pMDITabFrame;                 // 12 x 12: frame around window tabs
    QImage pCombobox;                    // 15 x 76: drop button normal, hot, pressed, disabled
    QImage pListView;                    // 17 x 105: header normal, pressed, hot, empty, sorted
    QImage pStatusBar;                   // 3 x 88: bar, panel, divider, bar in simple mode
    QImage pToolbar;                     // 34 x 85: toolbar background
    QImage pToolbarButton;               // 23 x 110: see ToolbarButtonFrame
    QImage pToolbarButtonDropDown;       // 23 x 110: the same with a drop-down part
    QImage pToolbarButtonDropDownRight;  // 11 x 110: the drop-down part alone
    QImage pMenuItem;                    // 23 x 44: highlighted item, open menu bar item
    QImage pMenuLeft;                    // 28 x 2: left band of a menu
    QImage pMenuCheck;                   // 16 x 64: tick, bullet, disabled tick, disabled bullet
    QImage pMenuCheckBorder;             // 20 x 60: box behind a mark: normal, hot, disabled
};

// Glyph states shared by pArrow's groups and several button pictures.
enum GlyphState { kGlyphNormal = 0, kGlyphHot = 1, kGlyphPressed = 2, kGlyphDisabled = 3 };
enum class ArrowDirection { Up = 0, Down = 1, Left = 2, Right = 3 };

// pArrow holds four arrows in four states each (cell 4 x direction + state), then the drop-down
// chevron of a combo box in the four states (cells 16 to 19).
constexpr int ArrowCell(ArrowDirection direction, int state) {
    return 4 * static_cast<int>(direction) + state;
}
constexpr int ChevronCell(int state) {
    return 16 + state;
}

// pScrollButton: the buttons of a lying bar (left, right), then of an upright bar (up, down), in
// four states each (frame 4 x button + state); then the four buttons in their hover look, shown
// while the cursor is over the bar.
constexpr int ScrollButtonFrame(int button, int state) {
    return 4 * button + state;
}
constexpr int ScrollHoverFrame(int button) {
    return 16 + button;
}

// pToolbarButton and its drop-down pictures: 5 frames.
enum ToolbarButtonFrame {
    kToolbarHot = 0,
    kToolbarPressed = 1,
    kToolbarChecked = 2,
    kToolbarCheckedHot = 3,
    kToolbarRaised = 4,
};

struct NamedPicture {
    const char* name;
    const QImage* image;
    int width;
    int height;
    bool keyed;
};

// Our own skin, drawn at start: a soft blue-grey look with rounded corners and gentle gradients.
SkinPictures MakeSkinPictures();

// Every picture with its name, its required size and whether it is keyed.
std::array<NamedPicture, 32> ListPictures(const SkinPictures& pictures);

}  // namespace kickvane::skin
