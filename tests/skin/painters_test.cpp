#include <cmath>
#include <functional>
#include <limits>
#include <set>

#include <gtest/gtest.h>
#include <QCursor>
#include <QGuiApplication>
#include <QWindow>

#include "filled_image.h"
#include "recording_surface.h"
#include "skin/image_surface.h"
#include "skin/skin.h"

namespace kickvane::skin {
namespace {

using testing::Filled;
using testing::RecordingSurface;
using Kind = RecordingSurface::Kind;

class FakePointer final : public PointerProbe {
public:
    explicit FakePointer(WindowHandle at, bool readable = true) : at_(at), readable_(readable) {}
    Status windowAtCursor(WindowHandle& window) const override {
        window = at_;
        return readable_ ? Status::Ok() : Status::Fail("cursor unreadable");
    }

private:
    WindowHandle at_;
    bool readable_;
};

// One skin for all tests: generating the pictures is the slow part.
Skin& theSkin() {
    static Skin skin;
    return skin;
}

using Paint = std::function<void(Surface&, int state)>;

TEST(PaintersTest, FramedPainters_PickTheirFrameByState_AndAFallbackForOtherStates) {
    Skin& k = theSkin();
    const SkinPictures& p = k.pictures();
    const Rect box{0, 0, 80, 24};
    const Paint button = [&](Surface& dc, int s) { k.ThemeButton(0, dc, s, false, false, box); };
    const Paint header = [&](Surface& dc, int s) { k.DrawListview(0, dc, 0, s, box); };
    const Paint tab = [&](Surface& dc, int s) { k.ThemeTab(0, dc, 1, s, box, 0); };
    const Paint combo = [&](Surface& dc, int s) { k.ThemeCombobox(0, dc, s, 1, box); };
    const Paint spinRight = [&](Surface& dc, int s) { k.ThemeSpinButton(dc, s, 3, box); };
    const Paint spinUp = [&](Surface& dc, int s) { k.ThemeSpinButton(dc, s, 2, box); };
    // Trackbar thumbs by ticks and orientation; looks 0 normal, 1 hot, 2 disabled while hot.
    const auto thumb = [&](int ticks, int orientation) -> Paint {
        return [&k, ticks, orientation](Surface& dc, int look) {
            k.ThemeTrackbar(0, dc, look != 2, look >= 1, ticks, 1, orientation, Rect{0, 0, 21, 21});
        };
    };
    struct Case {
        Paint paint;
        const QImage* picture;
        int normal;                  // the state that other states fall back to
        std::vector<int> ownFrames;  // states with a frame of their own
        std::vector<int> fallbacks;  // states without one
    };
    // Spin buttons: state 4 looks like state 0. Thumbs: looks 0 normal, 1 hot, 2 disabled.
    const Case cases[] = {{button, &p.button, 1, {5}, {0, 6}},
                          {header, &p.listHeaders, 1, {0}, {8}},
                          {tab, &p.tabHeads, 0, {1, 3}, {6}},
                          {combo, &p.comboButton, 1, {4}, {7}},
                          {spinRight, &p.spinLeftRight, 0, {2}, {4}},
                          {spinUp, &p.spinUpDown, 0, {3}, {4}},
                          {thumb(1, 0), &p.trackThumbDown, 0, {1, 2}, {}},
                          {thumb(0, 1), &p.trackThumbLeft, 0, {}, {}},
                          {thumb(2, 1), &p.trackThumbLying, 0, {2}, {}}};
    // The top of the frame that state `state` copies from, checking the copy on the way.
    const auto frameTop = [](const Case& c, int state) {
        RecordingSurface dc;
        c.paint(dc, state);
        auto copies = dc.of(Kind::Copy);
        if (copies.empty()) {
            copies = dc.of(Kind::CopyKeyed);  // keyed thumbs
        }
        EXPECT_EQ(copies.size(), 9u) << "state " << state;
        EXPECT_TRUE(!copies.empty() && copies[0].source == c.picture) << "state " << state;
        const int top = copies.empty() ? -1 : copies[0].from.y;
        EXPECT_TRUE(top >= 0 && top < c.picture->height()) << "state " << state;
        return top;
    };
    for (const Case& c : cases) {
        const int normal = frameTop(c, c.normal);
        std::set<int> tops{normal};
        for (int state : c.ownFrames) {
            EXPECT_TRUE(tops.insert(frameTop(c, state)).second) << "state " << state;
        }
        for (int state : c.fallbacks) {
            EXPECT_EQ(frameTop(c, state), normal) << "state " << state;
        }
    }
    RecordingSurface none;
    k.ThemeTab(0, none, 1, 0, box, 1);  // side tabs
    thumb(3, 1)(none, 0);
    EXPECT_TRUE(none.calls.empty());
}

TEST(PaintersTest, CheckAndOption_CopyTheirCellForPlDrawZero_AndFailForStatesWithoutACell) {
    QImage target = filled(40, 40, Qt::black);
    ImageSurface image(target);
    ASSERT_TRUE(theSkin().ThemeCheck(0, image, 3, 1, Rect{5, 7, 0, 0}).ok());
    EXPECT_EQ(target, filled(40, 40, Qt::black));
    ASSERT_TRUE(theSkin().ThemeCheck(0, image, 3, 0, Rect{5, 7, 0, 0}).ok());
    EXPECT_EQ(target.copy(5, 7, 13, 13), theSkin().pictures().checkBox.copy(0, 26, 13, 13));

    RecordingSurface dc;
    EXPECT_FALSE(theSkin().ThemeCheck(0, dc, 0, 0, Rect{}).ok());
    EXPECT_FALSE(theSkin().ThemeCheck(0, dc, 13, 0, Rect{}).ok());
    EXPECT_FALSE(theSkin().ThemeOption(0, dc, 9, 1, Rect{}).ok());
    EXPECT_TRUE(theSkin().ThemeOption(0, dc, 9, 2, Rect{}).ok());  // plDraw 2 draws nothing
    EXPECT_TRUE(dc.calls.empty());

    // An option button is round: its cell is copied with the key, the target shows around it.
    ASSERT_TRUE(theSkin().ThemeOption(0, dc, 6, 0, Rect{0, 0, 13, 13}).ok());
    const auto option = dc.of(Kind::CopyKeyed);
    ASSERT_EQ(option.size(), 1u);
    EXPECT_EQ(option[0].source, &theSkin().pictures().optionButton);
    EXPECT_EQ(option[0].from, (Piece{0, 5 * 13, 13, 13}));
}

TEST(PaintersTest, ThemeScroll_PicksButtonFrameByState_HoverOnlyWhileCursorIsOverTheBar) {
    Skin skin(makeSkinPictures());
    constexpr WindowHandle kBar = 42;
    const auto frame = [&](bool vertical, int part, int state, WindowHandle atCursor,
                           bool readable = true) {
        skin.setPointerProbe(std::make_shared<FakePointer>(atCursor, readable));
        RecordingSurface dc;
        skin.ThemeScroll(kBar, dc, Rect{0, 0, 17, 17}, part, state, vertical);
        const auto copies = dc.of(Kind::Copy);
        return copies.size() == 9u ? copies[0].from.y / 17 : -1;
    };
    // The down button of an upright bar: plain, hover, pressed, hot.
    EXPECT_EQ(frame(true, 1, 0, 7), 12);
    EXPECT_EQ(frame(true, 1, 0, kBar), 19);
    EXPECT_EQ(frame(true, 1, 1, kBar), 14);
    EXPECT_EQ(frame(true, 1, 2, kBar), 13);
    // The left button, and the right one disabled.
    EXPECT_EQ(frame(false, 0, 0, 7), 0);
    EXPECT_EQ(frame(false, 1, 3, 7), 7);
    // A cursor that cannot be read shows the plain look.
    EXPECT_EQ(frame(true, 1, 0, kBar, false), 12);
}

TEST(PaintersTest, ListboxAndCombobox_DrawTheWindowsText) {
    Skin skin(makeSkinPictures());
    skin.setWindowTextReader([](WindowHandle h) { return h == 5 ? "Bóng" : ""; });
    RecordingSurface list;
    skin.ThemeListbox(5, list, 1, Rect{10, 20, 200, 44});
    RecordingSurface combo;
    skin.ThemeCombobox(5, combo, 2, 0, Rect{10, 20, 200, 44});
    for (const RecordingSurface* dc : {&list, &combo}) {
        ASSERT_EQ(dc->of(Kind::Text).size(), 1u);
        EXPECT_EQ(dc->of(Kind::Text)[0].text, "Bóng");
    }
}

// Menu boxes draw by part and state; a bottom that is no pixel draws nothing.
TEST(PaintersTest, FlatBoxes_DrawByPartAndState_AndSkipBottomsThatAreNoPixels) {
    const auto fills = [](int part, int state, double bottom) {
        RecordingSurface dc;
        theSkin().ThemeMenus(0, dc, part, state, 0, 0, 40, bottom);
        return dc.fillColours().size();
    };
    EXPECT_EQ(fills(0, 1, 20.0), 1u);  // a plain box
    EXPECT_EQ(fills(1, 1, 20.0), 2u);  // a framed one
    EXPECT_EQ(fills(0, 2, 20.0), 0u);
    EXPECT_EQ(fills(0, 1, std::nan("")), 0u);
    EXPECT_EQ(fills(0, 1, 1e12), 0u);
}

TEST(PaintersTest, ReportingPainters_ReturnFailuresOfTheirSurface) {
    QImage none;
    ImageSurface nowhere(none);
    EXPECT_FALSE(theSkin().ThemePopupColor(0, nowhere, 1, Rect{0, 0, 10, 10}).ok());
    int measure = 0;
    EXPECT_FALSE(theSkin().ThemeMDITab(0, nowhere, 2, 0, 0, 80, 20, measure).ok());
    EXPECT_FALSE(theSkin().ThemeCheck(0, nowhere, 1, 0, Rect{}).ok());
    // Suppressing painters just draw nothing.
    theSkin().ThemeButton(0, nowhere, 1, false, false, Rect{0, 0, 10, 10});
}

TEST(PaintersTest, ThemeMDITab_RoundsItsCoordinates_AndRejectsOnesThatAreNoPixels) {
    RecordingSurface dc;
    int measure = 0;
    ASSERT_TRUE(theSkin().ThemeMDITab(0, dc, 10, 1.5f, 2.5f, 20.4f, 18.6f, measure).ok());
    EXPECT_EQ(dc.of(Kind::Fill)[0].area, (Rect{2, 2, 20, 19}));

    const float inf = std::numeric_limits<float>::infinity();
    EXPECT_FALSE(theSkin().ThemeMDITab(0, dc, 10, 0, 0, inf, 10, measure).ok());
    EXPECT_FALSE(theSkin().ThemeMDITab(0, dc, 10, 0, 0, 3e9f, 10, measure).ok());
}

TEST(PaintersTest, EveryPainter_StaysInsideThePicture_WithRectanglesAtTheCoordinateLimits) {
    const int lo = std::numeric_limits<int>::min();
    const int hi = std::numeric_limits<int>::max();
    Skin& skin = theSkin();
    skin.setPointerProbe(std::make_shared<FakePointer>(1));
    for (const Rect& box : {Rect{lo, lo, hi, hi}, Rect{hi, hi, lo, lo}, Rect{hi - 1, 0, hi, 5},
                            Rect{lo, lo, lo + 1, lo + 1}}) {
        QImage target = filled(16, 16, Qt::white);
        ImageSurface dc(target);
        const auto [l, t, r, b] = box;
        int measure = 0;
        for (int part = 0; part <= 15; ++part) {
            for (int state = -1; state <= 5; ++state) {
                skin.ThemeCommandBarMenu(1, dc, part, state, box);
                skin.ThemePropertyGrid(1, dc, state, part, box);
                skin.ThemeDate(1, dc, state, part, box);
                skin.ThemeSpinButton(dc, state, part, box);
                skin.DrawTextbox(1, dc, state, l, t, r, b);
                skin.ThemeTrackbar(1, dc, state > 0, state > 1, state, part % 2, part / 8, box);
                skin.ThemeScroll(1, dc, box, part, state, state % 2 == 0);
                skin.ThemeListbox(1, dc, part, box);
                skin.ThemeStatusBar(1, dc, part, box);
                skin.ThemeTab(1, dc, part, state, box, 0);
                skin.DrawListview(1, dc, part, state, box);
                skin.ThemeCombobox(1, dc, state, part, box);
                skin.ThemeButton(1, dc, state, false, false, box);
                skin.ThemeProgress(1, dc, part, r, b, box);
                (void)skin.ThemeCheck(1, dc, state, part, box);
                (void)skin.ThemeOption(1, dc, state, part, box);
                skin.ThemeUniToolbar(1, dc, part, 0, l, t, r, b, state, r, b);
                skin.ThemeMenus(1, dc, part, state, l, t, r, b);
                (void)skin.ThemePopupColor(1, dc, part, box);
                (void)skin.ThemeMDITab(1, dc, part, static_cast<float>(l), static_cast<float>(t),
                                       static_cast<float>(r), static_cast<float>(b), measure);
            }
        }
        EXPECT_EQ(target.size(), QSize(16, 16));
    }
}

TEST(PaintersTest, MDMouseOver_IsFalseOverAChildWindow_AndTrueOverTheChild) {
    QWindow parent;
    parent.setGeometry(100, 100, 200, 200);
    QWindow child(&parent);
    child.setGeometry(10, 10, 50, 50);
    parent.show();
    child.show();
    QCursor::setPos(130, 130);
    if (QCursor::pos() != QPoint(130, 130) ||
        QGuiApplication::topLevelAt(QCursor::pos()) == nullptr) {
        GTEST_SKIP() << "this platform does not place the cursor";
    }
    Skin skin(makeSkinPictures());
    bool over = true;
    ASSERT_TRUE(skin.MDMouseOver(static_cast<WindowHandle>(parent.winId()), over).ok());
    EXPECT_FALSE(over);
    ASSERT_TRUE(skin.MDMouseOver(static_cast<WindowHandle>(child.winId()), over).ok());
    EXPECT_TRUE(over);

    QCursor::setPos(250, 250);
    ASSERT_TRUE(skin.MDMouseOver(static_cast<WindowHandle>(parent.winId()), over).ok());
    EXPECT_TRUE(over);
}

}  // namespace
}  // namespace kickvane::skin
