#include "shell/game_finder.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QDialog>
#include <QLineEdit>
#include <QListWidget>
#include <QMessageBox>
#include <QSignalSpy>
#include <QTest>

#include "support/temp_dir.h"

namespace kickvane::shell {
namespace {

namespace fs = std::filesystem;
using testing::TempDir;
using testing::WriteFile;

// A game folder box, and a session whose game search looks in a home folder of its own.
class GameFinderTest : public ::testing::Test {
protected:
    session::GameSearch search() {
        session_.SetGameSearchFolders(
            {dir_ / "home", dir_ / "home/.config", dir_ / "home/.local/share", {}});
        return session_.GameSearchCommand();
    }

    fs::path AddGame(const std::string& prefix) {
        WriteFile(dir_ / "home" / prefix / "system.reg", "WINE REGISTRY Version 2\n");
        WriteFile(dir_ / "home" / prefix / "drive_c/FIFA/Gameloader.exe", "MZ");
        return dir_ / "home" / prefix / "drive_c/FIFA";
    }

    // Clicks the button and waits for the search's result on the window's thread.
    void Search(GameFinderButton& button) {
        QSignalSpy finished(&button, &GameFinderButton::searchFinished);
        QTest::mouseClick(&button, Qt::LeftButton);
        // Meanwhile the window goes on: the button waits, the pointer says so.
        EXPECT_FALSE(button.isEnabled());
        EXPECT_NE(QApplication::overrideCursor(), nullptr);
        ASSERT_TRUE(finished.wait(20000));
        EXPECT_TRUE(button.isEnabled());
        EXPECT_EQ(QApplication::overrideCursor(), nullptr);
    }

    template <typename T>
    T* OpenDialog() {
        QApplication::processEvents();
        for (QWidget* widget : QApplication::topLevelWidgets()) {
            if (auto* dialog = qobject_cast<T*>(widget); dialog != nullptr && dialog->isVisible()) {
                return dialog;
            }
        }
        return nullptr;
    }

    TempDir dir_;
    session::Session session_{dir_ / "tool"};
    QWidget panel_;
    QLineEdit* box_ = new QLineEdit(&panel_);
};

TEST_F(GameFinderTest, OneFindFillsTheBox_SeveralOpenAListWithSources_NoneSaysWhereItLooked) {
    GameFinderButton button(box_, search());

    Search(button);
    auto* message = OpenDialog<QMessageBox>();
    ASSERT_NE(message, nullptr);
    EXPECT_TRUE(message->text().contains(QStringLiteral("Đã tìm trong")));
    EXPECT_TRUE(message->text().contains(QStringLiteral(".wine")));
    message->close();
    EXPECT_TRUE(box_->text().isEmpty());

    const fs::path first = AddGame(".wine");
    Search(button);
    EXPECT_EQ(box_->text().toStdString(), fs::canonical(first).string());
    // The found folder is not kept until the settings are saved; the finder says so.
    message = OpenDialog<QMessageBox>();
    ASSERT_NE(message, nullptr);
    EXPECT_TRUE(message->text().contains(QStringLiteral("\"Lưu thiết lập\" để giữ")));
    message->close();

    const fs::path second = AddGame(".PlayOnLinux/wineprefix/FO2");
    box_->clear();
    Search(button);
    EXPECT_TRUE(box_->text().isEmpty());  // nothing chosen yet
    auto* dialog = OpenDialog<QDialog>();
    ASSERT_NE(dialog, nullptr);
    auto* list = dialog->findChild<QListWidget*>();
    ASSERT_NE(list, nullptr);
    ASSERT_EQ(list->count(), 2);
    EXPECT_TRUE(list->item(1)->text().contains(QStringLiteral("PlayOnLinux: FO2")));
    list->setCurrentRow(1);
    dialog->accept();
    EXPECT_EQ(box_->text().toStdString(), fs::canonical(second).string());
}

TEST(PathLinesTest, APathBreaksOnlyAfterAFolderSeparator) {
    const auto characters = [](const QString& text) { return static_cast<int>(text.size()); };
    const QString path =
        QStringLiteral("/home/player/.wine/drive_c/Program Files (x86)/FIFA Online 2");
    const QStringList lines = pathLines(path, 24, characters);
    EXPECT_EQ(lines, QStringList({"/home/player/.wine/", "drive_c/", "Program Files (x86)/",
                                  "FIFA Online 2"}));
    EXPECT_EQ(pathLines(QStringLiteral("C:\\Games\\FO2"), 8, characters),
              QStringList({"C:\\", "Games\\", "FO2"}));
    // A name wider than the line stays whole; a short path stays on one line.
    EXPECT_EQ(pathLines(QStringLiteral("/a/averyveryverylongname/b"), 6, characters),
              QStringList({"/a/", "averyveryverylongname/", "b"}));
    EXPECT_EQ(pathLines(path, 200, characters), QStringList{path});
    EXPECT_EQ(pathLines(QString(), 10, characters), QStringList{QString()});
}

TEST_F(GameFinderTest, ClosingTheWindowDuringASearchEndsItCleanly) {
    for (int i = 0; i < 200; ++i) {
        WriteFile(dir_ / "home/.wine/drive_c/d" / std::to_string(i) / "f.txt", "x");
    }
    AddGame(".wine");
    auto* button = new GameFinderButton(box_, search());
    QTest::mouseClick(button, Qt::LeftButton);
    delete button;  // stops and joins the search; its late result is dropped
    QApplication::processEvents();
    EXPECT_EQ(QApplication::overrideCursor(), nullptr);
    EXPECT_TRUE(box_->text().isEmpty());
}

}  // namespace
}  // namespace kickvane::shell
