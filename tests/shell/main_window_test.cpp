#include "shell/main_window.h"

#include <gtest/gtest.h>

#include <QTest>

#include "support/trees.h"
#include "window_fixture.h"

namespace kickvane::shell {
namespace {

using catalog::GroupId;
using catalog::OptionArray;
using testing::WriteFile;

class MainWindowTest : public testing::WindowFixture {
protected:
    static int VisiblePanels(const MainWindow& window) {
        int visible = 0;
        for (int i = 0; i < kTabCount; ++i) {
            visible += window.panel(i)->isVisibleTo(&window) ? 1 : 0;
        }
        return visible;
    }
};

TEST_F(MainWindowTest, StartsOnTheFirstTabAndEachTabClickShowsExactlyOnePanel) {
    auto window = Open();
    EXPECT_EQ(window->selection(), catalog::PatchSelection::Defaults());
    auto expectShown = [&](int tab) {
        EXPECT_EQ(window->currentTab(), tab);
        EXPECT_EQ(VisiblePanels(*window), 1);
        EXPECT_TRUE(window->panel(tab)->isVisibleTo(window.get()));
    };
    expectShown(0);
    for (int tab : {2, 2, 3, 0, 1}) {
        Click(window->tabHead(tab));
        expectShown(tab);
    }
    EXPECT_EQ(window->panel(0)->y(), window->tabHeight() + 16);
    for (int i = 0; i < kTabCount; ++i) {
        EXPECT_EQ(window->tabHead(i)->size(), window->tabHead(0)->size());
        EXPECT_EQ(window->panel(i)->geometry(), window->panel(0)->geometry());
    }
}

TEST_F(MainWindowTest, OptionButtonsFollowTheContainerRule) {
    auto window = Open();
    Click(window->tabHead(3));
    Click(window->optionButton(OptionArray::UniOption1, 5));
    EXPECT_FALSE(window->optionButton(OptionArray::UniOption1, 4)->isChecked());
    EXPECT_TRUE(window->optionButton(OptionArray::UniOption1, 0)->isChecked());
    // Clicking the chosen button again keeps it chosen.
    Click(window->optionButton(OptionArray::UniOption1, 5));
    EXPECT_TRUE(window->optionButton(OptionArray::UniOption1, 5)->isChecked());
    EXPECT_EQ(window->selection().chosen(GroupId::Pitch), 5);
}

TEST_F(MainWindowTest, SettingsLoadIntoTheWidgetsAndSaveRoundTrips) {
    WriteFile(tool() / "ThietLap.ini",
              "[Thiet lap]\r\nDuongDan=D:\\Games\\FO2\r\nPhimTat=F10\r\n[Thay doi]\r\nGdien=2\r\n"
              "[Bong]\r\nUCL 2011=True\r\n");
    {
        auto window = Open();
        EXPECT_EQ(window->gameFolderBox()->text(), "D:\\Games\\FO2");
        EXPECT_EQ(window->hotkeyBox()->currentText(), "F10");
        EXPECT_EQ(window->categoryCheck(3)->checkState(), Qt::PartiallyChecked);
        EXPECT_TRUE(window->optionButton(OptionArray::UniOption, 3)->isChecked());

        Click(window->categoryCheck(0));
        Click(window->tabHead(2));
        Click(window->optionButton(OptionArray::UniOption3, 6));
        window->gameFolderBox()->setText("/home/player/FIFA Online 2");
        window->hotkeyBox()->setCurrentText("F2");
        Click(window->saveButton());
        EXPECT_EQ(dialogs_.popups, QStringList{"Đã lưu thiết lập!|2"});
    }
    auto reopened = Open();
    EXPECT_EQ(reopened->gameFolderBox()->text(), "/home/player/FIFA Online 2");
    EXPECT_EQ(reopened->hotkeyBox()->currentText(), "F2");
    EXPECT_FALSE(reopened->categoryCheck(0)->isChecked());
    EXPECT_TRUE(reopened->optionButton(OptionArray::UniOption3, 6)->isChecked());
}

TEST_F(MainWindowTest, FailedSaveShowsAnErrorInsteadOfThePopup) {
    std::filesystem::create_directories(tool() / "ThietLap.ini");  // a folder where the file goes
    auto window = Open();
    ASSERT_EQ(dialogs_.messages.size(), 1);  // the start-up says the file cannot be read
    EXPECT_TRUE(dialogs_.messages[0].contains("là một thư mục"))
        << dialogs_.messages[0].toStdString();
    Click(window->saveButton());
    EXPECT_TRUE(dialogs_.popups.isEmpty());
    ASSERT_EQ(dialogs_.messages.size(), 2);
    EXPECT_TRUE(dialogs_.messages[1].startsWith("Thông báo|Không lưu được thiết lập!"));
}

TEST_F(MainWindowTest, HotkeyTickAppliesThePatchesOnlyForAKeyThatIsNamedAndPressed) {
    testing::MakeToolFolder(tool());
    testing::MakeGameFolder(game());
    // "f7" names no key: it stays as written and triggers nothing.
    WriteFile(tool() / "ThietLap.ini",
              "[Thiet lap]\r\nDuongDan=" + game().string() + "\r\nPhimTat=f7\r\n");
    auto window = Open();
    EXPECT_EQ(window->hotkeyBox()->currentText(), "f7");
    keys_->pressed.insert(0x76);
    window->pollHotkey();
    EXPECT_TRUE(sounds_.empty());
    window->hotkeyBox()->setCurrentText("F7");
    window->pollHotkey();  // pressed since the last sample
    window->pollHotkey();  // released meanwhile: no further run
    EXPECT_EQ(sounds_.size(), 1u);
    keys_->held.insert(0x76);
    window->pollHotkey();
    window->pollHotkey();
    EXPECT_EQ(sounds_.size(), 3u);
    EXPECT_TRUE(dialogs_.notices.isEmpty());
}

TEST_F(MainWindowTest, FailedStepsOfARunAreNamedInANotice) {
    testing::MakeToolFolder(tool());
    testing::MakeGameFolder(game(), /*withZData=*/false);
    auto window = Open();
    window->gameFolderBox()->setText(QString::fromStdString(game().string()));
    window->applyPatchesNow();
    ASSERT_EQ(dialogs_.notices.size(), 1);
    EXPECT_TRUE(dialogs_.notices[0].contains(
        "Thay đổi bóng: merge ExtrasFolder\\Ball\\Europa League 2011"));
    EXPECT_EQ(sounds_.size(), 1u);
}

TEST_F(MainWindowTest, LauncherMissingShowsTheMessageAndKeepsTheWindow) {
    std::filesystem::create_directories(game());
    auto window = Open();
    window->gameFolderBox()->setText(QString::fromStdString(game().string()));
    window->show();
    Click(window->launchButton());
    EXPECT_EQ(
        dialogs_.messages,
        QStringList{"Thông báo|Không tìm thấy Gameloader.exe hoặc đường dẫn không chính xác!"});
    EXPECT_TRUE(window->isVisible());
    EXPECT_TRUE(dialogs_.popups.isEmpty());
}

TEST_F(MainWindowTest, BrowseAndQuickLoadRememberTheirFolders) {
    std::filesystem::create_directories(tool() / "data/data2/players/heads/textures");
    WriteFile(dir_ / "faces/face1.dds", "face");
    auto window = Open();

    dialogs_.folders = {std::nullopt};
    Click(window->browseButton());
    EXPECT_EQ(window->gameFolderBox()->text(), "C:\\Program Files");

    // Cancelled on first use: nothing was chosen yet.
    dialogs_.folders = {std::nullopt};
    Click(window->quickLoadButton());
    EXPECT_EQ(dialogs_.messages, QStringList{"Thông báo|Bạn chưa chọn thư mục nào!"});

    dialogs_.folders = {QString::fromStdString((dir_ / "faces").string()), std::nullopt};
    Click(window->quickLoadButton());
    std::filesystem::remove(tool() / "data/data2/players/heads/textures/face1.dds");
    Click(window->quickLoadButton());  // cancelled: the folder chosen before is loaded again
    EXPECT_EQ(dialogs_.popups, QStringList({"Hoàn tất!|2", "Hoàn tất!|2"}));
    EXPECT_TRUE(std::filesystem::exists(tool() / "data/data2/players/heads/textures/face1.dds"));
}

}  // namespace
}  // namespace kickvane::shell
