#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "game/formats/flat_values.h"
#include "game/game_managers.h"

// What the reader of each game manager's files shares with the others: the user's folders, the
// scan that all of them add to, and the reading of folders and files with every problem named.
namespace kickvane::game::managers {

class ScanContext {
public:
    explicit ScanContext(const UserFolders& folders) : folders_(folders) {}

    const UserFolders& folders() const { return folders_; }
    fs::path Home(std::string_view relative) const { return folders_.home / relative; }
    ManagerScan& scan() { return scan_; }
    ManagerScan Take() { return std::move(scan_); }

    void Looked(const fs::path& place) { scan_.looked.push_back(place.string()); }
    void Add(ManagedPrefix entry) { scan_.entries.push_back(std::move(entry)); }

    // The text of a configuration file; a file that cannot be read is named in `skipped`.
    std::optional<std::string> ReadText(const fs::path& file);

    // A configuration file read and parsed; a file that cannot be read or parsed is named in
    // `skipped`.
    std::optional<FlatValues> ReadConfig(const fs::path& file, Parsed (*parse)(std::string_view));

    // A prefix named by no manager's file ($WINEPREFIX, ~/.wine), when it is a Wine prefix.
    void AddPlainPrefix(const fs::path& prefix, Manager manager, std::string name);

private:
    const UserFolders& folders_;
    ManagerScan scan_;
};

// The entries of a folder whose names end with `suffix` (all when empty): folders or files,
// sorted, at most kMaxFilesPerFolder of them.
inline constexpr size_t kMaxFilesPerFolder = 2000;
std::vector<fs::path> ListFolder(const fs::path& folder, std::string_view suffix, bool folders);

// One reader per manager, each for its usual place and its Flatpak's (and Snap's) where it has
// one.
void ScanLutris(ScanContext& context);
void ScanBottles(ScanContext& context);
void ScanHeroic(ScanContext& context);
void ScanPlayOnLinux(ScanContext& context);
void ScanSteam(ScanContext& context);
void ScanWineMenus(ScanContext& context);

}  // namespace kickvane::game::managers
