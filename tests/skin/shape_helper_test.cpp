#include "skin/shape_helper.h"

#include <gtest/gtest.h>

#include "recording_surface.h"
#include "skin/image_surface.h"

namespace kickvane::skin {
namespace {

using testing::RecordingSurface;

// RGB values pass through, system colours are translated first, unknown ones are none.
TEST(ShapeHelperTest, ColoursTranslateAndShadeEachChannelWithClamping) {
    EXPECT_EQ(ShapeHelper::translateColor(rgb(101, 147, 207)), 0x6593CFu);
    EXPECT_FALSE(ShapeHelper::translateColor(0x80000063).has_value());  // no such system colour
    EXPECT_FALSE(ShapeHelper::translateColor(0x01000005).has_value());  // no colour value
    EXPECT_EQ(ShapeHelper::shadeColor(rgb(10, 250, 128), -20), rgb(0, 230, 108));
    EXPECT_EQ(ShapeHelper::shadeColor(rgb(10, 250, 128), 20), rgb(30, 255, 148));
    EXPECT_EQ(ShapeHelper::shadeColor(kSysButtonFace, -20), rgb(216, 219, 224));
}

TEST(ShapeHelperTest, Boxes_FailAndDrawNothing_ForAnUnknownColour) {
    RecordingSurface dc;
    const ShapeHelper shapes;
    EXPECT_FALSE(shapes.fillBox(dc, 0, 0, 10, 10, 0x80000040).ok());
    EXPECT_FALSE(shapes.frameBox(dc, 0, 0, 10, 10, 0x02000000).ok());
    EXPECT_TRUE(dc.calls.empty());
}

TEST(ShapeHelperTest, FrameBox_OutlinesTheInsideOfItsRectangle) {
    QImage target(10, 10, QImage::Format_RGB32);
    target.fill(Qt::white);
    ImageSurface dc(target);
    ASSERT_TRUE(ShapeHelper().frameBox(dc, 2, 2, 8, 8, rgb(255, 0, 0)).ok());
    for (int y = 0; y < 10; ++y) {
        for (int x = 0; x < 10; ++x) {
            const bool inBox = x >= 2 && x < 8 && y >= 2 && y < 8;
            const bool onEdge = inBox && (x == 2 || x == 7 || y == 2 || y == 7);
            EXPECT_EQ(target.pixelColor(x, y), onEdge ? QColor(Qt::red) : QColor(Qt::white))
                << x << "," << y;
        }
    }
}

TEST(ShapeHelperTest, SunkenEdge_IsDarkAboveAndLeft_LightBelowAndRight) {
    QImage target(12, 12, QImage::Format_RGB32);
    target.fill(QColor(128, 128, 128));
    ImageSurface dc(target);
    ASSERT_TRUE(ShapeHelper().sunkenEdge(dc, Rect{0, 0, 12, 12}).ok());
    EXPECT_LT(target.pixelColor(5, 0).lightness(), target.pixelColor(5, 11).lightness());
    EXPECT_LT(target.pixelColor(1, 5).lightness(), target.pixelColor(10, 5).lightness());
    EXPECT_EQ(target.pixelColor(6, 6), QColor(128, 128, 128));
}

}  // namespace
}  // namespace kickvane::skin
