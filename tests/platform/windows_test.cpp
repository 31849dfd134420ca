// The Windows backends on their own system (run under Wine in CI): file times to 100 ns,
// Vietnamese names through the wide-character file functions, the ANSI code pages.
#include <windows.h>
// windows.h names its own ReplaceFile function as a macro; ours is the platform one.
#undef ReplaceFile

#include <gtest/gtest.h>

#include "platform/filesystem.h"
#include "platform/text_encoding.h"
#include "support/temp_dir.h"

namespace kickvane::platform {
namespace {

using testing::ReadText;
using testing::TempDir;
using testing::WriteFile;

// 100 ns ticks since 1601, as Windows keeps file times.
void SetWriteTime(const fs::path& file, std::uint64_t ticks) {
    HANDLE handle = CreateFileW(file.c_str(), FILE_WRITE_ATTRIBUTES, FILE_SHARE_READ, nullptr,
                                OPEN_EXISTING, FILE_ATTRIBUTE_NORMAL, nullptr);
    ASSERT_NE(handle, INVALID_HANDLE_VALUE);
    FILETIME time{static_cast<DWORD>(ticks), static_cast<DWORD>(ticks >> 32)};
    EXPECT_TRUE(SetFileTime(handle, nullptr, nullptr, &time));
    CloseHandle(handle);
}

TEST(WindowsUpToDateCopy, ComparesTheFullFileTime_AndContentsWhereTimesAreWholeSeconds) {
    TempDir dir;
    const fs::path tool = dir / "tool.dds";
    const fs::path game = dir / "game.dds";
    WriteFile(tool, "new!");
    WriteFile(game, "old!");
    constexpr std::uint64_t kSecond = 10'000'000;
    const std::uint64_t noon = 13'300'000'000ULL * kSecond;

    // Same size, same second, 0.3 s apart: a different file.
    SetWriteTime(tool, noon + 3'000'000);
    SetWriteTime(game, noon);
    EXPECT_FALSE(IsUpToDateCopy(tool, game));
    SetWriteTime(game, noon + 3'000'000);
    EXPECT_TRUE(IsUpToDateCopy(tool, game)) << "same size and time to 100 ns";

    // Whole-second times (FAT, zip archives) alone prove nothing: the bytes decide.
    SetWriteTime(tool, noon);
    SetWriteTime(game, noon);
    EXPECT_FALSE(IsUpToDateCopy(tool, game));
    ASSERT_TRUE(ReplaceFile(tool, game));
    EXPECT_TRUE(IsUpToDateCopy(tool, game));
    EXPECT_FALSE(IsUpToDateCopy(tool, dir / "missing.dds"));
}

TEST(WindowsFiles, VietnameseNamesFromUtf8TextReachTheFileSystem) {
    TempDir dir;
    // Paths are built from UTF-8 text, as the command line and the settings file give them.
    const fs::path folder = dir.path() / PathFromUtf8("Thư mục Việt");
    ASSERT_TRUE(MakeDirectory(folder));
    const fs::path file = folder / PathFromUtf8("Đội bóng.ini");
    ASSERT_TRUE(WriteFileAtomically(file, "x=1"));
    EXPECT_EQ(ReadRegularFile(file, 64).bytes, "x=1");
    EXPECT_EQ(file.filename().wstring(), L"\u0110\u1ed9i b\u00f3ng.ini");
    ASSERT_EQ(ListPlainFiles(folder).size(), 1u);
    EXPECT_EQ(ListPlainFiles(folder)[0].filename().string(), "Đội bóng.ini");
    const fs::path copy = folder / PathFromUtf8("Bản sao.ini");
    ASSERT_TRUE(ReplaceFile(file, copy));
    EXPECT_EQ(ReadText(copy), "x=1");
    EXPECT_TRUE(FindEntryIgnoringCase(folder, "BẢN SAO.INI"));  // Windows folds any letter
}

TEST(WindowsCodePages, OlderTextIsDecodedAndComposed) {
    // Windows-1258: "Việt Nam" as "Vi" + ê + combining dot below + "t Nam".
    EXPECT_EQ(CodePageTextToUtf8("Vi\xEA\xF2t Nam", 1258).value_or(""), "Việt Nam");
    EXPECT_EQ(CodePageTextToUtf8("\xD0\xEA\xEC", 1258).value_or(""), "Đế");
    EXPECT_EQ(CodePageTextToUtf8("Caf\xE9 \x80", 1252).value_or(""), "Café €");
    EXPECT_EQ(AnsiTextToUtf8("plain"), std::optional<std::string>("plain"));
}

// The system's own codes read as their causes: a file the game holds open without sharing is
// "in use", not a failure of unknown kind.
TEST(WindowsFailureCauses, SystemCodesAndAHeldFileReadAsTheirCauses) {
    const auto cause = [](DWORD code) {
        return ClassifyError(std::error_code(static_cast<int>(code), std::system_category()));
    };
    EXPECT_EQ(cause(ERROR_ACCESS_DENIED), FailureCause::NoPermission);
    EXPECT_EQ(cause(ERROR_WRITE_PROTECT), FailureCause::ReadOnlyDisk);
    EXPECT_EQ(cause(ERROR_HANDLE_DISK_FULL), FailureCause::DiskFull);
    EXPECT_EQ(cause(ERROR_LOCK_VIOLATION), FailureCause::InUse);
    EXPECT_EQ(cause(ERROR_PATH_NOT_FOUND), FailureCause::NotFound);
    EXPECT_EQ(cause(ERROR_CRC), FailureCause::DiskError);
    EXPECT_EQ(cause(ERROR_INVALID_FUNCTION), FailureCause::Other);

    TempDir dir;
    WriteFile(dir / "source.dds", "new");
    WriteFile(dir / "held.dds", "old");
    HANDLE held = CreateFileW((dir / "held.dds").c_str(), GENERIC_READ, 0, nullptr, OPEN_EXISTING,
                              FILE_ATTRIBUTE_NORMAL, nullptr);
    ASSERT_NE(held, INVALID_HANDLE_VALUE);
    const Status replaced = ReplaceFile(dir / "source.dds", dir / "held.dds");
    CloseHandle(held);
    ASSERT_FALSE(replaced.ok());
    EXPECT_EQ(replaced.failure().cause(), FailureCause::InUse) << replaced.reason();
    EXPECT_EQ(ReadText(dir / "held.dds"), "old");
}

}  // namespace
}  // namespace kickvane::platform
