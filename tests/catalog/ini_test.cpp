#include "catalog/ini.h"

#include <gtest/gtest.h>

#include <atomic>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <random>
#include <string>
#include <system_error>
#include <vector>

#ifndef _WIN32
#include <unistd.h>
#endif

namespace kickvane::catalog {
namespace {

namespace fs = std::filesystem;

class TempFolder {
public:
    TempFolder() {
        static std::atomic<int> counter{0};
        path_ =
            fs::temp_directory_path() / ("kickvane-ini-" + std::to_string(std::random_device{}()) +
                                         "-" + std::to_string(counter++));
        fs::create_directories(path_);
    }
    ~TempFolder() {
        std::error_code error;
        fs::permissions(path_, fs::perms::owner_all, fs::perm_options::add, error);
        fs::remove_all(path_, error);
    }
    TempFolder(const TempFolder&) = delete;
    TempFolder& operator=(const TempFolder&) = delete;

    const fs::path& path() const { return path_; }

private:
    fs::path path_;
};

void WriteBytes(const fs::path& file, std::string_view bytes) {
    std::ofstream out(file, std::ios::binary | std::ios::trunc);
    out.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
}

std::string ReadBytes(const fs::path& file) {
    std::ifstream in(file, std::ios::binary);
    return std::string(std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>());
}

std::vector<std::string> FileNames(const fs::path& folder) {
    std::vector<std::string> names;
    for (const fs::directory_entry& entry : fs::directory_iterator(folder)) {
        names.push_back(entry.path().filename().string());
    }
    return names;
}

bool RunningAsRoot() {
#ifdef _WIN32
    return false;
#else
    return ::geteuid() == 0;
#endif
}

class IniTest : public ::testing::Test {
protected:
    TempFolder folder_;
    fs::path file_ = folder_.path() / "ThietLap.ini";
};

using ReadIniTest = IniTest;
using WriteIniTest = IniTest;
using IniDocumentTest = IniTest;

TEST_F(ReadIniTest, MatchesNamesIgnoringCaseAndBlanks) {
    // A byte-order mark, then lines ending in LF and in CR LF.
    WriteBytes(
        file_,
        "\xEF\xBB\xBF[ Thiet Lap ]\n  duongdan =  D:\\Games\\FO2 \t\r\n[Bang Ti So]\nk+ns=True");

    EXPECT_EQ(ReadIni(file_, "Thiet lap", "DuongDan", "x"), "D:\\Games\\FO2");
    EXPECT_EQ(ReadIni(file_, "THIET LAP", " duongDAN ", "x"), "D:\\Games\\FO2");
    EXPECT_EQ(ReadIni(file_, "Bang Ti So", "K+NS", "False"), "True");
}

TEST_F(ReadIniTest, ReturnsEmpty_WhenKeyHasEmptyValue_AndDefaultOnlyWhenMissing) {
    WriteBytes(file_, "[Thiet lap]\r\nDuongDan=\r\nPhimTat=   \r\n");

    EXPECT_EQ(ReadIni(file_, "Thiet lap", "DuongDan", "C:\\Program Files"), "");
    EXPECT_EQ(ReadIni(file_, "Thiet lap", "PhimTat", "F7"), "");
    EXPECT_EQ(ReadIni(file_, "Thiet lap", "Missing", "F7"), "F7");
    EXPECT_EQ(ReadIni(file_, "Missing", "DuongDan", "F7"), "F7");
    EXPECT_EQ(ReadIni(folder_.path() / "none.ini", "Thiet lap", "DuongDan", "F7"), "F7");
    // The platform drops trailing blanks of the default, not leading ones.
    EXPECT_EQ(ReadIni(file_, "Missing", "Key", " F7 \t "), " F7");
}

TEST_F(ReadIniTest, StripsOneMatchingPairOfQuotes) {
    WriteBytes(file_,
               "[S]\nDouble=\"C:\\My Games\"\nSingle='x'\nMixed=\"x'\nLone=\"\nNested=\"\"q\"\"\n"
               "Inner=a\"b\"\n");

    EXPECT_EQ(ReadIni(file_, "S", "Double", ""), "C:\\My Games");
    EXPECT_EQ(ReadIni(file_, "S", "Single", ""), "x");
    EXPECT_EQ(ReadIni(file_, "S", "Mixed", ""), "\"x'");
    EXPECT_EQ(ReadIni(file_, "S", "Lone", ""), "\"");
    EXPECT_EQ(ReadIni(file_, "S", "Nested", ""), "\"q\"");
    EXPECT_EQ(ReadIni(file_, "S", "Inner", ""), "a\"b\"");
}

TEST_F(ReadIniTest, ToleratesStrayLines_AndReturnsFirstMatchingKey) {
    WriteBytes(file_,
               "Orphan=outside\n; Key=comment\n[S\nno equals sign\n[S] trailing text\r\n"
               ";Key=commented\nKey=first=still first\r\nKEY=second\n[Other]\nKey=other\n");

    EXPECT_EQ(ReadIni(file_, "S", "Key", "d"), "first=still first");
    EXPECT_EQ(ReadIni(file_, "Other", "Key", "d"), "other");
    EXPECT_EQ(ReadIni(file_, "", "Orphan", "d"), "d");
    EXPECT_EQ(ReadIni(file_, "S", "no equals sign", "d"), "d");
}

TEST_F(ReadIniTest, ReturnsLongValuesWhole) {
    const std::string path = "D:\\" + std::string(300, 'p') + "\\FIFA Online 2";
    ASSERT_TRUE(WriteIni(file_, "Thiet lap", "DuongDan", path).ok());

    EXPECT_EQ(ReadIni(file_, "Thiet lap", "DuongDan", ""), path);
}

TEST_F(ReadIniTest, DecodesLinesThatAreNotUtf8AsWindows1252) {
    WriteBytes(file_,
               "[Caf\xE9]\r\nDuongDan=C:\\Jeux\\Caf\xE9\r\nHigh=\x80\x81\x8A\x9F\r\n"
               "Utf=Caf\xC3\xA9\r\nMixed=\xC3\xA9\xE9\r\n");

    EXPECT_EQ(ReadIni(file_, "Caf\xC3\xA9", "DuongDan", ""), "C:\\Jeux\\Caf\xC3\xA9");
    // Euro sign, the unassigned 0x81 as U+0081, S caron, Y diaeresis.
    EXPECT_EQ(ReadIni(file_, "Caf\xC3\xA9", "High", ""), "\xE2\x82\xAC\xC2\x81\xC5\xA0\xC5\xB8");
    EXPECT_EQ(ReadIni(file_, "Caf\xC3\xA9", "Utf", ""), "Caf\xC3\xA9");
    // One invalid byte makes the whole line Windows-1252.
    EXPECT_EQ(ReadIni(file_, "Caf\xC3\xA9", "Mixed", ""), "\xC3\x83\xC2\xA9\xC3\xA9");
}

TEST_F(WriteIniTest, ReplacesValueInPlace_AndKeepsRestOfFile) {
    WriteBytes(file_,
               "; settings\r\n[Thiet lap]\r\n  duongdan = old \r\nPhimTat=F7\r\n\r\n"
               "; adboards\r\n[Khac]\r\nQcaoVN=False\r\n");

    ASSERT_TRUE(WriteIni(file_, " thiet LAP ", "DuongDan", "D:\\New").ok());
    ASSERT_TRUE(WriteIni(file_, "Thiet lap", "Extra", "1").ok());
    ASSERT_TRUE(WriteIni(file_, "Khac", "QcaoUCL", "True").ok());
    ASSERT_TRUE(WriteIni(file_, "Bong", "MacDinh", "False").ok());

    EXPECT_EQ(ReadBytes(file_),
              "; settings\r\n[Thiet lap]\r\nduongdan=D:\\New\r\nPhimTat=F7\r\nExtra=1\r\n\r\n"
              "; adboards\r\n[Khac]\r\nQcaoVN=False\r\nQcaoUCL=True\r\n"
              "[Bong]\r\nMacDinh=False\r\n");
}

TEST_F(WriteIniTest, KeepsByteOrderMark_AndRewritesOldLinesAsUtf8WithCrLf) {
    WriteBytes(file_, "\xEF\xBB\xBF[S]\nPath=C:\\Caf\xE9\nB=2\n");

    ASSERT_TRUE(WriteIni(file_, "S", "B", "3").ok());

    EXPECT_EQ(ReadBytes(file_), "\xEF\xBB\xBF[S]\r\nPath=C:\\Caf\xC3\xA9\r\nB=3\r\n");
}

TEST_F(WriteIniTest, UsesExistingFileWhateverTheLetterCaseOfItsName) {
    WriteBytes(file_, "[Thiet lap]\r\nPhimTat=F9\r\n");

    EXPECT_EQ(ReadIni(folder_.path() / "THIETLAP.INI", "Thiet lap", "PhimTat", ""), "F9");
    ASSERT_TRUE(WriteIni(folder_.path() / "Thietlap.ini", "KiemTra", "PhienBan", "v2.1").ok());

    EXPECT_EQ(FileNames(folder_.path()), std::vector<std::string>{"ThietLap.ini"});
    EXPECT_EQ(ReadBytes(file_), "[Thiet lap]\r\nPhimTat=F9\r\n[KiemTra]\r\nPhienBan=v2.1\r\n");
}

TEST_F(WriteIniTest, StripsLineBreaks_SoNoOtherEntryIsDisturbed) {
    ASSERT_TRUE(WriteIni(file_, "KiemTra", "PhienBan", "v2.1\r\n").ok());
    ASSERT_TRUE(WriteIni(file_, "KiemTra", "Next", "x\ny=1\r[Other]").ok());
    ASSERT_TRUE(WriteIni(file_, "Evil\r\n[Other", "K\r\n[Other]\nX", "1").ok());

    EXPECT_EQ(ReadIni(file_, "KiemTra", "PhienBan", ""), "v2.1");
    EXPECT_EQ(ReadIni(file_, "KiemTra", "Next", ""), "xy=1[Other]");
    EXPECT_EQ(ReadIni(file_, "KiemTra", "y", "none"), "none");
    EXPECT_EQ(ReadIni(file_, "Other", "X", "none"), "none");
    EXPECT_EQ(ReadIni(file_, "Evil[Other", "K[Other]X", ""), "1");
    EXPECT_EQ(ReadBytes(file_),
              "[KiemTra]\r\nPhienBan=v2.1\r\nNext=xy=1[Other]\r\n[Evil[Other]\r\nK[Other]X=1\r\n");
}

TEST_F(WriteIniTest, RejectsNamesThatWouldReadBackAsOtherEntries) {
    const std::string before = "[S]\r\nA=keep\r\n";
    WriteBytes(file_, before);

    EXPECT_FALSE(WriteIni(file_, "S", "A=B", "x").ok());
    EXPECT_FALSE(WriteIni(file_, "S", "[T]", "x").ok());
    EXPECT_FALSE(WriteIni(file_, "S", ";A", "x").ok());
    EXPECT_FALSE(WriteIni(file_, "S]x", "A", "x").ok());

    EXPECT_EQ(ReadBytes(file_), before);
}

TEST_F(WriteIniTest, Fails_WhenFolderIsMissing) {
    const fs::path target = folder_.path() / "missing" / "ThietLap.ini";

    const Status status = WriteIni(target, "Thiet lap", "PhimTat", "F7");

    EXPECT_FALSE(status.ok());
    EXPECT_FALSE(status.reason().empty());
    EXPECT_FALSE(fs::exists(target));
}

TEST_F(WriteIniTest, Fails_AndLeavesOldFileWhole_WhenFolderIsReadOnly) {
    if (RunningAsRoot()) {
        GTEST_SKIP() << "root ignores folder permissions";
    }
    const std::string before = "[Thiet lap]\r\nPhimTat=F7\r\n; note\n";
    WriteBytes(file_, before);
    fs::permissions(folder_.path(), fs::perms::owner_read | fs::perms::owner_exec);

    const Status status = WriteIni(file_, "Thiet lap", "PhimTat", "F9");

    fs::permissions(folder_.path(), fs::perms::owner_all);
    EXPECT_FALSE(status.ok());
    EXPECT_EQ(ReadBytes(file_), before);
    EXPECT_EQ(FileNames(folder_.path()), std::vector<std::string>{"ThietLap.ini"});
}

TEST_F(WriteIniTest, Fails_AndKeepsFile_WhenExistingFileCannotBeRead) {
    if (RunningAsRoot()) {
        GTEST_SKIP() << "root reads any file";
    }
    const std::string before = "[Thiet lap]\r\nDuongDan=D:\\Games\r\n";
    WriteBytes(file_, before);
    fs::permissions(file_, fs::perms::owner_write);

    const Status status = WriteIni(file_, "KiemTra", "PhienBan", "v2.1");

    fs::permissions(file_, fs::perms::owner_read | fs::perms::owner_write);
    EXPECT_FALSE(status.ok());
    EXPECT_EQ(ReadBytes(file_), before);
}

TEST_F(IniDocumentTest, SaveReplacesWholeFile) {
    WriteBytes(file_, "[KiemTra]\r\nPhienBan=v2.1\r\n");
    IniDocument document;
    ASSERT_TRUE(document.Set("Bong", "Europa League 2011", "True").ok());
    ASSERT_TRUE(document.Set("Bang Ti So", "K+NS", "False").ok());

    ASSERT_TRUE(document.Save(folder_.path() / "thietlap.ini").ok());

    EXPECT_EQ(FileNames(folder_.path()), std::vector<std::string>{"ThietLap.ini"});
    EXPECT_EQ(ReadBytes(file_),
              "[Bong]\r\nEuropa League 2011=True\r\n[Bang Ti So]\r\nK+NS=False\r\n");
}

TEST(IniDocumentGarbageTest, ParsesAnyBytes_AndReadsBackWhatWasSet) {
    constexpr char kAlphabet[] = "[]=;\r\n \t\"'aA\0\xEF\xBB\xBF\x80\x9D\xC3\xE9\xF4\xFF";
    const std::string alphabet(kAlphabet, sizeof(kAlphabet) - 1);
    std::mt19937 random(20240611);
    std::uniform_int_distribution<size_t> length(0, 120);
    std::uniform_int_distribution<size_t> pick(0, alphabet.size() - 1);
    for (int round = 0; round < 2000; ++round) {
        std::string bytes(length(random), ' ');
        for (char& c : bytes) {
            c = alphabet[pick(random)];
        }
        SCOPED_TRACE(::testing::PrintToString(bytes));

        IniDocument document = IniDocument::Parse(bytes);
        ASSERT_TRUE(document.Set("a", "a", "value").ok());
        EXPECT_EQ(document.Get("A", "A"), "value");

        const std::string saved = document.Serialize();
        const IniDocument reloaded = IniDocument::Parse(saved);
        EXPECT_EQ(reloaded.Serialize(), saved);
        EXPECT_EQ(reloaded.Get("a", "a"), "value");
    }
}

}  // namespace
}  // namespace kickvane::catalog
