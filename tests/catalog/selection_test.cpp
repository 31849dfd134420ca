#include "catalog/selection.h"

#include <gtest/gtest.h>

namespace kickvane::catalog {
namespace {

TEST(PatchSelection, DefaultsTurnOnAllButCrowdAndStadiumsAndChooseEachGroupsDefault) {
    const PatchSelection selection = PatchSelection::Defaults();
    for (int i = 0; i < kCategoryCount; ++i) {
        EXPECT_EQ(selection.isOn(i), i < 12) << i;
    }
    EXPECT_EQ(selection.chosenOption(GroupId::Ball)->key, "Europa League 2011");
    EXPECT_EQ(selection.chosenOption(GroupId::Scoreboard)->key, "MacDinh");
    EXPECT_EQ(selection.chosenOption(GroupId::Adboard)->key, "QcaoMacDinh");
    EXPECT_EQ(selection.chosenOption(GroupId::Pitch)->key, "CoMacDinh");
    EXPECT_EQ(selection.chosenOption(GroupId::Mark)->key, "MarkMacDinh");
}

TEST(PatchSelection, NothingIsChosenBeforeALoad) {
    const PatchSelection selection;
    for (const VariantGroup& group : Groups()) {
        EXPECT_FALSE(selection.chosen(group.id).has_value());
    }
}

TEST(PatchSelection, ChoosingClearsOnlyTheOtherVariantsOfTheSameContainer) {
    PatchSelection selection = PatchSelection::Defaults();
    // Adboard, pitch and mark share UniOption1 but sit in separate containers.
    selection.setOptionValue(OptionArray::UniOption1, 5, true);
    EXPECT_EQ(selection.chosen(GroupId::Pitch), 5);
    EXPECT_FALSE(selection.optionValue(OptionArray::UniOption1, 4));
    EXPECT_EQ(selection.chosen(GroupId::Adboard), 0);
    EXPECT_EQ(selection.chosen(GroupId::Mark), 8);

    // False on a variant that is not chosen changes nothing; on the chosen one it clears it.
    selection.setOptionValue(OptionArray::UniOption1, 6, false);
    EXPECT_EQ(selection.chosen(GroupId::Pitch), 5);
    selection.setOptionValue(OptionArray::UniOption1, 5, false);
    EXPECT_FALSE(selection.chosen(GroupId::Pitch).has_value());
    EXPECT_EQ(selection.chosen(GroupId::Adboard), 0);

    // Buttons outside the arrays are ignored.
    selection.setOptionValue(OptionArray::UniOption1, 11, true);
    selection.setOptionValue(OptionArray::UniOption, -1, true);
    EXPECT_EQ(selection.chosen(GroupId::Ball), 1);
}

TEST(PatchSelection, CategoryIsOnOnlyForSwitchValueOne) {
    PatchSelection selection;
    selection.setSwitchValue(3, 1);
    selection.setSwitchValue(4, 2);
    selection.setSwitchValue(5, -1);
    EXPECT_TRUE(selection.isOn(3));
    EXPECT_FALSE(selection.isOn(4));
    EXPECT_FALSE(selection.isOn(5));
    EXPECT_EQ(selection.switchValue(4), 2);
}

}  // namespace
}  // namespace kickvane::catalog
