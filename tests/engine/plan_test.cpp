#include "engine/plan.h"

#include <gtest/gtest.h>

namespace kickvane::engine {
namespace {

using catalog::OptionArray;
using catalog::PatchSelection;

PatchSelection OnlyCategory(int category) {
    PatchSelection selection = PatchSelection::Defaults();
    for (int i = 0; i < catalog::kCategoryCount; ++i) {
        selection.setSwitchValue(i, i == category ? 1 : 0);
    }
    return selection;
}

std::vector<std::string> Describe(const std::vector<PlanStep>& steps) {
    std::vector<std::string> lines;
    for (const PlanStep& step : steps) {
        lines.push_back(engine::Describe(step));
    }
    return lines;
}

TEST(BuildPlan, DefaultsRunCategoriesInSwitchOrder) {
    const std::vector<PlanStep> steps = BuildPlan(PatchSelection::Defaults());
    ASSERT_FALSE(steps.empty());
    for (size_t i = 1; i < steps.size(); ++i) {
        EXPECT_LE(steps[i - 1].category, steps[i].category);
    }
    EXPECT_EQ(steps.front().category, 0);
    EXPECT_EQ(steps.back().category, 11);  // crowd and stadiums are off by default
    EXPECT_EQ(steps.size(), 27u);
}

TEST(BuildPlan, NothingForCategoriesThatAreOffOrGroupsWithoutChoice) {
    PatchSelection off = PatchSelection::Defaults();
    for (int i = 0; i < catalog::kCategoryCount; ++i) {
        off.setSwitchValue(i, 0);
    }
    EXPECT_TRUE(BuildPlan(off).empty());

    PatchSelection ball = OnlyCategory(0);
    ball.setOptionValue(OptionArray::UniOption, 1, false);
    EXPECT_TRUE(BuildPlan(ball).empty());

    // The adboard's fixed step runs without a variant.
    PatchSelection adboard = OnlyCategory(2);
    adboard.setOptionValue(OptionArray::UniOption1, 0, false);
    EXPECT_EQ(Describe(BuildPlan(adboard)),
              std::vector<std::string>{"merge ToolDataRoot\\ingame_ad -> DataRoot\\ingame_ad"});
}

TEST(BuildPlan, VariantStepsAndFixedStepsInOrder) {
    PatchSelection adboard = OnlyCategory(2);
    adboard.setOptionValue(OptionArray::UniOption1, 3, true);
    EXPECT_EQ(
        Describe(BuildPlan(adboard)),
        (std::vector<std::string>{"merge ExtrasFolder\\adboard\\WC 2010 -> ZDataRoot\\adboard",
                                  "merge ToolDataRoot\\ingame_ad -> DataRoot\\ingame_ad"}));

    PatchSelection pitch = OnlyCategory(1);
    pitch.setOptionValue(OptionArray::UniOption1, 6, true);
    EXPECT_EQ(
        Describe(BuildPlan(pitch)),
        (std::vector<std::string>{
            "merge ExtrasFolder\\pitch\\Oval UCL -> DataRoot\\pitch\\textures",
            "merge ExtrasFolder\\pitch\\_textures -> DataRoot\\pitch\\textures",
            "copy ToolDataRoot\\pitch\\textures\\grass_dirt.dds -> DataRoot\\pitch\\textures",
            "copy ToolDataRoot\\pitch\\textures\\grass_pitchlines.dds -> DataRoot\\pitch\\textures",
            "merge ToolZDataRoot\\pitch -> ZDataRoot\\pitch"}));

    PatchSelection ball = OnlyCategory(0);
    ball.setOptionValue(OptionArray::UniOption, 0, true);
    EXPECT_EQ(Describe(BuildPlan(ball)),
              (std::vector<std::string>{"merge ToolDataRoot\\ball -> DataRoot\\ball",
                                        "merge ToolZDataRoot\\ball -> ZDataRoot\\ball"}));

    PatchSelection scoreboard = OnlyCategory(10);
    scoreboard.setOptionValue(OptionArray::UniOption3, 4, true);
    EXPECT_EQ(
        Describe(BuildPlan(scoreboard)),
        (std::vector<std::string>{
            "merge ExtrasFolder\\scoreboard\\K+ NS\\scoreboard -> DataRoot\\gui\\hud\\scoreboard",
            "merge ExtrasFolder\\scoreboard\\K+ NS\\namebar -> DataRoot\\gui\\hud\\namebar"}));

    PatchSelection mark = OnlyCategory(11);
    mark.setOptionValue(OptionArray::UniOption1, 10, true);
    EXPECT_EQ(Describe(BuildPlan(mark)),
              std::vector<std::string>{
                  "merge ExtrasFolder\\Indicator\\PES vang -> DataRoot\\gui\\hud\\Indicator"});
}

TEST(BuildPlan, GuardedStepsOfInterfaceEmblemsAndNets) {
    const std::vector<PlanStep> interface = BuildPlan(OnlyCategory(3));
    ASSERT_EQ(interface.size(), 8u);
    EXPECT_EQ(interface.back().source.relative, "\\gui\\font");
    for (const PlanStep& step : interface) {
        EXPECT_EQ(step.guard, StepGuard::IfSourceFolderExists);
    }
    EXPECT_EQ(Describe(BuildPlan(OnlyCategory(9))),
              (std::vector<std::string>{
                  "make folder DataRoot\\net (if DataRoot\\net\\textures is missing)",
                  "make folder DataRoot\\net\\textures (if DataRoot\\net\\textures is missing)",
                  "merge ToolDataRoot\\net\\textures -> DataRoot\\net\\textures"}));
}

}  // namespace
}  // namespace kickvane::engine
