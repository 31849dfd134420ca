#pragma once

#include <atomic>
#include <filesystem>
#include <string>
#include <vector>

#include "game/game_managers.h"
#include "game/wine_prefix.h"

namespace kickvane::game {

// A folder that holds the game's launcher, and how it was found.
struct FoundGame {
    fs::path folder;
    fs::path prefix;    // the Wine prefix it lies in; empty when none
    GameSource source;  // e.g. Lutris's entry "FIFA Online 2", then the search of its drive_c
};

struct FindOutcome {
    std::vector<FoundGame> games;      // in the search order, each folder once
    std::vector<std::string> looked;   // prefixes and configuration files looked at
    std::vector<SkippedFile> skipped;  // what could not be read, and why
    bool cutShort = false;             // a prefix's search reached its limits
    bool cancelled = false;
};

// Looks for "Gameloader.exe". On Linux, where players keep Windows games: $WINEPREFIX, ~/.wine,
// Lutris, Bottles, Heroic, PlayOnLinux, Steam's prefixes, Wine's menu entries; in each prefix the
// install folders that its registry records come first, then a bounded search of drive_c. On
// Windows (`folders` unused): the install folders of the registry's uninstall entries, the
// shortcuts on the desktop and in the Start menu that start a Gameloader.exe, then every fixed
// drive's top folders (Program Files and those named like "Games" first), four levels deep, within
// `limits`' time and entries, skipping Windows and links. Nothing is written anywhere. `cancel`,
// when given, ends the search early.
FindOutcome FindGame(const UserFolders& folders, const SearchLimits& limits,
                     const std::atomic<bool>* cancel = nullptr);

}  // namespace kickvane::game
