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

// A manager as a player knows it; Wine's own menu entries have no product name.
std::string ManagerText(game::Manager manager) {
    if (manager == game::Manager::WineMenu) {
        return "menu ứng dụng Wine";
    }
    return std::string(game::ManagerName(manager));
}

// A size limit in the unit it was set in: "4 MiB", "512 byte".
std::string SizeText(std::uintmax_t bytes) {
    constexpr std::uintmax_t kMiB = 1u << 20;
    if (bytes >= kMiB && bytes % kMiB == 0) {
        return std::to_string(bytes / kMiB) + " MiB";
    }
    return std::to_string(bytes) + " byte";
}

}  // namespace

std::string SourceText(const game::GameSource& source) {
    using Kind = game::GameSource::Kind;
    switch (source.kind) {
        case Kind::Shortcut:
            return "lối tắt: " + source.place;
        case Kind::Drive:
            return "tìm trên ổ " + source.place;
        case Kind::RegistryEntry:
            if (source.registryFile.empty()) {  // Windows' own registry
                return "sổ đăng ký, mục gỡ cài đặt " + source.place + " (" + source.value + ")";
            }
            break;
        case Kind::ManagerProgram:
        case Kind::PrefixSearch:
            break;
    }
    std::string text = ManagerText(source.manager) + FlatpakNote(source.flatpak);
    if (!source.name.empty()) {
        text += ": " + source.name;
    }
    text += " (" + source.configFile + ")";
    if (source.kind == Kind::PrefixSearch) {
        text += ", tìm trong drive_c";
    } else if (source.kind == Kind::RegistryEntry) {
        text += ", mục gỡ cài đặt trong " + source.registryFile + ": " + source.place + " (" +
                source.value + ")";
    }
    return text;
}

std::string SkippedReasonText(const game::SkippedFile& skipped) {
    switch (skipped.reason) {
        case game::SkipReason::Missing:
            return "không có file này";
        case game::SkipReason::NotAFile:
            return "không phải một file đọc được";
        case game::SkipReason::TooLarge:
            return "quá lớn (trên " + SizeText(skipped.number) + ")";
        case game::SkipReason::Unreadable:
            return "không đọc được: " +
                   text::CauseText({FailedAction::Read, skipped.path, skipped.error, {}}, {});
        case game::SkipReason::NotText:
            return "không phải văn bản";
        case game::SkipReason::Malformed:
            return skipped.number > 0 ? "sai định dạng ở dòng " + std::to_string(skipped.number)
                                      : "sai định dạng";
        case game::SkipReason::TooComplex:
            return "lồng quá sâu hoặc quá nhiều giá trị";
        case game::SkipReason::NotRegistry:
            return "không phải file sổ đăng ký của Wine";
        case game::SkipReason::SearchCut:
            return "dừng tìm ở giới hạn, sau " + std::to_string(skipped.number) + " mục";
    }
    return "bỏ qua";
}

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
    return "qua " + StarterName(plan) + " trong thư mục Wine " + platform::PathToUtf8(plan.prefix) +
           (plan.arch.empty() ? "" : " (" + plan.arch + ")");
}

std::string LaunchFailureText(const game::LaunchPlan& plan, const platform::ProgramState& state,
                              const text::ShownFolders& folders) {
    const std::string head = "Không khởi động được FIFA: ";
    using Kind = platform::ProgramState::Kind;
    switch (state.kind) {
        case Kind::Exited:
            return head + StarterName(plan) + " dừng ngay với mã lỗi " + CodeText(state.code) + ".";
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
