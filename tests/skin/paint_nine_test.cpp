#include "skin/paint_nine.h"

#include <climits>

#include <gtest/gtest.h>

#include "recording_surface.h"
#include "skin/image_surface.h"
#include "skin/pictures.h"

namespace kickvane::skin {
namespace {

using testing::RecordingSurface;
using Kind = RecordingSurface::Kind;

TEST(PaintNineTest, PaintNine_CopiesNinePiecesInOrder_CornersUnscaled) {
    const QImage button(43, 330, QImage::Format_RGB32);
    RecordingSurface dc;
    const Frame frame = FrameOf(button, 5, 2);
    ASSERT_EQ(frame.top, 132);
    ASSERT_EQ(frame.height, 66);

    ASSERT_TRUE(PaintNine(dc, button, Margins{3, 3, 3, 3}, Rect{10, 10, 110, 40}, frame).ok());

    ASSERT_EQ(dc.calls.size(), 10u);
    EXPECT_EQ(dc.calls[0].kind, Kind::Mode);
    EXPECT_EQ(dc.calls[0].mode, StretchMode::Halftone);
    const std::pair<Piece, Piece> expected[] = {
        {{10, 10, 3, 3}, {0, 132, 3, 3}},      // top-left
        {{107, 10, 3, 3}, {40, 132, 3, 3}},    // top-right
        {{10, 37, 3, 3}, {0, 195, 3, 3}},      // bottom-left
        {{107, 37, 3, 3}, {40, 195, 3, 3}},    // bottom-right
        {{13, 10, 94, 3}, {3, 132, 37, 3}},    // top
        {{10, 13, 3, 24}, {0, 135, 3, 60}},    // left
        {{107, 13, 3, 24}, {40, 135, 3, 60}},  // right
        {{13, 37, 94, 3}, {3, 195, 37, 3}},    // bottom
        {{13, 13, 94, 24}, {3, 135, 37, 60}},  // middle
    };
    for (std::size_t i = 0; i < 9; ++i) {
        const auto& call = dc.calls[i + 1];
        EXPECT_EQ(call.kind, Kind::Copy) << i;
        EXPECT_EQ(call.source, &button) << i;
        EXPECT_EQ(call.to, expected[i].first) << "piece " << i;
        EXPECT_EQ(call.from, expected[i].second) << "piece " << i;
    }
}

TEST(PaintNineTest, PaintNine_StretchesOnlyAlongWidth_WhenSideMarginsAreZero) {
    const QImage picture(17, 340, QImage::Format_RGB32);
    RecordingSurface dc;
    ASSERT_TRUE(
        PaintNine(dc, picture, Margins{0, 5, 0, 5}, Rect{0, 0, 200, 17}, FrameOf(picture, 20, 3))
            .ok());
    const auto copies = dc.Of(Kind::Copy);
    ASSERT_EQ(copies.size(), 3u);  // top, bottom, middle; corners and sides are empty
    EXPECT_EQ(copies[0].to, (Piece{0, 0, 200, 5}));
    EXPECT_EQ(copies[0].from, (Piece{0, 51, 17, 5}));
    EXPECT_EQ(copies[1].to, (Piece{0, 12, 200, 5}));
    EXPECT_EQ(copies[2].to, (Piece{0, 5, 200, 7}));
    EXPECT_EQ(copies[2].from, (Piece{0, 56, 17, 7}));
}

TEST(PaintNineTest, PaintNine_DrawsNothing_WhenTargetNarrowerOrLowerThanMargins) {
    const QImage picture(43, 330, QImage::Format_RGB32);
    const Frame frame = FrameOf(picture, 5, 0);
    for (const Rect& target : {Rect{0, 0, 5, 40}, Rect{0, 0, 40, 5}, Rect{50, 0, 10, 40}}) {
        RecordingSurface dc;
        EXPECT_TRUE(PaintNine(dc, picture, Margins{3, 3, 3, 3}, target, frame).ok());
        EXPECT_TRUE(dc.Of(Kind::Copy).empty());
    }
    // Exactly as wide as the margins: the corners and nothing between them.
    RecordingSurface dc;
    EXPECT_TRUE(PaintNine(dc, picture, Margins{3, 3, 3, 3}, Rect{0, 0, 6, 6}, frame).ok());
    EXPECT_EQ(dc.Of(Kind::Copy).size(), 4u);
}

TEST(PaintNineTest, PaintNine_FailsWithoutDrawing_OnMarginsOrFrameThatDoNotFit) {
    const QImage picture(21, 33, QImage::Format_RGB32);
    const Rect target{0, 0, 100, 100};
    struct Case {
        Margins margins;
        Frame frame;
    };
    for (const Case& c : {
             Case{Margins{3, 6, 3, 10}, Frame{21, 11, 0}},  // margins higher than the frame
             Case{Margins{-1, 3, 3, 3}, Frame{21, 11, 0}},  // negative margin
             Case{Margins{3, 3, 3, 3}, Frame{21, 11, 23}},  // frame past the picture's end
             Case{Margins{3, 3, 3, 3}, Frame{21, 11, -11}},
             Case{Margins{3, 3, 3, 3}, Frame{30, 11, 0}},  // wider than the picture
         }) {
        RecordingSurface dc;
        EXPECT_FALSE(PaintNine(dc, picture, c.margins, target, c.frame).ok());
        EXPECT_TRUE(dc.calls.empty());
    }
}

TEST(PaintNineTest, PaintNine_FailsWithoutDrawing_WhenPiecesLeaveCoordinateRange) {
    const QImage picture(43, 330, QImage::Format_RGB32);
    RecordingSurface dc;
    EXPECT_FALSE(PaintNine(dc, picture, Margins{3, 3, 3, 3}, Rect{INT_MIN, 0, INT_MAX, 40},
                           FrameOf(picture, 5, 0))
                     .ok());
    EXPECT_TRUE(dc.calls.empty());
}

TEST(PaintNineTest, PaintNineKeyed_LeavesTargetVisibleWhereFrameIsMagenta) {
    // A 6 x 6 frame: blue border two pixels wide around a magenta middle.
    QImage frame(6, 6, QImage::Format_RGB32);
    frame.fill(QColor(0, 0, 255));
    for (int y = 2; y < 4; ++y) {
        for (int x = 2; x < 4; ++x) {
            frame.setPixelColor(x, y, QColor(255, 0, 255));
        }
    }
    QImage target(20, 20, QImage::Format_RGB32);
    target.fill(QColor(0, 200, 0));
    ImageSurface dc(target);

    ASSERT_TRUE(PaintNineKeyed(dc, frame, Margins{2, 2, 2, 2}, Rect{0, 0, 20, 20}, Frame{6, 6, 0},
                               kMagentaKey)
                    .ok());

    EXPECT_EQ(target.pixelColor(10, 10), QColor(0, 200, 0));
    EXPECT_EQ(target.pixelColor(2, 2), QColor(0, 200, 0));
    EXPECT_EQ(target.pixelColor(1, 10), QColor(0, 0, 255));
    EXPECT_EQ(target.pixelColor(19, 19), QColor(0, 0, 255));
    EXPECT_EQ(target.pixelColor(10, 18), QColor(0, 0, 255));
}

}  // namespace
}  // namespace kickvane::skin
