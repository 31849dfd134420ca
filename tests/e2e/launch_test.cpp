// `kickvane launch` and `kickvane find-game` on a home of their own, with fake `wine`, `lutris`,
// `bottles-cli` and `flatpak` programs on a PATH of their own that record how they were started.
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <cstdlib>

#include "game/fake_home.h"
#include "platform/scoped_env.h"
#include "support/process.h"
#include "support/temp_dir.h"

namespace kickvane::testing {
namespace {

using Result = CommandResult;
using ::testing::HasSubstr;

class LaunchTest : public ::testing::Test {
protected:
    LaunchTest()
        : homeVariable_("HOME", home().string()),
          path_("PATH", (dir_ / "bin").string() + ":/usr/bin:/bin"),
          record_("KICKVANE_TEST_RECORD", (dir_ / "record.txt").string()),
          prefix_("WINEPREFIX", std::nullopt),
          xdgConfig_("XDG_CONFIG_HOME", std::nullopt),
          xdgData_("XDG_DATA_HOME", std::nullopt) {
        for (const char* name : {"wine", "lutris", "bottles-cli", "flatpak"}) {
            Install(name);
        }
    }

    fs::path home() const { return home_.home(); }

    // A fake program that writes its name, folder, Wine variables and arguments to the record.
    void Install(const std::string& name) {
        WriteProgram(
            dir_ / "bin" / name,
            "#!/bin/sh\n"
            "{ echo \"program=$(basename \"$0\")\"; echo \"pwd=$(pwd)\";\n"
            "  echo \"WINEPREFIX=${WINEPREFIX-unset}\"; echo \"WINEARCH=${WINEARCH-unset}\";\n"
            "  for a in \"$@\"; do echo \"arg=$a\"; done; } > \"$KICKVANE_TEST_RECORD.tmp\"\n"
            "mv \"$KICKVANE_TEST_RECORD.tmp\" \"$KICKVANE_TEST_RECORD\"\n");
    }

    Result Kickvane(const std::string& args) {
        return RunCommand(std::string("'") + KICKVANE_BINARY + "' " + args, dir_.path());
    }

    // Runs `kickvane launch` with `gameFolder` in the settings.
    Result RunLaunch(const fs::path& gameFolder) {
        WriteFile(dir_ / "tool/ThietLap.ini",
                  "[Thiet lap]\nDuongDan=" + gameFolder.string() + "\n");
        return Kickvane("launch --tool-folder '" + (dir_ / "tool").string() + "'");
    }

    // Runs `kickvane launch` for `gameFolder` and returns what the started program recorded.
    std::string Launch(const fs::path& gameFolder, Result* result = nullptr) {
        fs::remove(dir_ / "record.txt");
        const Result launched = RunLaunch(gameFolder);
        if (result != nullptr) {
            *result = launched;
        }
        EXPECT_EQ(launched.exitCode, 0) << launched.err;
        if (launched.exitCode != 0 || !WaitFor([&] { return fs::exists(dir_ / "record.txt"); })) {
            return {};
        }
        return ReadText(dir_ / "record.txt");
    }

    TempDir dir_;
    FakeHome home_;
    ScopedEnv homeVariable_, path_, record_, prefix_, xdgConfig_, xdgData_;
};

TEST_F(LaunchTest, WineRunsTheLauncherInItsOwnPrefixAndFolder_AndSaysSo) {
    const fs::path prefix = home_.MakePrefix("Games/fo2", "win32");
    WriteFile(prefix / "drive_c/FIFA Online 2/GameLoader.exe", "MZ");
    Result result;
    const std::string record = Launch(prefix / "drive_c/FIFA Online 2", &result);
    EXPECT_EQ(record, "program=wine\npwd=" + (prefix / "drive_c/FIFA Online 2").string() +
                          "\nWINEPREFIX=" + prefix.string() + "\nWINEARCH=win32\narg=" +
                          (prefix / "drive_c/FIFA Online 2/GameLoader.exe").string() + "\n");
    EXPECT_EQ(result.out, "đã khởi động Gameloader.exe qua Wine trong thư mục Wine " +
                              prefix.string() + " (win32)\n");
}

// A Wine (or a manager) that ends at once with an error has not started the game: the command
// says which program failed and how, and fails; one that could not run at all says why.
TEST_F(LaunchTest, WineThatFailsAtOnceIsAFailure_NamingItAndItsCode) {
    WriteFile(dir_ / "game/Gameloader.exe", "MZ");
    WriteProgram(dir_ / "bin/wine",
                 "#!/bin/sh\necho 'wine: could not load kernel32' >&2\nexit 3\n");
    Result result = RunLaunch(dir_ / "game");
    EXPECT_EQ(result.exitCode, 1);
    EXPECT_EQ(result.out, "");
    EXPECT_THAT(result.err, HasSubstr("Không khởi động được FIFA: Wine dừng ngay với mã lỗi 3."));

    // Found on PATH, but gone by the time it is run: an exec failure with the system's reason.
    WriteProgram(dir_ / "bin/wine", "#!/nonexistent/interpreter\n");
    result = RunLaunch(dir_ / "game");
    EXPECT_EQ(result.exitCode, 1);
    EXPECT_THAT(result.err, HasSubstr("Không khởi động được FIFA qua Wine: không chạy được "));
    EXPECT_THAT(result.err, HasSubstr("không tìm thấy"));
}

// Which manager starts which game, Flatpak builds included, is the launch plan's unit test.
TEST_F(LaunchTest, AManagerStartsItsOwnGame_WithoutWineVariablesOfOurs) {
    const fs::path bottle = home_.MakePrefix(".local/share/bottles/bottles/fifa", "win64");
    WriteFile(bottle / "bottle.yml", "Name: fifa\n");
    WriteFile(bottle / "drive_c/FO2/Gameloader.exe", "MZ");
    EXPECT_EQ(Launch(bottle / "drive_c/FO2"),
              "program=bottles-cli\npwd=" + (bottle / "drive_c/FO2").string() +
                  "\nWINEPREFIX=unset\nWINEARCH=unset\narg=run\narg=-b\narg=fifa\narg=-e\narg=" +
                  (bottle / "drive_c/FO2/Gameloader.exe").string() + "\n");
}

TEST_F(LaunchTest, MissingLauncherOrWineFailsWithAReason) {
    Result result = RunLaunch(dir_ / "none");
    EXPECT_EQ(result.exitCode, 1);
    EXPECT_THAT(result.err, HasSubstr("Gameloader.exe"));

    WriteFile(dir_ / "game/Gameloader.exe", "MZ");
    fs::remove(dir_ / "bin/wine");
    const ScopedEnv noSystemWine("PATH", (dir_ / "bin").string());
    result = RunLaunch(dir_ / "game");
    EXPECT_EQ(result.exitCode, 1);
    EXPECT_THAT(result.err, HasSubstr("Wine"));
}

TEST_F(LaunchTest, FindGameListsFoldersWithTheirSources_OrSaysWhereItLooked) {
    Result result = Kickvane("find-game");
    EXPECT_EQ(result.exitCode, 1);
    EXPECT_THAT(result.err, HasSubstr("không tìm thấy Gameloader.exe; đã tìm trong:"));
    EXPECT_THAT(result.err, HasSubstr(".wine"));

    const fs::path prefix = home_.MakePrefix(".PlayOnLinux/wineprefix/FO2", "win32");
    WriteFile(prefix / "drive_c/Games/FIFA/gameloader.EXE", "MZ");
    result = Kickvane("find-game");
    EXPECT_EQ(result.exitCode, 0) << result.err;
    EXPECT_EQ(result.out,
              (prefix / "drive_c/Games/FIFA").string() +
                  "\tPlayOnLinux: FO2 (~/.PlayOnLinux/wineprefix/FO2), tìm trong drive_c\n");

    // A file that cannot be read is named with its reason, status word first.
    WriteFile(home() / ".config/heroic/GamesConfig/bad.json", "{\n\"bad\": ");
    result = Kickvane("find-game");
    EXPECT_EQ(result.exitCode, 0) << result.err;
    EXPECT_THAT(result.err,
                HasSubstr("bỏ qua: " + (home() / ".config/heroic/GamesConfig/bad.json").string() +
                          ": sai định dạng ở dòng 2\n"));
}

}  // namespace
}  // namespace kickvane::testing
