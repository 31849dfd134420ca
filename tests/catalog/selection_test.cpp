#include "catalog/selection.h"

#include <gtest/gtest.h>

namespace kickvane::catalog {
namespace {

TEST(PatchSelection, ChoosingClearsOnlyTheOtherVariantsOfTheSameContainer) {
    PatchSelection selection = PatchSelection::Defaults();
    // Adboard, pitch and mark share one row but sit in separate containers.
    selection.SetOptionValue(OptionArray::Other, 5, true);
    EXPECT_EQ(selection.Chosen(GroupId::Pitch), 5);
    EXPECT_FALSE(selection.OptionValue(OptionArray::Other, 4));
    EXPECT_EQ(selection.Chosen(GroupId::Adboard), 0);
    EXPECT_EQ(selection.Chosen(GroupId::Mark), 8);

    // False on a variant that is not chosen changes nothing; on the chosen one it clears it.
    selection.SetOptionValue(OptionArray::Other, 6, false);
    EXPECT_EQ(selection.Chosen(GroupId::Pitch), 5);
    selection.SetOptionValue(OptionArray::Other, 5, false);
    EXPECT_FALSE(selection.Chosen(GroupId::Pitch).has_value());
    EXPECT_EQ(selection.Chosen(GroupId::Adboard), 0);

    // Buttons outside the arrays are ignored.
    selection.SetOptionValue(OptionArray::Other, 11, true);
    selection.SetOptionValue(OptionArray::Ball, -1, true);
    EXPECT_EQ(selection.Chosen(GroupId::Ball), 1);
}

}  // namespace
}  // namespace kickvane::catalog
