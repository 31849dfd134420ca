#pragma once

#include <filesystem>
#include <string>
#include <string_view>

#include "catalog/selection.h"
#include "platform/status.h"

namespace kickvane::catalog {

inline constexpr std::string_view kSettingsFileName = "ThietLap.ini";
inline constexpr std::string_view kDefaultGameFolder = "C:\\Program Files";
inline constexpr std::string_view kDefaultHotkey = "F7";

// What the settings file keeps for the user.
struct Settings {
    std::string gameFolder;
    std::string hotkey;
    PatchSelection selection;
};

// The settings file of a tool folder, under whatever letter case it exists ("Thietlap.ini" is
// the same file); "ThietLap.ini" when there is none yet.
std::filesystem::path SettingsFile(const std::filesystem::path& toolFolder);

// Loads the file into `settings`, key by key in catalog order. A missing file or key gives the
// key's default; a value that cannot be taken over (a switch that is no number, a variant that is
// no truth value) leaves that part of `settings` as it was. A file that exists but cannot be read
// as a settings file (a folder, a device, binary data, too large) gives every key its default
// and a failure with the reason: the user must hear that the choice in use is not theirs.
Status LoadSettings(const std::filesystem::path& toolFolder, Settings& settings);

// A fresh Settings as the window has them before the load, loaded from the file, and how the
// reading went.
struct LoadedSettings {
    Settings settings;
    Status status = Status::Ok();
};
LoadedSettings LoadSettings(const std::filesystem::path& toolFolder);

// Writes the whole file anew: exactly the sections "Thiet lap", "Thay doi", "Bong",
// "Bang Ti So" and "Khac" with their 39 keys. The new file replaces the old one only once it is
// written whole; on failure the old file stays and the reason comes back.
Status SaveSettings(const std::filesystem::path& toolFolder, const Settings& settings);

// How the load reads values: a whole number (e.g. " 1", "-2", "1.5" rounds to even), and a
// truth value ("True"/"False" in any case, or a number: zero is false).
std::optional<int> ParseWholeNumber(std::string_view text);
std::optional<bool> ParseTruthValue(std::string_view text);

}  // namespace kickvane::catalog
