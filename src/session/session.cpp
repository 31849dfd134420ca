#include "session/session.h"

#include "catalog/catalog.h"
#include "catalog/ini.h"
#include "platform/filesystem.h"
#include "platform/text.h"
#include "session/game_words.h"
#include "text/utf.h"
#include "text/vni.h"

namespace kickvane::session {

namespace {

constexpr std::string_view kNoticeTitle = "Thông báo";
// Long enough to be read over the game, which goes on meanwhile.
constexpr int kFailureAlertSeconds = 10;

text::Message Notice(std::string text) {
    return {text::Message::Kind::Notice, std::move(text), std::string(kNoticeTitle)};
}

// Where a group's added variant lies, for people: "extras\Ball\Foo".
std::string AddedFolder(catalog::GroupId group, std::string_view name) {
    return "extras\\" + std::string(catalog::GroupFolder(group)) + "\\" + std::string(name);
}

std::string DefaultLabel(catalog::GroupId group) {
    for (const catalog::PatchOption& option : catalog::Group(group).options) {
        if (option.isDefault) {
            return std::string(option.label);
        }
    }
    return {};
}

text::Message GoneNotice(const std::vector<catalog::GoneChoice>& gone) {
    std::string text = "Không còn thư mục của bộ đã chọn, đã chọn lại mặc định:";
    for (const catalog::GoneChoice& choice : gone) {
        text +=
            "\n• " + AddedFolder(choice.group, choice.name) + " → " + DefaultLabel(choice.group);
    }
    return Notice(std::move(text));
}

}  // namespace

std::string_view SkipReasonText(catalog::SkipReason reason) {
    switch (reason) {
        case catalog::SkipReason::Underscore:
            return "tên bắt đầu bằng _";
        case catalog::SkipReason::NotAFolder:
            return "không phải thư mục";
        case catalog::SkipReason::Empty:
            return "thư mục trống";
        case catalog::SkipReason::Unreadable:
            return "không đọc được";
        case catalog::SkipReason::NotText:
            return "tên không đọc được";
        case catalog::SkipReason::NotAKey:
            return "tên có ký tự không dùng được";
        case catalog::SkipReason::CatalogKey:
            return "trùng tên một mục có sẵn";
        case catalog::SkipReason::CaseTwin:
            return "trùng tên, chỉ khác chữ hoa chữ thường";
        case catalog::SkipReason::TakenInSection:
            break;
    }
    return "trùng tên một bộ ở nhóm khác";
}

std::string SkippedLine(const catalog::AddedVariants& added, catalog::GroupId group) {
    std::string line;
    if (added.FolderState(group) == catalog::GroupFolderState::Unreadable) {
        line =
            "Không đọc được hết thư mục extras\\" + std::string(catalog::GroupFolder(group)) + ".";
    }
    const auto skipped = added.Skipped(group);
    if (skipped.empty()) {
        return line;
    }
    line += line.empty() ? "Bỏ qua: " : " Bỏ qua: ";
    for (size_t i = 0; i < skipped.size(); ++i) {
        if (i > 0) {
            line += "; ";
        }
        const std::string& name = skipped[i].name;
        line += text::IsValidUtf8(name) ? name : text::LegacyTextToUtf8(name);
        line += " (" + std::string(SkipReasonText(skipped[i].reason)) + ")";
    }
    return line;
}

std::string FailureAlertText(size_t failures) {
    return "Đã chép, " + std::to_string(failures) + " bước lỗi: bấm để xem";
}

std::string StepLabel(const engine::PlanStep& step) {
    const catalog::PatchCategory& category =
        catalog::Categories()[static_cast<size_t>(step.category)];
    return std::string(platform::TrimBlanks(category.label));
}

std::string StepText(const engine::PlanStep& step) {
    const auto where = [](const engine::Location& location) {
        std::string_view root;
        switch (location.root) {
            case engine::Root::Data:
                root = "data2";
                break;
            case engine::Root::ZData:
                root = "zdata\\data2";
                break;
            case engine::Root::ToolData:
                root = "data\\data2";
                break;
            case engine::Root::ToolZData:
                root = "data\\zdata\\data2";
                break;
            case engine::Root::Extras:
                root = "extras";
                break;
        }
        return std::string(root) + location.relative;
    };
    std::string text;
    switch (step.kind) {
        case engine::StepKind::MergeCopy:
            text = "chép thư mục " + where(step.source) + " vào " + where(step.target);
            break;
        case engine::StepKind::FileCopy:
            text = "chép file " + where(step.source) + " vào " + where(step.target);
            break;
        case engine::StepKind::MakeFolder:
            text = "tạo thư mục " + where(step.target);
            break;
    }
    if (step.guard == engine::StepGuard::IfSourceFolderExists) {
        text += " (nếu công cụ có thư mục này)";
    } else if (step.guard == engine::StepGuard::IfGuardFolderMissing) {
        text += " (nếu chưa có " + where(step.guardFolder) + ")";
    }
    return text;
}

std::string FailedStepLine(const engine::StepOutcome& step, const text::ShownFolders& folders) {
    return StepLabel(step.step) + ": " + text::FailureText(step.failure, folders);
}

Session::Session(std::filesystem::path toolFolder, std::unique_ptr<platform::KeySampler> keys,
                 Launcher launch)
    : toolFolder_(std::move(toolFolder)),
      added_(catalog::AddedVariants::List(toolFolder_)),
      keys_(std::move(keys)),
      poll_(keys_.get()),
      launch_(std::move(launch)) {
    catalog::LoadedSettings loaded = catalog::LoadSettings(toolFolder_, added_);
    settings_ = std::move(loaded.settings);
    gone_ = std::move(loaded.gone);
    settingsRead_ = std::move(loaded.status);
    hotkeyValid_ = poll_.SetHotkey(settings_.hotkey);
}

void Session::SetCategoryOn(int switchIndex, bool on) {
    settings_.selection.SetSwitchValue(switchIndex, on ? 1 : 0);
}

void Session::ChooseOption(catalog::OptionArray array, int index) {
    settings_.selection.SetOptionValue(array, index, true);
}

void Session::ChooseAdded(catalog::GroupId group, std::string_view name) {
    if (added_.Find(group, name)) {
        settings_.selection.SetAddedValue(group, name, true);
    }
}

Outcome Session::RefreshAddedVariants() {
    added_ = catalog::AddedVariants::List(toolFolder_);
    std::vector<catalog::GoneChoice> gone;
    for (const catalog::VariantGroup& group : catalog::Groups()) {
        const std::string chosen(settings_.selection.ChosenAdded(group.id));
        if (!chosen.empty() && !added_.Find(group.id, chosen)) {
            catalog::ChooseGroupDefault(settings_.selection, group.id);
            gone.push_back({group.id, chosen});
        }
    }
    Outcome shown;
    if (!gone.empty()) {
        shown.messages.push_back(GoneNotice(gone));
    }
    return shown;
}

std::optional<text::Message> Session::TakeGoneNotice() {
    if (gone_.empty()) {
        return std::nullopt;
    }
    text::Message notice = GoneNotice(gone_);
    gone_.clear();
    return notice;
}

void Session::SetHotkeyText(std::string text) {
    settings_.hotkey = std::move(text);
    hotkeyValid_ = poll_.SetHotkey(settings_.hotkey);
}

std::string Session::ActiveHotkey() const {
    const std::optional<int> key = poll_.Key();
    if (!key) {
        return {};
    }
    std::string name = "F";
    name += std::to_string(*key - platform::kVirtualKeyF1 + 1);
    return name;
}

std::string Session::HotkeyProblem() const {
    if (hotkeyValid_) {
        return {};
    }
    const std::string active = ActiveHotkey();
    return "\"" + settings_.hotkey + "\" không phải phím F1–F12: " +
           (active.empty() ? "phím tắt chưa hoạt động." : "vẫn dùng " + active + ".");
}

std::optional<ApplyRun> Session::PollHotkey() {
    if (!poll_.Tick()) {
        return std::nullopt;
    }
    return Apply();
}

std::optional<text::Message> Session::SettingsProblem() const {
    if (settingsRead_) {
        return std::nullopt;
    }
    std::string why = text::Capitalised(text::FailureText(settingsRead_.failure(), ShownFolders()));
    if (!why.ends_with('.')) {
        why += '.';
    }
    return text::Message{text::Message::Kind::Warning,
                         why +
                             "\nĐang dùng thiết lập mặc định; phím tắt sẽ không chép gì cho đến "
                             "khi file được sửa hoặc xoá và chương trình được mở lại.",
                         std::string(kNoticeTitle)};
}

ApplyRun Session::Apply() {
    if (!settingsRead_) {
        ApplyRun refused;
        refused.refused = true;
        refused.shown.messages.push_back(*SettingsProblem());
        return refused;
    }
    ApplyRun run{
        engine::ApplyPatches(toolFolder_, settings_.gameFolder, settings_.selection), {}, {}};
    if (run.apply.message) {
        run.shown.messages.push_back(*run.apply.message);
    }
    run.shown.signalSound = run.apply.signalSound;
    const std::vector<engine::StepOutcome> failures = run.apply.Failures();
    if (!failures.empty()) {
        const text::ShownFolders folders = ShownFolders();
        std::string text = "Đã chép xong, nhưng ";
        text += std::to_string(failures.size());
        text += " bước không thành công:";
        for (const engine::StepOutcome& failure : failures) {
            text += "\n• ";
            text += FailedStepLine(failure, folders);
        }
        run.shown.messages.push_back(Notice(std::move(text)));
        run.failureAlert = Popup{FailureAlertText(failures.size()), kFailureAlertSeconds};
    }
    return run;
}

text::ShownFolders Session::ShownFolders() const {
    if (platform::TrimBlanks(settings_.gameFolder).empty()) {
        return {{}, toolFolder_};  // no game folder: nothing is shown from it
    }
    const engine::Roots roots = engine::ResolveRoots(toolFolder_, settings_.gameFolder);
    return {platform::ResolveCaseInsensitive(roots.data).parent_path(), toolFolder_};
}

std::vector<engine::PlanStep> Session::Plan() const {
    return engine::BuildPlan(settings_.selection);
}

Outcome Session::Save() {
    Outcome shown;
    const auto refuse = [&](const Failure& failure, const std::string& before) {
        shown.messages.push_back(
            {text::Message::Kind::Warning,
             "Không lưu được thiết lập!\n" + before +
                 text::Capitalised(text::FailureText(failure, ShownFolders())) + ".",
             std::string(kNoticeTitle)});
        return shown;
    };
    // The settings in use are defaults standing in for a file that could not be read; that file
    // may still hold the user's choice, so it is copied aside before it is written over.
    bool keptOld = false;
    if (!settingsRead_) {
        const std::filesystem::path file = catalog::SettingsFile(toolFolder_);
        if (platform::IsRegularFile(file)) {
            const std::filesystem::path backup =
                platform::FindEntryIgnoringCase(toolFolder_, kSettingsBackupName)
                    .value_or(toolFolder_ / kSettingsBackupName);
            if (const Status kept = platform::ReplaceFile(file, backup); !kept) {
                return refuse(kept.failure(), "Không giữ lại được file cũ thành " +
                                                  std::string(kSettingsBackupName) + ":\n");
            }
            keptOld = true;
        }
    }
    if (const Status saved = catalog::SaveSettings(toolFolder_, settings_, added_); !saved) {
        return refuse(saved.failure(), "");
    }
    settingsRead_ = Status::Ok();  // the file holds the settings in use now
    shown.popup = keptOld ? Popup{std::string(kSavedKeepingOldPopupText), 4}
                          : Popup{std::string(kSavedPopupText), 2};
    return shown;
}

LaunchRun Session::Launch(LaunchFrom from) {
    if (launchWatch_) {
        return {game::LaunchVerdict::Watching, {}, false, {}};
    }
    game::LaunchStart start = launch_(settings_.gameFolder);
    if (start.problem != game::LaunchProblem::None) {
        LaunchRun run{game::LaunchVerdict::Failed, {}, false, {}};
        run.shown.messages.push_back({text::Message::Kind::Component,
                                      start.problem == game::LaunchProblem::LauncherMissing
                                          ? text::VniToUnicodeUtf8(game::kLauncherMissingVni)
                                          : std::string(game::kWineMissingText),
                                      {}});
        return run;
    }
    launchPlan_ = std::move(start.plan);
    launchFrom_ = from;
    if (!start.program) {
        return LaunchDecided(game::LaunchVerdict::Started, {});
    }
    launchWatch_.emplace(std::move(start.program), launchClock_);
    // A program that could not be run at all is known at once.
    if (std::optional<LaunchRun> decided = TickLaunch()) {
        return std::move(*decided);
    }
    return {game::LaunchVerdict::Watching, LaunchWayText(launchPlan_), false, {}};
}

std::optional<LaunchRun> Session::TickLaunch() {
    if (!launchWatch_) {
        return std::nullopt;
    }
    const game::LaunchVerdict verdict = launchWatch_->Tick();
    if (verdict == game::LaunchVerdict::Watching) {
        return std::nullopt;
    }
    const platform::ProgramState state = launchWatch_->State();
    launchWatch_.reset();
    return LaunchDecided(verdict, state);
}

LaunchRun Session::LaunchDecided(game::LaunchVerdict verdict,
                                 const platform::ProgramState& state) const {
    LaunchRun run{verdict, LaunchWayText(launchPlan_), false, {}};
    if (verdict == game::LaunchVerdict::Failed) {
        run.shown.messages.push_back({text::Message::Kind::Component,
                                      LaunchFailureText(launchPlan_, state, ShownFolders()),
                                      {}});
    } else if (launchFrom_ == LaunchFrom::Window) {
        run.hideToTray = true;
        run.shown.popup = Popup{std::string(kHiddenPopupText), 2};
    }
    return run;
}

std::optional<std::string> RunStatusLine(const ApplyRun& run, ClockTime at) {
    if (run.refused) {
        return std::nullopt;
    }
    return engine::RunSummary(run.apply, at);
}

GameSearch Session::GameSearchCommand() const {
    return [folders = searchFolders_.value_or(game::UserFolders::FromEnvironment())](
               const std::atomic<bool>& cancel) {
        return game::FindGame(folders, game::SearchLimits{}, &cancel);
    };
}

Status Session::RecordNewVersion(std::string version) {
    updates_.versionText = std::move(version);
    return catalog::WriteIni(catalog::SettingsFile(toolFolder_), "KiemTra", "PhienBan",
                             updates_.versionText);
}

QuickLoadRun Session::QuickLoad(std::optional<std::filesystem::path> chosen) {
    if (chosen) {
        quickLoadFolder_ = std::move(*chosen);
    }
    QuickLoadRun run{engine::QuickLoad(toolFolder_, quickLoadFolder_), {}};
    if (run.load.message) {
        run.shown.messages.push_back(*run.load.message);
    }
    if (run.load.stopped) {
        return run;
    }
    if (!run.load.failures.empty()) {
        std::string text = "Một số file không chép được:";
        for (const engine::QuickLoadFailure& failure : run.load.failures) {
            text += "\n• " + failure.pattern + ": " +
                    text::FailureText(failure.failure, ShownFolders());
        }
        run.shown.messages.push_back(Notice(std::move(text)));
    }
    run.shown.popup = Popup{std::string(kQuickLoadDonePopupText), 2};
    return run;
}

}  // namespace kickvane::session
