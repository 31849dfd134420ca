#pragma once

#include <QCheckBox>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QMenu>
#include <QPointer>
#include <QPushButton>
#include <QRadioButton>
#include <QTimer>
#include <QWidget>
#include <array>
#include <filesystem>
#include <functional>
#include <memory>
#include <vector>

#include "catalog/settings.h"
#include "engine/hotkey_poll.h"
#include "engine/launcher.h"
#include "shell/dialogs.h"
#include "shell/fade_model.h"
#include "shell/side_windows.h"
#include "shell/tray.h"
#include "shell/update_check.h"
#include "shell/widgets.h"
#include "shell/window_ui.h"

namespace kickvane::shell {

inline constexpr int kTabCount = 4;
inline constexpr int kClientWidth = 425;
inline constexpr int kClientHeight = 478;
inline constexpr int kTabHeadWidth = 82;
inline constexpr int kTabHeadHeight = 31;
inline const QColor kUnselectedTabColour{0xE0, 0xE0, 0xE0};

// Texts and run-time values that the window keeps for its parts: popup texts, the active skin,
// the quick load's folder and what the update check fetched.
struct HiddenTexts {
    QString skn = QStringLiteral("skin1");
    QString skintxt = QStringLiteral("Đã thay đổi giao diện!");
    QString text2 = QStringLiteral("Đã lưu thiết lập!");
    QString tAlert = QStringLiteral("Ẩn xuống khay hệ thống!");
    QString cph = QStringLiteral("Hoàn tất!");
    QString cpn;   // the folder chosen for the quick load
    QString pban;  // version text of the last update check
    QString vlk;   // download link of the last update check
};

// What the window needs from outside; tests pass fakes.
struct ShellServices {
    Dialogs* dialogs = nullptr;                        // not owned
    std::unique_ptr<platform::KeySampler> keySampler;  // null: no global key state here
    SoundPlayer playSound;
    std::function<engine::LaunchResult(std::string_view, engine::EngineUi&)> launchGame =
        engine::LaunchGame;
    // Where the update check asks; tests point it at a server of their own.
    UpdateCheck::Options updates = UpdateCheck::DefaultOptions();
    // Makes the tray icon with the window's tray menu; null: the desktop's tray.
    std::function<std::unique_ptr<TrayIcon>(const QIcon&, QMenu*)> makeTray;
};

// The look of one skin: its picture prefix and the colours of the entries.
struct SkinLook {
    QString name;            // "skin1" or "skin2", the prefix of its pictures
    QColor entryBackground;  // tick boxes, option buttons, the framed groups
    QColor labelText;
    QColor labelBackground;
};
SkinLook LightSkin();
SkinLook DarkSkin();

// The main window: four panels under tab heads with the catalog's check boxes and option buttons,
// the game folder, the hotkey and the command buttons. It polls the hotkey every 100 ms and
// applies the chosen sets when the key is pressed anywhere on the desktop.
class MainWindow final : public QWidget {
    Q_OBJECT
public:
    MainWindow(std::filesystem::path toolFolder, ShellServices services, QWidget* parent = nullptr);
    ~MainWindow() override;

    const std::filesystem::path& toolFolder() const { return toolFolder_; }
    HiddenTexts& hiddenTexts() { return hidden_; }

    int currentTab() const { return currentTab_; }
    int tabHeight() const { return tabHeight_; }
    void selectTab(int index);
    TabHead* tabHead(int index) const { return tabs_[static_cast<size_t>(index)]; }
    PictureBox* panel(int index) const { return panels_[static_cast<size_t>(index)]; }

    QCheckBox* categoryCheck(int switchIndex) const;
    QRadioButton* optionButton(catalog::OptionArray array, int index) const;
    ClickableLabel* categoryLabel(int switchIndex) const;
    ClickableLabel* optionLabel(catalog::OptionArray array, int index) const;
    QLineEdit* gameFolderBox() const { return gameFolder_; }
    QComboBox* hotkeyBox() const { return hotkey_; }
    QPushButton* saveButton() const { return save_; }
    QPushButton* launchButton() const { return launch_; }
    QPushButton* quickLoadButton() const { return quickLoad_; }
    QPushButton* browseButton() const { return browse_; }
    QPushButton* runHiddenButton() const { return runHidden_; }
    QPushButton* translucentButton() const { return translucent_; }
    QPushButton* skinButton(int skin) const { return skin == 1 ? skin1_ : skin2_; }
    QPushButton* infoButton() const { return info_; }
    QPushButton* helpButton() const { return help_; }
    QPushButton* checkUpdateButton() const { return checkUpdate_; }
    QPushButton* downloadButton() const { return download_; }
    UpdateFlow* updateFlow() const { return updateFlow_.get(); }
    QMenu* trayMenu() { return &trayMenu_; }
    TrayIcon* tray() const { return tray_.get(); }
    PreviewWindow* previewWindow() const { return preview_; }
    const FadeModel& fade() const { return fade_; }
    QColor labelTextColour() const;

    // The settings as the widgets hold them now.
    catalog::Settings currentSettings() const;
    const catalog::PatchSelection& selection() const { return selection_; }

    // Applies the chosen sets now, as a hotkey press does; ignored while a run is going on.
    void applyPatchesNow();
    // One tick of the hotkey poll.
    void pollHotkey();

    void saveSettings();
    void launchGame();
    void quickLoad();
    void browseGameFolder();

    // Draws the tab heads and shows the current panel, with the active skin's pictures.
    void paintTabs();

    // Starts a fade of the window's opacity towards `target` by `step` every 20 ms.
    void startFade(int target, int step);
    // Sets the window's opacity at once; the fade goes on from where it stood.
    TranslucentResult makeTranslucent(int alpha);
    void fadeTick();

    void applySkin(const SkinLook& look);
    void showPreview(catalog::LabelArray labels, int index);
    // "Chạy ẩn": fades towards 150, hides to the tray and says so.
    void runHidden();
    // "Hiện chương trình": shows the window and fades it in.
    void showFromTray();
    void launchGameFromTray();
    void showAbout();
    void showHelp();
    // "Thoát": the tray icon goes first, then the program ends.
    void exitFromTray();

signals:
    // A catalog label was clicked: label array and index, for the preview.
    void labelClicked(catalog::LabelArray labels, int index);
    // The user chose to end the program from the tray menu.
    void exitRequested();
    // The user closed the window, which ends the program.
    void closed();

protected:
    void paintEvent(QPaintEvent* event) override;
    void closeEvent(QCloseEvent* event) override;

private:
    void buildTabs();
    void buildCategoryPanel(QWidget* panel);
    void buildGroupPanel(QWidget* panel, catalog::GroupId group, int top);
    void buildVariantFrames(QWidget* panel);
    void buildButtons();
    void buildTrayMenu();
    void hideToTray();
    QWidget* showSideWindow(QPointer<QWidget>& window, QWidget* (*create)(QWidget*));
    void initTabs();
    void layoutPanels(const QString& panelPicture);
    void loadSettings();
    void showSelection();
    void onOptionClicked(catalog::OptionArray array, int index);
    QString skinFile(const QString& skin, const QString& suffix) const;

    std::filesystem::path toolFolder_;
    ShellServices services_;
    WindowUi ui_;
    HiddenTexts hidden_;
    catalog::PatchSelection selection_;

    int currentTab_ = 0;
    int tabHeight_ = 32;
    std::array<TabHead*, kTabCount> tabs_{};
    std::array<PictureBox*, kTabCount> panels_{};
    std::array<QCheckBox*, catalog::kCategoryCount> checks_{};
    std::array<ClickableLabel*, catalog::kCategoryCount> categoryLabels_{};
    struct OptionWidgets {
        catalog::OptionArray array;
        int index;
        QRadioButton* button;
        ClickableLabel* label;
    };
    std::vector<OptionWidgets> options_;
    std::array<PictureBox*, 3> groupFrames_{};

    QLineEdit* gameFolder_ = nullptr;
    QPushButton* browse_ = nullptr;
    QComboBox* hotkey_ = nullptr;
    QLabel* hotkeyLabel_ = nullptr;
    QPushButton* save_ = nullptr;
    QPushButton* launch_ = nullptr;
    QPushButton* quickLoad_ = nullptr;
    QPushButton* runHidden_ = nullptr;
    QPushButton* translucent_ = nullptr;
    QPushButton* skin1_ = nullptr;
    QPushButton* skin2_ = nullptr;
    QPushButton* info_ = nullptr;
    QPushButton* help_ = nullptr;
    QPushButton* checkUpdate_ = nullptr;
    QPushButton* download_ = nullptr;
    QPixmap background_;

    FadeModel fade_;
    QTimer fadeTimer_;
    QMenu trayMenu_;
    std::unique_ptr<TrayIcon> tray_;
    std::unique_ptr<UpdateFlow> updateFlow_;
    QPointer<PreviewWindow> preview_;
    QPointer<QWidget> about_;
    QPointer<QWidget> helpWindow_;

    std::unique_ptr<engine::HotkeyPoll> poll_;
    QTimer hotkeyTimer_;
    bool applying_ = false;
};

}  // namespace kickvane::shell
