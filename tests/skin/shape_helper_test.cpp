#include "skin/shape_helper.h"

#include <gtest/gtest.h>

#include "recording_surface.h"

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

}  // namespace
}  // namespace kickvane::skin
