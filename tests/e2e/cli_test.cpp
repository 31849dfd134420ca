// The kickvane program's subcommands, run as a user runs them, on temporary folders.
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <cstdlib>

#include "support/process.h"
#include "support/temp_dir.h"
#include "support/trees.h"

namespace kickvane::testing {
namespace {

using Result = CommandResult;
using ::testing::HasSubstr;
using ::testing::Not;

// A tool folder and a game folder, fresh for each case.
class CliTest : public ToolAndGameTest {
protected:
    // Runs the program with `args` (already quoted for the shell) and `input` on standard input.
    Result Kickvane(const std::string& args, const std::string& input = "") {
        return RunCommand(std::string("'") + KICKVANE_BINARY + "' " + args, dir_.path(), input);
    }

    static std::string Quote(const fs::path& path) { return "'" + path.string() + "'"; }

    std::string Folders() const {
        return "--tool-folder " + Quote(tool()) + " --game " + Quote(game());
    }
};

TEST_F(CliTest, PlanListsTheStepsAndApplyExitsZeroOneOrTwo) {
    const Result plan = Kickvane("plan " + Folders());
    EXPECT_EQ(plan.exitCode, 0);
    EXPECT_THAT(plan.out,
                HasSubstr("Thay đổi Mark: chép thư mục data\\data2\\gui\\hud\\Indicator vào "
                          "data2\\gui\\hud\\Indicator\n"));
    EXPECT_FALSE(fs::exists(game() / "data2/cmn"));

    const Result done = Kickvane("apply " + Folders());
    EXPECT_EQ(done.exitCode, 0) << done.err;
    EXPECT_THAT(done.out,
                HasSubstr("xong    Thay đổi bóng: chép thư mục extras\\Ball\\Europa League 2011 "
                          "vào zdata\\data2\\ball ("));

    // The game folder comes from the settings when not given.
    fs::remove_all(game() / "zdata");
    WriteFile(tool() / "thietlap.ini",
              "[Thiet lap]\r\nDuongDan=" + game().string() + "\r\n[Thay doi]\r\nCDV=1\r\n");
    const std::string apply = "apply --tool-folder " + Quote(tool());
    const Result failed = Kickvane(apply);
    EXPECT_EQ(failed.exitCode, 1);
    EXPECT_THAT(failed.err,
                HasSubstr("lỗi: Thay đổi Cổ động viên: không chép được vào "
                          "zdata\\data2\\crowd\\textures: trò chơi không có thư mục này\n"));
    EXPECT_THAT(failed.out, HasSubstr("LỖI     Thay đổi Cổ động viên: không chép được vào"));

    fs::remove_all(game() / "data2");
    const Result noData = Kickvane(apply);
    EXPECT_EQ(noData.exitCode, 2);
    EXPECT_THAT(noData.err, HasSubstr("Không tìm thấy thư mục chứa FIFA Online 2"));
    fs::remove_all(tool() / "data");
    const Result noBase = Kickvane(apply);
    EXPECT_EQ(noBase.exitCode, 2);
    EXPECT_THAT(noBase.err, HasSubstr("Thư mục nguồn: Không tìm thấy: "));
}

// "list" shows every category and group, the chosen variants, the added ones and the skipped
// folders; "plan" runs an added scoreboard by the steps of the catalog's scoreboards.
TEST_F(CliTest, ListMarksChosenAndAddedVariantsAndNamesSkippedFolders) {
    WriteFile(tool() / "extras/scoreboard/Đài 1/scoreboard/sb.dds", "x");
    WriteFile(tool() / "extras/scoreboard/a=b/sb.dds", "x");
    WriteFile(tool() / "ThietLap.ini", "[Thiet lap]\r\nDuongDan=" + game().string() +
                                           "\r\n[Bang Ti So]\r\nMacDinh=False\r\nĐài 1=True\r\n");
    const Result list = Kickvane("list --tool-folder " + Quote(tool()));
    EXPECT_EQ(list.exitCode, 0) << list.err;
    EXPECT_THAT(list.out, HasSubstr("Bong [bật] Thay đổi bóng\n  ( ) MacDinh: Mặc định\n"
                                    "  (*) Europa League 2011: Europa League 2011\n"));
    EXPECT_THAT(list.out,
                HasSubstr("  ( ) SSUCLRed: Supa Strikas UCL Red\n  (*) Đài 1 [đã thêm]\n"
                          "  bỏ qua extras\\scoreboard\\a=b: tên có ký tự không dùng được\n"
                          "Mark [bật]"));
    EXPECT_THAT(list.out, HasSubstr("SVD [tắt] Thay đổi Sân vận động\n"));

    const Result plan = Kickvane("plan " + Folders());
    EXPECT_THAT(plan.out, HasSubstr("Thay đổi bảng tỉ số: chép thư mục extras\\scoreboard\\Đài "
                                    "1\\scoreboard vào data2\\gui\\hud\\scoreboard\n"
                                    "Thay đổi bảng tỉ số: chép thư mục extras\\scoreboard\\Đài "
                                    "1\\namebar vào data2\\gui\\hud\\namebar\n"));
}

TEST_F(CliTest, SettingsThatCannotBeReadStopApplyWithTheReasonAndCopyNothing) {
    WriteFile(tool() / "ThietLap.ini", std::string("\x7F"
                                                   "ELF\2\1\1\0\0\0",
                                                   10));
    const Result stopped = Kickvane("apply " + Folders());
    EXPECT_EQ(stopped.exitCode, 2);
    EXPECT_THAT(stopped.err, HasSubstr("ThietLap.ini không phải là văn bản"));
    EXPECT_FALSE(fs::exists(game() / "data2/cmn"));
    EXPECT_EQ(
        Kickvane("ini get " + Quote(tool() / "ThietLap.ini") + " 'Thiet lap' PhimTat F7").exitCode,
        1);
}

// A Windows path climbs no higher than its drive's root, as on Windows: the game folder stays
// in the Wine prefix, and nothing is written beside the prefix.
TEST_F(CliTest, ApplyToAWindowsPathWithDotsStaysInThePrefix) {
    const fs::path prefix = dir_ / "prefix";
    MakeGameFolder(prefix / "drive_c/elsewhere-game");
    MakeGameFolder(dir_ / "elsewhere-game");
    const Result done = RunCommand("WINEPREFIX=" + Quote(prefix) + " '" + KICKVANE_BINARY +
                                       "' apply --tool-folder " + Quote(tool()) +
                                       " --game 'C:\\..\\..\\elsewhere-game'",
                                   dir_.path(), "");
    EXPECT_EQ(done.exitCode, 0) << done.err;
    EXPECT_TRUE(fs::exists(prefix / "drive_c/elsewhere-game/data2/cmn"));
    EXPECT_FALSE(fs::exists(dir_ / "elsewhere-game/data2/cmn"));
}

TEST_F(CliTest, QuickLoadExitCodes) {
    fs::remove_all(tool() / "data/data2/players/bodies");
    WriteFile(dir_ / "faces/face1.dds", "face");
    WriteFile(dir_ / "faces/skin1.dds", "skin");  // no bodies folder in the base set
    const auto quickLoad = [&](const char* folder) {
        return Kickvane("quick-load " + Quote(dir_ / folder) + " --tool-folder " + Quote(tool()));
    };
    const Result partly = quickLoad("faces");
    EXPECT_EQ(partly.exitCode, 1);
    EXPECT_EQ(partly.out, "Hoàn tất!\n");
    fs::remove(dir_ / "faces/skin1.dds");
    EXPECT_EQ(quickLoad("faces").exitCode, 0);
    const Result empty = quickLoad("nothing");
    EXPECT_EQ(empty.exitCode, 2);
    EXPECT_EQ(empty.err, "Thư mục này không có file Face hay Ball nào\n");
}

TEST_F(CliTest, VniConvertsArgumentOrStandardInput) {
    EXPECT_EQ(Kickvane("vni 'Tho6ng ba1o'").out, "Thông báo\n");
    EXPECT_EQ(Kickvane("vni", "U71ng du5ng\nd9u7o7ng\n").out, "Ứng dụng\nđương\n");
}

TEST_F(CliTest, IniGetAndSet) {
    const std::string file = Quote(dir_ / "ThietLap.ini");
    EXPECT_EQ(Kickvane("ini set " + file + " 'Thiet lap' PhimTat F9").exitCode, 0);
    EXPECT_EQ(Kickvane("ini get " + Quote(dir_ / "THIETLAP.INI") + " 'thiet lap' phimtat").out,
              "F9\n");
    EXPECT_EQ(Kickvane("ini get " + file + " 'Thiet lap' DuongDan 'C:\\Program Files'").out,
              "C:\\Program Files\n");
    const Result failed = Kickvane("ini set " + Quote(dir_ / "missing/ThietLap.ini") + " a b c");
    EXPECT_NE(failed.exitCode, 0);
    EXPECT_FALSE(failed.err.empty());
}

TEST_F(CliTest, UnknownCommandOrMissingArgumentsShowUsage) {
    EXPECT_EQ(Kickvane("frobnicate").exitCode, 2);
    const Result usage = Kickvane("apply --game");
    EXPECT_EQ(usage.exitCode, 2);
    EXPECT_THAT(usage.err, HasSubstr("Cách dùng: kickvane"));
    // The help speaks the player's language, with no English left in its descriptions.
    const Result help = Kickvane("--help");
    EXPECT_EQ(help.exitCode, 0);
    for (const char* english : {"Usage", "copy the", "the game", "settings value"}) {
        EXPECT_THAT(help.out, Not(HasSubstr(english)));
    }
}

}  // namespace
}  // namespace kickvane::testing
