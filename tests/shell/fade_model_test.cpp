#include "shell/fade_model.h"

#include <gtest/gtest.h>

#include <vector>

namespace kickvane::shell {
namespace {

// Runs a fade to its end and returns the opacities it applied.
std::vector<int> RunFade(FadeModel& fade, int target, int step) {
    fade.start(target, step);
    std::vector<int> applied;
    while (fade.running() && applied.size() < 100) {
        applied.push_back(fade.advance().alpha);
    }
    return applied;
}

// Each fade starts where the last one stopped; one already at or beyond its target still takes
// one step, and the opacity stays within 0 and 255.
TEST(FadeModel, EachFadeStartsWhereTheLastStoppedAndStaysWithinZeroTo255) {
    FadeModel fade;
    fade.start(240, 15);
    const FadeModel::Tick first = fade.advance();
    EXPECT_EQ(first.alpha, 15);
    EXPECT_TRUE(first.firstInLife);
    EXPECT_FALSE(fade.advance().firstInLife);
    EXPECT_EQ(RunFade(fade, 240, 15).size(), 14u);  // 45 ... 240
    EXPECT_EQ(RunFade(fade, 150, -15), (std::vector<int>{225, 210, 195, 180, 165, 150}));
    EXPECT_EQ(RunFade(fade, 150, -15), std::vector<int>{135});
    EXPECT_EQ(RunFade(fade, 255, 15).size(), 8u);              // 150 ... 255
    EXPECT_EQ(RunFade(fade, 255, 15), std::vector<int>{255});  // 270 is clamped
    EXPECT_EQ(RunFade(fade, 100, 15), std::vector<int>{255});
    EXPECT_EQ(RunFade(fade, 10, -300), std::vector<int>{0});
}

}  // namespace
}  // namespace kickvane::shell
