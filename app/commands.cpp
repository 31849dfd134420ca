#include "commands.h"

#include <iostream>
#include <optional>
#include <string>

#include "catalog/ini.h"
#include "catalog/settings.h"
#include "engine/apply.h"
#include "engine/quick_load.h"
#include "platform/filesystem.h"
#include "platform/single_instance.h"
#include "text/vni.h"

namespace kickvane::app {

namespace {

namespace fs = std::filesystem;

constexpr int kExitOk = 0;
constexpr int kExitFailedSteps = 1;
constexpr int kExitStopped = 2;

// The command line's face of the engine: messages on standard error, popups on standard output,
// no sound.
class ConsoleUi final : public engine::EngineUi {
public:
    text::MessageHelper& Messages() override { return messages_; }
    void ShowPlainMessage(std::string_view text, std::string_view title) override {
        std::cerr << title << ": " << text << '\n';
    }
    void PlaySound(const fs::path&) override {}
    void ShowPopup(const engine::PopupRequest& popup) override { std::cout << popup.text << '\n'; }

private:
    text::ConsoleMessageHelper messages_{std::cerr};
};

struct Options {
    fs::path toolFolder = platform::ProgramFolder();
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
    return options;
}

catalog::Settings LoadFor(const Options& options) {
    catalog::Settings settings = catalog::LoadSettings(options.toolFolder);
    if (options.game) {
        settings.gameFolder = *options.game;
    }
    return settings;
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
    const catalog::Settings settings = LoadFor(*options);
    ConsoleUi ui;
    const engine::ApplyOutcome outcome = engine::ApplyPatches(
        options->toolFolder, settings.gameFolder, settings.selection, ui, PrintStep);
    if (outcome.stopped()) {
        return kExitStopped;
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
    const catalog::Settings settings = LoadFor(*options);
    const engine::Roots roots = engine::ResolveRoots(options->toolFolder, settings.gameFolder);
    for (engine::Root root : {engine::Root::Data, engine::Root::ZData, engine::Root::ToolData,
                              engine::Root::ToolZData, engine::Root::Extras}) {
        std::cout << engine::RootName(root) << " = "
                  << platform::ResolveCaseInsensitive(roots.Of(root)).string() << '\n';
    }
    for (const engine::PlanStep& step : engine::BuildPlan(settings.selection)) {
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
    ConsoleUi ui;
    const engine::QuickLoadOutcome outcome =
        engine::QuickLoad(options->toolFolder, platform::PathFromUtf8(options->positional[0]), ui);
    if (outcome.stopped) {
        return kExitStopped;
    }
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
        std::cout << catalog::ReadIni(platform::PathFromUtf8(args[1]), args[2], args[3], fallback)
                  << '\n';
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
