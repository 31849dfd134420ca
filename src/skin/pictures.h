#pragma once

#include <array>

#include <QImage>

namespace kickvane::skin {

// The skin: one picture per kind of control part. Frames and cells are stacked from the top down.
// Pictures marked "keyed" use magenta (kMagentaKey) where the target shows through.
struct SkinPictures {
    QImage button;                 // 43 x 330: normal, hot, pressed, disabled, default
    QImage checkBox;               // 13 x 156: unticked, ticked, mixed; each normal, hot,
                                   //           pressed, disabled
    QImage optionButton;           // 13 x 104, keyed: unset, set; each as checkBox
    QImage progress;               // 125 x 34: trough 53 x 18, bar 125 x 16 below it
    QImage progressVertical;       // 18 x 104: upright trough 18 x 53, bar 16 x 51 below
    QImage arrows;                 // 9 x 180, keyed: see arrowCell
    QImage scrollButtons;          // 17 x 340: see scrollButtonFrame
    QImage scrollThumbVertical;    // 21 x 68: upright thumb; normal, hot, pressed, disabled
    QImage scrollThumbHorizontal;  // 17 x 88: lying thumb; as above
    QImage spinLeftRight;          // 10 x 136: left then right button, 4 states each
    QImage spinUpDown;             // 17 x 80: up then down button, 4 states each
    QImage trackThumbLying;        // 21 x 45, keyed: lying thumb; normal, hot, disabled
    QImage trackThumbLeft;         // 21 x 33, keyed: lying thumb pointing left
    QImage trackThumbRight;        // 21 x 33, keyed: lying thumb pointing right
    QImage trackThumbUpright;      // 15 x 63, keyed: upright thumb
    QImage trackThumbUp;           // 11 x 63, keyed: upright thumb pointing up
    QImage trackThumbDown;         // 11 x 63, keyed: upright thumb pointing down
    QImage tabPanel;               // 80 x 92: tab panel
    QImage tabHeads;               // 57 x 120: tab heads normal, hot, selected, disabled,
                                   //           selected with focus
    QImage windowTabs;             // 26 x 42, keyed: window tab active, inactive
    QImage windowTabFrame;         // 12 x 12: frame around window tabs
    QImage comboButton;            // 15 x 76: drop button normal, hot, pressed, disabled
    QImage listHeaders;            // 17 x 105: header normal, pressed, hot, empty, sorted
    QImage statusBar;              // 3 x 88: bar, panel, divider, bar in simple mode
    QImage toolbar;                // 34 x 85: toolbar background
    QImage toolbarButton;          // 23 x 110: see ToolbarButtonFrame
    QImage toolbarDropDownButton;  // 23 x 110: the same with a drop-down part
    QImage toolbarDropDownArrow;   // 11 x 110: the drop-down part alone
    QImage menuItem;               // 23 x 44: highlighted item, open menu bar item
    QImage menuBand;               // 28 x 2: left band of a menu
    QImage menuMarks;              // 16 x 64: tick, bullet, disabled tick, disabled bullet
    QImage menuMarkBox;            // 20 x 60: box behind a mark: normal, hot, disabled
};

// Looks shared by the arrow glyphs and several button pictures, in the order of their frames.
enum GlyphState { kGlyphNormal = 0, kGlyphHot = 1, kGlyphPressed = 2, kGlyphDisabled = 3 };
enum class ArrowDirection { Up = 0, Down = 1, Left = 2, Right = 3 };

// arrows holds four arrows in four states each (cell 4 x direction + state), then the drop-down
// chevron of a combo box in the four states (cells 16 to 19).
constexpr int arrowCell(ArrowDirection direction, int state) {
    return 4 * static_cast<int>(direction) + state;
}
constexpr int chevronCell(int state) {
    return 16 + state;
}

// scrollButtons: the buttons of a lying bar (left, right), then of an upright bar (up, down), in
// four states each (frame 4 x button + state); then the four buttons in their hover look, shown
// while the cursor is over the bar.
constexpr int scrollButtonFrame(int button, int state) {
    return 4 * button + state;
}
constexpr int scrollHoverFrame(int button) {
    return 16 + button;
}

// toolbarButton and its drop-down pictures: 5 frames.
enum ToolbarButtonFrame {
    kToolbarHot = 0,
    kToolbarPressed = 1,
    kToolbarChecked = 2,
    kToolbarCheckedHot = 3,
    kToolbarRaised = 4,
};

struct NamedPicture {
    const char* name;  // as the gallery sheet labels it
    const QImage* image;
    int width;
    int height;
    bool keyed;
};

// Our own skin, drawn at start: a soft blue-grey look with rounded corners and gentle gradients.
SkinPictures makeSkinPictures();

// Every picture with its name, its required size and whether it is keyed.
std::array<NamedPicture, 32> listPictures(const SkinPictures& pictures);

}  // namespace kickvane::skin
