#include "shell/fade_model.h"

#include <gtest/gtest.h>

#include <vector>

namespace kickvane::shell {
namespace {

// Runs a fade to its end and returns the opacities it applied.
std::vector<int> RunFade(FadeModel& fade, int target, int step) {
    fade.Start(target, step);
    std::vector<int> applied;
    while (fade.running() && applied.size() < 100) {
        applied.push_back(fade.Step().alpha);
    }
    return applied;
}

TEST(FadeModel, StartUpFadesFromFifteenToTwoFortyInSixteenTicks) {
    FadeModel fade;
    fade.Start(240, 15);
    const FadeModel::Tick first = fade.Step();
    EXPECT_EQ(first.alpha, 15);
    EXPECT_TRUE(first.firstInLife);
    EXPECT_FALSE(first.ended);
    std::vector<int> rest = RunFade(fade, 240, 15);
    EXPECT_EQ(rest.size(), 15u);
    EXPECT_EQ(rest.back(), 240);
    EXPECT_FALSE(fade.running());
    EXPECT_FALSE(fade.Step().firstInLife);
}

TEST(FadeModel, FadesStartFromWhereTheLastOneStoppedAndClamp) {
    FadeModel fade;
    RunFade(fade, 240, 15);
    EXPECT_EQ(RunFade(fade, 255, 15), std::vector<int>{255});  // 240 to 255 in one tick
    EXPECT_EQ(RunFade(fade, 255, 15), std::vector<int>{255});  // 270 is clamped; ends at once

    // "Chạy ẩn" from 240 ends at exactly 150 after six ticks, and once more goes to 135.
    FadeModel hidden;
    RunFade(hidden, 240, 15);
    EXPECT_EQ(RunFade(hidden, 150, -15), (std::vector<int>{225, 210, 195, 180, 165, 150}));
    EXPECT_EQ(RunFade(hidden, 150, -15), std::vector<int>{135});
    // From 150 back to full opacity takes seven ticks.
    EXPECT_EQ(RunFade(hidden, 255, 15).size(), 8u);  // from 135: 150 ... 255
}

TEST(FadeModel, FadeAlreadyBeyondItsTargetEndsAfterOneStep) {
    FadeModel fade;
    RunFade(fade, 240, 15);
    EXPECT_EQ(RunFade(fade, 100, 15), std::vector<int>{255});
    EXPECT_EQ(RunFade(fade, 255, -15), std::vector<int>{240});
    EXPECT_EQ(RunFade(fade, 10, -300), std::vector<int>{0});
}

}  // namespace
}  // namespace kickvane::shell
