#pragma once

#include <atomic>
#include <chrono>
#include <filesystem>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "catalog/added_variants.h"
#include "catalog/settings.h"
#include "engine/apply.h"
#include "engine/hotkey_poll.h"
#include "engine/plan.h"
#include "engine/quick_load.h"
#include "engine/run_summary.h"
#include "game/find_game.h"
#include "game/launcher.h"
#include "text/failure_text.h"
#include "text/message.h"

// The tool's state and commands, free of any user interface. The window, the tray, the trigger
// command and the command line drive one Session and show what its commands return.
namespace kickvane::session {

// The failure alert's text for `failures` failed steps.
std::string FailureAlertText(size_t failures);

// Texts of the corner popups that confirm an action.
inline constexpr std::string_view kSavedPopupText = "Đã lưu thiết lập!";
// After a save over a settings file that could not be read: the old file was kept beside it.
inline constexpr std::string_view kSavedKeepingOldPopupText =
    "Đã lưu thiết lập!\nFile cũ không đọc được, đã giữ lại thành ThietLap.ini.bak";
inline constexpr std::string_view kSettingsBackupName = "ThietLap.ini.bak";
inline constexpr std::string_view kHiddenPopupText = "Ẩn xuống khay hệ thống!";
// Said instead where no tray is up: the window minimises, since hidden it could not come back.
inline constexpr std::string_view kNoTrayPopupText = "Không có khay hệ thống: đã thu nhỏ cửa sổ!";
inline constexpr std::string_view kSkinChangedPopupText = "Đã thay đổi giao diện!";
inline constexpr std::string_view kQuickLoadDonePopupText = "Hoàn tất!";

// How often the user interface runs one tick of the hotkey poll.
inline constexpr std::chrono::milliseconds kHotkeyPollInterval = engine::HotkeyPoll::kInterval;

struct Popup {
    std::string text;
    int seconds = 2;

    friend bool operator==(const Popup&, const Popup&) = default;
};

// What a command asks the user interface to show, in this order: the signal sound (it follows
// the copies), then the messages, then the popup.
struct Outcome {
    std::filesystem::path signalSound;  // played without waiting; empty: no sound
    std::vector<text::Message> messages;
    std::optional<Popup> popup;
};

// The update check's findings: the host's version text and download link, as fetched.
struct UpdateState {
    std::string versionText;
    std::string downloadLink;
};

// Where the launcher was asked for: the window's button hides the window to the tray and says
// so; the tray menu's entry leaves everything as it is.
enum class LaunchFrom { Window, Tray };

// A start of the game's launcher. The program is watched for a moment (Session::TickLaunch)
// before it counts as started: one that fails at once is reported, and the window stays.
struct LaunchRun {
    game::LaunchVerdict verdict = game::LaunchVerdict::Started;
    std::string way;  // which way it was started, in words: "qua Wine trong thư mục Wine …"
    bool hideToTray = false;
    Outcome shown;

    bool watching() const { return verdict == game::LaunchVerdict::Watching; }
    bool started() const { return verdict == game::LaunchVerdict::Started; }
};

struct ApplyRun {
    engine::ApplyOutcome apply;
    Outcome shown;
    // When steps failed: the corner alert that stands for the list of failures where a box would
    // take the focus from the game ("Đã chép, 2 bước lỗi: bấm để xem"). The list is then the
    // last of the messages.
    std::optional<Popup> failureAlert;
    // The settings file could not be read, so no copy was tried: the defaults in its place are
    // not the user's choice.
    bool refused = false;
};

struct QuickLoadRun {
    engine::QuickLoadOutcome load;
    Outcome shown;
};

// Starts the game's launcher; a start with no program to watch counts as started at once.
using Launcher = std::function<game::LaunchStart(std::string_view gameFolder)>;
using LaunchClock = game::LaunchWatch::Clock;
// How often the user interface ticks a watched launch.
inline constexpr std::chrono::milliseconds kLaunchWatchInterval = game::kLaunchWatchInterval;

// A time of day on the user's clock.
using ClockTime = engine::ClockTime;

// One line for places without room for more (the tray icon's tooltip): when the run was, how many
// sets it copied and how many steps failed, or why it stopped. Nothing for a run that was
// refused, which copied nothing and tells the user so itself.
std::optional<std::string> RunStatusLine(const ApplyRun& run, ClockTime at);

// The game search's answer: the folders that hold the launcher, where it looked, what it skipped.
using GameSearchOutcome = game::FindOutcome;
using FoundGame = game::FoundGame;
using SkippedFile = game::SkippedFile;
// The game search as a command that owns what it needs, so it can run on another thread;
// setting `cancel` ends it early.
using GameSearch = std::function<GameSearchOutcome(const std::atomic<bool>& cancel)>;

class Session {
public:
    // Loads the settings of `toolFolder`. `keys` samples the global key state for the hotkey;
    // null where there is none. `launch` starts the game's launcher.
    explicit Session(std::filesystem::path toolFolder,
                     std::unique_ptr<platform::KeySampler> keys = nullptr,
                     Launcher launch = game::LaunchGame);

    const std::filesystem::path& ToolFolder() const { return toolFolder_; }
    const catalog::Settings& Settings() const { return settings_; }
    // Ok when the settings file was read, or is missing or empty (the defaults apply).
    const Status& SettingsRead() const { return settingsRead_; }
    // For the user, when the settings file could not be read: why, and that the defaults show.
    std::optional<text::Message> SettingsProblem() const;
    const catalog::PatchSelection& Selection() const { return settings_.selection; }
    bool HasGlobalKeys() const { return keys_ != nullptr; }

    void SetGameFolder(std::string folder) { settings_.gameFolder = std::move(folder); }
    // A ticked box is on (1), a cleared one off (0); a stored value other than these is lost.
    void SetCategoryOn(int switchIndex, bool on);
    // Chooses a variant; the others of its group are cleared.
    void ChooseOption(catalog::OptionArray array, int index);

    // The variants the player added to the groups' folders, as listed at start or last refresh.
    const catalog::AddedVariants& AddedVariants() const { return added_; }
    // Chooses an added variant of the group; a name that is not listed changes nothing.
    void ChooseAdded(catalog::GroupId group, std::string_view name);
    // Lists the groups' folders again (the window calls it when it comes back from the tray).
    // A chosen added variant whose folder went away gives way to its group's default, and the
    // outcome says so.
    Outcome RefreshAddedVariants();
    // Once: which chosen added variants were gone when the settings were loaded, and that their
    // groups took their defaults. Empty afterwards, and when none was gone.
    std::optional<text::Message> TakeGoneNotice();

    // Takes the hotkey text as typed; it is saved as it stands. A text that names no key keeps
    // the key in use as it was; HotkeyValid() says so.
    void SetHotkeyText(std::string text);
    bool HotkeyValid() const { return hotkeyValid_; }
    // The name of the key the poll reacts to ("F7"); empty when none.
    std::string ActiveHotkey() const;
    // For the user, when the hotkey text names no key: what is wrong and which key is in use.
    // Empty when the text names a key.
    std::string HotkeyProblem() const;

    // One tick of the hotkey poll: applies the patches when the key was pressed.
    std::optional<ApplyRun> PollHotkey();
    // When to tick: on every readable event of the descriptor (-1: none), and on the poll's
    // interval while HotkeyNeedsTicks() says so.
    int HotkeyWakeDescriptor() const { return poll_.WakeDescriptor(); }
    bool HotkeyNeedsTicks() const { return poll_.NeedsTicks(); }

    ApplyRun Apply();
    std::vector<engine::PlanStep> Plan() const;
    // Writes the settings file. When it could not be read at the start, the first save keeps
    // the old file as "ThietLap.ini.bak" (replacing an older one) and says so; without that copy
    // nothing is written.
    Outcome Save();
    // Starts the launcher. The run is usually still watched then: TickLaunch says how it ended.
    // Asked again while a start is watched, it starts nothing and says nothing.
    LaunchRun Launch(LaunchFrom from);
    // One look at the watched start; the run once it is decided (started or failed).
    std::optional<LaunchRun> TickLaunch();
    // The clock of the launch's watch; tests set one of their own.
    void SetLaunchClock(LaunchClock clock) { launchClock_ = std::move(clock); }
    // Loads from `chosen`, or from the folder chosen last time when the user picked none.
    QuickLoadRun QuickLoad(std::optional<std::filesystem::path> chosen);
    const std::filesystem::path& QuickLoadFolder() const { return quickLoadFolder_; }

    // Looks for the game's launcher in the Wine prefixes and game managers' folders of the user
    // (of the folders set with SetGameSearchFolders: tests use homes of their own).
    GameSearch GameSearchCommand() const;
    void SetGameSearchFolders(game::UserFolders folders) { searchFolders_ = std::move(folders); }

    const UpdateState& Updates() const { return updates_; }
    // The update host has a version other than this one: keeps it and records it in the settings
    // file ("KiemTra", "PhienBan"; line breaks dropped). Nothing reads the key back, so a failed
    // write is only returned.
    Status RecordNewVersion(std::string version);
    // Keeps the version text that the update host gave, as fetched.
    void KeepVersion(std::string version) { updates_.versionText = std::move(version); }
    // Keeps the download link that the update host gave, as fetched.
    void RecordDownloadLink(std::string link) { updates_.downloadLink = std::move(link); }

    // The game folder of the settings and the tool folder, which failures name paths from.
    text::ShownFolders ShownFolders() const;

private:
    LaunchRun LaunchDecided(game::LaunchVerdict verdict, const platform::ProgramState& state) const;

    std::filesystem::path toolFolder_;
    catalog::AddedVariants added_;
    std::vector<catalog::GoneChoice> gone_;
    catalog::Settings settings_;
    Status settingsRead_ = Status::Ok();
    std::unique_ptr<platform::KeySampler> keys_;
    engine::HotkeyPoll poll_;
    bool hotkeyValid_ = true;
    Launcher launch_;
    LaunchClock launchClock_ = std::chrono::steady_clock::now;
    std::optional<game::LaunchWatch> launchWatch_;
    game::LaunchPlan launchPlan_;
    LaunchFrom launchFrom_ = LaunchFrom::Window;
    std::filesystem::path quickLoadFolder_;
    UpdateState updates_;
    std::optional<game::UserFolders> searchFolders_;
};

// The line under a group that names the folders of its added variants that were passed over and
// why ("Bỏ qua: Foo (thư mục trống)"); empty when there are none.
std::string SkippedLine(const catalog::AddedVariants& added, catalog::GroupId group);
// Why a folder was passed over, in a few words: "thư mục trống".
std::string_view SkipReasonText(catalog::SkipReason reason);

// What a step does, for people: "chép thư mục extras\Ball\UCL 2011 vào zdata\data2\ball". Tool
// folders start with "data" or "extras", the game's with "data2" or "zdata".
std::string StepText(const engine::PlanStep& step);

// The category's label of a step, as the window shows it: "Cổ động viên".
std::string StepLabel(const engine::PlanStep& step);

// One line per failed step for people: "Cổ động viên: không chép được vào
// zdata\data2\crowd\textures: trò chơi không có thư mục này".
std::string FailedStepLine(const engine::StepOutcome& step, const text::ShownFolders& folders);

}  // namespace kickvane::session
