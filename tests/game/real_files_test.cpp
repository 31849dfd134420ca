// The game managers' files as those programs write them (PyYAML's folded lines and escapes,
// Steam's older library list, Heroic's Proton prefixes), and games whose launcher lies outside
// every prefix: found, and started in the prefix that the manager names.
#include <gtest/gtest.h>

#include "game/fake_home.h"
#include "game/find_game.h"
#include "game/launch_plan.h"

namespace kickvane::game {
namespace {

namespace fs = std::filesystem;
using testing::FakeHome;
using testing::Installed;
using testing::WriteFile;
using Args = std::vector<std::string>;
using Env = platform::EnvironmentAdditions;

const FoundGame* FoundIn(const FindOutcome& outcome, const fs::path& folder) {
    for (const FoundGame& game : outcome.games) {
        if (game.folder == fs::canonical(folder)) {
            return &game;
        }
    }
    return nullptr;
}

// Lutris writes with PyYAML, which folds a long "exe:" onto a second line; the exe lies outside
// the prefix, and Lutris itself is not installed.
TEST(RealFiles, LutrisExeFoldedOverTwoLines_OutsideItsPrefix_RunsInTheNamedPrefix) {
    FakeHome home;
    const fs::path prefix = home.MakePrefix("Games/fifa-online-2", "win32");
    const fs::path game = FakeHome::MakeGame(home / "Trò chơi/Nexon Corporation/FIFA Online 2");
    testing::WriteProgram(home / ".local/share/lutris/runners/wine/lutris-7.2-2-x86_64/bin/wine",
                          "#!/bin/sh\n");
    const std::string exe = (game / "Gameloader.exe").string();
    const size_t fold = exe.rfind(' ');
    WriteFile(home / ".config/lutris/games/fifa-online-2-1701234567.yml",
              "game:\n"
              "  args: ''\n"
              "  exe: \"" +
                  exe.substr(0, fold) + "\\\n    \\ " + exe.substr(fold + 1) +
                  "\"\n"
                  "  prefix: " +
                  prefix.string() +
                  "\n"
                  "game_slug: fifa-online-2\n"
                  "name: FIFA Online 2\n"
                  "requires: null\n"
                  "slug: fifa-online-2\n"
                  "system: {}\n"
                  "wine:\n"
                  "  version: lutris-7.2-2-x86_64\n");
    // The same value folded as a plain scalar, as PyYAML writes it where no escape is needed.
    const fs::path other =
        FakeHome::MakeGame(home / "Games/Some Other Place With A Long Name/FIFA");
    const std::string otherExe = (other / "Gameloader.exe").string();
    const size_t otherFold = otherExe.rfind(" Long");
    WriteFile(home / ".config/lutris/games/fifa-2-1701234568.yml",
              "game:\n  exe: " + otherExe.substr(0, otherFold) + "\n    " +
                  otherExe.substr(otherFold + 1) + "\n  prefix: " + prefix.string() +
                  "\nname: FIFA 2\n");

    const FindOutcome found = FindGame(home.folders(), SearchLimits{});
    const FoundGame* lutris = FoundIn(found, game);
    ASSERT_NE(lutris, nullptr) << ::testing::PrintToString(found.skipped);
    EXPECT_EQ(lutris->source.manager, Manager::Lutris);
    EXPECT_EQ(lutris->source.name, "FIFA Online 2");
    EXPECT_EQ(lutris->source.configFile, "~/.config/lutris/games/fifa-online-2-1701234567.yml");
    ASSERT_NE(FoundIn(found, other), nullptr);

    const LaunchDecision decision = PlanLaunch(game.string(), home.folders(), Installed({"wine"}));
    ASSERT_EQ(decision.problem, LaunchProblem::None);
    EXPECT_EQ(decision.plan.program,
              home / ".local/share/lutris/runners/wine/lutris-7.2-2-x86_64/bin/wine");
    EXPECT_EQ(decision.plan.environment,
              (Env{{"WINEPREFIX", prefix.string()}, {"WINEARCH", "win32"}}));
}

// A program added to a bottle from outside it, its path with Vietnamese letters that PyYAML
// writes as escapes in a double-quoted value folded over two lines.
TEST(RealFiles, BottlesProgramOutsideItsBottle_IsFound_AndRunsThroughBottlesOrItsBottle) {
    FakeHome home;
    const fs::path bottle = home.MakePrefix(".local/share/bottles/bottles/FIFA", "win64");
    const fs::path game = FakeHome::MakeGame(
        home / "Tr\xC3\xB2 ch\xC6\xA1i/B\xC3\xB3ng \xC4\x91\xC3\xA1/FIFA Online 2");
    testing::WriteProgram(home / ".local/share/bottles/runners/soda-7.0-9/bin/wine", "#!/bin/sh\n");
    const std::string folded = home.home().string() +
                               "/Tr\\xF2 ch\\u01A1i/B\\xF3ng \\u0111\\xE1/FIFA\\\n      \\ Online "
                               "2/Gameloader.exe";
    WriteFile(bottle / "bottle.yml",
              "Arch: win64\n"
              "Custom_Path: false\n"
              "External_Programs:\n"
              "  5a1e2b7c-0d5f-4f7e-9c52-3f0d2c8e6b11:\n"
              "    arguments: ''\n"
              "    executable: Gameloader.exe\n"
              "    folder: \"" +
                  home.home().string() +
                  "/Tr\\xF2 ch\\u01A1i/B\\xF3ng \\u0111\\xE1/FIFA Online 2\"\n"
                  "    id: 5a1e2b7c-0d5f-4f7e-9c52-3f0d2c8e6b11\n"
                  "    name: Gameloader\n"
                  "    path: \"" +
                  folded +
                  "\"\n"
                  "Name: FIFA\n"
                  "Path: FIFA\n"
                  "Runner: soda-7.0-9\n"
                  "Versioning: false\n");

    const FindOutcome found = FindGame(home.folders(), SearchLimits{});
    ASSERT_NE(FoundIn(found, game), nullptr) << ::testing::PrintToString(found.skipped);

    const std::string launcher = (game / "Gameloader.exe").string();
    LaunchDecision decision =
        PlanLaunch(game.string(), home.folders(), Installed({"bottles-cli", "wine"}));
    EXPECT_EQ(decision.plan.program, "/fake/bin/bottles-cli");
    EXPECT_EQ(decision.plan.arguments, (Args{"run", "-b", "FIFA", "-e", launcher}));

    decision = PlanLaunch(game.string(), home.folders(), Installed({"wine"}));
    EXPECT_EQ(decision.plan.program, home / ".local/share/bottles/runners/soda-7.0-9/bin/wine");
    EXPECT_EQ(decision.plan.environment,
              (Env{{"WINEPREFIX", bottle.string()}, {"WINEARCH", "win64"}}));
}

// Steams before 2021 list their libraries as "1" "<path>", without a "path" key.
TEST(RealFiles, SteamsOlderLibraryListIsRead) {
    FakeHome home;
    fs::create_directories(home / ".local/share/Steam/steamapps");
    WriteFile(home / ".local/share/Steam/steamapps/libraryfolders.vdf",
              "\"LibraryFolders\"\n{\n\t\"TimeNextStatsReport\"\t\t\"1561832478\"\n"
              "\t\"ContentStatsID\"\t\t\"-158337411110787451\"\n\t\"1\"\t\t\"" +
                  (home / "Tr\xC3\xB2 ch\xC6\xA1i/SteamLibrary").string() + "\"\n}\n");
    const fs::path game = FakeHome::MakeGame(
        home.MakePrefix("Tr\xC3\xB2 ch\xC6\xA1i/SteamLibrary/steamapps/compatdata/2871234567/pfx") /
        "drive_c/FIFA Online 2");

    const FindOutcome found = FindGame(home.folders(), SearchLimits{});
    const FoundGame* steam = FoundIn(found, game);
    ASSERT_NE(steam, nullptr);
    EXPECT_EQ(steam->source.manager, Manager::Steam);
    EXPECT_TRUE(steam->source.name.starts_with("2871234567")) << steam->source.name;
}

// Heroic names the folder of a Proton game, which keeps its Wine prefix in "pfx"; a sideloaded
// game may lie outside that prefix altogether.
TEST(RealFiles, HeroicProtonPrefixIsItsPfx_AndASideloadedGameRunsInItsNamedPrefix) {
    FakeHome home;
    const fs::path proton = home / ".steam/steam/steamapps/common/Proton - Experimental";
    testing::WriteProgram(proton / "proton", "#!/usr/bin/env python3\n");
    testing::WriteProgram(proton / "files/bin/wine", "#!/bin/sh\n");
    const fs::path pfx = home.MakePrefix("Games/Heroic/Prefixes/default/FIFA/pfx");
    const fs::path inside = FakeHome::MakeGame(pfx / "drive_c/Program Files/FIFA Online 2");
    const fs::path outside = FakeHome::MakeGame(home / "Games/FIFA Online 2 (sideload)");
    WriteFile(home / ".config/heroic/GamesConfig/Xk2Lr9vQ.json",
              "{\n  \"Xk2Lr9vQ\": {\n    \"autoInstallDxvk\": true,\n    \"enableEsync\": true,\n"
              "    \"winePrefix\": \"" +
                  (home / "Games/Heroic/Prefixes/default/FIFA").string() +
                  "\",\n    \"wineVersion\": {\n      \"bin\": \"" + (proton / "proton").string() +
                  "\",\n      \"name\": \"Proton - Proton - Experimental\",\n"
                  "      \"type\": \"proton\"\n    }\n  },\n  \"version\": \"v0\",\n"
                  "  \"explicit\": true\n}\n");
    WriteFile(home / ".config/heroic/sideload_apps/library.json",
              "{\n  \"games\": [\n    {\n      \"runner\": \"sideload\",\n"
              "      \"app_name\": \"Xk2Lr9vQ\",\n"
              "      \"title\": \"FIFA Online 2 \\\"Vi\xE1\xBB\x87t Nam\\\"\",\n"
              "      \"install\": {\n        \"executable\": \"" +
                  (outside / "Gameloader.exe").string() +
                  "\",\n        \"platform\": \"windows\",\n        \"is_dlc\": false\n      },\n"
                  "      \"is_installed\": true\n    }\n  ]\n}\n");

    const FindOutcome found = FindGame(home.folders(), SearchLimits{});
    const FoundGame* inPfx = FoundIn(found, inside);
    ASSERT_NE(inPfx, nullptr) << ::testing::PrintToString(found.looked);
    EXPECT_EQ(inPfx->prefix, pfx);
    const FoundGame* sideloaded = FoundIn(found, outside);
    ASSERT_NE(sideloaded, nullptr);
    EXPECT_EQ(sideloaded->source.manager, Manager::Heroic);
    EXPECT_EQ(sideloaded->source.name, "FIFA Online 2 \"Vi\xE1\xBB\x87t Nam\"");

    // Proton's own script wants Steam's environment: the Wine inside Proton runs the game.
    for (const fs::path& game : {inside, outside}) {
        const LaunchDecision decision =
            PlanLaunch(game.string(), home.folders(), Installed({"wine"}));
        ASSERT_EQ(decision.problem, LaunchProblem::None) << game;
        EXPECT_EQ(decision.plan.program, proton / "files/bin/wine") << game;
        EXPECT_EQ(decision.plan.environment,
                  (Env{{"WINEPREFIX", game == inside ? fs::canonical(pfx).string() : pfx.string()},
                       {"WINEARCH", "win64"}}))
            << game;
    }
}

}  // namespace
}  // namespace kickvane::game
