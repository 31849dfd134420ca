#pragma once

#include <filesystem>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "game/game_managers.h"
#include "game/wine_prefix.h"
#include "platform/process.h"

namespace kickvane::game {

// Which program starts the game's launcher.
enum class LaunchWay {
    Direct,   // the launcher itself, a program this system runs
    Lutris,   // Lutris runs its game
    Bottles,  // Bottles runs the launcher in a bottle
    Wine,     // Wine runs the launcher
};

// What to run to start the game's launcher, and which way that is, for the words a player reads.
struct LaunchPlan {
    fs::path program;
    std::vector<std::string> arguments;
    platform::EnvironmentAdditions environment;
    fs::path workingFolder;

    LaunchWay way = LaunchWay::Direct;
    bool flatpak = false;               // Lutris or Bottles: their Flatpak build
    std::optional<Manager> wineKeptBy;  // Wine: the manager whose Wine build it is
    fs::path prefix;                    // Wine: the prefix; empty: the environment's
    std::string arch;                   // Wine: the prefix's "win32" or "win64", when recorded
    std::string gameName;               // Lutris: the game's name (or short name)
    std::string gameId;                 // Lutris: the game's number; Bottles: the bottle
};

enum class LaunchProblem { None, LauncherMissing, WineMissing };

struct LaunchDecision {
    LaunchProblem problem = LaunchProblem::None;
    LaunchPlan plan;
};

// Finds a program by name on PATH; empty when there is none.
using ProgramLookup = std::function<fs::path(const std::string&)>;

// Decides how to start "Gameloader.exe" of the game folder (the user's text: a native path or a
// Windows path in the Wine prefix):
// - a launcher this system runs itself is started directly;
// - a game that Lutris or Bottles knows (its program is this launcher, or the bottle holds it) is
//   started through that manager, the Flatpak build where the manager's files are the Flatpak's;
// - otherwise Wine runs it in the game folder with WINEPREFIX set to the prefix that holds the
//   folder (and WINEARCH where the prefix records it), using the Wine build that Lutris or Heroic
//   keep for that prefix when there is one.
LaunchDecision PlanLaunch(std::string_view gameFolder, const UserFolders& folders,
                          const ProgramLookup& findProgram);

}  // namespace kickvane::game
