#pragma once

#include <chrono>
#include <functional>
#include <memory>
#include <string_view>

#include "game/launch_plan.h"
#include "platform/process.h"

namespace kickvane::game {

inline constexpr std::string_view kLauncherMissingVni =
    "Kho6ng ti2m tha61y Gameloader.exe hoa85c d9u7o72ng da64n kho6ng chi1nh xa1c!";
inline constexpr std::string_view kWineMissingText =
    "Không chạy được Gameloader.exe: máy chưa cài Wine. Hãy cài Wine (gói wine) rồi thử lại.";

// A start of the game's launcher: why nothing was started, or the plan and a watch on the
// program that was started for it.
struct LaunchStart {
    LaunchProblem problem = LaunchProblem::None;
    LaunchPlan plan;
    std::unique_ptr<platform::ProgramWatch> program;  // set when problem is None
};

// Starts "Gameloader.exe" from the game folder without waiting, with the game folder as the
// working folder, the way PlanLaunch decides (through the game's manager, or Wine in the game's
// own prefix; a file that this system can run itself directly).
LaunchStart LaunchGame(std::string_view gameFolder);

// How long a started program is watched: one that fails within this time (a missing Wine
// prefix, a game manager that cannot find its game) is reported, one that still runs has started.
inline constexpr std::chrono::milliseconds kLaunchWatchTime{2000};
// How often the watch looks at the program while it waits.
inline constexpr std::chrono::milliseconds kLaunchWatchInterval{100};

enum class LaunchVerdict {
    Watching,  // no decision yet
    Started,   // still running at the end of the watch, or ended with code 0
    Failed,    // could not be run, or ended with another code or by a signal within the watch
};

// Decides whether a started program has started the game, from what a watch says at each tick.
// A program that ends at once with code 0 counts as started: a game manager hands the game over
// to its copy that already runs, and ends. Time comes from `now`, so tests drive it.
class LaunchWatch {
public:
    using Clock = std::function<std::chrono::steady_clock::time_point()>;

    LaunchWatch(std::unique_ptr<platform::ProgramWatch> program, Clock now,
                std::chrono::milliseconds watchTime = kLaunchWatchTime);

    // Looks at the program once. Once decided, the verdict stays and the watch on the program is
    // let go (the program goes on by itself).
    LaunchVerdict Tick();
    LaunchVerdict Verdict() const { return verdict_; }
    // The program's state when the verdict was reached (for a failure: its code or its cause).
    const platform::ProgramState& State() const { return state_; }

private:
    std::unique_ptr<platform::ProgramWatch> program_;
    Clock now_;
    std::chrono::steady_clock::time_point deadline_;
    LaunchVerdict verdict_ = LaunchVerdict::Watching;
    platform::ProgramState state_;
};

}  // namespace kickvane::game
