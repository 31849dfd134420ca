#pragma once

#include <array>
#include <optional>
#include <string>
#include <string_view>

#include "catalog/catalog.h"

namespace kickvane::catalog {

// The user's choice: one switch value per category and at most one chosen variant per group.
// It mirrors the window's check boxes and option buttons, including their rule that choosing a
// variant clears the other variants of its container and that clearing one touches nothing else.
class PatchSelection {
public:
    // Nothing chosen and every switch 0, as the widgets are before the settings are loaded.
    PatchSelection() = default;

    // The catalog's defaults, as a load without a settings file gives them.
    static PatchSelection Defaults();

    int SwitchValue(int switchIndex) const;
    void SetSwitchValue(int switchIndex, int value);
    // A category is on only when its switch value is exactly 1.
    bool IsOn(int switchIndex) const { return SwitchValue(switchIndex) == 1; }

    // The value of option button `index` of `array`.
    bool OptionValue(OptionArray array, int index) const;
    // True chooses the variant and clears the others of its container; false clears only it.
    void SetOptionValue(OptionArray array, int index, bool value);

    // The chosen variant of a group, as its index in the group's option array.
    std::optional<int> Chosen(GroupId group) const;
    const PatchOption* ChosenOption(GroupId group) const;

    // A variant the player added to the group, by its folder name. It takes part in the same
    // rule: choosing it clears the group's catalog option and the other way round.
    void SetAddedValue(GroupId group, std::string_view name, bool value);
    bool AddedValue(GroupId group, std::string_view name) const;
    // The chosen added variant's name; empty when the group's choice is none or a catalog option.
    std::string_view ChosenAdded(GroupId group) const;
    bool HasChoice(GroupId group) const { return Chosen(group) || !ChosenAdded(group).empty(); }

    friend bool operator==(const PatchSelection&, const PatchSelection&) = default;

private:
    std::array<int, kCategoryCount> switches_{};
    std::array<std::optional<int>, kGroupCount> chosen_{};
    std::array<std::string, kGroupCount> chosenAdded_{};
};

}  // namespace kickvane::catalog
