#include "catalog/settings.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstdlib>
#include <limits>

#include "catalog/ini.h"
#include "platform/filesystem.h"

namespace kickvane::catalog {

namespace {

constexpr std::string_view kMainSection = "Thiet lap";
constexpr std::string_view kFolderKey = "DuongDan";
constexpr std::string_view kHotkeyKey = "PhimTat";

bool EqualsIgnoringCase(std::string_view a, std::string_view b) {
    return platform::NamesEqualIgnoringCase(a, b);
}

std::string ValueOr(const IniDocument& file, std::string_view section, std::string_view key,
                    std::string_view fallback) {
    return file.Get(section, key).value_or(std::string(fallback));
}

}  // namespace

std::filesystem::path SettingsFile(const std::filesystem::path& toolFolder) {
    return platform::FindEntryIgnoringCase(toolFolder, kSettingsFileName)
        .value_or(toolFolder / kSettingsFileName);
}

std::optional<int> ParseWholeNumber(std::string_view text) {
    text = platform::TrimBlanks(text);
    if (text.empty()) {
        return std::nullopt;
    }
    int value = 0;
    const char* end = text.data() + text.size();
    auto [ptr, error] = std::from_chars(text.data(), end, value);
    if (error == std::errc() && ptr == end) {
        return value;
    }
    // A decimal number rounds to the nearest whole one, halves to even, as the widgets take it.
    const std::string copy(text);
    char* parsedEnd = nullptr;
    const double number = std::strtod(copy.c_str(), &parsedEnd);
    if (parsedEnd != copy.c_str() + copy.size() || !std::isfinite(number)) {
        return std::nullopt;
    }
    const double rounded = std::nearbyint(number);
    if (rounded < std::numeric_limits<int>::min() || rounded > std::numeric_limits<int>::max()) {
        return std::nullopt;
    }
    return static_cast<int>(rounded);
}

std::optional<bool> ParseTruthValue(std::string_view text) {
    text = platform::TrimBlanks(text);
    if (EqualsIgnoringCase(text, "True")) {
        return true;
    }
    if (EqualsIgnoringCase(text, "False")) {
        return false;
    }
    if (const std::optional<int> number = ParseWholeNumber(text)) {
        return *number != 0;
    }
    return std::nullopt;
}

void ChooseGroupDefault(PatchSelection& selection, GroupId id) {
    const VariantGroup& group = Group(id);
    for (const PatchOption& option : group.options) {
        if (option.isDefault) {
            selection.SetOptionValue(group.array, option.index, true);
        }
    }
}

namespace {

bool IsCatalogKey(std::string_view section, std::string_view key) {
    for (const VariantGroup& group : Groups()) {
        for (const PatchOption& option : group.options) {
            if (group.section == section && EqualsIgnoringCase(option.key, key)) {
                return true;
            }
        }
    }
    return false;
}

bool IsAddedKey(const AddedVariants& added, std::string_view section, std::string_view key) {
    for (const VariantGroup& group : Groups()) {
        if (group.section != section) {
            continue;
        }
        for (const AddedVariant& variant : added.Of(group.id)) {
            if (EqualsIgnoringCase(variant.name, key)) {
                return true;
            }
        }
    }
    return false;
}

// The groups that the load left without a choice while their section says "True" for a variant
// that is neither the catalog's nor among `added`: that variant's folder is gone. Such a group
// falls back to its default. A section shared by several groups cannot tell whose the key was;
// each group without a choice takes the next such key.
void FallBackFromGoneVariants(const IniDocument& file, const AddedVariants& added,
                              PatchSelection& selection, std::vector<GoneChoice>* gone) {
    std::vector<std::string_view> sections;
    for (const VariantGroup& group : Groups()) {
        if (std::find(sections.begin(), sections.end(), group.section) == sections.end()) {
            sections.push_back(group.section);
        }
    }
    for (std::string_view section : sections) {
        std::vector<std::string> goneTrue;
        for (const auto& [key, value] : file.Entries(section)) {
            if (!IsCatalogKey(section, key) && !IsAddedKey(added, section, key) &&
                ParseTruthValue(value).value_or(false)) {
                goneTrue.push_back(key);
            }
        }
        size_t next = 0;
        for (const VariantGroup& group : Groups()) {
            if (group.section != section || goneTrue.empty() || selection.HasChoice(group.id)) {
                continue;
            }
            ChooseGroupDefault(selection, group.id);
            if (gone) {
                gone->push_back({group.id, goneTrue[std::min(next++, goneTrue.size() - 1)]});
            }
        }
    }
}

}  // namespace

Status LoadSettings(const std::filesystem::path& toolFolder, Settings& settings,
                    const AddedVariants& added, std::vector<GoneChoice>* gone) {
    IniDocument file;
    Status status = IniDocument::Read(SettingsFile(toolFolder), &file);
    settings.gameFolder = ValueOr(file, kMainSection, kFolderKey, kDefaultGameFolder);
    settings.hotkey = ValueOr(file, kMainSection, kHotkeyKey, kDefaultHotkey);
    for (const PatchCategory& category : Categories()) {
        const std::string fallback = std::to_string(category.defaultValue);
        if (auto value =
                ParseWholeNumber(ValueOr(file, kCategorySection, category.key, fallback))) {
            settings.selection.SetSwitchValue(category.switchIndex, *value);
        }
    }
    // Values are applied one after the other in catalog order, so within a group the last "True"
    // wins and a group read as all "False" keeps no chosen variant.
    for (const VariantGroup& group : Groups()) {
        for (const PatchOption& option : group.options) {
            const std::string_view fallback = option.isDefault ? "True" : "False";
            if (auto value = ParseTruthValue(ValueOr(file, group.section, option.key, fallback))) {
                settings.selection.SetOptionValue(group.array, option.index, *value);
            }
        }
    }
    // The player's own variants come after the catalog's, so a "True" of theirs wins.
    for (const VariantGroup& group : Groups()) {
        for (const AddedVariant& variant : added.Of(group.id)) {
            if (auto value = ParseTruthValue(ValueOr(file, group.section, variant.name, "False"))) {
                settings.selection.SetAddedValue(group.id, variant.name, *value);
            }
        }
    }
    FallBackFromGoneVariants(file, added, settings.selection, gone);
    return status;
}

LoadedSettings LoadSettings(const std::filesystem::path& toolFolder, const AddedVariants& added) {
    LoadedSettings loaded;
    loaded.status = LoadSettings(toolFolder, loaded.settings, added, &loaded.gone);
    return loaded;
}

Status SaveSettings(const std::filesystem::path& toolFolder, const Settings& settings,
                    const AddedVariants& added) {
    IniDocument file;
    Status status = Status::Ok();
    auto set = [&](std::string_view section, std::string_view key, std::string_view value) {
        if (status) {
            status = file.Set(section, key, value);
        }
    };
    set(kMainSection, kFolderKey, settings.gameFolder);
    set(kMainSection, kHotkeyKey, settings.hotkey);
    for (const PatchCategory& category : Categories()) {
        set(kCategorySection, category.key,
            std::to_string(settings.selection.SwitchValue(category.switchIndex)));
    }
    for (const VariantGroup& group : Groups()) {
        for (const PatchOption& option : group.options) {
            set(group.section, option.key,
                settings.selection.OptionValue(group.array, option.index) ? "True" : "False");
        }
    }
    for (const VariantGroup& group : Groups()) {
        for (const AddedVariant& variant : added.Of(group.id)) {
            set(group.section, variant.name,
                settings.selection.AddedValue(group.id, variant.name) ? "True" : "False");
        }
    }
    if (!status) {
        return status;
    }
    return file.Save(SettingsFile(toolFolder));
}

}  // namespace kickvane::catalog
