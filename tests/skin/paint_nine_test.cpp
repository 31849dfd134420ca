#include "skin/paint_nine.h"

#include <climits>

#include <gtest/gtest.h>

#include "recording_surface.h"
#include "skin/pictures.h"

namespace kickvane::skin {
namespace {

using testing::RecordingSurface;
using Kind = RecordingSurface::Kind;

TEST(PaintNineTest, PaintNine_SmoothsAndCopiesNinePieces_CornersUnscaledSidesStretched) {
    const QImage button(43, 330, QImage::Format_RGB32);
    RecordingSurface dc;  // frame 2 of 5, each 66 high
    ASSERT_TRUE(
        paintNine(dc, button, Margins{3, 3, 3, 3}, Rect{10, 10, 110, 40}, frameOf(button, 5, 2))
            .ok());

    ASSERT_EQ(dc.calls.size(), 10u);
    EXPECT_EQ(dc.calls[0].mode, StretchMode::Halftone);
    const auto copies = dc.of(Kind::Copy);
    ASSERT_EQ(copies.size(), 9u);
    EXPECT_EQ(copies[0].source, &button);
    EXPECT_EQ(copies[0].to, (Piece{10, 10, 3, 3}));  // top-left corner
    EXPECT_EQ(copies[0].from, (Piece{0, 132, 3, 3}));
    EXPECT_EQ(copies[3].to, (Piece{107, 37, 3, 3}));  // bottom-right corner
    EXPECT_EQ(copies[3].from, (Piece{40, 195, 3, 3}));
    EXPECT_EQ(copies[5].to, (Piece{10, 13, 3, 24}));  // left side
    EXPECT_EQ(copies[5].from, (Piece{0, 135, 3, 60}));
    EXPECT_EQ(copies[8].to, (Piece{13, 13, 94, 24}));  // middle
    EXPECT_EQ(copies[8].from, (Piece{3, 135, 37, 60}));
}

TEST(PaintNineTest, PaintNine_DrawsNothing_WhenTargetNarrowerOrLowerThanMargins) {
    const QImage picture(43, 330, QImage::Format_RGB32);
    const Frame frame = frameOf(picture, 5, 0);
    for (const Rect& target : {Rect{0, 0, 5, 40}, Rect{0, 0, 40, 5}, Rect{50, 0, 10, 40}}) {
        RecordingSurface dc;
        EXPECT_TRUE(paintNine(dc, picture, Margins{3, 3, 3, 3}, target, frame).ok());
        EXPECT_TRUE(dc.of(Kind::Copy).empty());
    }
    // Exactly as wide as the margins: the corners and nothing between them.
    RecordingSurface dc;
    EXPECT_TRUE(paintNine(dc, picture, Margins{3, 3, 3, 3}, Rect{0, 0, 6, 6}, frame).ok());
    EXPECT_EQ(dc.of(Kind::Copy).size(), 4u);
}

TEST(PaintNineTest, PaintNine_FailsWithoutDrawing_OnMarginsFrameOrPiecesThatDoNotFit) {
    const QImage picture(21, 33, QImage::Format_RGB32);
    const Margins m3{3, 3, 3, 3};
    const Rect target{0, 0, 100, 100};
    struct Case {
        Margins margins;
        Frame frame;
        Rect target;
    };
    for (const Case& c : {
             Case{Margins{3, 6, 3, 10}, Frame{21, 11, 0}, target},  // margins higher than frame
             Case{Margins{-1, 3, 3, 3}, Frame{21, 11, 0}, target},
             Case{m3, Frame{21, 11, 23}, target},  // frame past the picture's end
             Case{m3, Frame{21, 11, -11}, target},
             Case{m3, Frame{30, 11, 0}, target},                         // wider than the picture
             Case{m3, Frame{21, 11, 0}, Rect{INT_MIN, 0, INT_MAX, 40}},  // out of coordinates
         }) {
        RecordingSurface dc;
        EXPECT_FALSE(paintNine(dc, picture, c.margins, c.target, c.frame).ok());
        EXPECT_TRUE(dc.calls.empty());
    }
}

}  // namespace
}  // namespace kickvane::skin
