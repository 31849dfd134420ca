#include "catalog/selection.h"

#include <gtest/gtest.h>

namespace kickvane::catalog {
namespace {

TEST(PatchSelection, DefaultsTurnOnAllButCrowdAndStadiumsAndChooseInEveryGroup) {
    const PatchSelection defaults = PatchSelection::Defaults();
    for (int i = 0; i < kCategoryCount; ++i) {
        EXPECT_EQ(defaults.isOn(i), i < 12) << i;
    }
    for (const VariantGroup& group : Groups()) {
        EXPECT_TRUE(defaults.chosen(group.id).has_value());
        EXPECT_FALSE(PatchSelection().chosen(group.id).has_value());  // before a load
    }
}

TEST(PatchSelection, ChoosingClearsOnlyTheOtherVariantsOfTheSameContainer) {
    PatchSelection selection = PatchSelection::Defaults();
    // Adboard, pitch and mark share one row but sit in separate containers.
    selection.setOptionValue(OptionArray::Other, 5, true);
    EXPECT_EQ(selection.chosen(GroupId::Pitch), 5);
    EXPECT_FALSE(selection.optionValue(OptionArray::Other, 4));
    EXPECT_EQ(selection.chosen(GroupId::Adboard), 0);
    EXPECT_EQ(selection.chosen(GroupId::Mark), 8);

    // False on a variant that is not chosen changes nothing; on the chosen one it clears it.
    selection.setOptionValue(OptionArray::Other, 6, false);
    EXPECT_EQ(selection.chosen(GroupId::Pitch), 5);
    selection.setOptionValue(OptionArray::Other, 5, false);
    EXPECT_FALSE(selection.chosen(GroupId::Pitch).has_value());
    EXPECT_EQ(selection.chosen(GroupId::Adboard), 0);

    // Buttons outside the arrays are ignored.
    selection.setOptionValue(OptionArray::Other, 11, true);
    selection.setOptionValue(OptionArray::Ball, -1, true);
    EXPECT_EQ(selection.chosen(GroupId::Ball), 1);
}

TEST(PatchSelection, CategoryIsOnOnlyForSwitchValueOne) {
    PatchSelection selection;
    for (int value : {1, 2, -1}) {
        selection.setSwitchValue(3, value);
        EXPECT_EQ(selection.isOn(3), value == 1);
        EXPECT_EQ(selection.switchValue(3), value);
    }
}

}  // namespace
}  // namespace kickvane::catalog

namespace kickvane::catalog {
namespace {

TEST(Catalog, LooksUpEntriesByKeyWithinTheirSection) {
    EXPECT_EQ(FindCategory("CDV")->switchIndex, 12);
    EXPECT_EQ(FindOption("Khac", "CoCaro")->index, 5);
    // "MacDinh" is a key of two sections; each lookup finds its own.
    EXPECT_EQ(FindOption("Bong", "MacDinh")->isDefault, false);
    EXPECT_EQ(FindOption("Bang Ti So", "MacDinh")->isDefault, true);
    EXPECT_EQ(FindOption("Khac", "MacDinh"), nullptr);
    EXPECT_EQ(FindCategory("Khac")->switchIndex, 5);  // the category, not the section
}

}  // namespace
}  // namespace kickvane::catalog
