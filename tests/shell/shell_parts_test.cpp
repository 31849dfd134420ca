// The window's shell: fade, tray icon and menu, small buttons, skins and previews.
#include <gtest/gtest.h>

#include <QDir>
#include <QSignalSpy>
#include <QTest>

#include "shell/alert_popup.h"
#include "window_fixture.h"

namespace kickvane::shell {
namespace {

class ShellPartsTest : public testing::WindowFixture {
protected:
    void SetUp() override { countLaunches_ = true; }

    std::unique_ptr<MainWindow> Show(std::filesystem::path folder = {}) {
        auto window = Open(std::move(folder));
        window->show();
        return window;
    }

    static QAction* TrayEntry(MainWindow& window, const QString& text) {
        for (QAction* action : window.trayMenu()->actions()) {
            if (action->text() == text) {
                return action;
            }
        }
        return nullptr;
    }

    static void SavePicture(QWidget& widget, const QString& name) {
        QDir().mkpath(QStringLiteral(KICKVANE_ARTIFACTS));
        widget.grab().save(QStringLiteral(KICKVANE_ARTIFACTS "/") + name);
    }

    static void WritePicture(const std::filesystem::path& file, QColor colour) {
        std::filesystem::create_directories(file.parent_path());
        QImage image(40, 20, QImage::Format_RGB32);
        image.fill(colour);
        image.save(QString::fromStdString(file.string()), "JPG");
    }
};

TEST_F(ShellPartsTest, StartUpFadesInToTwoFortyAndTranslucencyKeepsTheFadesPlace) {
    auto window = Show();
    EXPECT_TRUE(window->fade().running());
    FinishFade(*window);
    EXPECT_EQ(window->fade().alpha(), 240);

    EXPECT_EQ(window->makeTranslucent(256), TranslucentResult::OutOfRange);
    EXPECT_EQ(window->makeTranslucent(-1), TranslucentResult::OutOfRange);
    Click(window->translucentButton());
    EXPECT_EQ(window->fade().alpha(), 240);  // "Trans" does not move the fade
    TrayEntry(*window, "Hiện chương trình")->trigger();
    window->fadeTick();
    EXPECT_EQ(window->fade().alpha(), 255);  // from 240, not from 160
}

TEST_F(ShellPartsTest, TrayMenuEntriesAndRunningHidden) {
    auto window = Show();
    EXPECT_TRUE(tray_->added);

    // "Chạy ẩn": fade towards 150, out of sight, popup; the icon stays.
    FinishFade(*window);
    Click(window->runHiddenButton());
    EXPECT_FALSE(window->isVisible());
    EXPECT_TRUE(tray_->added);
    EXPECT_EQ(dialogs_.popups, QStringList{"Ẩn xuống khay hệ thống!|2"});
    FinishFade(*window);
    EXPECT_EQ(window->fade().alpha(), 150);

    // Starting the game from the tray leaves the window as it is and shows no popup.
    TrayEntry(*window, "Khởi động FIFA")->trigger();
    EXPECT_EQ(launches_, 1);
    EXPECT_FALSE(window->isVisible());
    EXPECT_EQ(dialogs_.popups.size(), 1);
    TrayEntry(*window, "Hiện chương trình")->trigger();
    EXPECT_TRUE(window->isVisible());

    // The launcher button hides the window to the tray and says so.
    Click(window->launchButton());
    EXPECT_EQ(launches_, 2);
    EXPECT_FALSE(window->isVisible());
    EXPECT_EQ(dialogs_.popups.last(), "Ẩn xuống khay hệ thống!|2");

    QSignalSpy exit(window.get(), &MainWindow::exitRequested);
    TrayEntry(*window, "Thoát")->trigger();
    EXPECT_FALSE(tray_->added);
    EXPECT_EQ(exit.count(), 1);
}

TEST_F(ShellPartsTest, AboutAndHelpOpenAsSideWindowsOfTheMainWindow) {
    auto window = Show();
    TrayEntry(*window, "Thông tin")->trigger();
    Click(window->helpButton());
    for (const char* title : {"Thong tin", "Huong dan"}) {
        QWidget* side = nullptr;
        for (QWidget* widget : QApplication::topLevelWidgets()) {
            side = widget->windowTitle() == title && widget->isVisible() ? widget : side;
        }
        ASSERT_NE(side, nullptr) << title;
        EXPECT_EQ(side->parentWidget(), window.get());
    }
}

TEST_F(ShellPartsTest, WithoutATrayHostHidingMinimisesAndClosingRemovesTheIcon) {
    hostRunning_ = false;
    auto window = Show();
    Click(window->runHiddenButton());
    EXPECT_TRUE(window->isVisible());
    EXPECT_TRUE(window->isMinimized());

    QSignalSpy closed(window.get(), &MainWindow::closed);
    window->close();
    EXPECT_FALSE(tray_->added);
    EXPECT_EQ(closed.count(), 1);
}

TEST_F(ShellPartsTest, SkinsRecolourTheEntriesAndUseTheirPicturesKeepingTheTab) {
    for (const char* name : {"skin1_selected", "skin1_unselect", "skin1_panel", "skin2_selected",
                             "skin2_unselect", "skin2_bg"}) {
        WritePicture(tool() / "skin" / (std::string(name) + ".jpg"), Qt::darkGray);
    }
    auto window = Show();
    const auto labelColour = [&] {
        return window->optionLabel(catalog::OptionArray::UniOption1, 10)
            ->palette()
            .color(QPalette::WindowText);
    };
    Click(window->tabHead(2));
    Click(window->skinButton(2));
    EXPECT_EQ(window->hiddenTexts().skn, "skin2");
    EXPECT_EQ(window->currentTab(), 2);
    EXPECT_EQ(labelColour(), QColor(Qt::white));
    EXPECT_TRUE(window->tabHead(2)->pictureFile().endsWith("skin2_selected.jpg"));
    EXPECT_TRUE(window->tabHead(0)->pictureFile().endsWith("skin2_unselect.jpg"));
    // skin2_panel.jpg is missing: the panels keep skin 1's picture.
    EXPECT_TRUE(window->panel(2)->pictureFile().endsWith("skin1_panel.jpg"));
    EXPECT_EQ(dialogs_.popups, QStringList{"Đã thay đổi giao diện!|1"});

    Click(window->tabHead(1));
    EXPECT_TRUE(window->tabHead(1)->pictureFile().endsWith("skin2_selected.jpg"));
    Click(window->skinButton(1));
    EXPECT_EQ(labelColour(), QColor(Qt::black));
}

TEST_F(ShellPartsTest, LabelClicksShowTheirPreviewInOneSharedWindow) {
    WritePicture(tool() / "img/t2_img_3.jpg", Qt::red);
    WritePicture(tool() / "img/t4_img_10.jpg", Qt::green);
    WritePicture(tool() / "img/t1_img_12.jpg", Qt::blue);
    auto window = Show();

    Click(window->categoryLabel(12));
    ASSERT_NE(window->previewWindow(), nullptr);
    EXPECT_TRUE(window->previewWindow()->pictureFile().endsWith("img/t1_img_12.jpg"));
    PreviewWindow* preview = window->previewWindow();
    Click(window->tabHead(1));
    Click(window->optionLabel(catalog::OptionArray::UniOption, 3));
    EXPECT_EQ(window->previewWindow(), preview);
    EXPECT_TRUE(preview->pictureFile().endsWith("img/t2_img_3.jpg"));
    EXPECT_EQ(preview->windowTitle(), "Xem truoc");

    Click(window->tabHead(3));
    Click(window->optionLabel(catalog::OptionArray::UniOption1, 10));
    EXPECT_TRUE(preview->pictureFile().endsWith("img/t4_img_10.jpg"));
    // No t4_img_9.jpg: the window keeps the picture it shows.
    Click(window->optionLabel(catalog::OptionArray::UniOption1, 9));
    EXPECT_TRUE(preview->pictureFile().endsWith("img/t4_img_10.jpg"));
    EXPECT_TRUE(preview->isVisible());
}

TEST_F(ShellPartsTest, CheckButtonRunsTheUpdateCheckAndReportsAnUnreachableHost) {
    auto window = Show();
    QSignalSpy finished(window->updateFlow(), &UpdateFlow::checkFinished);
    Click(window->checkUpdateButton());
    ASSERT_TRUE(finished.wait(15000));
    ASSERT_EQ(dialogs_.messages.size(), 1);
    EXPECT_TRUE(dialogs_.messages[0].contains("Không kiểm tra được phiên bản mới"));
    EXPECT_TRUE(window->checkUpdateButton()->isVisible());
    EXPECT_TRUE(window->checkUpdateButton()->isEnabled());
    EXPECT_FALSE(window->downloadButton()->isVisible());
}

TEST_F(ShellPartsTest, PopupWindowFollowsItsModelAndClosesWhenItFinishes) {
    QPointer<AlertPopup> popup = AlertPopup::Show(QStringLiteral("Đã lưu thiết lập!"), 2);
    ASSERT_TRUE(popup->isVisible());
    EXPECT_TRUE(popup->testAttribute(Qt::WA_ShowWithoutActivating));
    for (int i = 0; i < 5; ++i) {
        popup->Tick();
    }
    const text::PixelRect rect = popup->model().WindowPixels();
    EXPECT_EQ(popup->geometry(), QRect(rect.left, rect.top, rect.width, rect.height));
    // Rising, resting, leaving: it closes and deletes itself at the end.
    for (int i = 0; i < 2000 && popup && popup->isVisible(); ++i) {
        popup->Tick();
    }
    ASSERT_TRUE(popup);
    EXPECT_TRUE(popup->model().Finished());
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    EXPECT_TRUE(popup.isNull());
}

// Pictures of the finished window for people to look at, from the tool folder the build laid out.
TEST_F(ShellPartsTest, ScreenshotsOfBothSkinsAndAPreview) {
    const std::filesystem::path tool = KICKVANE_TOOL_DIR;
    if (!std::filesystem::exists(tool / "skin/skin2_bg.jpg")) {
        GTEST_SKIP() << "the artwork is not built";
    }
    auto window = Show(tool);
    FinishFade(*window);
    SavePicture(*window, "window-skin1.png");
    window->applySkin(DarkSkin());
    SavePicture(*window, "window-skin2.png");
    Click(window->tabHead(1));
    Click(window->optionLabel(catalog::OptionArray::UniOption, 3));
    ASSERT_NE(window->previewWindow(), nullptr);
    SavePicture(*window->previewWindow(), "preview-ball-3.png");
    EXPECT_FALSE(window->previewWindow()->pictureFile().isEmpty());
}

}  // namespace
}  // namespace kickvane::shell
