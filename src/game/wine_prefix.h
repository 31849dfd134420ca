#pragma once

#include <atomic>
#include <chrono>
#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "game/search_report.h"

// Wine prefixes: the folders with "drive_c", the registry files and the "dosdevices" drive links
// in which Windows programs live on Linux.
namespace kickvane::game {

namespace fs = std::filesystem;

// The user's folders that the search and the launch look at, read from the environment once so
// that tests can give folders of their own.
struct UserFolders {
    fs::path home;
    fs::path configHome;  // $XDG_CONFIG_HOME, else ~/.config
    fs::path dataHome;    // $XDG_DATA_HOME, else ~/.local/share
    fs::path winePrefix;  // $WINEPREFIX; empty when unset

    static UserFolders FromEnvironment();
};

// Registry files larger than this are skipped rather than read.
inline constexpr size_t kMaxRegistryBytes = 64u << 20;

// The path with links and "." and ".." resolved as far as it exists; lexically normal otherwise.
fs::path CanonicalOrNormal(const fs::path& path);

// True when `folder` is `parent` or lies below it (both canonical).
bool IsWithinFolder(const fs::path& folder, const fs::path& parent);

// A folder with "drive_c" and at least one of "system.reg" and "user.reg".
bool IsWinePrefix(const fs::path& folder);

// The nearest folder, from `folder` itself upwards, that is a Wine prefix.
std::optional<fs::path> FindPrefixHolding(const fs::path& folder);

// The prefix whose "dosdevices" drive link (other than the one for the whole file system, "z:")
// leads to a folder that holds `folder`; the first of `prefixes` that has one.
std::optional<fs::path> FindPrefixMapping(const fs::path& folder,
                                          const std::vector<fs::path>& prefixes);

// "win32" or "win64" as the prefix's registry records it; empty when it records none.
std::string ReadPrefixArch(const fs::path& prefix);

// A place the registry of a prefix names as a program's install folder.
struct RecordedInstall {
    std::string windowsFolder;  // as recorded, a folder (for DisplayIcon: the icon file's folder)
    std::string registryFile;   // "system.reg" or "user.reg"
    std::string key;            // the uninstall entry's key: "...\Uninstall\FIFA Online 2"
    std::string valueName;      // "InstallLocation" or "DisplayIcon"
};

// The install folders recorded in the prefix's uninstall entries (InstallLocation and the folder
// of DisplayIcon, also under Wow6432Node). A registry file that cannot be read, is malformed or is
// too large is named in `skipped`.
std::vector<RecordedInstall> ReadRecordedInstalls(const fs::path& prefix,
                                                  std::vector<SkippedFile>& skipped);

// Bounds of one search of a drive_c tree.
struct SearchLimits {
    int maxDepth = 8;
    size_t maxEntries = 200000;
    std::chrono::milliseconds maxTime{4000};
};

struct TreeSearch {
    std::vector<fs::path> folders;  // folders that hold a file named like `fileName`
    bool cutShort = false;          // a limit was reached or the search was cancelled
    size_t entriesSeen = 0;
};

// Breadth-first search of `root` for files named `fileName` without regard to letter case. Links
// to folders are not followed (drive links and home folder links would lead out of the tree or
// round in circles); unreadable folders are passed over; "windows" at the top is skipped. Stops at
// the limits or when `cancel` becomes true.
TreeSearch SearchTreeForFile(const fs::path& root, std::string_view fileName,
                             const SearchLimits& limits, const std::atomic<bool>* cancel);

}  // namespace kickvane::game
