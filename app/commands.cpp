#include "commands.h"

#include <iostream>
#include <optional>
#include <string>

#include "catalog/ini.h"
#include "platform/filesystem.h"
#include "platform/single_instance.h"
#include "session/session.h"
#include "text/vni.h"

namespace kickvane::app {

namespace {

namespace fs = std::filesystem;

constexpr int kExitOk = 0;
constexpr int kExitFailedSteps = 1;
constexpr int kExitStopped = 2;

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

struct Options {
    fs::path toolFolder;
    std::optional<std::string> game;
    std::vector<std::string_view> positional;
};

// Reads "--tool-folder DIR" and, where allowed, "--game DIR"; the rest is positional.
std::optional<Options> ParseOptions(Args args, bool allowGame) {
    Options options;
    for (size_t i = 0; i < args.size(); ++i) {
        const std::string_view arg = args[i];
        const bool takesValue = arg == "--tool-folder" || (allowGame && arg == "--game");
        if (takesValue) {
            if (i + 1 >= args.size()) {
                std::cerr << "kickvane: " << arg << " needs a folder\n";
                return std::nullopt;
            }
            if (arg == "--game") {
                options.game = std::string(args[++i]);
            } else {
                options.toolFolder = fs::absolute(platform::PathFromUtf8(args[++i]));
            }
        } else if (arg.starts_with("--")) {
            std::cerr << "kickvane: unknown option " << arg << '\n';
            return std::nullopt;
        } else {
            options.positional.push_back(arg);
        }
    }
    if (options.toolFolder.empty()) {
        options.toolFolder = DefaultToolFolder();
    }
    return options;
}

// The session of the tool folder, with the game folder of the command line. nullopt, with the
// reason on standard error, when the settings file exists but cannot be read: acting on defaults
// the user never chose would be wrong.
std::optional<session::Session> SessionFor(const Options& options) {
    std::optional<session::Session> session(std::in_place, options.toolFolder);
    if (const Status& read = session->settingsRead(); !read) {
        std::cerr << "kickvane: " << read.reason() << '\n';
        return std::nullopt;
    }
    if (options.game) {
        session->setGameFolder(*options.game);
    }
    return session;
}

std::string_view CategoryKey(int switchIndex) {
    return catalog::Categories()[static_cast<size_t>(switchIndex)].key;
}

void PrintStep(const engine::StepOutcome& outcome) {
    switch (outcome.state) {
        case engine::StepState::Done:
            std::cout << "done     ";
            break;
        case engine::StepState::NotNeeded:
            std::cout << "skipped  ";
            break;
        case engine::StepState::Failed:
            std::cout << "FAILED   ";
            break;
    }
    std::cout << CategoryKey(outcome.step.category) << ": " << engine::Describe(outcome.step);
    if (outcome.state == engine::StepState::Failed) {
        std::cout << ": " << outcome.reason;
    } else if (outcome.step.kind != engine::StepKind::MakeFolder &&
               outcome.state == engine::StepState::Done) {
        std::cout << " (" << outcome.files.copied << " copied, " << outcome.files.upToDate
                  << " up to date)";
    }
    std::cout << '\n';
}

}  // namespace

void PrintUsage(std::ostream& out) {
    out << "Usage: kickvane [--tool-folder DIR]      open the window\n"
           "       kickvane COMMAND [ARGS]\n"
           "\n"
           "  apply [--tool-folder DIR] [--game DIR]   copy the chosen sets into the game\n"
           "  plan [--tool-folder DIR] [--game DIR]    list the copy steps, copy nothing\n"
           "  quick-load SOURCE [--tool-folder DIR]     add face and ball files to the base set\n"
           "  vni [TEXT]                                convert VNI-typed text to Unicode\n"
           "  ini get FILE SECTION KEY [DEFAULT]        read one settings value\n"
           "  ini set FILE SECTION KEY VALUE            write one settings value\n"
           "  trigger                                   make the running window apply the sets "
           "now\n"
           "  launch [--tool-folder DIR]                start the game where it lives (its game\n"
           "                                            manager, or Wine in its own prefix)\n"
           "  find-game                                 list the folders that hold Gameloader.exe\n"
           "  skin-gallery OUT.png                      draw every themed control into a sheet\n"
           "\n"
           "The tool folder defaults to the program's folder; the selection and the game folder\n"
           "come from its ThietLap.ini.\n";
}

int RunApply(Args args) {
    const std::optional<Options> options = ParseOptions(args, true);
    if (!options || !options->positional.empty()) {
        PrintUsage(std::cerr);
        return kExitStopped;
    }
    std::optional<session::Session> session = SessionFor(*options);
    if (!session) {
        return kExitStopped;
    }
    const session::ApplyRun run = session->Apply();
    const engine::ApplyOutcome& outcome = run.apply;
    if (outcome.stopped()) {
        Print(run.shown);
        return kExitStopped;
    }
    for (const engine::StepOutcome& step : outcome.steps) {
        PrintStep(step);
    }
    const std::vector<engine::StepOutcome> failures = outcome.Failures();
    std::cout << outcome.steps.size() << " steps, " << failures.size() << " failed\n";
    for (const engine::StepOutcome& failure : failures) {
        std::cerr << "failed: " << CategoryKey(failure.step.category) << ": "
                  << engine::Describe(failure.step) << ": " << failure.reason << '\n';
    }
    return failures.empty() ? kExitOk : kExitFailedSteps;
}

int RunPlan(Args args) {
    const std::optional<Options> options = ParseOptions(args, true);
    if (!options || !options->positional.empty()) {
        PrintUsage(std::cerr);
        return kExitStopped;
    }
    const std::optional<session::Session> session = SessionFor(*options);
    if (!session) {
        return kExitStopped;
    }
    const engine::Roots roots =
        engine::ResolveRoots(options->toolFolder, session->settings().gameFolder);
    for (engine::Root root : {engine::Root::Data, engine::Root::ZData, engine::Root::ToolData,
                              engine::Root::ToolZData, engine::Root::Extras}) {
        std::cout << engine::RootName(root) << " = "
                  << platform::ResolveCaseInsensitive(roots.Of(root)).string() << '\n';
    }
    for (const engine::PlanStep& step : session->Plan()) {
        std::cout << CategoryKey(step.category) << ": " << engine::Describe(step) << '\n';
    }
    return kExitOk;
}

int RunQuickLoad(Args args) {
    const std::optional<Options> options = ParseOptions(args, false);
    if (!options || options->positional.size() != 1) {
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
    for (const std::string& failure : outcome.failures) {
        std::cerr << "failed: " << failure << '\n';
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
            std::cerr << "kickvane: " << read.reason() << '\n';
            return 1;
        }
        std::cout << catalog::ReadIni(file, args[2], args[3], fallback) << '\n';
        return kExitOk;
    }
    if (args.size() == 5 && args[0] == "set") {
        const Status written =
            catalog::WriteIni(platform::PathFromUtf8(args[1]), args[2], args[3], args[4]);
        if (!written) {
            std::cerr << "kickvane: " << written.reason() << '\n';
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
    if (!platform::SendToRunningInstance("trigger")) {
        std::cerr << "kickvane: Kickvane chưa chạy, không có gì để kích hoạt.\n";
        return 1;
    }
    return kExitOk;
}

}  // namespace kickvane::app
