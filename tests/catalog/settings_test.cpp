#include "catalog/settings.h"

#include <gtest/gtest.h>

#include <regex>

#include "support/temp_dir.h"

namespace kickvane::catalog {
namespace {

using testing::ReadText;
using testing::TempDir;
using testing::WriteFile;

// Sections and keys in file order, read back from the saved text.
std::vector<std::string> Lines(const std::string& text) {
    std::vector<std::string> lines;
    std::string line;
    for (char c : text) {
        if (c == '\n') {
            if (!line.empty() && line.back() == '\r') {
                line.pop_back();
            }
            if (!line.empty()) {
                lines.push_back(line);
            }
            line.clear();
        } else {
            line += c;
        }
    }
    return lines;
}

TEST(Settings, MissingFileLoadsDefaults) {
    TempDir tool;
    const Settings settings = LoadSettings(tool.path());
    EXPECT_EQ(settings.gameFolder, "C:\\Program Files");
    EXPECT_EQ(settings.hotkey, "F7");
    EXPECT_EQ(settings.selection, PatchSelection::Defaults());
}

TEST(Settings, SaveWritesExactlyTheFiveSectionsInOrderAndDropsOthers) {
    TempDir tool;
    WriteFile(tool / "ThietLap.ini", "[KiemTra]\r\nPhienBan=v2.1\r\n[Extra]\r\nx=1\r\n");
    Settings settings{"C:\\Games\\FO2", "F10", PatchSelection::Defaults()};
    ASSERT_TRUE(SaveSettings(tool.path(), settings).ok());

    const std::vector<std::string> lines = Lines(ReadText(tool / "ThietLap.ini"));
    std::vector<std::string> sections;
    int keys = 0;
    for (const std::string& line : lines) {
        if (line.front() == '[') {
            sections.push_back(line);
        } else {
            ++keys;
        }
    }
    EXPECT_EQ(sections, (std::vector<std::string>{"[Thiet lap]", "[Thay doi]", "[Bong]",
                                                  "[Bang Ti So]", "[Khac]"}));
    EXPECT_EQ(keys, 39);
    EXPECT_EQ(lines[1], "DuongDan=C:\\Games\\FO2");
    EXPECT_EQ(lines[2], "PhimTat=F10");
    EXPECT_EQ(lines[4], "Bong=1");
    EXPECT_EQ(lines[17], "SVD=0");
    EXPECT_EQ(lines[19], "MacDinh=False");
    EXPECT_EQ(lines[20], "Europa League 2011=True");
}

TEST(Settings, SaveThenLoadRestoresEverySwitchAndVariant) {
    TempDir tool;
    Settings saved{"/home/player/.wine/drive_c/Program Files/Garena/FIFA Online 2 with a long name",
                   "F3", PatchSelection::Defaults()};
    saved.selection.setSwitchValue(0, 0);
    saved.selection.setSwitchValue(12, 1);
    saved.selection.setOptionValue(OptionArray::UniOption, 3, true);
    saved.selection.setOptionValue(OptionArray::UniOption3, 7, true);
    saved.selection.setOptionValue(OptionArray::UniOption1, 3, true);
    saved.selection.setOptionValue(OptionArray::UniOption1, 6, true);
    saved.selection.setOptionValue(OptionArray::UniOption1, 10, false);  // mark: none chosen
    saved.selection.setOptionValue(OptionArray::UniOption1, 8, false);
    ASSERT_TRUE(SaveSettings(tool.path(), saved).ok());

    const Settings loaded = LoadSettings(tool.path());
    EXPECT_EQ(loaded.gameFolder, saved.gameFolder);  // whole, however long
    EXPECT_EQ(loaded.hotkey, "F3");
    EXPECT_EQ(loaded.selection, saved.selection);
}

TEST(Settings, LoadTakesValuesKeyByKey) {
    TempDir tool;
    WriteFile(tool / "ThietLap.ini",
              "[Thiet lap]\nDuongDan=\nPhimTat=f7\n"
              "[Thay doi]\nBong=abc\nCo=0\nQcao= 1 \nGdien=2\n"
              "[Bong]\nMacDinh=True\nUCL 2011=true\n"
              "[Khac]\nQcaoMacDinh=False\nCoMacDinh=0\nMarkMacDinh=maybe\n");
    Settings settings;  // as the widgets are before the load
    settings.selection.setSwitchValue(0, 1);
    LoadSettings(tool.path(), settings);

    EXPECT_EQ(settings.gameFolder, "");               // empty value, not the default
    EXPECT_EQ(settings.hotkey, "f7");                 // handed over unchanged
    EXPECT_EQ(settings.selection.switchValue(0), 1);  // "abc" leaves the switch as it was
    EXPECT_FALSE(settings.selection.isOn(1));
    EXPECT_TRUE(settings.selection.isOn(2));
    EXPECT_EQ(settings.selection.switchValue(3), 2);
    EXPECT_FALSE(settings.selection.isOn(3));
    EXPECT_TRUE(settings.selection.isOn(4));  // missing key: default
    EXPECT_FALSE(settings.selection.isOn(12));
    // The last "True" of a group wins; a group read as all false keeps nothing.
    EXPECT_EQ(settings.selection.chosenOption(GroupId::Ball)->key, "UCL 2011");
    EXPECT_FALSE(settings.selection.chosen(GroupId::Adboard).has_value());
    EXPECT_FALSE(settings.selection.chosen(GroupId::Pitch).has_value());
    // "maybe" is no truth value: the button keeps its state instead of taking the default.
    EXPECT_FALSE(settings.selection.chosen(GroupId::Mark).has_value());
}

TEST(Settings, FileIsFoundAndReplacedUnderAnyLetterCase) {
    TempDir tool;
    WriteFile(tool / "Thietlap.ini", "[Thiet lap]\r\nPhimTat=F2\r\n");
    EXPECT_EQ(LoadSettings(tool.path()).hotkey, "F2");

    Settings settings = LoadSettings(tool.path());
    settings.hotkey = "F9";
    ASSERT_TRUE(SaveSettings(tool.path(), settings).ok());
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator(tool.path()),
                            std::filesystem::directory_iterator()),
              1);
    EXPECT_EQ(LoadSettings(tool.path()).hotkey, "F9");
}

TEST(Settings, FailedSaveIsReportedAndKeepsThePreviousFile) {
    TempDir tool;
    WriteFile(tool / "ThietLap.ini", "[Thiet lap]\r\nPhimTat=F2\r\n");
    Settings settings = LoadSettings(tool.path());
    EXPECT_FALSE(SaveSettings(tool / "missing", settings).ok());

    // A file that cannot be replaced: its name is taken by a folder.
    TempDir blocked;
    std::filesystem::create_directories(blocked / "ThietLap.ini");
    EXPECT_FALSE(SaveSettings(blocked.path(), settings).ok());
    EXPECT_EQ(ReadText(tool / "ThietLap.ini"), "[Thiet lap]\r\nPhimTat=F2\r\n");
}

TEST(Settings, ValueParsing) {
    EXPECT_EQ(ParseWholeNumber(" 1 "), 1);
    EXPECT_EQ(ParseWholeNumber("-3"), -3);
    EXPECT_EQ(ParseWholeNumber("1.5"), 2);
    EXPECT_EQ(ParseWholeNumber("2.5"), 2);
    EXPECT_FALSE(ParseWholeNumber("abc").has_value());
    EXPECT_FALSE(ParseWholeNumber("").has_value());
    EXPECT_FALSE(ParseWholeNumber("1e99").has_value());
    EXPECT_EQ(ParseTruthValue("tRuE"), true);
    EXPECT_EQ(ParseTruthValue("FALSE"), false);
    EXPECT_EQ(ParseTruthValue("0"), false);
    EXPECT_EQ(ParseTruthValue("-1"), true);
    EXPECT_FALSE(ParseTruthValue("yes").has_value());
}

}  // namespace
}  // namespace kickvane::catalog
