#include "engine/launcher.h"

#include <gtest/gtest.h>

#include "platform/scoped_env.h"
#include "platform/wait_until.h"
#include "support/trees.h"

namespace kickvane::engine {
namespace {

namespace fs = std::filesystem;
using testing::ReadText;
using testing::WriteFile;

// A game folder whose Gameloader.exe is either a script this system runs itself or a Windows
// program, and a PATH holding only a fake `wine` that records how it was started.
class LauncherTest : public ::testing::Test {
protected:
    fs::path game() const { return dir_ / "game"; }
    fs::path record() const { return dir_ / "started.txt"; }

    void WriteScript(const fs::path& file, const std::string& body) {
        WriteFile(file, "#!/bin/sh\n" + body);
        fs::permissions(file, fs::perms::owner_all, fs::perm_options::replace);
    }

    // A script that writes its working folder and arguments, one a line, and "end" when done.
    // It uses shell builtins only: PATH holds nothing but the fake wine.
    std::string Recorder() const {
        return "{ pwd; for a in \"$@\"; do echo \"$a\"; done; echo end; } > '" + record().string() +
               "'\n";
    }

    // What the started program recorded, without the end mark; empty when it never ran.
    std::string Recorded() {
        const auto text = [&] { return fs::exists(record()) ? ReadText(record()) : ""; };
        EXPECT_TRUE(testing::WaitUntil([&] { return text().ends_with("end\n"); }));
        const std::string recorded = text();
        return recorded.ends_with("end\n") ? recorded.substr(0, recorded.size() - 4) : "";
    }

    testing::TempDir dir_;
    testing::ScopedEnv path_{"PATH", (dir_ / "bin").string()};
};

TEST_F(LauncherTest, ANativeLauncherStartsDirectlyInTheGameFolder) {
    WriteScript(game() / "Gameloader.exe", Recorder());
    const LaunchOutcome outcome = LaunchGame(game().string());
    EXPECT_TRUE(outcome.started());
    EXPECT_FALSE(outcome.message);
    EXPECT_EQ(Recorded(), game().string() + "\n");
}

TEST_F(LauncherTest, AWindowsLauncherStartsThroughWineInTheGameFolderInAnyLetterCase) {
    WriteFile(game() / "GameLoader.EXE", "MZ\x90");
    WriteScript(dir_ / "bin/wine", Recorder());
    const LaunchOutcome outcome = LaunchGame(game().string());
    EXPECT_TRUE(outcome.started());
    EXPECT_EQ(Recorded(), game().string() + "\n" + (game() / "GameLoader.EXE").string() + "\n");
}

TEST_F(LauncherTest, WithoutWineOrWithoutALauncherNothingStartsAndTheMessageSaysWhy) {
    WriteFile(game() / "Gameloader.exe", "MZ\x90");
    const LaunchOutcome noWine = LaunchGame(game().string());
    EXPECT_EQ(noWine.result, LaunchResult::WineMissing);
    ASSERT_TRUE(noWine.message);
    EXPECT_EQ(noWine.message->text, kWineMissingText);

    fs::remove(game() / "Gameloader.exe");
    const LaunchOutcome missing = LaunchGame(game().string());
    EXPECT_EQ(missing.result, LaunchResult::LauncherMissing);
    ASSERT_TRUE(missing.message);
    EXPECT_EQ(missing.message->text,
              "Không tìm thấy Gameloader.exe hoặc đường dẫn không chính xác!");
    EXPECT_FALSE(fs::exists(record()));
}

}  // namespace
}  // namespace kickvane::engine
