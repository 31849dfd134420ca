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

using MainWindowTest = testing::WindowFixture;

// Each tab click shows exactly one panel.
TEST_F(MainWindowTest, TabSwitchesShowOnePanel) {
    auto window = Open();
    CatalogPanels& panels = window->panels();
    EXPECT_EQ(panels.currentTab(), 0);
    for (int tab : {1, 2, 2, 3, 0, 3}) {
        Click(panels.tabHead(tab));
        EXPECT_EQ(panels.currentTab(), tab);
        for (int i = 0; i < kTabCount; ++i) {
            EXPECT_EQ(panels.panel(i)->isVisibleTo(window.get()), i == tab) << tab << " " << i;
        }
    }
}

TEST_F(MainWindowTest, SettingsLoadIntoTheWidgetsAndSaveRoundTrips) {
    WriteFile(tool() / "ThietLap.ini",
              "[Thiet lap]\r\nDuongDan=D:\\Games\\FO2\r\nPhimTat=F10\r\n[Thay doi]\r\nGdien=2\r\n"
              "[Bong]\r\nUCL 2011=True\r\n");
    {
        auto window = Open();
        CatalogPanels& panels = window->panels();
        EXPECT_EQ(panels.gameFolderBox()->text(), "D:\\Games\\FO2");
        EXPECT_EQ(window->buttons().hotkeyBox()->currentText(), "F10");
        EXPECT_EQ(panels.categoryCheck(3)->checkState(), Qt::PartiallyChecked);
        EXPECT_TRUE(panels.optionButton(OptionArray::Ball, 3)->isChecked());

        Click(panels.categoryCheck(0));
        Click(panels.tabHead(2));
        Click(panels.optionButton(OptionArray::Scoreboard, 6));
        Click(panels.optionButton(OptionArray::Scoreboard, 6));  // again: stays chosen
        panels.gameFolderBox()->setText("/home/player/FIFA Online 2");
        window->buttons().hotkeyBox()->setCurrentText("F2");
        QTest::keyClick(window->buttons().hotkeyBox()->lineEdit(), Qt::Key_Return);
        Click(window->buttons().save());
        EXPECT_EQ(dialogs_.popups, QStringList{"Đã lưu thiết lập!|2"});
    }
    const catalog::Settings saved = catalog::LoadSettings(tool()).settings;
    EXPECT_EQ(saved.gameFolder, "/home/player/FIFA Online 2");
    EXPECT_EQ(saved.hotkey, "F2");
    EXPECT_FALSE(saved.selection.IsOn(0));
    EXPECT_EQ(saved.selection.Chosen(GroupId::Scoreboard), 6);
}

TEST_F(MainWindowTest, UnreadableSettingsAreSaidAtStartAndAFailedSaveShowsNoPopup) {
    std::filesystem::create_directories(tool() / "ThietLap.ini");  // a folder where the file goes
    auto window = Open();
    QCoreApplication::processEvents();
    ASSERT_EQ(dialogs_.messages.size(), 1);
    EXPECT_TRUE(dialogs_.messages[0].contains("là một thư mục"))
        << dialogs_.messages[0].toStdString();
    Click(window->buttons().save());
    EXPECT_TRUE(dialogs_.popups.isEmpty());
    ASSERT_EQ(dialogs_.messages.size(), 2);
    EXPECT_TRUE(dialogs_.messages[1].startsWith("Thông báo|Không lưu được thiết lập!"));
}

TEST_F(MainWindowTest, AHotkeyTextThatNamesNoKeyIsNamedBesideTheBox) {
    testing::MakeToolFolder(tool());
    testing::MakeGameFolder(game());
    WriteFile(tool() / "ThietLap.ini",
              "[Thiet lap]\r\nDuongDan=" + game().string() + "\r\nPhimTat=f7\r\n");
    auto window = Open();
    CommandButtons& buttons = window->buttons();
    EXPECT_EQ(buttons.hotkeyBox()->currentText(), "f7");
    EXPECT_FALSE(buttons.hotkeyProblem()->isHidden());
    EXPECT_TRUE(buttons.hotkeyProblem()->text().contains("chưa hoạt động"));

    for (const char* typed : {"F9", "F"}) {
        buttons.hotkeyBox()->setCurrentText(typed);
        QTest::keyClick(buttons.hotkeyBox()->lineEdit(), Qt::Key_Return);
        EXPECT_EQ(buttons.hotkeyProblem()->isHidden(), std::string_view(typed) == "F9");
    }
    // A finished text that names no key: the last key stays in use.
    EXPECT_TRUE(buttons.hotkeyProblem()->text().contains("vẫn dùng F9"));
    keys_->pressed.insert(0x78);
    window->pollHotkey();
    EXPECT_EQ(sounds_.size(), 1u);
}

// Browse opens at the typed folder, quick load first at nothing, then at the folder it loaded,
// which a cancelled picker loads again.
TEST_F(MainWindowTest, FolderPickersOpenWhereTheUserIsAndQuickLoadRemembersItsFolder) {
    std::filesystem::create_directories(tool() / "data/data2/players/heads/textures");
    WriteFile(dir_ / "faces/face1.dds", "face");
    const QString faces = QString::fromStdString((dir_ / "faces").string());
    auto window = Open();
    window->panels().gameFolderBox()->setText(QStringLiteral("D:\\Games\\FO2"));

    dialogs_.folders = {std::nullopt, std::nullopt, faces, std::nullopt};
    Click(window->panels().browseButton());
    EXPECT_EQ(window->panels().gameFolderBox()->text(), "D:\\Games\\FO2");
    Click(window->buttons().quickLoad());
    EXPECT_EQ(dialogs_.messages, QStringList{"Thông báo|Bạn chưa chọn thư mục nào!"});
    Click(window->buttons().quickLoad());
    std::filesystem::remove(tool() / "data/data2/players/heads/textures/face1.dds");
    Click(window->buttons().quickLoad());
    EXPECT_EQ(dialogs_.starts, QStringList({"D:\\Games\\FO2", "", "", faces}));
    EXPECT_EQ(dialogs_.popups, QStringList({"Hoàn tất!|2", "Hoàn tất!|2"}));
    EXPECT_TRUE(std::filesystem::exists(tool() / "data/data2/players/heads/textures/face1.dds"));
}

TEST_F(MainWindowTest, EveryButtonHasAMnemonicAndEveryEntryAnAccessibleName) {
    auto window = Open();
    QStringList mnemonics;
    for (const QPushButton* button : window->findChildren<QPushButton*>()) {
        const QString caption = button->text();
        const qsizetype amp = caption.indexOf(QLatin1Char('&'));
        ASSERT_GE(amp, 0) << caption.toStdString();
        mnemonics << caption.mid(amp + 1, 1).toLower();
    }
    // "Tải về" takes the place of "Kiểm tra cập nhật"; the others are all seen at once.
    mnemonics.removeDuplicates();
    EXPECT_EQ(mnemonics.size(), window->findChildren<QPushButton*>().size());
    for (const QAbstractButton* entry : window->findChildren<QAbstractButton*>()) {
        if (!qobject_cast<const QPushButton*>(entry)) {
            EXPECT_FALSE(entry->accessibleName().isEmpty());
        }
    }
    EXPECT_EQ(window->panels().categoryCheck(12)->accessibleName(), "Thay đổi Cổ động viên");
    EXPECT_EQ(window->panels().optionButton(OptionArray::Scoreboard, 4)->accessibleName(),
              "K+ Nhịp sống");
}

// A run over another program reports its failures in the red corner alert, which takes no focus;
// its click and the tray entry open the list, and a run without failures takes the entry away.
TEST_F(MainWindowTest, FailuresOfARunOverTheGameShowAsAnAlertThatOpensTheList) {
    testing::MakeToolFolder(tool());
    testing::MakeGameFolder(game(), false);  // no zdata: the ball's copy fails
    WriteFile(tool() / "ThietLap.ini", "[Thiet lap]\r\nDuongDan=" + game().string() + "\r\n");
    auto window = Open();
    QAction* entry = window->tray().entry(QString::fromUtf8(shell::kFailuresEntryText));
    ASSERT_NE(entry, nullptr);
    EXPECT_FALSE(entry->isVisible());

    window->applyPatchesNow();  // the window is not in front
    ASSERT_EQ(dialogs_.alerts.size(), 1);
    EXPECT_TRUE(dialogs_.alerts[0].startsWith(QStringLiteral("Đã chép, ")));
    EXPECT_TRUE(dialogs_.alerts[0].contains(QStringLiteral(" bước lỗi: bấm để xem|")));
    EXPECT_TRUE(dialogs_.notices.isEmpty());
    EXPECT_TRUE(dialogs_.messages.isEmpty());
    EXPECT_EQ(sounds_.size(), 1u);
    EXPECT_TRUE(entry->isVisible());

    dialogs_.alertClick();
    ASSERT_EQ(dialogs_.notices.size(), 1);
    EXPECT_TRUE(dialogs_.notices[0].contains(
        QStringLiteral("không chép được vào zdata\\data2\\ball: trò chơi không có thư mục này")))
        << dialogs_.notices[0].toStdString();
    entry->trigger();
    EXPECT_EQ(dialogs_.notices.size(), 2);

    testing::MakeGameFolder(game());
    window->applyPatchesNow();
    EXPECT_EQ(dialogs_.notices.size(), 2);
    EXPECT_FALSE(entry->isVisible());
}

}  // namespace
}  // namespace kickvane::shell
