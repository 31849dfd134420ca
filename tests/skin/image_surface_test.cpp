#include "skin/image_surface.h"

#include <climits>

#include <gtest/gtest.h>

namespace kickvane::skin {
namespace {

QImage Filled(int w, int h, const QColor& colour) {
    QImage image(w, h, QImage::Format_RGB32);
    image.fill(colour);
    return image;
}

TEST(ImageSurfaceTest, Copy_UsesNearestPixelWhenPlain_AndBlendsWhenHalftone) {
    QImage source(2, 1, QImage::Format_RGB32);
    source.setPixelColor(0, 0, Qt::black);
    source.setPixelColor(1, 0, Qt::white);

    QImage plain = Filled(8, 1, Qt::red);
    ImageSurface plainDc(plain);
    ASSERT_TRUE(plainDc.Copy(source, Piece{0, 0, 2, 1}, Piece{0, 0, 8, 1}).ok());
    for (int x = 0; x < 8; ++x) {
        EXPECT_EQ(plain.pixelColor(x, 0), x < 4 ? QColor(Qt::black) : QColor(Qt::white)) << x;
    }

    QImage smooth = Filled(8, 1, Qt::red);
    ImageSurface smoothDc(smooth);
    smoothDc.SetStretchMode(StretchMode::Halftone);
    ASSERT_TRUE(smoothDc.Copy(source, Piece{0, 0, 2, 1}, Piece{0, 0, 8, 1}).ok());
    const int middle = smooth.pixelColor(4, 0).red();
    EXPECT_GT(middle, 0);
    EXPECT_LT(middle, 255);
}

TEST(ImageSurfaceTest, Copy_DoesNotBlendInNeighbouringFrame_WhenSmoothing) {
    // Two frames of two rows each; stretching the red one must stay pure red.
    QImage source(1, 4, QImage::Format_RGB32);
    for (int y = 0; y < 4; ++y) {
        source.setPixelColor(0, y, y < 2 ? QColor(Qt::red) : QColor(Qt::blue));
    }
    QImage target = Filled(3, 16, Qt::white);
    ImageSurface dc(target);
    dc.SetStretchMode(StretchMode::Halftone);
    ASSERT_TRUE(dc.Copy(source, Piece{0, 0, 1, 2}, Piece{0, 0, 3, 16}).ok());
    for (int y = 0; y < 16; ++y) {
        EXPECT_EQ(target.pixelColor(1, y), QColor(Qt::red)) << y;
    }
}

TEST(ImageSurfaceTest, CopyKeyed_KeepsTargetUnderKeyPixels_WhenStretched) {
    QImage source(2, 2, QImage::Format_RGB32);
    source.fill(QColor(255, 0, 255));
    source.setPixelColor(0, 0, QColor(10, 20, 30));
    QImage target = Filled(4, 4, Qt::green);
    ImageSurface dc(target);
    dc.SetStretchMode(StretchMode::Halftone);  // keyed copies never blend the key

    ASSERT_TRUE(dc.CopyKeyed(source, Piece{0, 0, 2, 2}, Piece{0, 0, 4, 4}, kMagentaKey).ok());

    for (int y = 0; y < 4; ++y) {
        for (int x = 0; x < 4; ++x) {
            const QColor expected = x < 2 && y < 2 ? QColor(10, 20, 30) : QColor(Qt::green);
            EXPECT_EQ(target.pixelColor(x, y), expected) << x << "," << y;
        }
    }
}

TEST(ImageSurfaceTest, Copy_FailsAndLeavesTarget_WhenPieceIsOutsideItsPicture) {
    const QImage source = Filled(4, 4, Qt::black);
    QImage target = Filled(4, 4, Qt::white);
    ImageSurface dc(target);
    EXPECT_FALSE(dc.Copy(source, Piece{2, 2, 3, 3}, Piece{0, 0, 4, 4}).ok());
    EXPECT_FALSE(dc.CopyKeyed(source, Piece{0, -1, 2, 2}, Piece{0, 0, 4, 4}, kMagentaKey).ok());
    EXPECT_FALSE(dc.Copy(source, Piece{0, 0, 2, 2}, Piece{INT_MAX, 0, 4, 4}).ok());
    EXPECT_EQ(target, Filled(4, 4, Qt::white));

    QImage none;
    ImageSurface nowhere(none);
    EXPECT_FALSE(nowhere.Copy(source, Piece{0, 0, 2, 2}, Piece{0, 0, 2, 2}).ok());
}

TEST(ImageSurfaceTest, Fill_ClipsToPicture_EvenAtCoordinateLimits) {
    QImage target = Filled(5, 5, Qt::white);
    ImageSurface dc(target);
    ASSERT_TRUE(dc.Fill(Rect{INT_MIN, INT_MIN, INT_MAX, 2}, Rgb(1, 2, 3)).ok());
    EXPECT_EQ(target.pixelColor(4, 1), QColor(1, 2, 3));
    EXPECT_EQ(target.pixelColor(4, 2), QColor(Qt::white));
    ASSERT_TRUE(dc.Fill(Rect{3, 3, 1, 5}, Rgb(9, 9, 9)).ok());  // inverted: nothing
    EXPECT_EQ(target.pixelColor(2, 3), QColor(Qt::white));
}

TEST(ImageSurfaceTest, Text_DrawsInsideItsBoxOnly) {
    QImage target = Filled(120, 40, Qt::white);
    ImageSurface dc(target);
    ASSERT_TRUE(dc.Text(Rect{10, 10, 60, 30}, "Kickvane Kickvane Kickvane", Rgb(0, 0, 0)).ok());
    int inside = 0;
    int outside = 0;
    for (int y = 0; y < 40; ++y) {
        for (int x = 0; x < 120; ++x) {
            if (target.pixelColor(x, y) != QColor(Qt::white)) {
                (x >= 10 && x < 60 && y >= 10 && y < 30 ? inside : outside) += 1;
            }
        }
    }
    EXPECT_GT(inside, 20);
    EXPECT_EQ(outside, 0);
}

}  // namespace
}  // namespace kickvane::skin
