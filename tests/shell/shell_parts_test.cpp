// The window's shell: fade, tray icon and menu, small buttons, skins and previews.
#include <gtest/gtest.h>

#include <QDir>
#include <QLabel>
#include <QScreen>
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
        return window.tray().entry(text);
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
    FinishFade(*window);
    EXPECT_EQ(window->fade().alpha(), 240);
    EXPECT_EQ(window->makeTranslucent(256), TranslucentResult::OutOfRange);
    Click(window->buttons().translucent());
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
    Click(window->buttons().runHidden());
    EXPECT_FALSE(window->isVisible());
    EXPECT_TRUE(tray_->added);
    EXPECT_EQ(dialogs_.popups, QStringList{"Ẩn xuống khay hệ thống!|2"});
    FinishFade(*window);
    EXPECT_EQ(window->fade().alpha(), 150);

    // Starting the game from the tray leaves the window as it is.
    TrayEntry(*window, "Khởi động FIFA")->trigger();
    EXPECT_EQ(launches_, 1);
    EXPECT_FALSE(window->isVisible());
    TrayEntry(*window, "Hiện chương trình")->trigger();
    EXPECT_TRUE(window->isVisible());

    // The launcher button hides the window to the tray.
    Click(window->buttons().launch());
    EXPECT_EQ(launches_, 2);
    EXPECT_FALSE(window->isVisible());

    QSignalSpy exit(window.get(), &MainWindow::exitRequested);
    TrayEntry(*window, "Thoát")->trigger();
    EXPECT_FALSE(tray_->added);
    EXPECT_EQ(exit.count(), 1);
}

// "Khởi động FIFA" waits, disabled, for the started program's fate: a Wine that fails at once
// leaves the window up with the reason; one that still runs at the end of the watch hides it.
TEST_F(ShellPartsTest, LaunchButtonWaitsForTheStart_AFailureStaysAndSaysWhy) {
    using Kind = platform::ProgramState::Kind;
    launchScript_ = {testing::ProgramIs(Kind::Running), testing::ProgramIs(Kind::Exited, 2)};
    auto window = Show();
    QPushButton* launch = window->buttons().launch();
    Click(launch);
    EXPECT_EQ(launches_, 1);
    EXPECT_FALSE(launch->isEnabled());
    EXPECT_EQ(launch->text(), QStringLiteral("Đang mở FIFA…"));
    TrayEntry(*window, "Khởi động FIFA")->trigger();  // one start at a time
    EXPECT_EQ(launches_, 1);
    QTRY_VERIFY_WITH_TIMEOUT(launch->isEnabled(), 30000);
    EXPECT_EQ(launch->text(), QStringLiteral("Khởi động &FIFA"));
    EXPECT_TRUE(window->isVisible());
    EXPECT_TRUE(dialogs_.popups.isEmpty());
    EXPECT_EQ(dialogs_.messages,
              QStringList{"Thông báo|Không khởi động được FIFA: Wine dừng ngay với mã lỗi 2."});

    launchScript_ = {testing::ProgramIs(Kind::Running)};
    Click(launch);
    EXPECT_TRUE(window->isVisible());
    launchClock_.now += game::kLaunchWatchTime;
    QTRY_VERIFY_WITH_TIMEOUT(!window->isVisible(), 30000);
    EXPECT_TRUE(launch->isEnabled());
    EXPECT_EQ(dialogs_.popups, QStringList{"Ẩn xuống khay hệ thống!|2"});
}

TEST_F(ShellPartsTest, WithoutATrayHostHidingMinimisesAndClosingRemovesTheIcon) {
    hostRunning_ = false;
    auto window = Show();
    Click(window->buttons().runHidden());
    EXPECT_TRUE(window->isVisible());
    EXPECT_TRUE(window->isMinimized());
    // It says so, rather than claim a hiding that would leave no way back.
    EXPECT_EQ(dialogs_.popups, QStringList{"Không có khay hệ thống: đã thu nhỏ cửa sổ!|2"});

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
    CatalogPanels& panels = window->panels();
    const auto labelColour = [&] {
        return panels.optionLabel(catalog::OptionArray::Other, 10)
            ->palette()
            .color(QPalette::WindowText);
    };
    Click(panels.tabHead(2));
    Click(window->buttons().skin(2));
    EXPECT_EQ(panels.currentTab(), 2);
    EXPECT_EQ(labelColour(), QColor(Qt::white));
    EXPECT_TRUE(panels.tabHead(2)->pictureFile().endsWith("skin2_selected.jpg"));
    EXPECT_TRUE(panels.tabHead(0)->pictureFile().endsWith("skin2_unselect.jpg"));
    // skin2_panel.jpg is missing: the panels keep skin 1's picture.
    EXPECT_TRUE(panels.panel(2)->pictureFile().endsWith("skin1_panel.jpg"));
    EXPECT_EQ(dialogs_.popups, QStringList{"Đã thay đổi giao diện!|1"});

    Click(panels.tabHead(1));
    EXPECT_TRUE(panels.tabHead(1)->pictureFile().endsWith("skin2_selected.jpg"));
    Click(window->buttons().skin(1));
    EXPECT_EQ(labelColour(), QColor(Qt::black));
}

// In each skin the note under a bad hotkey reads well on its ground, and skin 2 draws its tick
// boxes and option buttons on the entries' dark colour.
TEST_F(ShellPartsTest, TheHotkeyNoteReadsInBothSkinsAndSkinTwoTicksOnItsOwnColour) {
    EXPECT_NEAR(contrastRatio(Qt::black, Qt::white), 21.0, 0.01);
    EXPECT_NEAR(contrastRatio(Qt::gray, Qt::gray), 1.0, 0.01);
    auto window = Show();
    QLabel* note = window->buttons().hotkeyProblem();
    for (int skin : {2, 1}) {
        Click(window->buttons().skin(skin));
        const QPalette palette = note->palette();
        EXPECT_TRUE(note->autoFillBackground());
        EXPECT_GE(
            contrastRatio(palette.color(QPalette::WindowText), palette.color(QPalette::Window)),
            4.5)
            << "skin " << skin;
    }
    Click(window->buttons().skin(2));
    CatalogPanels& panels = window->panels();
    for (QWidget* entry :
         {static_cast<QWidget*>(panels.categoryCheck(0)),
          static_cast<QWidget*>(panels.optionButton(catalog::OptionArray::Ball, 1))}) {
        EXPECT_EQ(entry->palette().color(QPalette::Base), darkSkin().entryBackground);
        EXPECT_GE(contrastRatio(entry->palette().color(QPalette::Text),
                                entry->palette().color(QPalette::Base)),
                  4.5);
    }
}

TEST_F(ShellPartsTest, LabelClicksShowTheirPreviewInOneSharedCentredWindow) {
    WritePicture(tool() / "img/t2_img_3.jpg", Qt::red);
    WritePicture(tool() / "img/t4_img_10.jpg", Qt::green);
    WritePicture(tool() / "img/t1_img_12.jpg", Qt::blue);
    auto window = Show();
    CatalogPanels& panels = window->panels();

    Click(panels.categoryLabel(12));
    PreviewWindow* preview = window->sideWindows().preview();
    ASSERT_NE(preview, nullptr);
    EXPECT_TRUE(preview->pictureFile().endsWith("img/t1_img_12.jpg"));
    // Centred on the window's screen, within the frame's few pixels unknown before it shows.
    const QPoint offset =
        preview->frameGeometry().center() - window->screen()->availableGeometry().center();
    EXPECT_LE(offset.manhattanLength(), 10) << offset.x() << "," << offset.y();
    Click(panels.tabHead(1));
    Click(panels.optionLabel(catalog::OptionArray::Ball, 3));
    EXPECT_EQ(window->sideWindows().preview(), preview);
    EXPECT_TRUE(preview->pictureFile().endsWith("img/t2_img_3.jpg"));

    Click(panels.tabHead(3));
    Click(panels.optionLabel(catalog::OptionArray::Other, 10));
    EXPECT_TRUE(preview->pictureFile().endsWith("img/t4_img_10.jpg"));
    // No t4_img_9.jpg: the window keeps the picture it shows.
    Click(panels.optionLabel(catalog::OptionArray::Other, 9));
    EXPECT_TRUE(preview->pictureFile().endsWith("img/t4_img_10.jpg"));
    EXPECT_TRUE(preview->isVisible());
}

TEST_F(ShellPartsTest, CheckButtonRunsTheUpdateCheckAndReportsAnUnreachableHost) {
    auto window = Show();
    QSignalSpy finished(&window->updateFlow(), &UpdateFlow::checkFinished);
    Click(window->buttons().checkUpdate());
    ASSERT_TRUE(finished.wait(15000));
    ASSERT_EQ(dialogs_.messages.size(), 1);
    EXPECT_TRUE(dialogs_.messages[0].contains("Không kiểm tra được phiên bản mới"));
    EXPECT_TRUE(window->buttons().checkUpdate()->isEnabled());
}

TEST_F(ShellPartsTest, PopupWindowFollowsItsModelAndClosesWhenItFinishes) {
    QPointer<AlertPopup> popup = AlertPopup::open(QStringLiteral("Đã lưu thiết lập!"), 2);
    ASSERT_TRUE(popup->isVisible());
    EXPECT_TRUE(popup->testAttribute(Qt::WA_ShowWithoutActivating));
    for (int i = 0; i < 5; ++i) {
        popup->tick();
    }
    const popup::PixelRect rect = popup->model().WindowPixels();
    EXPECT_EQ(popup->geometry(), QRect(rect.left, rect.top, rect.width, rect.height));
    // Rising, resting, leaving: it closes and deletes itself at the end.
    for (int i = 0; i < 2000 && popup && popup->isVisible(); ++i) {
        popup->tick();
    }
    ASSERT_TRUE(popup);
    EXPECT_TRUE(popup->model().Finished());
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    EXPECT_TRUE(popup.isNull());
}

// The failure alert is the popup on red, takes no focus, and its click opens what it stands for.
TEST_F(ShellPartsTest, FailureAlertIsARedPopupWhoseClickOpensTheList) {
    QtDialogs dialogs;
    int clicks = 0;
    dialogs.showFailureAlert(QStringLiteral("Đã chép, 2 bước lỗi: bấm để xem"), 10,
                             [&clicks] { ++clicks; });
    AlertPopup* alert = nullptr;
    for (QWidget* widget : QApplication::topLevelWidgets()) {
        if (auto* popup = qobject_cast<AlertPopup*>(widget); popup && popup->isVisible()) {
            alert = popup;
        }
    }
    ASSERT_NE(alert, nullptr);
    EXPECT_EQ(alert->model().Text(), "Đã chép, 2 bước lỗi: bấm để xem");
    EXPECT_EQ(alert->model().Fill(), popup::kFailurePopupColour);
    EXPECT_TRUE(alert->testAttribute(Qt::WA_ShowWithoutActivating));
    const QImage drawn = alert->grab().toImage();
    int red = 0;
    for (int y = 0; y < drawn.height(); ++y) {
        for (int x = 0; x < drawn.width(); ++x) {
            red += drawn.pixelColor(x, y) == QColor(0xB0, 0x00, 0x00) ? 1 : 0;
        }
    }
    EXPECT_GT(red, drawn.width() * drawn.height() / 2);  // the ground, under text and frame
    QTest::mouseClick(alert, Qt::LeftButton, {}, QPoint(10, 10));
    EXPECT_EQ(clicks, 1);
    alert->close();
}

// The built artwork: the header buttons stand on the plain part of each skin's banner, clear of
// the tool's name and version; pictures of the finished window are kept for people to look at.
TEST_F(ShellPartsTest, HeaderButtonsLeaveTheBannerTitleVisibleInBothSkins) {
    const std::filesystem::path tool = KICKVANE_TOOL_DIR;
    if (!std::filesystem::exists(tool / "skin/skin2_bg.jpg")) {
        GTEST_SKIP() << "the artwork is not built";
    }
    auto window = Show(tool);
    FinishFade(*window);
    for (const SkinLook& look : {lightSkin(), darkSkin()}) {
        window->applySkin(look);
        const QImage banner = window->skins().background().toImage();
        ASSERT_FALSE(banner.isNull());
        // Under the buttons the banner's columns are all alike: no letter of the title there.
        const QRect buttons = window->buttons().checkUpdate()->geometry().united(
            window->buttons().download()->geometry());
        const int reference = buttons.right() + 2;
        for (int x = buttons.left(); x <= buttons.right(); ++x) {
            for (int y = buttons.top(); y <= buttons.bottom(); ++y) {
                const QColor here = banner.pixelColor(x, y);
                const QColor plain = banner.pixelColor(reference, y);
                ASSERT_LT(std::abs(here.lightness() - plain.lightness()), 40)
                    << look.name.toStdString() << " at " << x << "," << y;
            }
        }
        SavePicture(*window, QStringLiteral("window-%1.png").arg(look.name));
    }
    Click(window->panels().tabHead(1));
    Click(window->panels().optionLabel(catalog::OptionArray::Ball, 3));
    ASSERT_NE(window->sideWindows().preview(), nullptr);
    EXPECT_FALSE(window->sideWindows().preview()->pictureFile().isEmpty());
    SavePicture(*window->sideWindows().preview(), "preview-ball-3.png");
}

}  // namespace
}  // namespace kickvane::shell
