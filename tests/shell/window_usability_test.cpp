// The window from the keyboard, its side windows, its folder dialogs and its tray tooltip.
#include <gtest/gtest.h>

#include <QAbstractProxyModel>
#include <QAccessible>
#include <QApplication>
#include <QFileDialog>
#include <QFileSystemModel>
#include <QLabel>
#include <QPushButton>
#include <QTest>

#include "platform/scoped_env.h"
#include "shell/dialogs.h"
#include "support/trees.h"
#include "window_fixture.h"

namespace kickvane::shell {
namespace {

namespace fs = std::filesystem;
using testing::ScopedEnv;

class WindowUsabilityTest : public testing::WindowFixture {
protected:
    std::unique_ptr<MainWindow> ShowActive() {
        auto window = Open();
        window->show();
        QApplication::setActiveWindow(window.get());
        EXPECT_TRUE(QTest::qWaitForWindowActive(window.get()));
        return window;
    }

    static void Press(QWidget* widget, Qt::Key key) { QTest::keyClick(widget, key); }

    static QWidget* SideWindow(const char* title) {
        for (QWidget* widget : QApplication::topLevelWidgets()) {
            if (widget->windowTitle() == title && widget->isVisible()) {
                return widget;
            }
        }
        return nullptr;
    }
};

TEST_F(WindowUsabilityTest, TabKeyReachesTabHeadsAndLabelsWhichTheKeyboardActivates) {
    std::filesystem::create_directories(tool() / "img");
    QImage(40, 20, QImage::Format_RGB32)
        .save(QString::fromStdString((tool() / "img/t1_img_3.jpg").string()));
    auto window = ShowActive();

    std::set<QWidget*> reached;
    for (int i = 0; i < 80 && QApplication::focusWidget(); ++i) {
        reached.insert(QApplication::focusWidget());
        Press(QApplication::focusWidget(), Qt::Key_Tab);
    }
    for (int tab = 0; tab < kTabCount; ++tab) {
        EXPECT_TRUE(reached.count(window->panels().tabHead(tab))) << tab;
    }
    EXPECT_TRUE(reached.count(window->panels().categoryLabel(3)));

    window->panels().tabHead(1)->setFocus(Qt::TabFocusReason);
    Press(window->panels().tabHead(1), Qt::Key_Space);
    EXPECT_EQ(window->panels().currentTab(), 1);
    // The arrows walk the column and choose as they go; they stop at its ends.
    for (int expected : {2, 3, 3}) {
        Press(QApplication::focusWidget(), Qt::Key_Down);
        EXPECT_EQ(window->panels().currentTab(), expected);
        EXPECT_TRUE(window->panels().tabHead(expected)->hasFocus());
    }
    Press(window->panels().tabHead(3), Qt::Key_Left);
    EXPECT_EQ(window->panels().currentTab(), 2);

    window->panels().categoryLabel(3)->setFocus(Qt::TabFocusReason);
    Press(window->panels().categoryLabel(3), Qt::Key_Return);
    ASSERT_NE(window->sideWindows().preview(), nullptr);
    EXPECT_TRUE(window->sideWindows().preview()->pictureFile().endsWith("t1_img_3.jpg"));
    Press(window->sideWindows().preview(), Qt::Key_Escape);
    EXPECT_FALSE(window->sideWindows().preview() && window->sideWindows().preview()->isVisible());
}

TEST_F(WindowUsabilityTest, FocusFrameShowsForKeyboardFocusOnly) {
    auto window = ShowActive();
    for (QWidget* widget : std::initializer_list<QWidget*>{window->panels().tabHead(1),
                                                           window->panels().categoryLabel(0)}) {
        window->panels().tabHead(3)->setFocus(Qt::MouseFocusReason);
        const QImage unfocused = widget->grab().toImage();
        widget->setFocus(Qt::MouseFocusReason);
        EXPECT_EQ(widget->grab().toImage(), unfocused);  // a click shows no frame
        Press(widget, Qt::Key_Shift);
        EXPECT_NE(widget->grab().toImage(), unfocused);  // a key press does
        window->panels().tabHead(3)->setFocus(Qt::MouseFocusReason);
        widget->setFocus(Qt::BacktabFocusReason);
        EXPECT_NE(widget->grab().toImage(), unfocused);
    }
}

TEST_F(WindowUsabilityTest, TabHeadsAndLabelsTellAssistiveToolsWhatTheyAreAndDo) {
    auto window = Open();
    QAccessibleInterface* tab = QAccessible::queryAccessibleInterface(window->panels().tabHead(2));
    ASSERT_NE(tab, nullptr);
    EXPECT_EQ(tab->role(), QAccessible::PageTab);
    EXPECT_EQ(tab->text(QAccessible::Name), "Tỉ số");
    ASSERT_NE(tab->actionInterface(), nullptr);
    tab->actionInterface()->doAction(QAccessibleActionInterface::pressAction());
    EXPECT_EQ(window->panels().currentTab(), 2);

    ClickableLabel* label = window->panels().categoryLabel(12);
    QAccessibleInterface* entry = QAccessible::queryAccessibleInterface(label);
    ASSERT_NE(entry, nullptr);
    EXPECT_EQ(entry->role(), QAccessible::Button);
    EXPECT_EQ(entry->text(QAccessible::Name), label->text());
    EXPECT_FALSE(label->text().isEmpty());
}

TEST_F(WindowUsabilityTest, AboutAndHelpAreSideWindowsThatCloseWithTheirButtonAndWithEscape) {
    auto window = Open();
    window->show();
    for (const char* title : {"Thong tin", "Huong dan"}) {
        for (Qt::Key key : {Qt::Key_unknown, Qt::Key_Escape, Qt::Key_Return}) {
            SCOPED_TRACE(std::string(title) + " " + std::to_string(key));
            if (std::string_view(title) == "Thong tin") {
                Click(window->buttons().info());
            } else {
                Click(window->buttons().help());
            }
            QPointer<QWidget> side = SideWindow(title);
            ASSERT_TRUE(side);
            EXPECT_EQ(side->parentWidget(), window.get());
            auto* close = side->findChild<QPushButton*>(QStringLiteral("close"));
            ASSERT_NE(close, nullptr);
            if (key == Qt::Key_unknown) {
                Click(close);
            } else {
                Press(key == Qt::Key_Escape ? side.data() : close, key);
            }
            QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
            EXPECT_TRUE(side.isNull());
        }
    }
}

TEST_F(WindowUsabilityTest, FolderDialogStartsAtTheNearestExistingFolderElseInTheWinePrefix) {
    const fs::path home = dir_ / "home";
    const fs::path prefix = home / ".wine";
    std::filesystem::create_directories(prefix / "drive_c/Program Files/Games");
    ScopedEnv homeEnv("HOME", home.string());
    ScopedEnv prefixEnv("WINEPREFIX", prefix.string());
    const auto native = [](const fs::path& path) { return QString::fromStdString(path.string()); };

    EXPECT_EQ(folderDialogStart(native(prefix / "drive_c/Program Files/Games")),
              native(prefix / "drive_c/Program Files/Games"));
    // Missing folders below an existing one, in the Wine prefix, in any letter case.
    EXPECT_EQ(folderDialogStart(QStringLiteral("c:\\program files\\games\\FIFA Online 2")),
              native(prefix / "drive_c/Program Files/Games"));
    EXPECT_EQ(folderDialogStart(native(home / "nowhere/deeper")), native(home));
    // Nothing usable typed: the prefix's drive C, else home.
    for (const char* nothing : {"", "  ", "relative/folder"}) {
        EXPECT_EQ(folderDialogStart(QString::fromUtf8(nothing)), native(prefix / "drive_c"))
            << nothing;
    }
    std::filesystem::remove_all(prefix);
    EXPECT_EQ(folderDialogStart(QString()), native(home));
}

TEST_F(WindowUsabilityTest, FolderDialogSpeaksVietnameseAndListsHiddenFolders) {
    std::filesystem::create_directories(dir_ / ".wine");
    std::filesystem::create_directories(dir_ / "Games");
    QFileDialog dialog;
    prepareFolderDialog(dialog, QStringLiteral("Ho tro nap nhanh cac file Face va Ball"),
                        QString::fromStdString(dir_.path().string()));
    EXPECT_EQ(dialog.proxyModel()->headerData(0, Qt::Horizontal, Qt::DisplayRole).toString(),
              "Tên");

    auto* model = dialog.findChild<QFileSystemModel*>();
    ASSERT_NE(model, nullptr);
    const QModelIndex folder = model->index(QString::fromStdString(dir_.path().string()));
    QStringList listed;
    for (int i = 0; i < 200 && listed.size() < 2; ++i) {
        QTest::qWait(10);
        listed.clear();
        for (int row = 0; row < model->rowCount(folder); ++row) {
            listed << model->index(row, 0, folder).data().toString();
        }
    }
    listed.sort();
    EXPECT_EQ(listed, QStringList({".wine", "Games"}));
    const QModelIndex type = dialog.proxyModel()->mapFromSource(model->index(0, 2, folder));
    EXPECT_EQ(type.data().toString(), "Thư mục");
}

// A run with failed steps names them in a notice; the tray's tooltip keeps its summary.
TEST_F(WindowUsabilityTest, ARunIsSummedUpInTheTrayTooltipAndItsFailedStepsInANotice) {
    testing::MakeToolFolder(tool());
    testing::MakeGameFolder(game(), /*withZData=*/false);
    auto window = Open();
    window->show();  // in front: the failures show in the notice at once
    window->activateWindow();
    ASSERT_TRUE(QTest::qWaitForWindowActive(window.get()));
    EXPECT_EQ(tray_->toolTip(), "Kickvane v2.0");
    window->panels().gameFolderBox()->setText(QString::fromStdString(game().string()));
    window->applyPatchesNow();
    EXPECT_EQ(sounds_.size(), 1u);
    ASSERT_EQ(dialogs_.notices.size(), 1);
    EXPECT_TRUE(dialogs_.notices[0].contains(
        "• Thay đổi bóng: không chép được vào zdata\\data2\\ball: trò chơi không có thư mục này"))
        << dialogs_.notices[0].toStdString();
    const QStringList lines = tray_->toolTip().split(QLatin1Char('\n'));
    ASSERT_EQ(lines.size(), 2);
    EXPECT_EQ(lines[0], "Kickvane v2.0");
    EXPECT_TRUE(lines[1].startsWith("Lần chạy lúc ")) << lines[1].toStdString();
    EXPECT_FALSE(lines[1].endsWith(" 0 lỗi")) << lines[1].toStdString();

    window->panels().gameFolderBox()->setText(QString::fromStdString((dir_ / "missing").string()));
    window->applyPatchesNow();
    EXPECT_TRUE(tray_->toolTip().contains("đã dừng")) << tray_->toolTip().toStdString();
    // Windows shows at most 127 characters of a tray tooltip; the longest summary must fit.
    EXPECT_LE(tray_->toolTip().size(), 127);

    // A line break in the status stays on one line.
    tray_->setStatusLine(QStringLiteral("a\nb"));
    EXPECT_EQ(tray_->toolTip(), "Kickvane v2.0\na b");
}

}  // namespace
}  // namespace kickvane::shell
