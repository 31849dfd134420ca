#include "catalog/added_variants.h"

#include <algorithm>
#include <system_error>

#include "platform/filesystem.h"
#include "platform/text.h"
#include "text/utf.h"

namespace kickvane::catalog {

namespace fs = std::filesystem;

namespace {

size_t Slot(GroupId group) {
    return static_cast<size_t>(group);
}

// The last name of a catalog option's set folder ("\Ball\UCL 2011" gives "UCL 2011").
std::string_view SetName(const PatchOption& option) {
    const size_t slash = option.sourceFolder.rfind('\\');
    return slash == std::string_view::npos ? option.sourceFolder
                                           : option.sourceFolder.substr(slash + 1);
}

enum class Contents { HasFile, NoFile, Unreadable };

// Whether a folder holds a file anywhere inside, links to folders followed. The walk is bounded
// in depth and in entries, so a link that leads back up or a huge tree cannot hold the start up;
// a tree too big to finish looking through counts as holding files.
Contents LookForFile(const fs::path& folder, int depth, int& budget) {
    std::error_code ec;
    fs::directory_iterator it(folder, ec);
    if (ec) {
        return Contents::Unreadable;
    }
    std::vector<fs::path> subfolders;
    for (fs::directory_iterator end; !ec && it != end; it.increment(ec)) {
        if (--budget <= 0) {
            return Contents::HasFile;
        }
        std::error_code statusError;
        const fs::file_status status = fs::status(it->path(), statusError);
        if (fs::is_regular_file(status)) {
            return Contents::HasFile;
        }
        if (fs::is_directory(status)) {
            subfolders.push_back(it->path());
        }
    }
    if (depth <= 0) {
        return subfolders.empty() ? Contents::NoFile : Contents::HasFile;
    }
    for (const fs::path& subfolder : subfolders) {
        if (LookForFile(subfolder, depth - 1, budget) == Contents::HasFile) {
            return Contents::HasFile;
        }
    }
    return Contents::NoFile;
}

bool KeyOfSection(std::string_view section, std::string_view name) {
    for (const VariantGroup& group : Groups()) {
        if (group.section != section) {
            continue;
        }
        for (const PatchOption& option : group.options) {
            if (platform::NamesEqualIgnoringCase(option.key, name)) {
                return true;
            }
        }
    }
    return false;
}

}  // namespace

std::string_view GroupFolder(GroupId group) {
    switch (group) {
        case GroupId::Ball:
            return "Ball";
        case GroupId::Scoreboard:
            return "scoreboard";
        case GroupId::Adboard:
            return "adboard";
        case GroupId::Pitch:
            return "pitch";
        case GroupId::Mark:
            break;
    }
    return "Indicator";
}

std::string AddedVariant::SourceFolder() const {
    return "\\" + std::string(GroupFolder(group)) + "\\" + name;
}

bool IsUsableKey(std::string_view name) {
    if (name.empty() || name.front() == ';' || platform::TrimBlanks(name) != name) {
        return false;
    }
    return name.find_first_of(std::string_view("=[]\r\n\\/\0", 9)) == std::string_view::npos;
}

AddedVariants AddedVariants::List(const fs::path& toolFolder) {
    AddedVariants list;
    const fs::path extras =
        platform::FindEntryIgnoringCase(toolFolder, "extras").value_or(toolFolder / "extras");
    for (const VariantGroup& group : Groups()) {
        const size_t slot = Slot(group.id);
        const std::optional<fs::path> folder =
            platform::FindEntryIgnoringCase(extras, GroupFolder(group.id));
        if (!folder || !platform::IsDirectory(*folder)) {
            list.states_[slot] = GroupFolderState::Missing;
            continue;
        }
        std::error_code ec;
        fs::directory_iterator it(*folder, ec);
        std::vector<std::pair<std::string, fs::path>> entries;
        for (fs::directory_iterator end; !ec && it != end; it.increment(ec)) {
            entries.emplace_back(platform::PathToUtf8(it->path().filename()), it->path());
        }
        if (ec) {
            // What was listed before the failure still counts.
            list.states_[slot] = GroupFolderState::Unreadable;
        }
        std::sort(entries.begin(), entries.end());

        auto skip = [&](const std::string& name, SkipReason reason) {
            list.skipped_[slot].push_back({group.id, name, reason});
        };
        auto isCatalogSet = [&](std::string_view name) {
            return std::any_of(group.options.begin(), group.options.end(),
                               [&](const PatchOption& o) {
                                   return !o.sourceFolder.empty() && SetName(o) == name;
                               });
        };
        // The folder that stands for each catalog set, as the copy finds it: the exact spelling,
        // else the first in name order that differs only in letter case.
        std::vector<std::string> catalogStandIns;
        for (const auto& entry : entries) {
            const std::string& name = entry.first;
            const fs::path& path = entry.second;
            if (name.starts_with('.') || (group.id == GroupId::Pitch && name == "_textures")) {
                continue;
            }
            if (name.starts_with('_')) {
                skip(name, SkipReason::Underscore);
                continue;
            }
            if (!text::IsValidUtf8(name)) {
                skip(name, SkipReason::NotText);
                continue;
            }
            std::error_code statusError;
            const fs::file_status status = fs::status(path, statusError);
            if (!fs::is_directory(status)) {
                const bool denied = statusError == std::errc::permission_denied;
                skip(name, denied ? SkipReason::Unreadable : SkipReason::NotAFolder);
                continue;
            }
            if (isCatalogSet(name)) {
                continue;
            }
            const PatchOption* twinOf = nullptr;
            for (const PatchOption& option : group.options) {
                if (!option.sourceFolder.empty() &&
                    platform::NamesEqualIgnoringCase(SetName(option), name)) {
                    twinOf = &option;
                }
            }
            if (twinOf) {
                const std::string_view set = SetName(*twinOf);
                const bool exactExists =
                    std::any_of(entries.begin(), entries.end(),
                                [&](const auto& other) { return other.first == set; });
                const bool standInTaken =
                    std::any_of(catalogStandIns.begin(), catalogStandIns.end(),
                                [&](const std::string& s) { return s == set; });
                if (exactExists || standInTaken) {
                    skip(name, SkipReason::CaseTwin);
                } else {
                    catalogStandIns.emplace_back(set);  // the catalog's set under this spelling
                }
                continue;
            }
            if (!IsUsableKey(name)) {
                skip(name, SkipReason::NotAKey);
                continue;
            }
            if (KeyOfSection(group.section, name)) {
                skip(name, SkipReason::CatalogKey);
                continue;
            }
            const auto sameKey = [&](const AddedVariant& v) {
                return platform::NamesEqualIgnoringCase(v.name, name);
            };
            if (std::any_of(list.added_[slot].begin(), list.added_[slot].end(), sameKey)) {
                skip(name, SkipReason::CaseTwin);
                continue;
            }
            bool taken = false;
            for (const VariantGroup& earlier : Groups()) {
                if (earlier.id == group.id) {
                    break;
                }
                const auto& others = list.added_[Slot(earlier.id)];
                taken = taken || (earlier.section == group.section &&
                                  std::any_of(others.begin(), others.end(), sameKey));
            }
            if (taken) {
                skip(name, SkipReason::TakenInSection);
                continue;
            }
            int budget = 10000;
            switch (LookForFile(path, 8, budget)) {
                case Contents::HasFile:
                    list.added_[slot].push_back({group.id, name});
                    break;
                case Contents::NoFile:
                    skip(name, SkipReason::Empty);
                    break;
                case Contents::Unreadable:
                    skip(name, SkipReason::Unreadable);
                    break;
            }
        }
    }
    return list;
}

std::span<const AddedVariant> AddedVariants::Of(GroupId group) const {
    return added_[Slot(group)];
}

const AddedVariant* AddedVariants::Find(GroupId group, std::string_view name) const {
    for (const AddedVariant& variant : added_[Slot(group)]) {
        if (variant.name == name) {
            return &variant;
        }
    }
    return nullptr;
}

std::span<const SkippedFolder> AddedVariants::Skipped(GroupId group) const {
    return skipped_[Slot(group)];
}

GroupFolderState AddedVariants::FolderState(GroupId group) const {
    return states_[Slot(group)];
}

bool AddedVariants::empty() const {
    return std::all_of(added_.begin(), added_.end(), [](const auto& v) { return v.empty(); });
}

void AddedVariants::Add(AddedVariant variant) {
    added_[Slot(variant.group)].push_back(std::move(variant));
}

}  // namespace kickvane::catalog
