#include "session/game_words.h"

#include <cstdio>

#include "platform/filesystem.h"

namespace kickvane::session {

namespace {

std::string FlatpakNote(bool flatpak) {
    return flatpak ? " (Flatpak)" : "";
}

// An exit code as the system writes it: small ones in decimal, Windows' status codes in hex.
std::string CodeText(int code) {
    if (code >= 0 && code <= 255) {
        return std::to_string(code);
    }
    char hex[16];
    std::snprintf(hex, sizeof hex, "0x%08X", static_cast<unsigned>(code));
    return hex;
}

}  // namespace

std::string StarterName(const game::LaunchPlan& plan) {
    switch (plan.way) {
        case game::LaunchWay::Direct:
            return "Gameloader.exe";
        case game::LaunchWay::Lutris:
            return "Lutris" + FlatpakNote(plan.flatpak);
        case game::LaunchWay::Bottles:
            return "Bottles" + FlatpakNote(plan.flatpak);
        case game::LaunchWay::Wine:
            break;
    }
    if (plan.wineKeptBy) {
        return "Wine của " + std::string(game::ManagerName(*plan.wineKeptBy));
    }
    return "Wine";
}

std::string LaunchWayText(const game::LaunchPlan& plan) {
    switch (plan.way) {
        case game::LaunchWay::Direct:
            return "trực tiếp";
        case game::LaunchWay::Lutris:
            return "qua " + StarterName(plan) + ": " + plan.gameName +
                   (plan.gameId.empty() ? "" : " (số " + plan.gameId + ")");
        case game::LaunchWay::Bottles:
            return "qua " + StarterName(plan) + ": " + plan.gameId;
        case game::LaunchWay::Wine:
            break;
    }
    if (plan.prefix.empty()) {
        return "qua " + StarterName(plan) + " trong thư mục Wine mặc định";
    }
    return "qua " + StarterName(plan) + " trong thư mục Wine " +
           platform::PathToUtf8(plan.prefix) + (plan.arch.empty() ? "" : " (" + plan.arch + ")");
}

std::string LaunchFailureText(const game::LaunchPlan& plan, const platform::ProgramState& state,
                              const text::ShownFolders& folders) {
    const std::string head = "Không khởi động được FIFA: ";
    using Kind = platform::ProgramState::Kind;
    switch (state.kind) {
        case Kind::Exited:
            return head + StarterName(plan) + " dừng ngay với mã lỗi " + CodeText(state.code) +
                   ".";
        case Kind::Killed:
            return head + StarterName(plan) + " bị dừng bởi tín hiệu " +
                   std::to_string(state.code) + ".";
        case Kind::NotRun:
            break;
        case Kind::Starting:
        case Kind::Running:
            return head + StarterName(plan) + " không chạy.";  // not a failure; never asked
    }
    const std::string what = text::FailureText(state.failure, folders) + ".";
    if (plan.way == game::LaunchWay::Direct) {
        return head + what;
    }
    return "Không khởi động được FIFA qua " + StarterName(plan) + ": " + what;
}

}  // namespace kickvane::session
