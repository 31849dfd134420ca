#include "engine/plan.h"

#include <gtest/gtest.h>

#include "catalog/added_variants.h"

namespace kickvane::engine {
namespace {

using catalog::OptionArray;
using catalog::PatchSelection;

PatchSelection OnlyCategory(int category) {
    PatchSelection selection = PatchSelection::Defaults();
    for (int i = 0; i < catalog::kCategoryCount; ++i) {
        selection.SetSwitchValue(i, i == category ? 1 : 0);
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

TEST(BuildPlan, CategoriesRunInSwitchOrderAndOnlyWhenOn) {
    const std::vector<PlanStep> steps = BuildPlan(PatchSelection::Defaults());
    ASSERT_FALSE(steps.empty());
    for (size_t i = 1; i < steps.size(); ++i) {
        EXPECT_LE(steps[i - 1].category, steps[i].category);
    }
    EXPECT_TRUE(BuildPlan(OnlyCategory(-1)).empty());
}

TEST(BuildPlan, VariantStepsComeBeforeTheFixedStepsAndAGroupWithoutChoiceHasOnlyThese) {
    PatchSelection ball = OnlyCategory(0);
    ball.SetOptionValue(OptionArray::Ball, 1, false);
    EXPECT_TRUE(BuildPlan(ball).empty());

    PatchSelection adboard = OnlyCategory(2);
    adboard.SetOptionValue(OptionArray::Other, 0, false);
    EXPECT_EQ(Describe(BuildPlan(adboard)),
              std::vector<std::string>{"merge ToolDataRoot\\ingame_ad -> DataRoot\\ingame_ad"});
    adboard.SetOptionValue(OptionArray::Other, 3, true);
    EXPECT_EQ(
        Describe(BuildPlan(adboard)),
        (std::vector<std::string>{"merge ExtrasFolder\\adboard\\WC 2010 -> ZDataRoot\\adboard",
                                  "merge ToolDataRoot\\ingame_ad -> DataRoot\\ingame_ad"}));
}

// A variant the player added runs the very steps of the catalog's variants of its group, from its
// own folder; choosing it clears the group's catalog option and the other way round.
TEST(BuildPlan, AddedVariantRunsTheStepsOfItsGroupsCatalogVariantsFromItsFolder) {
    for (const catalog::VariantGroup& group : catalog::Groups()) {
        SCOPED_TRACE(std::string(group.section) + " " +
                     std::string(catalog::GroupFolder(group.id)));
        const catalog::PatchOption& listed = group.options[1];
        PatchSelection chosen = OnlyCategory(group.ownerSwitch);
        chosen.SetOptionValue(group.array, listed.index, true);
        std::vector<std::string> expected = Describe(BuildPlan(chosen));
        const catalog::AddedVariant added{group.id, "Bộ mới 2026"};
        for (std::string& line : expected) {
            if (const size_t at = line.find(listed.sourceFolder); at != std::string::npos) {
                line.replace(at, listed.sourceFolder.size(), added.SourceFolder());
            }
        }

        chosen.SetAddedValue(group.id, added.name, true);
        EXPECT_FALSE(chosen.OptionValue(group.array, listed.index));
        const std::vector<std::string> steps = Describe(BuildPlan(chosen));
        EXPECT_EQ(steps, expected);
        EXPECT_NE(steps.front().find("Bộ mới 2026"), std::string::npos);

        chosen.SetOptionValue(group.array, listed.index, true);
        EXPECT_TRUE(chosen.ChosenAdded(group.id).empty());
    }
}

}  // namespace
}  // namespace kickvane::engine
