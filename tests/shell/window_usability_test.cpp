// The window from the keyboard, its side windows, its folder dialogs and its tray tooltip.
#include <gtest/gtest.h>

#include <QAbstractProxyModel>
#include <QAccessible>
#include <QApplication>
#include <QDir>
#include <QFileDialog>
#include <QFileSystemModel>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QTest>
#include <QWheelEvent>

#include "platform/scoped_env.h"
#include "shell/dialogs.h"
#include "shell/side_windows.h"
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
    for (const char* title : {"Thông tin", "Hướng dẫn"}) {
        for (Qt::Key key : {Qt::Key_unknown, Qt::Key_Escape, Qt::Key_Return}) {
            SCOPED_TRACE(std::string(title) + " " + std::to_string(key));
            if (std::string_view(title) == "Thông tin") {
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

// "F1" on the way to "F13" must not become the hotkey: only a finished name counts.
TEST_F(WindowUsabilityTest, TypingChangesTheHotkeyOnlyOnceFinished) {
    auto window = ShowActive();
    HotkeyBox* box = window->buttons().hotkeyBox();
    TabHead* head = window->panels().tabHead(0);
    EXPECT_TRUE(head->hasFocus());  // not the hotkey box
    box->setFocus(Qt::MouseFocusReason);
    box->lineEdit()->selectAll();
    for (const char key : std::string_view("F13")) {
        QTest::keyClick(box->lineEdit(), key);
        EXPECT_EQ(window->session().ActiveHotkey(), "F7") << box->currentText().toStdString();
    }
    EXPECT_EQ(box->currentText(), "F13");
    Press(box->lineEdit(), Qt::Key_Return);
    EXPECT_EQ(window->session().Settings().hotkey, "F13");
    EXPECT_EQ(window->session().ActiveHotkey(), "F7");  // names no key: the last one stays

    box->lineEdit()->selectAll();
    QTest::keyClicks(box->lineEdit(), QStringLiteral("F9"));
    EXPECT_EQ(window->session().ActiveHotkey(), "F7");
    head->setFocus(Qt::TabFocusReason);  // leaving the box finishes the name
    EXPECT_EQ(window->session().ActiveHotkey(), "F9");

    // The box suggests nothing the player did not type: "F" and Enter is no key, so F9 stays;
    // a choice from the list still is one.
    box->setFocus(Qt::MouseFocusReason);
    box->lineEdit()->selectAll();
    QTest::keyClick(box->lineEdit(), 'F');
    EXPECT_EQ(box->currentText(), "F");
    Press(box->lineEdit(), Qt::Key_Return);
    EXPECT_EQ(box->currentText(), "F");
    EXPECT_EQ(window->session().ActiveHotkey(), "F9");
    EXPECT_FALSE(window->buttons().hotkeyProblem()->isHidden());
    box->setCurrentIndex(3);
    emit box->textActivated(box->itemText(3));
    EXPECT_EQ(window->session().ActiveHotkey(), "F4");
}

TEST_F(WindowUsabilityTest, TheWheelTurnsTheHotkeyOnlyWhileItHasTheFocus) {
    auto window = ShowActive();
    HotkeyBox* box = window->buttons().hotkeyBox();
    const auto wheelDown = [box] {
        const QPointF at(box->width() / 2.0, box->height() / 2.0);
        QWheelEvent wheel(at, box->mapToGlobal(at), QPoint(), QPoint(0, -120), Qt::NoButton,
                          Qt::NoModifier, Qt::NoScrollPhase, false);
        QApplication::sendEvent(box, &wheel);
    };
    wheelDown();
    EXPECT_EQ(box->currentText(), "F7");
    EXPECT_EQ(window->session().ActiveHotkey(), "F7");
    box->setFocus(Qt::MouseFocusReason);
    wheelDown();
    EXPECT_EQ(box->currentText(), "F8");
    EXPECT_EQ(window->session().ActiveHotkey(), "F8");
}

// The focus goes back to the current tab head after a tab switch, hiding to the tray and coming
// back: a key or the wheel meant for something else never reaches the hotkey box.
TEST_F(WindowUsabilityTest, TheFocusNeverRestsInTheHotkeyBoxAfterTabSwitchHideOrRestore) {
    auto window = ShowActive();
    HotkeyBox* box = window->buttons().hotkeyBox();
    const auto inBox = [&] {
        QWidget* focused = window->focusWidget();
        return focused == box || box->isAncestorOf(focused);
    };
    box->setFocus(Qt::TabFocusReason);
    ASSERT_TRUE(inBox());
    window->panels().selectTab(2);
    EXPECT_FALSE(inBox());
    EXPECT_EQ(window->focusWidget(), window->panels().tabHead(2));

    box->setFocus(Qt::TabFocusReason);
    Click(window->buttons().runHidden());
    EXPECT_FALSE(window->isVisible());
    EXPECT_FALSE(inBox());
    box->setFocus(Qt::OtherFocusReason);  // whatever happened while hidden
    emit window->tray().showRequested();
    EXPECT_TRUE(window->isVisible());
    EXPECT_FALSE(inBox());
    EXPECT_EQ(box->focusPolicy(), Qt::StrongFocus);  // click and Tab, not the wheel
}

// The side windows take the keyboard at once, so Escape closes them without a click first.
TEST_F(WindowUsabilityTest, SideWindowsTakeTheFocusSoEscapeClosesThemAtOnce) {
    std::filesystem::create_directories(tool() / "img");
    QImage(40, 20, QImage::Format_RGB32)
        .save(QString::fromStdString((tool() / "img/t1_img_3.jpg").string()));
    auto window = ShowActive();
    const auto escapeCloses = [](const char* title) {
        QPointer<QWidget> side = SideWindow(title);
        ASSERT_TRUE(side) << title;
        ASSERT_TRUE(QTest::qWaitFor([&] { return QApplication::activeWindow() == side; })) << title;
        ASSERT_NE(QApplication::focusWidget(), nullptr);
        EXPECT_EQ(QApplication::focusWidget()->window(), side.data()) << title;
        Press(QApplication::focusWidget(), Qt::Key_Escape);
        EXPECT_FALSE(side && side->isVisible()) << title;
    };
    Press(window->buttons().info(), Qt::Key_Space);
    QWidget* about = SideWindow("Thông tin");
    ASSERT_NE(about, nullptr);
    // Beside the main window, or at least clear of its command buttons.
    const QRect buttons(window->buttons().save()->mapToGlobal(QPoint(0, 0)),
                        window->buttons().save()->size());
    EXPECT_FALSE(about->frameGeometry().intersects(buttons));
    QDir().mkpath(QStringLiteral(KICKVANE_ARTIFACTS));
    about->grab().save(QStringLiteral(KICKVANE_ARTIFACTS "/about-window.png"));
    escapeCloses("Thông tin");
    window->activateWindow();
    Click(window->buttons().help());
    escapeCloses("Hướng dẫn");
    window->activateWindow();
    window->panels().categoryLabel(3)->setFocus(Qt::TabFocusReason);
    Press(window->panels().categoryLabel(3), Qt::Key_Return);
    escapeCloses("Xem trước");
}

TEST(SideWindowPositionTest, BesideTheOwnerWhenThereIsRoomElseOverItClearOfTheButtons) {
    const QRect area(0, 0, 1280, 760);
    const QSize size(440, 300);
    // Room on the right, then only on the left.
    EXPECT_EQ(sideWindowPosition(area, QRect(100, 50, 430, 510), 520, size), QPoint(538, 50));
    EXPECT_EQ(sideWindowPosition(area, QRect(800, 50, 430, 510), 520, size), QPoint(352, 50));
    // No room on either side: centred over the owner, its bottom above the buttons.
    const QRect owner(420, 100, 430, 510);
    const QPoint over = sideWindowPosition(area, owner, 560, size);
    EXPECT_EQ(over.x(), owner.center().x() - size.width() / 2);
    EXPECT_LE(over.y() + size.height(), 560);
    EXPECT_GE(over.y(), area.top());
    // A screen too small for both: inside the work area all the same.
    const QRect small(0, 20, 600, 400);
    const QPoint inside = sideWindowPosition(small, QRect(50, 40, 430, 510), 500, size);
    EXPECT_TRUE(small.contains(QRect(inside, size))) << inside.x() << "," << inside.y();
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
    prepareFolderDialog(dialog, QStringLiteral("Hỗ trợ nạp nhanh các file Face và Ball"),
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
