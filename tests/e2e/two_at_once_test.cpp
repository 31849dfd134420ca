// Two copies of the program at work on the same files at the same time: each ends as if it had
// been alone.
#include <gtest/gtest.h>

#include <map>
#include <string>

#include "support/process.h"
#include "support/temp_dir.h"
#include "support/trees.h"

namespace kickvane::testing {
namespace {

// Every file under `folder` by its path inside it, with its content.
std::map<std::string, std::string> FilesUnder(const fs::path& folder) {
    std::map<std::string, std::string> files;
    for (const auto& entry : fs::recursive_directory_iterator(folder)) {
        if (entry.is_regular_file()) {
            files[fs::relative(entry.path(), folder).string()] = ReadText(entry.path());
        }
    }
    return files;
}

// A shell loop of `kickvane ini set` that writes `key` `times` times and prints how many of the
// saves failed, with the first reason.
std::string SaveLoop(const fs::path& file, const std::string& key, int times) {
    return "failed=0; for i in $(seq " + std::to_string(times) +
           "); do '" KICKVANE_BINARY "' ini set '" + file.string() + "' 'Thiet lap' " + key +
           " \"$i\" 2>>'" + file.string() + "." + key +
           ".err' || failed=$((failed + 1)); done; echo $failed";
}

TEST(TwoAtOnce, SavesOfOneSettingsFileNeverFailEachOther) {
    TempDir dir;
    const fs::path file = dir / "ThietLap.ini";
    WriteFile(file, "[Thiet lap]\r\nPhimTat=F7\r\nA=0\r\nB=0\r\n");
    constexpr int kSaves = 300;
    ChildProcess first({"sh", "-c", SaveLoop(file, "A", kSaves)}, (dir / "first.out").string());
    ChildProcess second({"sh", "-c", SaveLoop(file, "B", kSaves)}, (dir / "second.out").string());
    EXPECT_EQ(first.Wait(std::chrono::minutes(5)), 0);
    EXPECT_EQ(second.Wait(std::chrono::minutes(5)), 0);
    EXPECT_EQ(ReadText(dir / "first.out"), "0\n") << ReadText(dir / "ThietLap.ini.A.err");
    EXPECT_EQ(ReadText(dir / "second.out"), "0\n") << ReadText(dir / "ThietLap.ini.B.err");
    EXPECT_EQ(ReadText(file), "[Thiet lap]\r\nPhimTat=F7\r\nA=300\r\nB=300\r\n");
}

// Two applies on a game folder that lacks most of the folders they create: a folder or file that
// the other made first is no failure, and the game ends as one apply alone leaves it.
TEST(TwoAtOnce, AppliesOnOneGameFolderBothSucceed) {
    TempDir dir;
    MakeToolFolder(dir / "tool");
    WriteFile(dir / "tool/ThietLap.ini", "[Thay doi]\r\nBong=1\r\nCo=1\r\nGdien=1\r\nSVD=1\r\n");
    const auto apply = [&](const fs::path& game, const char* log) {
        return std::make_unique<ChildProcess>(
            std::vector<std::string>{KICKVANE_BINARY, "apply", "--tool-folder",
                                     (dir / "tool").string(), "--game", game.string()},
            (dir / log).string());
    };
    MakeGameFolder(dir / "alone");
    ASSERT_EQ(apply(dir / "alone", "alone.log")->Wait(), 0) << ReadText(dir / "alone.log");
    const auto expected = FilesUnder(dir / "alone");

    for (int round = 0; round < 8; ++round) {
        const fs::path game = dir / ("game" + std::to_string(round));
        MakeGameFolder(game);
        auto first = apply(game, "first.log");
        auto second = apply(game, "second.log");
        EXPECT_EQ(first->Wait(), 0) << ReadText(dir / "first.log");
        EXPECT_EQ(second->Wait(), 0) << ReadText(dir / "second.log");
        EXPECT_EQ(FilesUnder(game), expected) << "round " << round;
    }
}

}  // namespace
}  // namespace kickvane::testing
