#pragma once

#include <QSocketNotifier>
#include <QTimer>
#include <QWidget>
#include <filesystem>
#include <memory>

#include "session/session.h"
#include "shell/catalog_panels.h"
#include "shell/command_buttons.h"
#include "shell/dialogs.h"
#include "shell/fade_model.h"
#include "shell/game_finder.h"
#include "shell/outcome_view.h"
#include "shell/side_window_set.h"
#include "shell/skins.h"
#include "shell/tray_menu.h"
#include "shell/update_flow.h"

namespace kickvane::shell {

inline constexpr int kClientWidth = 425;
inline constexpr int kClientHeight = 478;

// What the window needs from outside; tests pass fakes.
struct ShellServices {
    Dialogs* dialogs = nullptr;  // not owned
    SoundPlayer playSound;
    // Where the update check asks; tests point it at a server of their own.
    UpdateFetchOptions updates = defaultUpdateOptions();
    // Makes the tray icon with the window's tray menu; null: the desktop's tray.
    TrayFactory makeTray;
};

// The main window, a view of the session: the catalog panels, the command buttons, the skins,
// the tray and the side windows show the session's state and hand the user's actions to it.
// It drives the session's hotkey poll every 100 ms and its fade every 20 ms.
class MainWindow final : public QWidget {
    Q_OBJECT
public:
    MainWindow(session::Session& session, ShellServices services, QWidget* parent = nullptr);
    ~MainWindow() override;

    session::Session& session() { return session_; }
    CatalogPanels& panels() { return *panels_; }
    CommandButtons& buttons() { return *buttons_; }
    WindowSkins& skins() { return skins_; }
    TrayMenu& tray() { return *tray_; }
    SideWindowSet& sideWindows() { return sideWindows_; }
    UpdateFlow& updateFlow() { return *updateFlow_; }
    const FadeModel& fade() const { return fade_; }

    // Ends the tool as "Thoát" in the tray menu does: the tray icon goes, nothing is saved.
    void exitFromTray();

    // Applies the chosen sets now, as a hotkey press does. Asked while a run and its messages
    // are still going on, it runs once after them.
    void applyPatchesNow();
    // One tick of the hotkey poll.
    void pollHotkey();

    void applySkin(const SkinLook& look);
    // Sets the window's opacity at once; the fade goes on from where it stood.
    TranslucentResult makeTranslucent(int alpha);
    void fadeTick();

signals:
    // The user chose to end the program from the tray menu.
    void exitRequested();
    // The user closed the window, which ends the program.
    void closed();

protected:
    void paintEvent(QPaintEvent* event) override;
    void closeEvent(QCloseEvent* event) override;

private:
    // Shows a patch run's outcome and keeps its result in the tray icon's tooltip.
    // Shows a run of the hotkey or the trigger command. Its failures show in a box while the
    // window is in front; over another program (the game) they show as the corner alert, which
    // takes no focus and whose click, like the tray entry, opens the list.
    void showRun(const session::ApplyRun& run);
    void showRunAlone(const session::ApplyRun& run);  // no other run starts meanwhile
    // The failures of the last run that reported them by the corner alert.
    void showLastFailures();
    // Starts the run that applyPatchesNow was asked for during the one that just ended.
    void runAgainIfAsked();
    void saveSettings();
    // Starts the game's launcher; while its start is watched, ticks the watch.
    void launchGame(session::LaunchFrom from);
    void watchLaunch();
    // A decided start: hides to the tray after one from the button, or says why it failed.
    void showLaunch(session::LaunchRun run);
    void quickLoad();
    void browseGameFolder();
    // Starts a fade of the window's opacity towards `target` by `step` every 20 ms.
    void startFade(int target, int step);
    // Sets the window's opacity, 0 to 255.
    void setAlpha(int alpha);
    // "Chạy ẩn": fades towards 150, hides to the tray and says so.
    void runHidden();
    // "Hiện chương trình": shows the window and fades it in.
    void showFromTray();
    // "Thoát": the tray icon goes first, then the program ends.

    void connectPanels();
    void connectButtons();
    void connectTray();
    void showSession();
    void showHotkey();
    // Hides the window to the tray; without a tray host it minimises instead. True when hidden.
    bool hideToTray();
    // hideToTray, then says what happened: `popup` when hidden, the lack of a tray otherwise.
    void hideAndSay(const session::Popup& popup);
    void showAddedVariants();
    // Moves the focus from the hotkey box, if it is there, to the current tab head.
    void moveFocusOffHotkey();

    session::Session& session_;
    ShellServices services_;
    OutcomeView outcomes_;
    CatalogPanels* panels_;
    CommandButtons* buttons_;
    WindowSkins skins_;
    SideWindowSet sideWindows_;
    std::unique_ptr<TrayMenu> tray_;
    std::unique_ptr<UpdateFlow> updateFlow_;

    FadeModel fade_;
    QTimer fadeTimer_;
    QTimer hotkeyTimer_;  // runs only while the key needs polling (held, or no key events)
    QTimer launchTimer_;  // runs only while a start of the game is watched
    std::unique_ptr<QSocketNotifier> hotkeyWake_;  // key events; null where none come
    bool applying_ = false;
    std::optional<text::Message> lastFailures_;
    bool applyAgain_ = false;  // applyPatchesNow was asked for during a run
};

}  // namespace kickvane::shell
