#include "game/find_game.h"

#include <gtest/gtest.h>

#include <map>

#include "game/fake_home.h"
#include "game/game_managers.h"

namespace kickvane::game {
namespace {

namespace fs = std::filesystem;
using testing::FakeHome;
using testing::WriteFile;

std::vector<std::string> SourcesOf(const FindOutcome& outcome) {
    std::vector<std::string> sources;
    for (const FoundGame& game : outcome.games) {
        sources.push_back(std::string(ManagerName(game.source.manager)) + ": " + game.source.name);
    }
    return sources;
}

// The reason a file of this name was skipped for; nullopt when none was.
std::optional<SkipReason> SkipOf(const FindOutcome& outcome, const std::string& name) {
    for (const SkippedFile& skipped : outcome.skipped) {
        if (skipped.path.filename() == name) {
            return skipped.reason;
        }
    }
    return std::nullopt;
}

// Every entry under `root` with the size and time of its files, to prove that nothing was written.
std::map<fs::path, std::string> Snapshot(const fs::path& root) {
    std::map<fs::path, std::string> entries;
    for (auto it = fs::recursive_directory_iterator(root); it != fs::recursive_directory_iterator();
         ++it) {
        if (it->is_symlink()) {
            it.disable_recursion_pending();
        }
        entries[it->path()] =
            it->is_regular_file() && !it->is_symlink()
                ? std::to_string(it->file_size()) + "@" +
                      std::to_string(it->last_write_time().time_since_epoch().count())
                : "";
    }
    return entries;
}

// One fake home with a game in every kind of place, and broken files among them.
class FindGameTest : public ::testing::Test {
protected:
    void SetUp() override {
        // ~/.wine: the registry records a folder on drive d:, outside drive_c.
        const fs::path wine = home_.MakePrefix(
            ".wine", "win32",
            "[Software\\\\Wow6432Node\\\\Microsoft\\\\Windows\\\\CurrentVersion\\\\Uninstall\\\\"
            "FO2] 1\n\"DisplayIcon\"=\"D:\\\\Games\\\\FIFA Online 2\\\\GameLoader.EXE,0\"\n");
        FakeHome::MakeGame(home_ / "disk-d/Games/FIFA Online 2", "GameLoader.EXE");
        fs::create_directory_symlink(home_ / "disk-d", wine / "dosdevices/d:");

        // Lutris: a game whose exe is the launcher, and a broken configuration.
        const fs::path lutrisPrefix = home_.MakePrefix("Games/fifa-online-2");
        FakeHome::MakeGame(lutrisPrefix / "drive_c/Program Files/FIFA");
        WriteFile(home_ / ".config/lutris/games/fifa-online-2-1700000000.yml",
                  "game:\n  exe: " +
                      (lutrisPrefix / "drive_c/Program Files/FIFA/Gameloader.exe").string() +
                      "\n  prefix: " + lutrisPrefix.string() + "\nwine:\n  version: lutris-7\n");
        WriteFile(home_ / ".local/share/lutris/games/broken.yml", std::string("\0\1\2garbage", 10));

        // Bottles kept elsewhere through placeholder.yml; the game is found in drive_c.
        const fs::path bottle = home_.MakePrefix("elsewhere/fifa-bottle");
        WriteFile(bottle / "bottle.yml", "Name: fifa-bottle\nArch: win64\n");
        FakeHome::MakeGame(bottle / "drive_c/users/me/FO2", "gameloader.exe");
        WriteFile(
            home_ /
                ".var/app/com.usebottles.bottles/data/bottles/bottles/fifa-bottle/placeholder.yml",
            "Path: " + bottle.string() + "\n");

        // Heroic: a sideloaded game with its prefix in GamesConfig; a broken JSON file.
        const fs::path heroicPrefix = home_.MakePrefix("Games/Heroic/Prefixes/fo2");
        FakeHome::MakeGame(heroicPrefix / "drive_c/Heroic FO2");
        WriteFile(home_ / ".config/heroic/GamesConfig/abc.json",
                  "{\"abc\": {\"winePrefix\": \"" + heroicPrefix.string() + "\"}}");
        WriteFile(home_ / ".config/heroic/GamesConfig/bad.json", "{\"bad\": ");
        WriteFile(home_ / ".config/heroic/sideload_apps/library.json",
                  "{\"games\": [{\"app_name\": \"abc\", \"title\": \"FIFA Heroic\", \"install\": "
                  "{\"executable\": \"" +
                      (heroicPrefix / "drive_c/Heroic FO2/Gameloader.exe").string() + "\"}}]}");

        // A Steam library named in libraryfolders.vdf. (PlayOnLinux: the find-game command's test.)
        WriteFile(
            home_ / ".local/share/Steam/steamapps/libraryfolders.vdf",
            "\"libraryfolders\" { \"1\" { \"path\" \"" + (home_ / "lib2").string() + "\" } }");
        FakeHome::MakeGame(home_.MakePrefix("lib2/steamapps/compatdata/3000000000/pfx") /
                           "drive_c/Steam FO2");

        // A huge registry file is skipped, not read.
        const fs::path huge = home_.MakePrefix(".local/share/wineprefixes/huge");
        fs::resize_file(huge / "user.reg", kMaxRegistryBytes + 1);
        WriteFile(home_ / ".local/share/applications/wine/Programs/FIFA.desktop",
                  "[Desktop Entry]\nName=FIFA\nExec=env WINEPREFIX=\"" + huge.string() +
                      "\" wine C:\\\\\\\\x.lnk\n");
    }

    FakeHome home_;
};

TEST_F(FindGameTest, FindsEveryPlaceInOrder_NamesSources_SkipsBrokenFiles_AndWritesNothing) {
    const auto before = Snapshot(home_.home());
    const FindOutcome outcome = FindGame(home_.folders(), SearchLimits{});
    EXPECT_EQ(Snapshot(home_.home()), before);

    ASSERT_EQ(outcome.games.size(), 5u) << ::testing::PrintToString(SourcesOf(outcome));
    EXPECT_EQ(outcome.games[0].folder, fs::canonical(home_ / "disk-d/Games/FIFA Online 2"));
    const GameSource& recorded = outcome.games[0].source;
    EXPECT_EQ(recorded.kind, GameSource::Kind::RegistryEntry);
    EXPECT_EQ(recorded.manager, Manager::Wine);
    EXPECT_EQ(recorded.configFile, "~/.wine");
    EXPECT_EQ(recorded.registryFile, "system.reg");
    EXPECT_EQ(recorded.place,
              "Software\\Wow6432Node\\Microsoft\\Windows\\CurrentVersion\\Uninstall\\FO2");
    EXPECT_EQ(recorded.value, "DisplayIcon");
    EXPECT_EQ(outcome.games[1].folder,
              fs::canonical(home_ / "Games/fifa-online-2/drive_c/Program Files/FIFA"));
    EXPECT_EQ(outcome.games[1].source.kind, GameSource::Kind::ManagerProgram);
    EXPECT_EQ(outcome.games[1].source.configFile,
              "~/.config/lutris/games/fifa-online-2-1700000000.yml");
    EXPECT_EQ(outcome.games[2].source.kind, GameSource::Kind::PrefixSearch);
    EXPECT_TRUE(outcome.games[2].source.flatpak);
    EXPECT_EQ(outcome.games[2].source.configFile, "~/elsewhere/fifa-bottle/bottle.yml");
    EXPECT_EQ(SourcesOf(outcome),
              (std::vector<std::string>{"Wine: ~/.wine", "Lutris: fifa-online-2",
                                        "Bottles: fifa-bottle", "Heroic: FIFA Heroic",
                                        "Steam: " + outcome.games[4].source.name}));
    EXPECT_TRUE(outcome.games[4].source.name.starts_with("3000000000"));
    EXPECT_EQ(outcome.games[4].prefix, home_ / "lib2/steamapps/compatdata/3000000000/pfx");

    EXPECT_EQ(SkipOf(outcome, "broken.yml"), SkipReason::NotText);
    EXPECT_EQ(SkipOf(outcome, "bad.json"), SkipReason::Malformed);
    EXPECT_EQ(SkipOf(outcome, "user.reg"), SkipReason::TooLarge);
    EXPECT_FALSE(outcome.cutShort);
}

TEST_F(FindGameTest, LimitsAndCancellationEndTheSearchEarly) {
    SearchLimits tight;
    tight.maxEntries = 3;
    const FindOutcome limited = FindGame(home_.folders(), tight);
    EXPECT_TRUE(limited.cutShort);
    // Finds that need no tree search still come through.
    ASSERT_FALSE(limited.games.empty());
    EXPECT_EQ(limited.games[0].source.value, "DisplayIcon");
    EXPECT_EQ(SkipOf(limited, "drive_c"), SkipReason::SearchCut);

    std::atomic<bool> cancel{true};
    const FindOutcome cancelled = FindGame(home_.folders(), SearchLimits{}, &cancel);
    EXPECT_TRUE(cancelled.cancelled);
    EXPECT_TRUE(cancelled.games.empty());
}

TEST(SearchTreeForFile, MatchesAnyCase_SkipsLinksAndTheWindowsFolder_AndStopsAtTheDepth) {
    FakeHome home;
    const fs::path root = home / "drive_c";
    FakeHome::MakeGame(root / "a/b", "GAMELOADER.exe");
    FakeHome::MakeGame(root / "windows/x");
    FakeHome::MakeGame(root / "1/2/3/4/5");
    fs::create_directory_symlink(root, root / "a/loop");
    SearchLimits limits;
    limits.maxDepth = 4;
    const TreeSearch search = SearchTreeForFile(root, "Gameloader.exe", limits, nullptr);
    ASSERT_EQ(search.folders.size(), 1u);
    EXPECT_EQ(search.folders[0], root / "a/b");
    EXPECT_FALSE(search.cutShort);
}

TEST(WinePrefix, FindsThePrefixThatHoldsOrMapsAFolder_AndReadsItsArch) {
    FakeHome home;
    const fs::path prefix = home.MakePrefix("p", "win32");
    fs::create_directories(home / "mnt/games/FIFA");
    fs::create_directory_symlink(home / "mnt/games", prefix / "dosdevices/e:");
    fs::create_directories(prefix / "drive_c/Games/FIFA");

    EXPECT_EQ(FindPrefixHolding(prefix / "drive_c/Games/FIFA"), fs::canonical(prefix));
    EXPECT_FALSE(FindPrefixHolding(home / "mnt/games/FIFA"));
    EXPECT_EQ(FindPrefixMapping(home / "mnt/games/FIFA", {home / "none", prefix}), prefix);
    EXPECT_FALSE(FindPrefixMapping(home / "elsewhere", {prefix}));  // z: maps / and is ignored
    EXPECT_EQ(ReadPrefixArch(prefix), "win32");
}

}  // namespace
}  // namespace kickvane::game
