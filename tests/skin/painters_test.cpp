#include <cmath>
#include <limits>

#include <gtest/gtest.h>
#include <QCursor>
#include <QGuiApplication>
#include <QWindow>

#include "recording_surface.h"
#include "skin/image_surface.h"
#include "skin/skin.h"

namespace kickvane::skin {
namespace {

using testing::RecordingSurface;
using Kind = RecordingSurface::Kind;

class FakePointer final : public PointerProbe {
public:
    explicit FakePointer(WindowHandle at, bool readable = true) : at_(at), readable_(readable) {}
    Status WindowAtCursor(WindowHandle& window) const override {
        window = at_;
        return readable_ ? Status::Ok() : Status::Fail("cursor unreadable");
    }

private:
    WindowHandle at_;
    bool readable_;
};

// One skin for all tests: generating the pictures is the slow part.
Skin& TheSkin() {
    static Skin skin;
    return skin;
}

// The frame top of the middle piece of the first PaintNine in `dc`, i.e. frame top + top margin.
int MiddleSourceY(const RecordingSurface& dc, std::size_t copyIndex = 8) {
    const auto copies = dc.Of(Kind::Copy);
    return copies.size() > copyIndex ? copies[copyIndex].from.y : -1;
}

TEST(PaintersTest, ThemeButton_PicksFrameByState_AndFrameZeroForOtherStates) {
    const Skin& skin = TheSkin();
    const std::pair<int, int> stateToTop[] = {{1, 0},   {2, 66}, {3, 132}, {4, 198},
                                              {5, 264}, {9, 0},  {0, 0},   {-3, 0}};
    for (const auto& [state, top] : stateToTop) {
        RecordingSurface dc;
        TheSkin().ThemeButton(0, dc, state, false, false, Rect{0, 0, 75, 23});
        const auto copies = dc.Of(Kind::Copy);
        ASSERT_EQ(copies.size(), 9u) << state;
        EXPECT_EQ(copies[0].source, &skin.Pictures().pButton);
        EXPECT_EQ(copies[0].from.y, top) << "state " << state;
        EXPECT_EQ(copies[3].from.y + copies[3].from.height, top + 66) << "state " << state;
    }
}

TEST(PaintersTest, ThemeCheck_CopiesItsCellUnscaled_OnlyForPlDrawZero) {
    const Skin& skin = TheSkin();
    QImage target(40, 40, QImage::Format_RGB32);
    target.fill(Qt::black);
    ImageSurface dc(target);
    ASSERT_TRUE(TheSkin().ThemeCheck(0, dc, 3, 0, Rect{5, 7, 0, 0}).ok());
    EXPECT_EQ(target.copy(5, 7, 13, 13), skin.Pictures().pCheck.copy(0, 26, 13, 13));

    QImage untouched(40, 40, QImage::Format_RGB32);
    untouched.fill(Qt::black);
    QImage second = untouched;
    ImageSurface dc2(second);
    ASSERT_TRUE(TheSkin().ThemeCheck(0, dc2, 3, 1, Rect{5, 7, 0, 0}).ok());
    EXPECT_EQ(second, untouched);
}

TEST(PaintersTest, ThemeCheckAndThemeOption_ReportStatesWithoutACell) {
    RecordingSurface dc;
    EXPECT_FALSE(TheSkin().ThemeCheck(0, dc, 0, 0, Rect{}).ok());
    EXPECT_FALSE(TheSkin().ThemeCheck(0, dc, 13, 0, Rect{}).ok());
    EXPECT_FALSE(TheSkin().ThemeOption(0, dc, 9, 1, Rect{}).ok());
    EXPECT_TRUE(dc.calls.empty());
    EXPECT_TRUE(TheSkin().ThemeOption(0, dc, 9, 2, Rect{}).ok());  // plDraw 2 draws nothing
}

TEST(PaintersTest, ThemeOption_LeavesTargetVisibleThroughMagenta) {
    const QImage& option = TheSkin().Pictures().pOption;
    QImage target(13, 13, QImage::Format_RGB32);
    target.fill(QColor(0, 200, 0));
    ImageSurface dc(target);
    ASSERT_TRUE(TheSkin().ThemeOption(0, dc, 6, 0, Rect{0, 0, 13, 13}).ok());
    int keyed = 0;
    for (int y = 0; y < 13; ++y) {
        for (int x = 0; x < 13; ++x) {
            const QColor source = option.pixelColor(x, 5 * 13 + y);
            if (source == QColor(255, 0, 255)) {
                ++keyed;
                EXPECT_EQ(target.pixelColor(x, y), QColor(0, 200, 0)) << x << "," << y;
            } else {
                EXPECT_EQ(target.pixelColor(x, y), source) << x << "," << y;
            }
        }
    }
    EXPECT_GT(keyed, 0);
}

TEST(PaintersTest, ThemeScroll_PicksButtonFrameByTable_WithHoverWhileCursorIsOverWindow) {
    Skin skin(MakeSkinPictures());
    constexpr WindowHandle kBar = 42;
    // {vertical, part} -> frames for eState 0, 0 with hover, 1, 2, 3.
    struct Row {
        bool vertical;
        int part;
        int frames[5];
    };
    const Row table[] = {{false, 0, {0, 16, 2, 1, 3}},
                         {false, 1, {4, 17, 6, 5, 7}},
                         {true, 0, {8, 18, 10, 9, 11}},
                         {true, 1, {12, 19, 14, 13, 15}}};
    for (const Row& row : table) {
        const std::pair<int, WindowHandle> looks[] = {
            {0, 7}, {0, kBar}, {1, kBar}, {2, kBar}, {3, kBar}};
        for (int i = 0; i < 5; ++i) {
            skin.SetPointerProbe(std::make_shared<FakePointer>(looks[i].second));
            RecordingSurface dc;
            skin.ThemeScroll(kBar, dc, Rect{0, 0, 17, 17}, row.part, looks[i].first, row.vertical);
            const auto copies = dc.Of(Kind::Copy);
            ASSERT_EQ(copies.size(), 9u);
            EXPECT_EQ(copies[0].from.y, row.frames[i] * 17)
                << "vertical " << row.vertical << " part " << row.part << " look " << i;
        }
    }
    // A cursor that cannot be read shows the plain look.
    skin.SetPointerProbe(std::make_shared<FakePointer>(kBar, false));
    RecordingSurface dc;
    skin.ThemeScroll(kBar, dc, Rect{0, 0, 17, 17}, 1, 0, true);
    EXPECT_EQ(dc.Of(Kind::Copy)[0].from.y, 12 * 17);
}

TEST(PaintersTest, ThemeScroll_CentresTheArrowGlyph_WithTheKey) {
    Skin skin(MakeSkinPictures());
    skin.SetPointerProbe(std::make_shared<FakePointer>(0));
    RecordingSurface dc;
    skin.ThemeScroll(1, dc, Rect{100, 50, 117, 67}, 0, 1, true);
    const auto glyphs = dc.Of(Kind::CopyKeyed);
    ASSERT_EQ(glyphs.size(), 1u);
    EXPECT_EQ(glyphs[0].source, &skin.Pictures().pArrow);
    EXPECT_EQ(glyphs[0].to, (Piece{104, 54, 9, 9}));
    EXPECT_EQ(glyphs[0].from, (Piece{0, ArrowCell(ArrowDirection::Up, kGlyphPressed) * 9, 9, 9}));
    EXPECT_EQ(glyphs[0].colour, kMagentaKey);
}

TEST(PaintersTest, ThemeScroll_StretchesTrackAlongItsLengthOnly) {
    RecordingSurface upright;
    TheSkin().ThemeScroll(0, upright, Rect{0, 0, 17, 200}, 2, 0, true);
    const auto a = upright.Of(Kind::Copy);
    ASSERT_EQ(a.size(), 3u);
    EXPECT_EQ(a[0].from, (Piece{0, 8 * 17, 17, 5}));
    EXPECT_EQ(a[2].to, (Piece{0, 5, 17, 190}));

    RecordingSurface lying;
    TheSkin().ThemeScroll(0, lying, Rect{0, 0, 200, 17}, 3, 1, false);
    const auto b = lying.Of(Kind::Copy);
    ASSERT_EQ(b.size(), 3u);
    EXPECT_EQ(b[0].from, (Piece{0, 3 * 17, 5, 17}));
    EXPECT_EQ(b[2].to, (Piece{5, 0, 190, 17}));
}

TEST(PaintersTest, ThemeSpinButton_PicksPictureAndFrameByButtonAndState) {
    const SkinPictures& p = TheSkin().Pictures();
    struct Case {
        int button;
        int state;
        const QImage* picture;
        int frame;
        int frameHeight;
    };
    for (const Case& c : {Case{0, 0, &p.pSpinHor, 0, 17}, Case{0, 3, &p.pSpinHor, 3, 17},
                          Case{3, 4, &p.pSpinHor, 4, 17}, Case{3, 2, &p.pSpinHor, 6, 17},
                          Case{2, 1, &p.pSpinVer, 1, 10}, Case{1, 0, &p.pSpinVer, 4, 10},
                          Case{1, 3, &p.pSpinVer, 7, 10}}) {
        RecordingSurface dc;
        TheSkin().ThemeSpinButton(dc, c.state, c.button, Rect{0, 0, 17, 17});
        const auto copies = dc.Of(Kind::Copy);
        ASSERT_FALSE(copies.empty());
        EXPECT_EQ(copies[0].source, c.picture) << c.button << "/" << c.state;
        EXPECT_EQ(copies[0].from.y, c.frame * c.frameHeight) << c.button << "/" << c.state;
        EXPECT_EQ(dc.Of(Kind::CopyKeyed).size(), 1u);  // the arrow
    }
}

TEST(PaintersTest, ThemeProgress_DrawsTroughToItsEdgesAndBarInsetByTwo) {
    const SkinPictures& p = TheSkin().Pictures();
    RecordingSurface dc;
    TheSkin().ThemeProgress(0, dc, 0, 200, 18, Rect{0, 0, 100, 18});
    const auto copies = dc.Of(Kind::Copy);
    ASSERT_EQ(copies.size(), 18u);
    EXPECT_EQ(copies[0].source, &p.pProgress);
    EXPECT_EQ(copies[0].to, (Piece{0, 0, 2, 2}));
    EXPECT_EQ(copies[3].to, (Piece{198, 16, 2, 2}));  // trough over 200 x 18
    EXPECT_EQ(copies[9].to, (Piece{2, 2, 2, 6}));     // bar from (2, 2) ...
    EXPECT_EQ(copies[12].to, (Piece{96, 11, 2, 5}));  // ... to (98, 16)
    EXPECT_EQ(copies[9].from.y, 18);

    RecordingSurface none;
    TheSkin().ThemeProgress(0, none, 0, 0, 18, Rect{0, 0, 0, 18});
    EXPECT_TRUE(none.Of(Kind::Copy).empty());

    RecordingSurface upright;
    TheSkin().ThemeProgress(0, upright, 1, 18, 200, Rect{0, 0, 18, 0});
    const auto troughOnly = upright.Of(Kind::Copy);
    ASSERT_EQ(troughOnly.size(), 9u);
    EXPECT_EQ(troughOnly[0].source, &p.pProgressHor);
}

TEST(PaintersTest, ThemeTrackbar_DrawsEveryThumb_WithItsPictureAndFrame) {
    const SkinPictures& p = TheSkin().Pictures();
    struct Case {
        int orientation;
        int ticks;
        const QImage* picture;
    };
    for (const Case& c : {Case{0, 0, &p.pTrackBarVerTop}, Case{0, 1, &p.pTrackBarVerBottom},
                          Case{0, 2, &p.pTrackBarVerBold}, Case{1, 0, &p.pTrackBarHorLeft},
                          Case{1, 1, &p.pTrackBarHorRight}, Case{1, 2, &p.pTrackBarHorBold}}) {
        const bool lyingBar = c.orientation == 0;
        const Rect box = lyingBar ? Rect{0, 0, 11, 21} : Rect{0, 0, 21, 11};
        const int frameHeight = c.picture->height() / 3;
        const std::pair<bool, bool> looks[] = {{true, false}, {true, true}, {false, true}};
        for (int frame = 0; frame < 3; ++frame) {
            RecordingSurface dc;
            TheSkin().ThemeTrackbar(0, dc, looks[frame].first, looks[frame].second, c.ticks, 1,
                                    c.orientation, box);
            const auto copies = dc.Of(Kind::CopyKeyed);
            ASSERT_EQ(copies.size(), 9u) << c.orientation << "/" << c.ticks;
            EXPECT_EQ(copies[0].source, c.picture);
            EXPECT_EQ(copies[0].from.y, frame * frameHeight);
        }
    }
}

TEST(PaintersTest, ThemeCombobox_DrawsButtonShiftedLeftAndUp_WithItsChevron) {
    const SkinPictures& p = TheSkin().Pictures();
    const std::pair<int, int> stateToFrame[] = {{1, 0}, {5, 0}, {2, 1}, {3, 2}, {4, 3}, {7, 0}};
    for (const auto& [state, frame] : stateToFrame) {
        RecordingSurface dc;
        TheSkin().ThemeCombobox(0, dc, state, 1, Rect{100, 10, 117, 31});
        const auto copies = dc.Of(Kind::Copy);
        ASSERT_EQ(copies.size(), 9u);
        EXPECT_EQ(copies[0].source, &p.pCombobox);
        EXPECT_EQ(copies[0].from.y, frame * 19) << state;
        EXPECT_EQ(copies[0].to, (Piece{98, 10, 3, 3}));
        EXPECT_EQ(copies[3].to, (Piece{114, 27, 3, 3}));  // bottom edge at 30
        const auto glyph = dc.Of(Kind::CopyKeyed);
        ASSERT_EQ(glyph.size(), 1u);
        EXPECT_EQ(glyph[0].from.y, ChevronCell(frame) * 9);
    }
}

TEST(PaintersTest, ListviewAndTab_PickFramesByState) {
    const std::pair<int, int> listStates[] = {{0, 3}, {1, 0}, {2, 2}, {3, 1}, {8, 0}};
    for (const auto& [state, frame] : listStates) {
        RecordingSurface dc;
        TheSkin().DrawListview(0, dc, 0, state, Rect{0, 0, 80, 21});
        EXPECT_EQ(MiddleSourceY(dc), frame * 21 + 3) << state;
    }
    const std::pair<int, int> tabStates[] = {{0, 0}, {1, 1}, {2, 2}, {3, 4}, {6, 0}};
    for (const auto& [state, frame] : tabStates) {
        RecordingSurface dc;
        TheSkin().ThemeTab(0, dc, 1, state, Rect{0, 0, 60, 24}, 0);
        EXPECT_EQ(MiddleSourceY(dc), frame * 24 + 6) << state;
    }
    RecordingSurface sideTabs;
    TheSkin().ThemeTab(0, sideTabs, 1, 0, Rect{0, 0, 60, 24}, 1);
    EXPECT_TRUE(sideTabs.calls.empty());
}

TEST(PaintersTest, ListboxAndCombobox_DrawTheWindowsTextInTheirTextArea) {
    Skin skin(MakeSkinPictures());
    skin.SetWindowTextReader([](WindowHandle h) { return h == 5 ? "Bóng" : ""; });
    RecordingSurface list;
    skin.ThemeListbox(5, list, 1, Rect{10, 20, 200, 44});
    const auto listText = list.Of(Kind::Text);
    ASSERT_EQ(listText.size(), 1u);
    EXPECT_EQ(listText[0].text, "Bóng");
    EXPECT_EQ(listText[0].area, (Rect{36, 20, 200, 44}));

    RecordingSurface combo;
    skin.ThemeCombobox(5, combo, 2, 0, Rect{10, 20, 200, 44});
    const auto comboText = combo.Of(Kind::Text);
    ASSERT_EQ(comboText.size(), 1u);
    EXPECT_EQ(comboText[0].area, (Rect{10, 22, 198, 42}));
}

TEST(PaintersTest, FlatBoxes_UseTheColoursOfTheirPartAndState) {
    const Colour face = Rgb(236, 239, 244);
    const Colour shadow = Rgb(160, 172, 190);
    const Colour pale = Rgb(191, 208, 237);
    const Colour edge = Rgb(49, 106, 197);
    const Colour cream = Rgb(247, 246, 238);
    const Colour creamEdge = Rgb(172, 168, 153);
    struct Case {
        int part;
        int state;
        std::vector<Colour> fills;
    };
    for (const Case& c :
         {Case{0, 1, {face}}, Case{0, 2, {}}, Case{1, 0, {shadow}}, Case{1, 1, {pale, edge}},
          Case{2, 0, {face}}, Case{2, 3, {Rgb(255, 255, 255)}}, Case{4, 0, {pale, edge}},
          Case{4, 1, {cream, creamEdge}}, Case{5, 0, {cream, creamEdge}},
          Case{5, 1, {Rgb(160, 187, 228), edge}}, Case{5, 2, {Rgb(227, 235, 247), edge}},
          Case{5, 3, {}}, Case{6, 9, {shadow}}, Case{7, 0, {}}}) {
        RecordingSurface dc;
        TheSkin().ThemeMenus(0, dc, c.part, c.state, 0, 0, 40, 20.0);
        EXPECT_EQ(dc.FillColours(), c.fills) << c.part << "/" << c.state;
    }
    RecordingSurface line;
    TheSkin().ThemeMenus(0, line, 3, 0, 1, 2, 30, 2.4);
    ASSERT_EQ(line.Of(Kind::Line).size(), 1u);
    EXPECT_EQ(line.Of(Kind::Line)[0].area, (Rect{1, 2, 30, 2}));

    for (double bottom : {std::nan(""), 1e12}) {
        RecordingSurface dc;
        TheSkin().ThemeMenus(0, dc, 0, 0, 0, 0, 40, bottom);
        EXPECT_TRUE(dc.calls.empty());
    }

    RecordingSurface scrollBox;
    TheSkin().ThemeScroll(0, scrollBox, Rect{0, 0, 17, 17}, 4, 1, false);
    EXPECT_EQ(scrollBox.FillColours(), (std::vector<Colour>{Rgb(171, 188, 217), edge}));
}

TEST(PaintersTest, ReportingPainters_ReturnFailuresOfTheirSurface) {
    QImage none;
    ImageSurface nowhere(none);
    EXPECT_FALSE(TheSkin().ThemePopupColor(0, nowhere, 1, Rect{0, 0, 10, 10}).ok());
    int measure = 0;
    EXPECT_FALSE(TheSkin().ThemeMDITab(0, nowhere, 2, 0, 0, 80, 20, measure).ok());
    EXPECT_FALSE(TheSkin().ThemeCheck(0, nowhere, 1, 0, Rect{}).ok());
    // Suppressing painters just draw nothing.
    TheSkin().ThemeButton(0, nowhere, 1, false, false, Rect{0, 0, 10, 10});
}

TEST(PaintersTest, ThemeMDITab_RoundsItsCoordinates_AndRejectsOnesThatAreNoPixels) {
    RecordingSurface dc;
    int measure = 0;
    ASSERT_TRUE(TheSkin().ThemeMDITab(0, dc, 10, 1.5f, 2.5f, 20.4f, 18.6f, measure).ok());
    EXPECT_EQ(dc.Of(Kind::Fill)[0].area, (Rect{2, 2, 20, 19}));

    const float inf = std::numeric_limits<float>::infinity();
    EXPECT_FALSE(TheSkin().ThemeMDITab(0, dc, 10, 0, 0, inf, 10, measure).ok());
    EXPECT_FALSE(TheSkin().ThemeMDITab(0, dc, 10, 0, 0, 3e9f, 10, measure).ok());

    EXPECT_TRUE(TheSkin().ThemeMDITab(0, dc, 7, 0, 0, 0, 0, measure).ok());
    EXPECT_EQ(measure, 15);
    EXPECT_TRUE(TheSkin().ThemeMDITab(0, dc, 8, 0, 0, 0, 0, measure).ok());
    EXPECT_EQ(measure, 5);
}

TEST(PaintersTest, EveryPainter_StaysInsideThePicture_WithRectanglesAtTheCoordinateLimits) {
    const int lo = std::numeric_limits<int>::min();
    const int hi = std::numeric_limits<int>::max();
    Skin& skin = TheSkin();
    skin.SetPointerProbe(std::make_shared<FakePointer>(1));
    for (const Rect& box : {Rect{lo, lo, hi, hi}, Rect{hi, hi, lo, lo}, Rect{hi - 1, 0, hi, 5},
                            Rect{lo, lo, lo + 1, lo + 1}}) {
        QImage target(16, 16, QImage::Format_RGB32);
        target.fill(Qt::white);
        ImageSurface dc(target);
        int measure = 0;
        for (int part = 0; part <= 15; ++part) {
            for (int state = -1; state <= 5; ++state) {
                skin.ThemeCommandBarMenu(1, dc, part, state, box);
                skin.ThemePropertyGrid(1, dc, state, part, box);
                skin.ThemeDate(1, dc, state, part, box);
                skin.ThemeSpinButton(dc, state, part, box);
                skin.DrawTextbox(1, dc, state, box.left, box.top, box.right, box.bottom);
                skin.ThemeTrackbar(1, dc, state > 0, state > 1, state, part % 2, part / 8, box);
                skin.ThemeScroll(1, dc, box, part, state, state % 2 == 0);
                skin.ThemeListbox(1, dc, part, box);
                skin.ThemeStatusBar(1, dc, part, box);
                skin.ThemeTab(1, dc, part, state, box, 0);
                skin.DrawListview(1, dc, part, state, box);
                skin.ThemeCombobox(1, dc, state, part, box);
                skin.ThemeButton(1, dc, state, false, false, box);
                skin.ThemeProgress(1, dc, part, box.right, box.bottom, box);
                (void)skin.ThemeCheck(1, dc, state, part, box);
                (void)skin.ThemeOption(1, dc, state, part, box);
                skin.ThemeUniToolbar(1, dc, part, 0, box.left, box.top, box.right, box.bottom,
                                     state, box.right, box.bottom);
                skin.ThemeMenus(1, dc, part, state, box.left, box.top, box.right, box.bottom);
                (void)skin.ThemePopupColor(1, dc, part, box);
                (void)skin.ThemeMDITab(1, dc, part, static_cast<float>(box.left),
                                       static_cast<float>(box.top), static_cast<float>(box.right),
                                       static_cast<float>(box.bottom), measure);
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
    Skin skin(MakeSkinPictures());
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
