#pragma once

#include <filesystem>
#include <string>
#include <string_view>

#include <vector>

#include "catalog/added_variants.h"
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

// A chosen variant the player had added whose folder is gone: its group fell back to its default.
struct GoneChoice {
    GroupId group;
    std::string name;

    friend bool operator==(const GoneChoice&, const GoneChoice&) = default;
};

// Loads the file into `settings`, key by key in catalog order, then the keys of the variants in
// `added` (each group's after the catalog's, in listing order). A missing file or key gives the
// key's default; a value that cannot be taken over (a switch that is no number, a variant that is
// no truth value) leaves that part of `settings` as it was. A file that exists but cannot be read
// as a settings file (a folder, a device, binary data, too large) gives every key its default
// and a failure with the reason: the user must hear that the choice in use is not theirs.
// A group left with no chosen variant because the "True" key of its section names an added
// variant that is not in `added` any more falls back to its default, and is listed in `gone`.
Status LoadSettings(const std::filesystem::path& toolFolder, Settings& settings,
                    const AddedVariants& added = {}, std::vector<GoneChoice>* gone = nullptr);

// A fresh Settings as the window has them before the load, loaded from the file, and how the
// reading went.
struct LoadedSettings {
    Settings settings;
    Status status = Status::Ok();
    std::vector<GoneChoice> gone;
};
LoadedSettings LoadSettings(const std::filesystem::path& toolFolder,
                            const AddedVariants& added = {});

// Writes the whole file anew: exactly the sections "Thiet lap", "Thay doi", "Bong",
// "Bang Ti So" and "Khac" with their 39 keys, then one key per variant in `added`, at the end of
// its group's section: "True" for the chosen one, "False" for the others. Keys of variants that
// are gone are not written again. The new file replaces the old one only once it is written
// whole; on failure the old file stays and the reason comes back.
Status SaveSettings(const std::filesystem::path& toolFolder, const Settings& settings,
                    const AddedVariants& added = {});

// Gives a group its catalog default, as a load without a settings file does.
void ChooseGroupDefault(PatchSelection& selection, GroupId group);

// How the load reads values: a whole number (e.g. " 1", "-2", "1.5" rounds to even), and a
// truth value ("True"/"False" in any case, or a number: zero is false).
std::optional<int> ParseWholeNumber(std::string_view text);
std::optional<bool> ParseTruthValue(std::string_view text);

}  // namespace kickvane::catalog
