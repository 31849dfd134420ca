#include "session/game_words.h"

#include <gtest/gtest.h>

#include <set>
#include <sstream>

namespace kickvane::session {
namespace {

using game::GameSource;
using game::LaunchWay;
using game::Manager;
using game::SkipReason;
using Kind = platform::ProgramState::Kind;

const std::error_code kDenied = std::make_error_code(std::errc::permission_denied);

// Words a text may hold that carry no mark: names of programs and files, Vietnamese words
// written without one, units.
const std::set<std::string> kPlainWords = {
    // outside names
    "Wine", "Lutris", "Bottles", "Heroic", "PlayOnLinux", "Steam", "Flatpak", "FIFA",
    "Gameloader.exe", "drive_c", "system.reg", "user.reg", "InstallLocation", "DisplayIcon",
    "UninstallString", "win64", "MiB", "byte", "HKEY_LOCAL_MACHINE",
    // the test's own names
    "Online", "FO2", "fifa", "An",
    // Vietnamese without marks
    "trong", "qua", "file", "menu", "sau", "sai", "ngay", "tin", "con"};

bool HasMark(const std::string& text) {
    for (const unsigned char c : text) {
        if (c >= 0x80) {
            return true;
        }
    }
    return false;
}

// The words of `text` that are neither Vietnamese (with their marks or in kPlainWords) nor
// numbers, paths or keys.
std::vector<std::string> ForeignWords(const std::string& text) {
    std::vector<std::string> foreign;
    std::istringstream words(text);
    for (std::string word; words >> word;) {
        // Punctuation around a word: "(win64)", "lỗi:", "3.".
        while (!word.empty() && word.front() == '(') {
            word.erase(0, 1);
        }
        while (!word.empty() && std::string_view("):,.").find(word.back()) != std::string::npos &&
               word != "D:\\") {
            word.pop_back();
        }
        const bool path = word.find_first_of("/\\~") != std::string::npos;
        const bool number =
            word.find_first_not_of("0123456789x") == std::string::npos || word.starts_with("0x");
        if (!HasMark(word) && !path && !number && !kPlainWords.contains(word)) {
            foreign.push_back(word);
        }
    }
    return foreign;
}

// Every text, and whether it adds words of its own (a manager's entry alone is only names).
std::vector<std::pair<std::string, bool>> AllTexts() {
    std::vector<std::pair<std::string, bool>> texts;
    // Where a find came from: every kind, on Linux with every manager.
    for (const Manager manager : {Manager::Wine, Manager::Lutris, Manager::Bottles, Manager::Heroic,
                                  Manager::PlayOnLinux, Manager::Steam, Manager::WineMenu}) {
        for (const GameSource::Kind kind :
             {GameSource::Kind::ManagerProgram, GameSource::Kind::RegistryEntry,
              GameSource::Kind::PrefixSearch}) {
            GameSource source;
            source.kind = kind;
            source.manager = manager;
            source.flatpak = manager == Manager::Bottles;
            source.name = "FIFA Online 2";
            source.configFile = "~/.config/x/fifa.yml";
            source.registryFile = "system.reg";
            source.place = "Software\\Microsoft\\Windows\\CurrentVersion\\Uninstall\\FO2";
            source.value = "InstallLocation";
            texts.emplace_back(SourceText(source), kind != GameSource::Kind::ManagerProgram ||
                                                       manager == Manager::WineMenu);
        }
    }
    GameSource windows;
    windows.kind = GameSource::Kind::RegistryEntry;
    windows.place =
        "HKEY_LOCAL_MACHINE\\Software\\Microsoft\\Windows\\CurrentVersion\\Uninstall\\FO2";
    windows.value = "UninstallString";
    texts.emplace_back(SourceText(windows), true);
    windows.kind = GameSource::Kind::Shortcut;
    windows.place = "C:\\Users\\An\\Desktop\\FIFA.lnk";
    texts.emplace_back(SourceText(windows), true);
    windows.kind = GameSource::Kind::Drive;
    windows.place = "D:\\";
    texts.emplace_back(SourceText(windows), true);

    // Why a file was skipped: every reason.
    for (const SkipReason reason :
         {SkipReason::Missing, SkipReason::NotAFile, SkipReason::TooLarge, SkipReason::Unreadable,
          SkipReason::NotText, SkipReason::Malformed, SkipReason::TooComplex,
          SkipReason::NotRegistry, SkipReason::SearchCut}) {
        game::SkippedFile skipped{"/home/an/.config/x/fifa.yml", reason, 4u << 20, kDenied,
                                  "parse error at line 1"};
        texts.emplace_back(SkippedReasonText(skipped), true);
    }

    // Which way a start went, and how it failed.
    for (const LaunchWay way :
         {LaunchWay::Direct, LaunchWay::Lutris, LaunchWay::Bottles, LaunchWay::Wine}) {
        for (const bool managersWine : {false, true}) {
            game::LaunchPlan plan;
            plan.way = way;
            plan.gameName = "FIFA Online 2";
            plan.gameId = "42";
            if (managersWine) {
                plan.wineKeptBy = Manager::Lutris;
                plan.prefix = "/home/an/Games/fifa";
                plan.arch = "win64";
            }
            texts.emplace_back(LaunchWayText(plan), true);
            for (const Kind kind : {Kind::Exited, Kind::Killed, Kind::NotRun}) {
                platform::ProgramState state{kind, kind == Kind::Killed ? 9 : 3, {}};
                const auto missing = std::make_error_code(std::errc::no_such_file_or_directory);
                state.failure = {FailedAction::Run, "/usr/bin/wine", missing, {}};
                texts.emplace_back(LaunchFailureText(plan, state, {}), true);
            }
        }
    }
    return texts;
}

// Every source, reason and way has its words in Vietnamese, with its marks where it adds words of
// its own, and no English word is left.
TEST(GameWords, EveryValueIsWordedInVietnamese) {
    for (const auto& [text, ownWords] : AllTexts()) {
        SCOPED_TRACE(text);
        EXPECT_FALSE(text.empty());
        EXPECT_EQ(ForeignWords(text), std::vector<std::string>{});
        // "qua Bottles: 42" is Vietnamese with no mark to show it.
        EXPECT_EQ(HasMark(text) || text.starts_with("qua "), ownWords);
    }
}

// The words hold what a player needs to act: the program that failed and its code, the file's line.
TEST(GameWords, FailuresNameTheProgramAndTheirDetail) {
    game::LaunchPlan plan;
    plan.way = LaunchWay::Wine;
    plan.wineKeptBy = Manager::Heroic;
    EXPECT_EQ(LaunchFailureText(plan, {Kind::Exited, 3, {}}, {}),
              "Không khởi động được FIFA: Wine của Heroic dừng ngay với mã lỗi 3.");
    EXPECT_EQ(LaunchFailureText(plan, {Kind::Exited, static_cast<int>(0xC0000135), {}}, {}),
              "Không khởi động được FIFA: Wine của Heroic dừng ngay với mã lỗi 0xC0000135.");
    plan.way = LaunchWay::Direct;
    platform::ProgramState notRun{Kind::NotRun, 0, {}};
    const std::filesystem::path game = std::filesystem::current_path() / "fifa";
    notRun.failure = {FailedAction::Run, game / "Gameloader.exe", kDenied, {}};
    EXPECT_EQ(LaunchFailureText(plan, notRun, {game, {}}),
              "Không khởi động được FIFA: không chạy được Gameloader.exe: không có quyền chạy.");

    game::SkippedFile malformed{"/x.json", SkipReason::Malformed, 7, {}, {}};
    EXPECT_EQ(SkippedReasonText(malformed), "sai định dạng ở dòng 7");
    malformed.number = 0;
    EXPECT_EQ(SkippedReasonText(malformed), "sai định dạng");
    game::SkippedFile unreadable{"/x.json", SkipReason::Unreadable, 0, kDenied, {}};
    EXPECT_EQ(SkippedReasonText(unreadable), "không đọc được: không có quyền đọc");
}

}  // namespace
}  // namespace kickvane::session
