#include "game/launch_plan.h"

#include <gtest/gtest.h>
#include <sqlite3.h>

#include "game/fake_home.h"

namespace kickvane::game {
namespace {

namespace fs = std::filesystem;
using testing::FakeHome;
using testing::Installed;
using testing::WriteFile;
using Args = std::vector<std::string>;

void MakeLutrisDatabase(const fs::path& file, const std::string& configName) {
    fs::create_directories(file.parent_path());
    sqlite3* db = nullptr;
    ASSERT_EQ(sqlite3_open(file.c_str(), &db), SQLITE_OK);
    const std::string sql =
        "CREATE TABLE games (id INTEGER PRIMARY KEY, name TEXT, slug TEXT, configpath TEXT);"
        "INSERT INTO games VALUES (7, 'Other', 'other', 'other-1');"
        "INSERT INTO games VALUES (42, 'FIFA Online 2', 'fifa-online-2', '" +
        configName + "');";
    ASSERT_EQ(sqlite3_exec(db, sql.c_str(), nullptr, nullptr, nullptr), SQLITE_OK);
    sqlite3_close(db);
}

TEST(PlanLaunch, LutrisGameStartsThroughLutris_ByItsNumber_OrFlatpak_OrFallsBackToItsWine) {
    FakeHome home;
    const fs::path prefix = home.MakePrefix("Games/fifa");
    const fs::path game = FakeHome::MakeGame(prefix / "drive_c/FIFA");
    const std::string yml = "game:\n  exe: " + (game / "Gameloader.exe").string() +
                            "\n  prefix: " + prefix.string() + "\nwine:\n  version: lutris-8\n";
    WriteFile(home / ".config/lutris/games/fifa-online-2-1700.yml", yml);
    MakeLutrisDatabase(home / ".local/share/lutris/pga.db", "fifa-online-2-1700");
    testing::WriteProgram(home / ".local/share/lutris/runners/wine/lutris-8/bin/wine",
                          "#!/bin/sh\n");

    LaunchDecision decision =
        PlanLaunch(game.string(), home.folders(), Installed({"lutris", "wine"}));
    ASSERT_EQ(decision.problem, LaunchProblem::None);
    EXPECT_EQ(decision.plan.program, "/fake/bin/lutris");
    EXPECT_EQ(decision.plan.arguments, Args{"lutris:rungameid/42"});
    EXPECT_EQ(decision.plan.workingFolder, game);
    EXPECT_EQ(decision.plan.way, LaunchWay::Lutris);
    EXPECT_EQ(decision.plan.gameName, "FIFA Online 2");
    EXPECT_EQ(decision.plan.gameId, "42");

    // Without Lutris installed: Wine in the prefix, with the Wine build Lutris keeps for it.
    decision = PlanLaunch(game.string(), home.folders(), Installed({"wine"}));
    EXPECT_EQ(decision.plan.program, home / ".local/share/lutris/runners/wine/lutris-8/bin/wine");
    EXPECT_EQ(decision.plan.arguments, Args{(game / "Gameloader.exe").string()});

    // The Flatpak build's files, without a database: started by the short name.
    fs::remove_all(home / ".config/lutris");
    WriteFile(home / ".var/app/net.lutris.Lutris/data/lutris/games/fifa-online-2-1700.yml", yml);
    decision = PlanLaunch(game.string(), home.folders(), Installed({"lutris", "flatpak", "wine"}));
    EXPECT_EQ(decision.plan.program, "/fake/bin/flatpak");
    EXPECT_EQ(decision.plan.arguments,
              (Args{"run", "net.lutris.Lutris", "lutris:rungame/fifa-online-2"}));
}

TEST(PlanLaunch, BottleThatHoldsTheGameStartsThroughBottlesCli_NativeOrFlatpak) {
    FakeHome home;
    const fs::path bottle = home.MakePrefix(".local/share/bottles/bottles/FIFA");
    WriteFile(bottle / "bottle.yml", "Name: FIFA Bottle\nArch: win64\n");
    const fs::path game =
        FakeHome::MakeGame(bottle / "drive_c/Program Files/FO2", "gameLoader.exe");
    const std::string launcher = (game / "gameLoader.exe").string();

    LaunchDecision decision =
        PlanLaunch(game.string(), home.folders(), Installed({"bottles-cli", "wine"}));
    EXPECT_EQ(decision.plan.program, "/fake/bin/bottles-cli");
    EXPECT_EQ(decision.plan.arguments, (Args{"run", "-b", "FIFA Bottle", "-e", launcher}));
    EXPECT_TRUE(decision.plan.environment.empty());

    fs::rename(home / ".local/share/bottles", home / "moved");
    // The Flatpak's placeholder names where the bottle is kept now.
    const fs::path moved = home / "moved/bottles/FIFA/drive_c/Program Files/FO2";
    WriteFile(home / ".var/app/com.usebottles.bottles/data/bottles/bottles/FIFA/placeholder.yml",
              "Path: " + (home / "moved/bottles/FIFA").string() + "\n");
    decision = PlanLaunch(moved.string(), home.folders(), Installed({"flatpak", "wine"}));
    EXPECT_EQ(decision.plan.program, "/fake/bin/flatpak");
    EXPECT_EQ(decision.plan.arguments,
              (Args{"run", "--command=bottles-cli", "com.usebottles.bottles", "run", "-b",
                    "FIFA Bottle", "-e", (moved / "gameLoader.exe").string()}));
}

TEST(PlanLaunch, OtherwiseWineRunsInTheGamesOwnPrefix_WithItsArch) {
    FakeHome home;
    const fs::path prefix = home.MakePrefix("Games/fo2", "win32");
    const fs::path game = FakeHome::MakeGame(prefix / "drive_c/FIFA");
    const ProgramLookup wineOnly = Installed({"wine", "lutris", "bottles-cli"});

    LaunchDecision decision = PlanLaunch(game.string(), home.folders(), wineOnly);
    ASSERT_EQ(decision.problem, LaunchProblem::None);
    EXPECT_EQ(decision.plan.program, "/fake/bin/wine");
    EXPECT_EQ(decision.plan.environment,
              (platform::EnvironmentAdditions{{"WINEPREFIX", fs::canonical(prefix).string()},
                                              {"WINEARCH", "win32"}}));
    EXPECT_EQ(decision.plan.workingFolder, game);

    // A game folder on a drive that a prefix maps, outside the prefix itself.
    const fs::path wine = home.MakePrefix(".wine", "win64");
    const fs::path outside = FakeHome::MakeGame(home / "disk/FIFA");
    fs::create_directory_symlink(home / "disk", wine / "dosdevices/d:");
    decision = PlanLaunch(outside.string(), home.folders(), wineOnly);
    EXPECT_EQ(
        decision.plan.environment,
        (platform::EnvironmentAdditions{{"WINEPREFIX", wine.string()}, {"WINEARCH", "win64"}}));
    EXPECT_EQ(decision.plan.way, LaunchWay::Wine);
    EXPECT_EQ(decision.plan.prefix, wine);
    EXPECT_EQ(decision.plan.arch, "win64");
}

TEST(PlanLaunch, MissingLauncherOrWineIsSaid_AndANativeLauncherRunsDirectly) {
    FakeHome home;
    const fs::path game = FakeHome::MakeGame(home / "game");
    EXPECT_EQ(PlanLaunch((home / "empty").string(), home.folders(), Installed({"wine"})).problem,
              LaunchProblem::LauncherMissing);
    EXPECT_EQ(PlanLaunch(game.string(), home.folders(), Installed({})).problem,
              LaunchProblem::WineMissing);
    const LaunchDecision outside = PlanLaunch(game.string(), home.folders(), Installed({"wine"}));
    EXPECT_TRUE(outside.plan.environment.empty());
    EXPECT_EQ(outside.plan.way, LaunchWay::Wine);
    EXPECT_TRUE(outside.plan.prefix.empty());

    testing::WriteProgram(game / "Gameloader.exe", "#!/bin/sh\n");
    const LaunchDecision native = PlanLaunch(game.string(), home.folders(), Installed({}));
    EXPECT_EQ(native.plan.program, game / "Gameloader.exe");
    EXPECT_EQ(native.plan.way, LaunchWay::Direct);
}

}  // namespace
}  // namespace kickvane::game
