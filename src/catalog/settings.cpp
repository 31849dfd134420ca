#include "catalog/settings.h"

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

Status LoadSettings(const std::filesystem::path& toolFolder, Settings& settings) {
    IniDocument file;
    Status status = IniDocument::Read(SettingsFile(toolFolder), &file);
    settings.gameFolder = ValueOr(file, kMainSection, kFolderKey, kDefaultGameFolder);
    settings.hotkey = ValueOr(file, kMainSection, kHotkeyKey, kDefaultHotkey);
    for (const PatchCategory& category : Categories()) {
        const std::string fallback = std::to_string(category.defaultValue);
        if (auto value =
                ParseWholeNumber(ValueOr(file, kCategorySection, category.key, fallback))) {
            settings.selection.setSwitchValue(category.switchIndex, *value);
        }
    }
    // Values are applied one after the other in catalog order, so within a group the last "True"
    // wins and a group read as all "False" keeps no chosen variant.
    for (const VariantGroup& group : Groups()) {
        for (const PatchOption& option : group.options) {
            const std::string_view fallback = option.isDefault ? "True" : "False";
            if (auto value = ParseTruthValue(ValueOr(file, group.section, option.key, fallback))) {
                settings.selection.setOptionValue(group.array, option.index, *value);
            }
        }
    }
    return status;
}

LoadedSettings LoadSettings(const std::filesystem::path& toolFolder) {
    LoadedSettings loaded;
    loaded.status = LoadSettings(toolFolder, loaded.settings);
    return loaded;
}

Status SaveSettings(const std::filesystem::path& toolFolder, const Settings& settings) {
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
            std::to_string(settings.selection.switchValue(category.switchIndex)));
    }
    for (const VariantGroup& group : Groups()) {
        for (const PatchOption& option : group.options) {
            set(group.section, option.key,
                settings.selection.optionValue(group.array, option.index) ? "True" : "False");
        }
    }
    if (!status) {
        return status;
    }
    return file.Save(SettingsFile(toolFolder));
}

}  // namespace kickvane::catalog
