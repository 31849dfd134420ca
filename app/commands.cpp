#include "commands.h"

#include <iostream>
#include <optional>
#include <string>

#include "catalog/ini.h"
#include "platform/filesystem.h"
#include "platform/program.h"
#include "platform/single_instance.h"
#include "platform/text.h"
#include "session/session.h"
#include "text/failure_text.h"
#include "text/vni.h"

namespace kickvane::app {

namespace {

namespace fs = std::filesystem;

constexpr int kExitOk = 0;
constexpr int kExitFailedSteps = 1;
constexpr int kExitStopped = 2;
// `trigger`: a copy of the window runs but took nothing.
constexpr int kExitNoAnswer = 3;

// The command line's face of a command's outcome: messages on standard error, the popup on
// standard output, no sound.
void Print(const session::Outcome& shown) {
    for (const text::Message& message : shown.messages) {
        if (message.kind == text::Message::Kind::Component) {
            std::cerr << message.text << '\n';
        } else {
            std::cerr << message.title << ": " << message.text << '\n';
        }
    }
    if (shown.popup) {
        std::cout << shown.popup->text << '\n';
    }
}

// The session of the tool folder, with the game folder of the command line. nullopt, with the
// reason on standard error, when the settings file exists but cannot be read: acting on defaults
// the user never chose would be wrong.
std::optional<session::Session> SessionFor(const Options& options) {
    std::optional<session::Session> session(std::in_place, options.toolFolder);
    if (const std::optional<text::Message> problem = session->SettingsProblem()) {
        std::cerr << "kickvane: " << problem->text << '\n';
        return std::nullopt;
    }
    if (options.game) {
        session->SetGameFolder(*options.game);
    }
    return session;
}

// A status word padded to one width, so that the step texts line up.
constexpr std::string_view kDoneWord = "xong    ";
constexpr std::string_view kSkippedWord = "bỏ qua  ";
constexpr std::string_view kFailedWord = "LỖI     ";

// "xong    Bóng: chép thư mục extras\Ball\X vào zdata\data2\ball (3 file đã chép, 1 file không
// đổi)"; a failed step says why instead of the counts.
void PrintStep(const engine::StepOutcome& outcome, const text::ShownFolders& folders) {
    switch (outcome.state) {
        case engine::StepState::Done:
            std::cout << kDoneWord;
            break;
        case engine::StepState::NotNeeded:
            std::cout << kSkippedWord;
            break;
        case engine::StepState::Failed:
            std::cout << kFailedWord << session::FailedStepLine(outcome, folders) << '\n';
            return;
    }
    std::cout << session::StepLabel(outcome.step) << ": " << session::StepText(outcome.step);
    if (outcome.step.kind != engine::StepKind::MakeFolder &&
        outcome.state == engine::StepState::Done) {
        std::cout << " (" << outcome.files.copied << " file đã chép, " << outcome.files.upToDate
                  << " file không đổi)";
    }
    std::cout << '\n';
}

void PrintGroup(const session::Session& session, const catalog::VariantGroup& group) {
    const catalog::PatchSelection& selection = session.Selection();
    for (const catalog::PatchOption& option : group.options) {
        std::cout << "  " << (selection.OptionValue(group.array, option.index) ? "(*) " : "( ) ")
                  << option.key << ": " << option.label << '\n';
    }
    const catalog::AddedVariants& added = session.AddedVariants();
    for (const catalog::AddedVariant& variant : added.Of(group.id)) {
        std::cout << "  " << (selection.AddedValue(group.id, variant.name) ? "(*) " : "( ) ")
                  << variant.name << " [đã thêm]\n";
    }
    const std::string folder = "extras\\" + std::string(catalog::GroupFolder(group.id));
    switch (added.FolderState(group.id)) {
        case catalog::GroupFolderState::Listed:
            break;
        case catalog::GroupFolderState::Missing:
            std::cout << "  không có thư mục " << folder << '\n';
            break;
        case catalog::GroupFolderState::Unreadable:
            std::cout << "  không đọc được hết thư mục " << folder << '\n';
            break;
    }
    for (const catalog::SkippedFolder& skipped : added.Skipped(group.id)) {
        std::cout << "  bỏ qua " << folder << '\\' << skipped.name << ": "
                  << session::SkipReasonText(skipped.reason) << '\n';
    }
}

}  // namespace

std::optional<Options> ParseOptions(Args args, bool allowGame, size_t positional) {
    Options options;
    for (size_t i = 0; i < args.size(); ++i) {
        const std::string_view arg = args[i];
        const bool takesValue = arg == "--tool-folder" || (allowGame && arg == "--game");
        if (takesValue) {
            if (i + 1 >= args.size()) {
                std::cerr << "kickvane: " << arg << " cần một thư mục\n";
                return std::nullopt;
            }
            if (arg == "--game") {
                options.game = std::string(args[++i]);
            } else {
                options.toolFolder = fs::absolute(platform::PathFromUtf8(args[++i]));
            }
        } else if (arg.starts_with("--")) {
            std::cerr << "kickvane: không có tuỳ chọn " << arg << '\n';
            return std::nullopt;
        } else {
            options.positional.push_back(arg);
        }
    }
    if (options.positional.size() != positional) {
        return std::nullopt;
    }
    if (options.toolFolder.empty()) {
        options.toolFolder = DefaultToolFolder();
    }
    return options;
}

void PrintUsage(std::ostream& out) {
    out << "Cách dùng: kickvane [--tool-folder TM]     mở cửa sổ\n"
           "           kickvane LỆNH [THAM SỐ]\n"
           "\n"
           "  apply [--tool-folder TM] [--game TM]   chép các bộ đã chọn vào trò chơi\n"
           "  plan [--tool-folder TM] [--game TM]    liệt kê các bước chép, không chép gì\n"
           "  list [--tool-folder TM]                liệt kê các mục và các bộ: bộ đã chọn (*),\n"
           "                                         bộ đã thêm, thư mục bỏ qua\n"
           "  quick-load NGUỒN [--tool-folder TM]    thêm các file Face và Ball vào bộ gốc\n"
           "  vni [VĂN BẢN]                          đổi văn bản gõ kiểu VNI sang Unicode\n"
           "  ini get FILE MỤC KHOÁ [MẶC ĐỊNH]       đọc một giá trị thiết lập\n"
           "  ini set FILE MỤC KHOÁ GIÁ TRỊ          ghi một giá trị thiết lập\n"
           "  trigger                                bảo cửa sổ đang chạy chép các bộ ngay\n";
    if (platform::GameRunsUnderWine()) {
        out << "  launch [--tool-folder TM]              khởi động trò chơi nơi nó được cài (qua\n"
               "                                         trình quản lý trò chơi, hoặc Wine trong\n"
               "                                         prefix của nó)\n";
    } else {
        out << "  launch [--tool-folder TM]              khởi động Gameloader.exe trong thư mục\n"
               "                                         trò chơi\n";
    }
    out << "  find-game                              liệt kê các thư mục có Gameloader.exe\n"
           "  skin-gallery RA.png                    vẽ mọi điều khiển có giao diện vào một hình\n"
           "\n"
           "TM là một thư mục. Thư mục công cụ mặc định là thư mục của chương trình; các bộ đã\n"
           "chọn và thư mục trò chơi lấy từ ThietLap.ini trong đó.\n";
}

namespace {

// The session of a command that takes only the folder options; the usage or the settings
// file's problem is printed when there is none.
std::optional<session::Session> SessionForArguments(Args args, bool allowGame) {
    const std::optional<Options> options = ParseOptions(args, allowGame, 0);
    if (!options) {
        PrintUsage(std::cerr);
        return std::nullopt;
    }
    return SessionFor(*options);
}

}  // namespace

int RunApply(Args args) {
    std::optional<session::Session> session = SessionForArguments(args, true);
    if (!session) {
        return kExitStopped;
    }
    const session::ApplyRun run = session->Apply();
    const engine::ApplyOutcome& outcome = run.apply;
    if (outcome.Stopped()) {
        Print(run.shown);
        return kExitStopped;
    }
    const text::ShownFolders folders = session->ShownFolders();
    for (const engine::StepOutcome& step : outcome.steps) {
        PrintStep(step, folders);
    }
    const std::vector<engine::StepOutcome> failures = outcome.Failures();
    std::cout << outcome.steps.size() << " bước, " << failures.size() << " bước lỗi\n";
    for (const engine::StepOutcome& failure : failures) {
        std::cerr << "lỗi: " << session::FailedStepLine(failure, folders) << '\n';
    }
    return failures.empty() ? kExitOk : kExitFailedSteps;
}

int RunPlan(Args args) {
    const std::optional<session::Session> session = SessionForArguments(args, true);
    if (!session) {
        return kExitStopped;
    }
    // The two folders first, then the steps with paths relative to them: "data", "extras"
    // are the tool's, "data2", "zdata" the game's.
    const text::ShownFolders folders = session->ShownFolders();
    std::cout << "thư mục công cụ = " << platform::PathToUtf8(folders.tool) << '\n'
              << "thư mục trò chơi = " << platform::PathToUtf8(folders.game) << '\n';
    for (const engine::PlanStep& step : session->Plan()) {
        std::cout << session::StepLabel(step) << ": " << session::StepText(step) << '\n';
    }
    return kExitOk;
}

int RunList(Args args) {
    std::optional<session::Session> session = SessionForArguments(args, false);
    if (!session) {
        return kExitStopped;
    }
    if (std::optional<text::Message> gone = session->TakeGoneNotice()) {
        std::cerr << gone->title << ": " << gone->text << '\n';
    }
    for (const catalog::PatchCategory& category : catalog::Categories()) {
        std::cout << category.key
                  << (session->Selection().IsOn(category.switchIndex) ? " [bật] " : " [tắt] ")
                  << platform::TrimBlanks(category.label) << '\n';
        if (category.group) {
            PrintGroup(*session, catalog::Group(*category.group));
        }
    }
    return kExitOk;
}

int RunQuickLoad(Args args) {
    const std::optional<Options> options = ParseOptions(args, false, 1);
    if (!options) {
        PrintUsage(std::cerr);
        return kExitStopped;
    }
    session::Session session(options->toolFolder);
    const session::QuickLoadRun run =
        session.QuickLoad(platform::PathFromUtf8(options->positional[0]));
    const engine::QuickLoadOutcome& outcome = run.load;
    if (outcome.stopped) {
        Print(run.shown);
        return kExitStopped;
    }
    std::cout << run.shown.popup->text << '\n';
    for (const engine::QuickLoadFailure& failure : outcome.failures) {
        std::cerr << "lỗi: " << failure.pattern << ": "
                  << text::FailureText(failure.failure, session.ShownFolders()) << '\n';
    }
    return outcome.failures.empty() ? kExitOk : kExitFailedSteps;
}

int RunVni(Args args) {
    if (args.size() > 1) {
        PrintUsage(std::cerr);
        return kExitStopped;
    }
    if (args.size() == 1) {
        std::cout << text::VniToUnicodeUtf8(args[0]) << '\n';
        return kExitOk;
    }
    for (std::string line; std::getline(std::cin, line);) {
        std::cout << text::VniToUnicodeUtf8(line) << '\n';
    }
    return kExitOk;
}

int RunIni(Args args) {
    if (args.size() >= 4 && args.size() <= 5 && args[0] == "get") {
        const std::string_view fallback = args.size() == 5 ? args[4] : std::string_view();
        const fs::path file = platform::PathFromUtf8(args[1]);
        catalog::IniDocument document;
        if (const Status read = catalog::IniDocument::Read(file, &document); !read) {
            std::cerr << "kickvane: " << text::FailureText(read.failure(), {}) << '\n';
            return 1;
        }
        std::cout << catalog::ReadIni(file, args[2], args[3], fallback) << '\n';
        return kExitOk;
    }
    if (args.size() == 5 && args[0] == "set") {
        const Status written =
            catalog::WriteIni(platform::PathFromUtf8(args[1]), args[2], args[3], args[4]);
        if (!written) {
            std::cerr << "kickvane: " << text::FailureText(written.failure(), {}) << '\n';
            return 1;
        }
        return kExitOk;
    }
    PrintUsage(std::cerr);
    return kExitStopped;
}

int RunTrigger(Args args) {
    if (!args.empty()) {
        PrintUsage(std::cerr);
        return kExitStopped;
    }
    switch (platform::SendToRunningInstance("trigger")) {
        case platform::Delivery::Delivered:
            return kExitOk;
        case platform::Delivery::Queued:
            std::cout << "Kickvane đang bận, lần chép sẽ chạy khi xong.\n";
            return kExitOk;
        case platform::Delivery::NoAnswer:
            std::cerr << "kickvane: Kickvane đang chạy nhưng không trả lời; lần chép chưa được "
                         "nhận, hãy thử lại.\n";
            return kExitNoAnswer;
        case platform::Delivery::NotRunning:
        case platform::Delivery::Refused:
            break;
    }
    std::cerr << "kickvane: Kickvane chưa chạy, không có gì để kích hoạt.\n";
    return 1;
}

}  // namespace kickvane::app
