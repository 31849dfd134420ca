// The window's text boxes on the Windows platform: the game folder and the hotkey show in them,
// also where the system lacks the fonts the window asks for (a Wine prefix without Wine's own
// fonts, as these tests run in).
#include <QLineEdit>
#include <QMenu>

#include "shell/dialogs.h"
#include "shell/window_fixture.h"

namespace kickvane::testing {
namespace {

// Pixels of text inside a box: darker than its frame and its white ground.
int TextPixels(QLineEdit* box) {
    const QImage picture = box->grab().toImage();
    int dark = 0;
    for (int y = 2; y < picture.height() - 2; ++y) {
        for (int x = 2; x < picture.width() - 2; ++x) {
            dark += qGray(picture.pixel(x, y)) < 100 ? 1 : 0;
        }
    }
    return dark;
}

using WindowBoxesTest = WindowFixture;

TEST_F(WindowBoxesTest, GameFolderAndHotkeyShowInTheirBoxes) {
    const QString folder = QStringLiteral("C:\\Trò chơi\\FIFA Online 2");
    WriteFile(tool() / "ThietLap.ini",
              "[Thiet lap]\r\nDuongDan=" + folder.toStdString() + "\r\nPhimTat=F7\r\n");
    auto window = Open();
    window->show();  // the boxes are grabbed as they paint, with or without a display

    QLineEdit* folderBox = window->panels().gameFolderBox();
    QLineEdit* hotkeyBox = window->buttons().hotkeyBox()->lineEdit();
    ASSERT_EQ(folderBox->text(), folder);
    ASSERT_EQ(hotkeyBox->text(), "F7");
    EXPECT_GT(TextPixels(folderBox), 40)
        << "font: " << QFontInfo(folderBox->font()).family().toStdString();
    EXPECT_GT(TextPixels(hotkeyBox), 8)
        << "font: " << QFontInfo(hotkeyBox->font()).family().toStdString();
}

// The Vietnamese words of Qt's own menus travel inside the program's one file.
TEST_F(WindowBoxesTest, QtsOwnMenusSpeakVietnamese) {
    ASSERT_TRUE(shell::useVietnameseQtTexts());
    auto window = Open();
    std::unique_ptr<QMenu> menu(window->panels().gameFolderBox()->createStandardContextMenu());
    QStringList entries;
    for (const QAction* action : menu->actions()) {
        entries << action->text().section(QLatin1Char('\t'), 0, 0);
    }
    EXPECT_TRUE(entries.contains(QStringLiteral("&Hoàn tác"))) << entries.join(u'|').toStdString();
    EXPECT_TRUE(entries.contains(QStringLiteral("Chọn tất cả")))
        << entries.join(u'|').toStdString();
}

}  // namespace
}  // namespace kickvane::testing
