#pragma once

#include <string>
#include <string_view>

#include <optional>

#include "text/message.h"

namespace kickvane::game {

inline constexpr std::string_view kLauncherMissingVni =
    "Kho6ng ti2m tha61y Gameloader.exe hoa85c d9u7o72ng da64n kho6ng chi1nh xa1c!";
inline constexpr std::string_view kWineMissingText =
    "Không chạy được Gameloader.exe: máy chưa cài Wine. Hãy cài Wine (gói wine) rồi thử lại.";
inline constexpr std::string_view kStartFailedText = "Không chạy được Gameloader.exe: ";

enum class LaunchResult { Started, LauncherMissing, WineMissing, StartFailed };

struct LaunchOutcome {
    LaunchResult result = LaunchResult::Started;
    std::optional<text::Message> message;  // why it did not start
    std::string startedThrough;            // which way it started, for the user

    bool started() const { return result == LaunchResult::Started; }
};

// Starts "Gameloader.exe" from the game folder without waiting, with the game folder as the
// working folder, the way PlanLaunch decides (through the game's manager, or Wine in the game's
// own prefix; a file that this system can run itself directly). When it cannot start, the
// outcome says why in a message for the user.
LaunchOutcome LaunchGame(std::string_view gameFolder);

}  // namespace kickvane::game
