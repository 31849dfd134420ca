#include "game/windows_search.h"

#include <gtest/gtest.h>

namespace kickvane::game {
namespace {

// The forms uninstall entries write their program in: quoted, with an icon index, and unquoted
// command lines whose folder holds spaces.
TEST(WindowsSearch, FolderOfProgramValueReadsEveryFormOfUninstallEntries) {
    EXPECT_EQ(FolderOfProgramValue(R"("C:\Games\FIFA Online 2\Gameloader.exe",0)"),
              R"(C:\Games\FIFA Online 2)");
    EXPECT_EQ(FolderOfProgramValue(R"(C:\Games\FO2\Gameloader.exe,0)"), R"(C:\Games\FO2)");
    EXPECT_EQ(FolderOfProgramValue(R"(  C:\Program Files (x86)\FIFA Online 2\unins 000.EXE /S )"),
              R"(C:\Program Files (x86)\FIFA Online 2)");
    EXPECT_EQ(FolderOfProgramValue(R"("D:\Trò chơi\FO2\uninst.exe" /uninstall)"),
              "D:\\Trò chơi\\FO2");
    EXPECT_EQ(FolderOfProgramValue(R"(C:\Gameloader.exe)"), R"(C:\)");
    EXPECT_EQ(FolderOfProgramValue(R"(C:\Games\FO2\icon.ico)"), R"(C:\Games\FO2)");
    EXPECT_EQ(FolderOfProgramValue("MsiExec.exe /X{1234}"), "");
    EXPECT_EQ(FolderOfProgramValue(R"("unterminated\x.exe)"), "unterminated");
    EXPECT_EQ(FolderOfProgramValue("   "), "");
}

TEST(WindowsSearch, DriveFoldersLikelyToHoldGamesComeFirst_WindowsAndBookkeepingNever) {
    EXPECT_EQ(OrderDriveFolders({"$Recycle.Bin", "Users", "PROGRAM FILES", "Windows", "MyGames",
                                 "Program Files (x86)", "System Volume Information", "Data",
                                 "Trò chơi", "games"}),
              (std::vector<std::string>{"PROGRAM FILES", "MyGames", "Program Files (x86)", "games",
                                        "Users", "Data", "Trò chơi"}));
}

}  // namespace
}  // namespace kickvane::game
