#include "text/failure_text.h"

#include <gtest/gtest.h>

#include <cerrno>

namespace kickvane::text {
namespace {

namespace fs = std::filesystem;

// Absolute on every platform: "/" here, "C:\" on Windows.
const fs::path kRoot = fs::current_path().root_path();
const ShownFolders kFolders{kRoot / "home/an/.wine/drive_c/FIFA Online 2",
                            kRoot / "home/an/kickvane"};
const fs::path kGame = kFolders.game;
const fs::path kTool = kFolders.tool;

// A failure with a C library error number; each platform's own codes compare equal to these.
Failure SystemFailure(FailedAction action, const fs::path& path, int error) {
    return {action, path, std::error_code(error, std::generic_category()), {}};
}

// Each system reason reads as its own words, and the words of a refusal follow what was being
// done; a code the table does not know is named by its number.
TEST(FailureText, SystemReasonsReadAsTheirVietnameseCause) {
    const fs::path file = kGame / "data2/cmn/cmn_settings.dds";
    const struct {
        FailedAction action;
        int error;
        std::string text;
    } cases[] = {
        {FailedAction::Replace, EPERM, "không có quyền ghi"},
        {FailedAction::Read, EACCES, "không có quyền đọc"},
        {FailedAction::Write, ENOSPC, "ổ đĩa đã đầy"},
        {FailedAction::Replace, ETXTBSY,
         "file đang được chương trình khác dùng (có thể là trò chơi)"},
        {FailedAction::Read, ENOENT, "không tìm thấy"},
        {FailedAction::Replace, EISDIR, "ở đó là một thư mục, không phải file"},
        {FailedAction::CreateFolder, ENOTDIR, "ở đó là một file, không phải thư mục"},
        {FailedAction::Write, 9999, "lỗi hệ thống (mã 9999)"},
    };
    for (const auto& c : cases) {
        EXPECT_EQ(CauseText(SystemFailure(c.action, file, c.error), kFolders), c.text) << c.error;
    }
    // The portable conditions read the same as the system's codes.
    EXPECT_EQ(
        CauseText(
            {FailedAction::Write, file, std::make_error_code(std::errc::no_space_on_device), {}},
            kFolders),
        "ổ đĩa đã đầy");
}

// A folder the game lacks is the game's, not a fault of the disk (the session's notice test reads
// that sentence whole); one the tool lacks is simply missing.
TEST(FailureText, AMissingSourceFolderOfTheToolIsNotFound) {
    const auto missing = std::make_error_code(std::errc::no_such_file_or_directory);
    EXPECT_EQ(
        FailureText({FailedAction::CopyFrom, kTool / "extras/Ball/UCL", missing, {}}, kFolders),
        "không chép được từ extras\\Ball\\UCL: không tìm thấy");
}

// Paths inside the game or tool folder are shown from there, in any letter case of the folder,
// with backslashes; the deeper folder wins where one lies in the other; others stay whole.
TEST(FailureText, PathsAreShownFromTheGameOrToolFolder) {
    EXPECT_EQ(ShownPath(kGame / "data2/ball/ball.dds", kFolders), "data2\\ball\\ball.dds");
    EXPECT_EQ(ShownPath(kRoot / "home/an/.wine/drive_c/fifa online 2/ZData", kFolders), "ZData");
    EXPECT_EQ(ShownPath(kTool / "ThietLap.ini", kFolders), "ThietLap.ini");
    // Elsewhere, and in a folder whose name only starts like the game folder's: the whole path.
    for (const fs::path& outside : {kRoot / "tmp/elsewhere/x.dds",
                                    kRoot / "home/an/.wine/drive_c/FIFA Online 2 old/a", kGame}) {
        EXPECT_EQ(ShownPath(outside, kFolders), outside.string());
    }

    const ShownFolders nested{kRoot / "g", kRoot / "g/tools/kv"};
    EXPECT_EQ(ShownPath(kRoot / "g/tools/kv/data/a", nested), "data\\a");
    EXPECT_EQ(ShownPath(kRoot / "g/data2/a", nested), "data2\\a");
    EXPECT_EQ(ShownPath(kRoot / "g/data2/a", {}), (kRoot / "g/data2/a").string());
}

TEST(FailureText, WhatFailedLeadsAndCanStartASentence) {
    const Failure save = SystemFailure(FailedAction::Replace, kTool / "ThietLap.ini", EACCES);
    EXPECT_EQ(Capitalised(FailureText(save, kFolders)),
              "Không thay được ThietLap.ini: không có quyền ghi");
    EXPECT_EQ(
        FailureText(SystemFailure(FailedAction::Run, kRoot / "usr/bin/wine", EACCES), kFolders),
        "không chạy được " + (kRoot / "usr/bin/wine").string() + ": không có quyền chạy");
    // A failure no system code describes keeps the words its finder chose.
    EXPECT_EQ(FailureText({FailedAction::Other, {}, {}, "File thiết lập hỏng."}, kFolders),
              "File thiết lập hỏng.");
}

}  // namespace
}  // namespace kickvane::text
