#include "catalog/ini.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <iterator>
#include <string>
#include <tuple>
#include <utility>
#include <vector>

#ifndef _WIN32
#include <sys/stat.h>
#include <unistd.h>
#endif

#include "support/temp_dir.h"
#include "text/utf.h"

namespace kickvane::catalog {
namespace {

namespace fs = std::filesystem;
using testing::ReadText;
using testing::WriteFile;

class IniTest : public ::testing::Test {
protected:
    std::string Read(std::string_view section, std::string_view key) const {
        return ReadIni(file_, section, key, "<none>");
    }

    // The folder holds the settings file under its first name, and nothing else.
    bool OnlyTheFirstFile() const {
        return std::distance(fs::directory_iterator(dir_.path()), {}) == 1 && fs::exists(file_);
    }

    testing::TempDir dir_;
    fs::path file_ = dir_ / "ThietLap.ini";
};

// A byte-order mark, lines ending in LF and in CR LF, stray lines, and a line that is not
// UTF-8, which is read as Windows-1252 as a whole.
TEST_F(IniTest, ReadsNamesInAnyCase_OneQuotePair_TheFirstKey_AndOldLinesAsWindows1252) {
    WriteFile(file_,
              "\xEF\xBB\xBF; Key=comment\n[ Thiet Lap ]\n  duongdan =  D:\\Games\\FO2 \t\r\n"
              "Empty=\r\nBlank=   \r\n[S\nno equals sign\n[S] trailing text\r\n;Key=commented\n"
              "Key=first=still first\r\nKEY=second\nDouble=\"C:\\My Games\"\nMixed=\"x'\nLone=\"\n"
              "Nested=\"\"q\"\"\n[Caf\xE9]\r\nHigh=\x80\x81\x8A\x9F\r\nUtf=Caf\xC3\xA9\r\n"
              "Mixed=\xC3\xA9\xE9\r\n");
    const std::tuple<const char*, const char*, const char*> cases[] = {
        {"THIET LAP", " duongDAN ", "D:\\Games\\FO2"},
        {"Thiet lap", "Empty", ""},
        {"Thiet lap", "Blank", ""},
        {"Thiet lap", "Missing", "<none>"},
        {"Missing", "DuongDan", "<none>"},
        {"S", "Key", "first=still first"},
        {"S", "no equals sign", "<none>"},
        {"S", "Double", "C:\\My Games"},
        {"S", "Mixed", "\"x'"},
        {"S", "Lone", "\""},
        {"S", "Nested", "\"q\""},
        // Euro sign, the unassigned 0x81 as U+0081, S caron, Y diaeresis.
        {"Caf\xC3\xA9", "High", "\xE2\x82\xAC\xC2\x81\xC5\xA0\xC5\xB8"},
        {"Caf\xC3\xA9", "Utf", "Caf\xC3\xA9"},
        {"Caf\xC3\xA9", "Mixed", "\xC3\x83\xC2\xA9\xC3\xA9"}};
    for (const auto& [section, key, value] : cases) {
        EXPECT_EQ(Read(section, key), value) << section << " " << key;
    }
    EXPECT_EQ(ReadIni(dir_ / "none.ini", "Thiet lap", "DuongDan", "F7"), "F7");
    // The platform drops trailing blanks of the default, not leading ones.
    EXPECT_EQ(ReadIni(file_, "Missing", "Key", " F7 \t "), " F7");

    const std::string path = "D:\\" + std::string(300, 'p') + "\\FIFA Online 2";
    ASSERT_TRUE(WriteIni(file_, "Thiet lap", "DuongDan", path).ok());
    EXPECT_EQ(Read("Thiet lap", "DuongDan"), path);  // whole, however long
}

// The byte-order mark stays; lines the write does not set keep their bytes and their line ends.
TEST_F(IniTest, WriteReplacesValuesInPlace_AddsKeysAndSections_KeepsTheRest) {
    WriteFile(file_,
              "\xEF\xBB\xBF; settings\r\n[Thiet lap]\r\n  duongdan = old \r\nPhimTat=F7\n\r\n"
              "; adboards\r\n[Khac]\r\nQcaoVN=C:\\Caf\xE9\n");

    ASSERT_TRUE(WriteIni(file_, " thiet LAP ", "DuongDan", "D:\\New").ok());
    ASSERT_TRUE(WriteIni(file_, "Thiet lap", "Extra", "1").ok());
    ASSERT_TRUE(WriteIni(file_, "Khac", "QcaoUCL", "True").ok());
    ASSERT_TRUE(WriteIni(file_, "Bong", "MacDinh", "False").ok());

    EXPECT_EQ(ReadText(file_),
              "\xEF\xBB\xBF; settings\r\n[Thiet lap]\r\nduongdan=D:\\New\r\nPhimTat=F7\nExtra=1\r\n"
              "\r\n; adboards\r\n[Khac]\r\nQcaoVN=C:\\Caf\xE9\nQcaoUCL=True\r\n"
              "[Bong]\r\nMacDinh=False\r\n");
}

// A game folder that a Vietnamese Windows wrote in its code page (1258: "Trò" is "Tro" and a
// combining grave accent, "ơ" is 0xF5) reads as Vietnamese; a write of another key leaves that
// line, and every other line it does not set, byte for byte as it was.
TEST_F(IniTest, VietnameseWindowsLinesReadAsSuch_AndAWriteKeepsTheLinesItDoesNotSet) {
    const std::string folderLine = "DuongDan=C:\\Tro\xCC ch\xF5i";
    WriteFile(file_, "[Thiet lap]\r\n" + folderLine + "\r\nPhimTat=F7\n; Caf\xE9 \xA9\r\n");
#ifndef _WIN32  // Windows reads such lines in its own code page
    EXPECT_EQ(Read("Thiet lap", "DuongDan"), "C:\\Tr\xC3\xB2 ch\xC6\xA1i");
#endif
    ASSERT_TRUE(WriteIni(file_, "Thiet lap", "PhimTat", "F9").ok());
    ASSERT_TRUE(WriteIni(file_, "Khac", "QcaoVN", "True").ok());
    EXPECT_EQ(ReadText(file_), "[Thiet lap]\r\n" + folderLine +
                                   "\r\nPhimTat=F9\n; Caf\xE9 \xA9\r\n[Khac]\r\nQcaoVN=True\r\n");
}

// The writer never makes a file that the reader would refuse for its size.
TEST_F(IniTest, AWriteThatWouldMakeTheFileTooLargeIsRefusedAndChangesNothing) {
    const std::string value(120 * 1024, 'v');
    int written = 0;
    while (written < 20 && WriteIni(file_, "S", "K" + std::to_string(written), value).ok()) {
        ++written;
    }
    EXPECT_EQ(written, 8);
    const std::string before = ReadText(file_);
    const Status refused = WriteIni(file_, "S", "K8", value);
    ASSERT_FALSE(refused.ok());
    EXPECT_NE(refused.reason().find("1024 KiB"), std::string::npos) << refused.reason();
    EXPECT_EQ(ReadText(file_), before);
    EXPECT_EQ(Read("S", "K7"), value);  // what was written reads back
    EXPECT_TRUE(OnlyTheFirstFile());
}

TEST_F(IniTest, TheFileIsFoundWhateverTheLetterCaseOfItsName) {
    WriteFile(file_, "[Thiet lap]\r\nPhimTat=F9\r\n");

    EXPECT_EQ(ReadIni(dir_ / "THIETLAP.INI", "Thiet lap", "PhimTat", ""), "F9");
    ASSERT_TRUE(WriteIni(dir_ / "Thietlap.ini", "KiemTra", "PhienBan", "v2.1").ok());
    EXPECT_EQ(ReadText(file_), "[Thiet lap]\r\nPhimTat=F9\r\n[KiemTra]\r\nPhienBan=v2.1\r\n");

    IniDocument document;  // a saved document replaces the whole file
    ASSERT_TRUE(document.Set("Bang Ti So", "K+NS", "False").ok());
    ASSERT_TRUE(document.Save(dir_ / "thietlap.ini").ok());
    EXPECT_EQ(ReadText(file_), "[Bang Ti So]\r\nK+NS=False\r\n");
    EXPECT_TRUE(OnlyTheFirstFile());
}

// Line breaks in a value or name are dropped; names that would read back as other entries are
// refused.
TEST_F(IniTest, WriteNeverMakesOtherEntriesAppear) {
    ASSERT_TRUE(WriteIni(file_, "KiemTra", "PhienBan", "v2.1\r\n").ok());
    ASSERT_TRUE(WriteIni(file_, "KiemTra", "Next", "x\ny=1\r[Other]").ok());
    ASSERT_TRUE(WriteIni(file_, "Evil\r\n[Other", "K\r\n[Other]\nX", "1").ok());
    const std::string written =
        "[KiemTra]\r\nPhienBan=v2.1\r\nNext=xy=1[Other]\r\n[Evil[Other]\r\nK[Other]X=1\r\n";
    EXPECT_EQ(ReadText(file_), written);
    EXPECT_EQ(Read("Other", "X"), "<none>");

    for (const auto& [section, key] :
         {std::pair{"S", "A=B"}, {"S", "[T]"}, {"S", ";A"}, {"S]x", "A"}}) {
        EXPECT_FALSE(WriteIni(file_, section, key, "x").ok()) << section << " " << key;
    }
    EXPECT_EQ(ReadText(file_), written);
}

TEST_F(IniTest, FailedWriteLeavesTheOldFileWhole) {
    const Status missing =
        WriteIni(dir_ / "missing" / "ThietLap.ini", "Thiet lap", "PhimTat", "F7");
    EXPECT_FALSE(missing.ok());
    EXPECT_FALSE(missing.reason().empty());
    EXPECT_FALSE(fs::exists(dir_ / "missing"));
#ifdef _WIN32
    GTEST_SKIP() << "a read-only folder does not stop replacing its files on Windows";
#else
    if (::geteuid() == 0) {
        GTEST_SKIP() << "root ignores permissions";
    }
#endif
    const std::string before = "[Thiet lap]\r\nPhimTat=F7\r\n; note\n";
    WriteFile(file_, before);
    // A read-only folder takes no new file; a file that cannot be read must not be overwritten.
    for (const auto& [locked, perms] :
         {std::pair{dir_.path(), fs::perms::owner_read | fs::perms::owner_exec},
          std::pair{file_, fs::perms::owner_write}}) {
        fs::permissions(locked, perms);
        const Status status = WriteIni(file_, "Thiet lap", "PhimTat", "F9");
        fs::permissions(locked, fs::perms::owner_all);
        EXPECT_FALSE(status.ok()) << locked;
        EXPECT_EQ(ReadText(file_), before);
        EXPECT_TRUE(OnlyTheFirstFile());
    }
}

std::string Utf16(std::string_view utf8, bool bigEndian) {
    std::string bytes = bigEndian ? "\xFE\xFF" : "\xFF\xFE";
    for (const char16_t unit : text::Utf8ToUtf16(utf8)) {
        const char high = static_cast<char>(unit >> 8);
        const char low = static_cast<char>(unit & 0xFF);
        bytes += bigEndian ? high : low;
        bytes += bigEndian ? low : high;
    }
    return bytes;
}

TEST_F(IniTest, Utf16FilesAreReadAndWrittenBackInTheirByteOrder) {
    for (const bool bigEndian : {false, true}) {
        WriteFile(file_, Utf16("[Thiet lap]\r\nDuongDan=C:\\Trò chơi\r\n", bigEndian));
        EXPECT_EQ(Read("thiet lap", "DuongDan"), "C:\\Trò chơi");
        ASSERT_TRUE(WriteIni(file_, "Thiet lap", "PhimTat", "F9").ok());
        EXPECT_EQ(ReadText(file_),
                  Utf16("[Thiet lap]\r\nDuongDan=C:\\Trò chơi\r\nPhimTat=F9\r\n", bigEndian));
    }
}

TEST_F(IniTest, OnlyTheFirstSectionOfANameCountsAndLeadingKeysHaveTheEmptySection) {
    WriteFile(file_, "top=1\r\n[S]\r\nA=first\r\n[x]\r\n[s]\r\nA=second\r\nB=later\r\n");
    EXPECT_EQ(Read("", "top"), "1");
    EXPECT_EQ(Read("S", "top"), "<none>");
    EXPECT_EQ(Read("s", "A"), "first");
    EXPECT_EQ(Read("S", "B"), "<none>");

    ASSERT_TRUE(WriteIni(file_, "S", "B", "new").ok());
    ASSERT_TRUE(WriteIni(file_, "", "top2", "2").ok());
    EXPECT_EQ(
        ReadText(file_),
        "top=1\r\ntop2=2\r\n[S]\r\nA=first\r\nB=new\r\n[x]\r\n[s]\r\nA=second\r\nB=later\r\n");
}

// A settings file that is no text file of ours is reported, read as nothing and never written
// over; an empty file is simply empty.
TEST_F(IniTest, WhatCannotBeReadAsSettingsIsAFailureWithAReason) {
    const auto unreadable = [&](const fs::path& path) {
        IniDocument document;
        const Status read = IniDocument::Read(path, &document);
        EXPECT_FALSE(read.ok()) << path;
        EXPECT_NE(read.reason().find(path.filename().string()), std::string::npos) << path;
        EXPECT_EQ(ReadIni(path, "Thiet lap", "PhimTat", "F7"), "F7");
        EXPECT_FALSE(WriteIni(path, "Thiet lap", "PhimTat", "F9").ok()) << path;
    };
    const std::string junk("\x89PNG\r\n\x1A\n\0\0\0\rIHDR[Thiet lap]\nPhimTat=F1\n", 34);
    WriteFile(file_, junk);
    unreadable(file_);
    EXPECT_EQ(ReadText(file_), junk);
    WriteFile(file_, std::string(kMaxIniBytes + 1, 'x'));
    unreadable(file_);
    fs::remove(file_);
    fs::create_directory(file_);
    unreadable(file_);
#ifndef _WIN32
    unreadable("/dev/zero");
    ASSERT_EQ(::mkfifo((dir_ / "fifo.ini").c_str(), 0600), 0);
    unreadable(dir_ / "fifo.ini");
#endif

    WriteFile(dir_ / "empty.ini", "");
    IniDocument document;
    EXPECT_TRUE(IniDocument::Read(dir_ / "empty.ini", &document).ok());
    EXPECT_TRUE(IniDocument::Read(dir_ / "missing.ini", &document).ok());
}

}  // namespace
}  // namespace kickvane::catalog
