#include "catalog/settings.h"

#include <gtest/gtest.h>

#include "support/temp_dir.h"

namespace kickvane::catalog {
namespace {

using testing::ReadText;
using testing::TempDir;
using testing::WriteFile;

TEST(Settings, SaveWritesTheToolsSectionsOnlyAndTheirKeysInOrder) {
    TempDir tool;
    WriteFile(tool / "ThietLap.ini", "[KiemTra]\r\nPhienBan=v2.1\r\n[Extra]\r\nx=1\r\n");
    ASSERT_TRUE(SaveSettings(tool.path(), {"C:\\Games", "F10", PatchSelection::Defaults()}).ok());

    const std::string text = ReadText(tool / "ThietLap.ini");
    EXPECT_EQ(
        text.rfind("[Thiet lap]\r\nDuongDan=C:\\Games\r\nPhimTat=F10\r\n[Thay doi]\r\nBong=1\r\n",
                   0),
        0u);
    EXPECT_NE(text.find("\r\n[Bong]\r\nMacDinh=False\r\nEuropa League 2011=True\r\n"),
              std::string::npos);
    EXPECT_EQ(text.find("KiemTra"), std::string::npos);
    EXPECT_EQ(text.find("Extra"), std::string::npos);
}

TEST(Settings, LoadTakesValuesKeyByKey) {
    TempDir tool;
    WriteFile(tool / "ThietLap.ini",
              "[Thiet lap]\nDuongDan=\nPhimTat=f7\n"
              "[Thay doi]\nBong=abc\nCo=0\nQcao= 1 \nGdien=2\n"
              "[Bong]\nMacDinh=True\nUCL 2011=true\n"
              "[Khac]\nQcaoMacDinh=False\nCoMacDinh=0\nMarkMacDinh=maybe\n");
    Settings settings;  // as the widgets are before the load
    settings.selection.SetSwitchValue(0, 1);
    ASSERT_TRUE(LoadSettings(tool.path(), settings).ok());

    EXPECT_EQ(settings.gameFolder, "");               // empty value, not the default
    EXPECT_EQ(settings.hotkey, "f7");                 // handed over unchanged
    EXPECT_EQ(settings.selection.SwitchValue(0), 1);  // "abc" leaves the switch as it was
    EXPECT_FALSE(settings.selection.IsOn(1));
    EXPECT_TRUE(settings.selection.IsOn(2));
    EXPECT_EQ(settings.selection.SwitchValue(3), 2);
    EXPECT_TRUE(settings.selection.IsOn(4));  // missing key: default
    // The last "True" of a group wins; a group read as all false keeps nothing.
    EXPECT_EQ(settings.selection.ChosenOption(GroupId::Ball)->key, "UCL 2011");
    EXPECT_FALSE(settings.selection.Chosen(GroupId::Adboard).has_value());
    EXPECT_FALSE(settings.selection.Chosen(GroupId::Pitch).has_value());
    // "maybe" is no truth value: the button keeps its state instead of taking the default.
    EXPECT_FALSE(settings.selection.Chosen(GroupId::Mark).has_value());
}

// A settings file under another letter case is the settings readers' and writers' own test.
TEST(Settings, MissingFileLoadsTheDefaults) {
    TempDir tool;
    const LoadedSettings missing = LoadSettings(tool.path());
    EXPECT_TRUE(missing.status.ok());
    EXPECT_EQ(missing.settings.gameFolder, "C:\\Program Files");
    EXPECT_EQ(missing.settings.hotkey, "F7");
    EXPECT_EQ(missing.settings.selection, PatchSelection::Defaults());
}

TEST(Settings, NumbersRoundHalvesToEvenAndTruthValuesIgnoreLetterCase) {
    const std::pair<const char*, std::optional<int>> numbers[] = {
        {" 1 ", 1}, {"-3", -3}, {"1.5", 2}, {"2.5", 2}, {"abc", {}}, {"", {}}, {"1e99", {}}};
    for (const auto& [text, value] : numbers) {
        EXPECT_EQ(ParseWholeNumber(text), value) << text;
    }
    const std::pair<const char*, std::optional<bool>> truths[] = {
        {"tRuE", true}, {"FALSE", false}, {"0", false}, {"-1", true}, {"yes", {}}};
    for (const auto& [text, value] : truths) {
        EXPECT_EQ(ParseTruthValue(text), value) << text;
    }
}

}  // namespace
}  // namespace kickvane::catalog
