#pragma once

#include <cstdint>
#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <system_error>
#include <vector>

#include "game/search_report.h"
#include "game/wine_prefix.h"

// What the game managers of Linux know about Windows games: Lutris, Bottles, Heroic, PlayOnLinux,
// Steam (games added to it from outside), Wine's own menu entries, in their usual and their
// Flatpak and Snap locations. Their files are only ever read.
namespace kickvane::game {

// One prefix or game that a manager's configuration names.
struct ManagedPrefix {
    Manager manager = Manager::Wine;
    bool flatpak = false;  // kept by the Flatpak build of the manager
    fs::path prefix;       // the Wine prefix; may be empty where only a program is named
    fs::path executable;   // the program the manager starts for this game, when it names one
    std::string id;        // Lutris: the game's number; Bottles: the bottle's name; Heroic: app
    std::string slug;      // Lutris: the game's short name
    std::string name;      // the name the manager shows
    fs::path configFile;   // where this was read
    fs::path wineProgram;  // the Wine build the manager runs this game with, when it exists
};

// Everything found, in the search order, with the places looked at and the files skipped.
struct ManagerScan {
    std::vector<ManagedPrefix> entries;
    std::vector<std::string> looked;   // configuration folders and files read
    std::vector<SkippedFile> skipped;  // files that could not be used
};

// Configuration files larger than this are skipped rather than read.
inline constexpr size_t kMaxConfigBytes = 4u << 20;

// Reads every manager's configuration, in this order: $WINEPREFIX, ~/.wine, Lutris, Bottles,
// Heroic, PlayOnLinux, Steam, Wine's menu entries. On Windows, where games run natively, there is
// nothing to read and the scan is empty.
ManagerScan ScanGameManagers(const UserFolders& folders);

// Lutris keeps each game's number in its database; nullopt when the database or the row is
// missing (the reason goes to `problem`). `configName` is the game's configuration file name
// without ".yml".
struct LutrisGameRow {
    std::string id;
    std::string slug;
    std::string name;
};
std::optional<LutrisGameRow> ReadLutrisGame(const fs::path& database, std::string_view configName,
                                            std::string* problem);

}  // namespace kickvane::game
