#include "skin/paint_nine.h"

#include <climits>

#include <gtest/gtest.h>

#include "recording_surface.h"
#include "skin/pictures.h"

namespace kickvane::skin {
namespace {

using testing::RecordingSurface;
using Kind = RecordingSurface::Kind;

// Where the nine pieces come from and go is the gallery reference's to check, pixel for pixel,
// on the buttons it draws; here, boxes and frames that leave no room for them.
TEST(PaintNineTest, PaintNine_DrawsNothing_WhenTargetNarrowerOrLowerThanMargins) {
    const QImage picture(43, 330, QImage::Format_RGB32);
    const Frame frame = frameOf(picture, 5, 0);
    for (const Rect& target : {Rect{0, 0, 5, 40}, Rect{0, 0, 40, 5}, Rect{50, 0, 10, 40}}) {
        RecordingSurface dc;
        EXPECT_TRUE(paintNine(dc, picture, Margins{3, 3, 3, 3}, target, frame).ok());
        EXPECT_EQ(dc.count(Kind::Copy), 0);
    }
    // Exactly as wide as the margins: the corners and nothing between them.
    RecordingSurface dc;
    EXPECT_TRUE(paintNine(dc, picture, Margins{3, 3, 3, 3}, Rect{0, 0, 6, 6}, frame).ok());
    EXPECT_EQ(dc.count(Kind::Copy), 4);
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
