#pragma once

#include <functional>
#include <memory>
#include <string>

#include "platform/status.h"
#include "skin/paint_nine.h"
#include "skin/pictures.h"
#include "skin/pointer_probe.h"
#include "skin/shape_helper.h"
#include "skin/surface.h"

namespace kickvane::skin {

// Reads the text of a window as UTF-8 (the message helper's ReadWindowText); empty when unknown.
using WindowTextReader = std::function<std::string(WindowHandle)>;

// Paints skinned pictures of common controls into a surface the caller passes in. The caller owns
// the window and decides when to paint and in which state; the painters keep no state between
// calls and draw only inside the rectangle they are given.
//
// Selectors (plDraw, State, ePart, ...) are the small integers the control's owner-draw code
// passes. Values a painter does not know draw nothing. Most painters suppress errors: a failing
// step is skipped and the next runs. ThemeCheck, ThemeOption, ThemePopupColor and ThemeMDITab
// instead stop at the first error and return it.
class Skin {
public:
    // Our own generated pictures, the Qt cursor and no window text.
    Skin();
    explicit Skin(SkinPictures pictures);

    const SkinPictures& Pictures() const { return pictures_; }
    void SetPointerProbe(std::shared_ptr<const PointerProbe> probe) { probe_ = std::move(probe); }
    void SetWindowTextReader(WindowTextReader reader) { readText_ = std::move(reader); }

    // Menus of a command bar (the menu bar and its popups), by plDraw:
    //   0 menu bar item: State 1 hot, 2 open
    //   1 popup item highlight: State 1 enabled item, 2 disabled item
    //   2 left band of a popup
    //   3 box behind a mark: State 0 normal, 1 hot, 2 disabled
    //   4 tick, 5 bullet: State 0 or 1 normal, 2 disabled
    //   6 tick in its box, 7 bullet in its box: State as for 3
    //   8 a button inside a menu (its chevron): State 0 hot, 1 pressed, 2 checked
    //   9 a checked menu bar item: State 1 hot
    //   10 popup item highlight over the left band: State as for 1
    //   11 a raised button inside a menu
    void ThemeCommandBarMenu(WindowHandle hwnd, Surface& dc, int plDraw, int state,
                             const Rect& box);

    // A property grid: plDraw 1 with State 0 the panel; plDraw 0 a cell (State 0 normal, 1
    // selected, other a category row); plDraw 1 with State 1 the focus frame.
    void ThemePropertyGrid(WindowHandle hwnd, Surface& dc, int state, int plDraw, const Rect& box);

    // A date field: plDraw 1 with State 0 the field, plDraw 2 with State 0 its drop button.
    void ThemeDate(WindowHandle hwnd, Surface& dc, int state, int plDraw, const Rect& box);

    // sButton: 2 up, 1 down, 0 left, 3 right. State: 0 or 4 normal, 1 hot, 2 pressed,
    // 3 disabled. The arrow sits in the middle of the button.
    void ThemeSpinButton(Surface& dc, int state, int sButton, const Rect& box);

    // The outline of a text box for bState 0 or 1. Width and Height are the right and bottom edges,
    // as the outline takes them.
    void DrawTextbox(WindowHandle hwnd, Surface& dc, int bState, int x, int y, int width,
                     int height);

    // A track bar: plDraw 0 the channel, plDraw 1 the thumb. Ticks 0 points the thumb up (left
    // when upright), 1 down (right), 2 neither. cOrientation 0 is a lying bar with an upright
    // thumb; any other value an upright bar with a lying thumb. Frame: disabled, else hot, else
    // normal.
    void ThemeTrackbar(WindowHandle hwnd, Surface& dc, bool bEnable, bool hot, int ticks,
                       int plDraw, int cOrientation, const Rect& box);

    // A scroll bar part. ePart: 0 and 1 the arrow buttons (up/down or left/right), 2 and 3 the
    // track, 4 the size box, 5 the thumb. eState: 0 normal, 1 pressed, 2 hot, 3 disabled. A
    // normal button shows the hover look while the cursor is over lhWnd.
    void ThemeScroll(WindowHandle lhWnd, Surface& dc, const Rect& box, int ePart, int eState,
                     bool sVertical);

    // A list box item: plDraw 1 normal, 2 hot; the window's text follows from left + 26.
    void ThemeListbox(WindowHandle hwnd, Surface& dc, int plDraw, const Rect& box);

    // A status bar: 0 the bar, 1 the size grip, 2 a panel, 3 the trough and 4 the bar of a progress
    // part, 5 the bar in simple mode.
    void ThemeStatusBar(WindowHandle handle, Surface& dc, int plDraw, const Rect& box);

    // Tabs, when sPosition is 0 (tabs on top): plDraw 0 the panel, plDraw 1 a head with State
    // 0 normal, 1 hot, 2 selected, 3 selected with focus.
    void ThemeTab(WindowHandle handle, Surface& dc, int plDraw, int state, const Rect& box,
                  int sPosition);

    // A list view header: plDraw 0 by State (0 the empty header, 1 normal, 2 hot, 3 pressed),
    // plDraw 1 a normal header, plDraw 2 the outline of the list.
    void DrawListview(WindowHandle lhWnd, Surface& dc, int plDraw, int state, const Rect& box);

    // A combo box. plDraw 0: State 0 the field, 1 the selection, 2 the window's text. plDraw 1:
    // the drop button with State 1 or 5 normal, 2 hot, 3 pressed, 4 disabled. plDraw 2 with
    // State 0: a push-button look.
    void ThemeCombobox(WindowHandle hwnd, Surface& dc, int state, int plDraw, const Rect& box);

    // A push button: State 1 normal, 2 hot, 3 pressed, 4 disabled, 5 default; other values normal.
    void ThemeButton(WindowHandle hwnd, Surface& dc, int state, bool bFocus, bool bHotMove,
                     const Rect& box);

    // A progress bar: the trough from (box.left, box.top) to (pgWidth, pgHeight), when that
    // edge is positive, and the bar inset by 2 inside box. plDraw 0 lying, other upright.
    void ThemeProgress(WindowHandle handle, Surface& dc, int plDraw, int pgWidth, int pgHeight,
                       const Rect& box);

    // A check box of 13 x 13 at the box's top left, when plDraw is 0. State 1 to 4 unticked,
    // 5 to 8 ticked, 9 to 12 mixed; each normal, hot, pressed, disabled. Fails on other states.
    Status ThemeCheck(WindowHandle hwnd, Surface& dc, int state, int plDraw, const Rect& box);

    // An option button of 13 x 13 at the box's top left, when plDraw is 0 or 1. State 1 to 4
    // unset, 5 to 8 set. Fails on other states.
    Status ThemeOption(WindowHandle hwnd, Surface& dc, int state, int plDraw, const Rect& box);

    // A toolbar. The toolbar's own area is (0, 0, tbWidth, tbHeight); an item's area is
    // (ItemLeft, ItemTop + 2, ItemWidth, ItemHeight), the last two being right and bottom edges.
    //   0 background   1 button   2 button with drop-down   3 drop-down part alone
    //   4 combo drop button   5 panel
    // tbStatus for buttons: 0 flat (nothing), 1 hot, 2 pressed, 3 checked, 4 checked and hot,
    // 5 raised; for the combo button as ThemeCombobox's drop button.
    void ThemeUniToolbar(WindowHandle hwnd, Surface& dc, int plDraw, int itemIndex, int itemLeft,
                         int itemTop, int itemWidth, int itemHeight, int tbStatus, int tbWidth,
                         int tbHeight);

    // Sets `over` to whether the window under the cursor is exactly `handleWindow` (a child
    // window above it counts as another window). Fails when the cursor cannot be read.
    Status MDMouseOver(WindowHandle handleWindow, bool& over) const;

    // Flat boxes of menus; mnBottom arrives as a floating value and is rounded.
    void ThemeMenus(WindowHandle hwnd, Surface& dc, int plDraw, int state, int mnLeft, int mnTop,
                    int mnRight, double mnBottom);

    // Flat boxes of a colour popup: 0 background, 1 or 2 selected cell, 3 outline.
    Status ThemePopupColor(WindowHandle hwnd, Surface& dc, int plDraw, const Rect& box);

    // Window tabs. Coordinates are rounded to whole pixels.
    //   1 tab strip   2 active tab   5 inactive tab   6 frame around the page
    //   7 sets lReturn to 15 (tab strip height)   8 sets lReturn to 5 (tab overlap)
    //   10 hot button box   11 pressed button box   12 divider between inactive tabs
    Status ThemeMDITab(WindowHandle lhWnd, Surface& dc, int plDraw, float x, float y, float x1,
                       float y1, int& lReturn);

private:
    // Frame `index` of `picture` cut into `count` frames, stretched into `box`.
    Status Nine(Surface& dc, const QImage& picture, int count, int index, const Margins& margins,
                const Rect& box) const;
    Status NineKeyed(Surface& dc, const QImage& picture, int count, int index,
                     const Margins& margins, const Rect& box) const;
    Status Glyph(Surface& dc, int cell, const Rect& box) const;
    bool IsHot(WindowHandle window) const;
    std::string WindowText(WindowHandle window) const;

    SkinPictures pictures_;
    ShapeHelper shapes_;
    std::shared_ptr<const PointerProbe> probe_;
    WindowTextReader readText_;
};

// Where a 9 x 9 glyph goes to sit in the middle of `box`: left + (width / 2) - 4, halves rounded
// down, and the same downwards.
Piece GlyphPlace(const Rect& box);

}  // namespace kickvane::skin
