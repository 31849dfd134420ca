#include "catalog/selection.h"

#include <gtest/gtest.h>

namespace kickvane::catalog {
namespace {

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

TEST(Catalog, LooksUpEntriesByKeyWithinTheirSection) {
    // "MacDinh" is a key of two sections; each lookup finds its own.
    EXPECT_EQ(FindOption("Bong", "MacDinh")->isDefault, false);
    EXPECT_EQ(FindOption("Bang Ti So", "MacDinh")->isDefault, true);
    EXPECT_EQ(FindOption("Khac", "MacDinh"), nullptr);
    EXPECT_EQ(FindCategory("Khac")->switchIndex, 5);  // the category, not the section
}

}  // namespace
}  // namespace kickvane::catalog
