#pragma once

#include <filesystem>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

#include "game/wine_prefix.h"
#include "platform/process.h"

namespace kickvane::game {

// What to run to start the game's launcher.
struct LaunchPlan {
    fs::path program;
    std::vector<std::string> arguments;
    platform::EnvironmentAdditions environment;
    fs::path workingFolder;
    std::string description;  // which way the game is started, for the user
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
