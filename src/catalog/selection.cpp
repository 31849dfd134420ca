#include "catalog/selection.h"

namespace kickvane::catalog {

namespace {

bool ValidSwitch(int switchIndex) {
    return switchIndex >= 0 && switchIndex < kCategoryCount;
}

size_t Slot(GroupId group) {
    return static_cast<size_t>(group);
}

}  // namespace

PatchSelection PatchSelection::Defaults() {
    PatchSelection selection;
    for (const PatchCategory& category : Categories()) {
        selection.SetSwitchValue(category.switchIndex, category.defaultValue);
    }
    for (const VariantGroup& group : Groups()) {
        for (const PatchOption& option : group.options) {
            selection.SetOptionValue(group.array, option.index, option.isDefault);
        }
    }
    return selection;
}

int PatchSelection::SwitchValue(int switchIndex) const {
    return ValidSwitch(switchIndex) ? switches_[static_cast<size_t>(switchIndex)] : 0;
}

void PatchSelection::SetSwitchValue(int switchIndex, int value) {
    if (ValidSwitch(switchIndex)) {
        switches_[static_cast<size_t>(switchIndex)] = value;
    }
}

bool PatchSelection::OptionValue(OptionArray array, int index) const {
    const VariantGroup* group = GroupOfOption(array, index);
    return group && chosen_[Slot(group->id)] == index;
}

void PatchSelection::SetOptionValue(OptionArray array, int index, bool value) {
    const VariantGroup* group = GroupOfOption(array, index);
    if (!group) {
        return;
    }
    std::optional<int>& chosen = chosen_[Slot(group->id)];
    if (value) {
        chosen = index;
        chosenAdded_[Slot(group->id)].clear();
    } else if (chosen == index) {
        chosen.reset();
    }
}

std::optional<int> PatchSelection::Chosen(GroupId group) const {
    return chosen_[Slot(group)];
}

const PatchOption* PatchSelection::ChosenOption(GroupId group) const {
    const std::optional<int> index = Chosen(group);
    if (!index) {
        return nullptr;
    }
    for (const PatchOption& option : Group(group).options) {
        if (option.index == *index) {
            return &option;
        }
    }
    return nullptr;
}

void PatchSelection::SetAddedValue(GroupId group, std::string_view name, bool value) {
    std::string& chosen = chosenAdded_[Slot(group)];
    if (value && !name.empty()) {
        chosen = name;
        chosen_[Slot(group)].reset();
    } else if (chosen == name) {
        chosen.clear();
    }
}

bool PatchSelection::AddedValue(GroupId group, std::string_view name) const {
    return !name.empty() && chosenAdded_[Slot(group)] == name;
}

std::string_view PatchSelection::ChosenAdded(GroupId group) const {
    return chosenAdded_[Slot(group)];
}

}  // namespace kickvane::catalog
