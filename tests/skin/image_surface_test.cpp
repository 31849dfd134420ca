#include "skin/image_surface.h"

#include <climits>

#include <gtest/gtest.h>
#include <QPainter>

#include "filled_image.h"

namespace kickvane::skin {
namespace {

using testing::filled;

TEST(ImageSurfaceTest, Copy_UsesNearestPixelWhenPlain_AndBlendsWhenHalftone) {
    QImage source = filled(2, 1, Qt::black);
    source.setPixelColor(1, 0, Qt::white);
    QImage nearest = filled(8, 1, Qt::white);
    QPainter(&nearest).fillRect(0, 0, 4, 1, Qt::black);
    for (const StretchMode mode : {StretchMode::Plain, StretchMode::Halftone}) {
        QImage target = filled(8, 1, Qt::red);
        ImageSurface dc(target);
        dc.setStretchMode(mode);
        ASSERT_TRUE(dc.copy(source, Piece{0, 0, 2, 1}, Piece{0, 0, 8, 1}).ok());
        const int middle = target.pixelColor(4, 0).red();
        EXPECT_EQ(target == nearest, mode == StretchMode::Plain);
        EXPECT_EQ(middle > 0 && middle < 255, mode == StretchMode::Halftone) << middle;
    }
}

TEST(ImageSurfaceTest, Copy_DoesNotBlendInNeighbouringFrame_WhenSmoothing) {
    // Two frames of two rows each; stretching the red one must stay pure red.
    QImage source = filled(1, 4, Qt::blue);
    source.setPixelColor(0, 0, Qt::red);
    source.setPixelColor(0, 1, Qt::red);
    QImage target = filled(3, 16, Qt::white);
    ImageSurface dc(target);
    dc.setStretchMode(StretchMode::Halftone);
    ASSERT_TRUE(dc.copy(source, Piece{0, 0, 1, 2}, Piece{0, 0, 3, 16}).ok());
    EXPECT_EQ(target, filled(3, 16, Qt::red));
}

TEST(ImageSurfaceTest, CopyKeyed_KeepsTargetUnderKeyPixels_WhenStretched) {
    QImage source = filled(2, 2, QColor(255, 0, 255));
    source.setPixelColor(0, 0, QColor(10, 20, 30));
    QImage target = filled(4, 4, Qt::green);
    ImageSurface dc(target);
    dc.setStretchMode(StretchMode::Halftone);  // keyed copies never blend the key
    ASSERT_TRUE(dc.copyKeyed(source, Piece{0, 0, 2, 2}, Piece{0, 0, 4, 4}, kMagentaKey).ok());

    QImage expected = filled(4, 4, Qt::green);
    QPainter(&expected).fillRect(0, 0, 2, 2, QColor(10, 20, 30));
    EXPECT_EQ(target, expected);
}

TEST(ImageSurfaceTest, Copy_FailsAndLeavesTarget_WhenPieceIsOutsideItsPicture) {
    const QImage source = filled(4, 4, Qt::black);
    QImage target = filled(4, 4, Qt::white);
    ImageSurface dc(target);
    EXPECT_FALSE(dc.copy(source, Piece{2, 2, 3, 3}, Piece{0, 0, 4, 4}).ok());
    EXPECT_FALSE(dc.copyKeyed(source, Piece{0, -1, 2, 2}, Piece{0, 0, 4, 4}, kMagentaKey).ok());
    EXPECT_FALSE(dc.copy(source, Piece{0, 0, 2, 2}, Piece{INT_MAX, 0, 4, 4}).ok());
    EXPECT_EQ(target, filled(4, 4, Qt::white));

    QImage none;
    ImageSurface nowhere(none);
    EXPECT_FALSE(nowhere.copy(source, Piece{0, 0, 2, 2}, Piece{0, 0, 2, 2}).ok());
}

TEST(ImageSurfaceTest, Fill_ClipsToPicture_EvenAtCoordinateLimits) {
    QImage target = filled(5, 5, Qt::white);
    ImageSurface dc(target);
    ASSERT_TRUE(dc.fill(Rect{INT_MIN, INT_MIN, INT_MAX, 2}, rgb(1, 2, 3)).ok());
    EXPECT_EQ(target.pixelColor(4, 1), QColor(1, 2, 3));
    EXPECT_EQ(target.pixelColor(4, 2), QColor(Qt::white));
    ASSERT_TRUE(dc.fill(Rect{3, 3, 1, 5}, rgb(9, 9, 9)).ok());  // inverted: nothing
    EXPECT_EQ(target.pixelColor(2, 3), QColor(Qt::white));
}

}  // namespace
}  // namespace kickvane::skin
