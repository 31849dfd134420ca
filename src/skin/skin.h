#pragma once

#include <memory>
#include <optional>
#include <string_view>

#include "platform/status.h"
#include "skin/paint_nine.h"
#include "skin/pictures.h"
#include "skin/pointer_probe.h"
#include "skin/shape_helper.h"
#include "skin/surface.h"

namespace kickvane::skin {

enum class Orientation { Horizontal, Vertical };

// The four looks most controls have; also the order of their frames and of the arrow glyphs.
enum class ControlLook {
    Normal = kGlyphNormal,
    Hot = kGlyphHot,
    Pressed = kGlyphPressed,
    Disabled = kGlyphDisabled
};

enum class ButtonLook { Normal, Hot, Pressed, Disabled, Default };
enum class CheckState { Unticked, Ticked, Mixed };
enum class OptionState { Clear, Selected };

// A scroll bar's arrow button; Hover is the normal button while the cursor is over its bar.
enum class ScrollButtonLook { Normal, Hover, Hot, Pressed, Disabled };

// Where the point of a track bar's thumb goes: towards the top (left on a vertical bar), towards
// the bottom (right), or neither.
enum class ThumbPoint { TopOrLeft, BottomOrRight, None };
enum class ThumbLook { Normal, Hot, Disabled };

enum class ItemLook { Normal, Hot };
enum class TabLook { Normal, Hot, Selected, SelectedFocused };
enum class HeaderLook { Empty, Normal, Hot, Pressed };

enum class ComboPart {
    Field,       // the white field with its outline
    Selection,   // the highlighted selection
    PushButton,  // the whole box drawn as a push button
};

enum class PropertyGridPart { Panel, FocusFrame, Cell, SelectedCell, CategoryRow };
enum class DatePart { Field, DropButton };

enum class StatusBarPart {
    Bar,             // the bar with its divider at the right end
    SizeGrip,        // dots in the bottom-right corner
    Panel,           // a sunken panel on the bar
    ProgressTrough,  // the trough of a progress part, over the whole box
    ProgressBar,     // its bar, inset in the box; the box's right edge is how far it has come
    SimpleBar,       // the bar of a status bar without panels
};

// Parts of a command bar's menus. Their looks: see paintMenu.
enum class MenuPart {
    BarItem,            // an item of the menu bar
    ItemHighlight,      // the highlight of a popup item
    Band,               // the left band of a popup
    MarkBox,            // the box behind a tick or bullet
    Tick,               // a tick alone
    Bullet,             // a bullet alone
    BoxedTick,          // a tick in its box
    BoxedBullet,        // a bullet in its box
    Button,             // a button inside a menu, such as its chevron
    CheckedBarItem,     // a checked item of the menu bar
    HighlightOverBand,  // a popup item's highlight that covers the left band
    RaisedButton,       // a raised button inside a menu
};
enum class MenuLook { Normal, Hot, Open, Pressed, Checked, Disabled };

enum class ToolbarButtonPart {
    Button,              // a plain button
    ButtonWithDropDown,  // a button with its drop-down part at the right
    DropDown,            // the drop-down part alone
};
enum class ToolbarLook { Flat, Hot, Pressed, Checked, CheckedHot, Raised };

// The flat boxes of menus. Their looks: see paintMenuBox.
enum class MenuBox { Background, Item, Margin, Separator, Highlight, Button, Outline };
enum class MenuBoxLook { Normal, Hot, Pressed };

enum class ColourPopupPart { Background, SelectedCell, Outline };

enum class WindowTabPart {
    Strip,          // the strip the tabs stand on
    ActiveTab,      // the tab in front
    InactiveTab,    // a tab behind it
    PageFrame,      // the frame around the page under the tabs
    HotButton,      // the box of a strip button under the cursor
    PressedButton,  // the box of a pressed strip button
    Divider,        // a line between two inactive tabs, at the box's left edge
};
// The height of the window tabs' strip, and how far the active tab reaches over its neighbours.
inline constexpr int kWindowTabStripHeight = 15;
inline constexpr int kWindowTabOverlap = 5;

// Paints skinned pictures of common controls into a surface the caller passes in. The caller owns
// the window and decides when to paint and in which look; the painters keep no state between
// calls and draw only inside the rectangle they are given.
//
// Most painters suppress errors: a failing step is skipped and the next runs. The painters that
// return a Status (check box, option button, colour popup, window tabs) stop at the first error
// and return it.
class Skin {
public:
    // Our own generated pictures and the Qt cursor.
    Skin();
    explicit Skin(SkinPictures pictures);

    const SkinPictures& pictures() const { return pictures_; }
    void setPointerProbe(std::shared_ptr<const PointerProbe> probe) { probe_ = std::move(probe); }

    // Whether the window under the cursor is exactly `window` (a child window above it counts as
    // another window); nullopt when the cursor cannot be read. Callers use it to choose hot looks.
    std::optional<bool> isUnderCursor(WindowHandle window) const;

    void paintButton(Surface& dc, ButtonLook look, const Rect& box) const;

    // A 13 x 13 box at the top left of `box`.
    Status paintCheckBox(Surface& dc, CheckState state, ControlLook look, const Rect& box) const;
    // A round 13 x 13 button at the top left of `box`; the target shows around it.
    Status paintOptionButton(Surface& dc, OptionState state, ControlLook look,
                             const Rect& box) const;

    // The trough of a progress bar over `box`.
    void paintProgressTrough(Surface& dc, Orientation orientation, const Rect& box) const;
    // The bar of a progress bar, inset by 2 pixels inside `box`.
    void paintProgressBar(Surface& dc, Orientation orientation, const Rect& box) const;

    // A scroll bar's arrow button, its arrow in the middle.
    void paintScrollButton(Surface& dc, ArrowDirection direction, ScrollButtonLook look,
                           const Rect& box) const;
    // The track, stretched only along its length.
    void paintScrollTrack(Surface& dc, Orientation bar, const Rect& box) const;
    void paintScrollThumb(Surface& dc, Orientation bar, ControlLook look, const Rect& box) const;
    // The box where two scroll bars meet; a disabled one draws nothing.
    void paintSizeBox(Surface& dc, ControlLook look, const Rect& box) const;

    // A spin button, its arrow in the middle.
    void paintSpinButton(Surface& dc, ArrowDirection direction, ControlLook look,
                         const Rect& box) const;

    void paintTrackBarChannel(Surface& dc, const Rect& box) const;
    // A horizontal bar carries an upright thumb, a vertical bar a lying one.
    void paintTrackBarThumb(Surface& dc, Orientation bar, ThumbPoint point, ThumbLook look,
                            const Rect& box) const;

    // A list box item with its text from 26 pixels right of the box's left edge.
    void paintListBoxItem(Surface& dc, ItemLook look, const Rect& box, std::string_view text) const;

    // The push button look and the drop button take the box from 2 pixels left of `box` to one
    // pixel above its bottom.
    void paintComboBox(Surface& dc, ComboPart part, const Rect& box) const;
    void paintComboText(Surface& dc, const Rect& box, std::string_view text) const;
    // The drop button with its chevron.
    void paintComboButton(Surface& dc, ControlLook look, const Rect& box) const;

    void paintStatusBar(Surface& dc, StatusBarPart part, const Rect& box) const;

    void paintTabPanel(Surface& dc, const Rect& box) const;
    void paintTabHead(Surface& dc, TabLook look, const Rect& box) const;

    void paintListHeader(Surface& dc, HeaderLook look, const Rect& box) const;
    void paintListOutline(Surface& dc, const Rect& box) const;

    void paintPropertyGrid(Surface& dc, PropertyGridPart part, const Rect& box) const;
    void paintDate(Surface& dc, DatePart part, const Rect& box) const;

    // The looks each part shows (others draw nothing):
    //   BarItem: Hot, Open.  ItemHighlight, HighlightOverBand: Hot, Disabled (a disabled item
    //   under the cursor; the band is drawn for every look).  Band, RaisedButton: any.
    //   MarkBox, BoxedTick, BoxedBullet: Normal, Hot, Disabled.  Tick, Bullet: Normal, Hot (the
    //   same), Disabled.  Button: Hot, Pressed, Checked.  CheckedBarItem: Hot, any other.
    void paintMenu(Surface& dc, MenuPart part, MenuLook look, const Rect& box) const;

    // The toolbar's background over `bar`.
    void paintToolbarBackground(Surface& dc, const Rect& bar) const;
    // A Flat button draws nothing.
    void paintToolbarButton(Surface& dc, ToolbarButtonPart part, ToolbarLook look,
                            const Rect& item) const;
    void paintToolbarComboButton(Surface& dc, ControlLook look, const Rect& item) const;
    void paintToolbarPanel(Surface& dc, const Rect& item) const;

    // Flat boxes over `box`; the separator is a line from its top left to its bottom right.
    //   Background: Normal, Hot.  Item: Normal (outline), Hot (highlighted).  Margin: Normal
    //   (button face), other (white).  Separator, Outline: any.  Highlight: Normal (blue), other
    //   (cream).  Button: Normal, Hot, Pressed.
    void paintMenuBox(Surface& dc, MenuBox part, MenuBoxLook look, const Rect& box) const;

    Status paintColourPopup(Surface& dc, ColourPopupPart part, const Rect& box) const;

    Status paintWindowTab(Surface& dc, WindowTabPart part, const Rect& box) const;

    // The outline of a text box.
    void paintTextBoxOutline(Surface& dc, const Rect& box) const;

private:
    // Frame `index` of `picture` cut into `count` frames, stretched into `box`.
    Status nine(Surface& dc, const QImage& picture, int count, int index, const Margins& margins,
                const Rect& box) const;
    Status nineKeyed(Surface& dc, const QImage& picture, int count, int index,
                     const Margins& margins, const Rect& box) const;
    Status glyph(Surface& dc, int cell, const Rect& box) const;

    SkinPictures pictures_;
    ShapeHelper shapes_;
    std::shared_ptr<const PointerProbe> probe_;
};

// Where a 9 x 9 glyph goes to sit in the middle of `box`: left + (width / 2) - 4, halves rounded
// down, and the same downwards. Empty for a box whose width or height leaves the 32-bit range.
Piece glyphPlace(const Rect& box);

}  // namespace kickvane::skin
