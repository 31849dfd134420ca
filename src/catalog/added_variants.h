#pragma once

#include <array>
#include <filesystem>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "catalog/catalog.h"

// The variants the player adds: folders dropped beside the catalog's sets in a group's folder of
// the tool's "extras" folder. They are found by listing those folders, not fixed like the catalog.
namespace kickvane::catalog {

// The folder of a group below "extras" that holds its variants' sets ("Ball", "scoreboard",
// "adboard", "pitch", "Indicator").
std::string_view GroupFolder(GroupId group);

struct AddedVariant {
    GroupId group;
    std::string name;  // the folder's name (UTF-8): label, settings key and set folder at once

    // The set below "extras", as the catalog writes its own: "\Ball\<name>".
    std::string SourceFolder() const;

    friend bool operator==(const AddedVariant&, const AddedVariant&) = default;
};

// Why an entry of a group's folder is no added variant.
enum class SkipReason {
    Underscore,      // begins with '_', as folders that variants share do
    NotAFolder,      // a file, or a link to nothing
    Empty,           // no file anywhere inside
    Unreadable,      // the folder could not be listed
    NotText,         // the name is no valid UTF-8 text
    NotAKey,         // '=', '[', ']', ';' first, a line end, a backslash, blanks at either end
    CatalogKey,      // the key of a catalog option of the group's settings section
    CaseTwin,        // differs only in letter case from a catalog set or another added one
    TakenInSection,  // an added variant of an earlier group in the same section has the name
};

struct SkippedFolder {
    GroupId group;
    std::string name;  // as the folder lists it; not valid UTF-8 text for NotText
    SkipReason reason;

    friend bool operator==(const SkippedFolder&, const SkippedFolder&) = default;
};

// The group folder itself could not be looked at.
enum class GroupFolderState { Listed, Missing, Unreadable };

class AddedVariants {
public:
    AddedVariants() = default;

    // Lists the group folders of `toolFolder`'s "extras" folder (in any letter case). Hidden
    // names (leading '.') and the pitch's shared "_textures" are passed over silently; every
    // other entry that cannot be a variant is kept among the skipped ones.
    static AddedVariants List(const std::filesystem::path& toolFolder);

    // The added variants of a group in name order (byte order of UTF-8).
    std::span<const AddedVariant> Of(GroupId group) const;
    const AddedVariant* Find(GroupId group, std::string_view name) const;
    std::span<const SkippedFolder> Skipped(GroupId group) const;
    GroupFolderState FolderState(GroupId group) const;
    bool empty() const;

    // For tests and the demo: a list made by hand.
    void Add(AddedVariant variant);

    friend bool operator==(const AddedVariants&, const AddedVariants&) = default;

private:
    std::array<std::vector<AddedVariant>, kGroupCount> added_;
    std::array<std::vector<SkippedFolder>, kGroupCount> skipped_;
    std::array<GroupFolderState, kGroupCount> states_{};
};

// Whether `name` can be written as a settings key and read back as the same key.
bool IsUsableKey(std::string_view name);

}  // namespace kickvane::catalog
