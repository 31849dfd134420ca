// Subcommands that find the game and start it, and the choice of the tool folder.
#include <iostream>

#include "catalog/settings.h"
#include "commands.h"
#include "engine/find_game.h"
#include "engine/launch_plan.h"
#include "engine/launcher.h"
#include "engine/tool_folder.h"
#include "platform/filesystem.h"
#include "platform/process.h"
#include "text/vni.h"

namespace kickvane::app {

namespace fs = std::filesystem;

fs::path DefaultToolFolder() {
    const engine::ToolFolderChoice choice = engine::ChooseToolFolder(
        platform::ProgramFolder(), engine::UserFolders::FromEnvironment().dataHome);
    if (!choice.seedFrom.empty()) {
        if (const Status seeded = engine::SeedToolFolder(choice.seedFrom, choice.folder); !seeded) {
            std::cerr << "kickvane: cannot set up " << choice.folder.string() << ": "
                      << seeded.reason() << '\n';
        }
    }
    return choice.folder;
}

int RunLaunch(Args args) {
    fs::path toolFolder;
    if (args.size() == 2 && args[0] == "--tool-folder") {
        toolFolder = fs::absolute(fs::path(std::string(args[1])));
    } else if (args.empty()) {
        toolFolder = DefaultToolFolder();
    } else {
        PrintUsage(std::cerr);
        return 2;
    }
    const catalog::Settings settings = catalog::LoadSettings(toolFolder);
    const engine::LaunchDecision decision = engine::PlanLaunch(
        settings.gameFolder, engine::UserFolders::FromEnvironment(), platform::FindOnPath);
    switch (decision.problem) {
        case engine::LaunchProblem::LauncherMissing:
            std::cerr << "kickvane: " << text::VniToUnicodeUtf8(engine::kLauncherMissingVni) << " ("
                      << settings.gameFolder << ")\n";
            return 1;
        case engine::LaunchProblem::WineMissing:
            std::cerr << "kickvane: " << engine::kWineMissingText << '\n';
            return 1;
        case engine::LaunchProblem::None:
            break;
    }
    const engine::LaunchPlan& plan = decision.plan;
    const Status started = platform::StartDetached(plan.program, plan.arguments, plan.workingFolder,
                                                   true, plan.environment);
    if (!started) {
        std::cerr << "kickvane: " << started.reason() << '\n';
        return 1;
    }
    std::cout << "started " << plan.program.filename().string() << " through " << plan.description
              << '\n';
    return 0;
}

int RunFindGame(Args args) {
    if (!args.empty()) {
        PrintUsage(std::cerr);
        return 2;
    }
    const engine::FindOutcome outcome =
        engine::FindGame(engine::UserFolders::FromEnvironment(), engine::SearchLimits{});
    for (const engine::FoundGame& game : outcome.games) {
        std::cout << game.folder.string() << '\t' << game.source << '\n';
    }
    for (const std::string& skipped : outcome.skipped) {
        std::cerr << "skipped: " << skipped << '\n';
    }
    if (outcome.games.empty()) {
        std::cerr << "kickvane: no Gameloader.exe found; looked in:\n";
        for (const std::string& place : outcome.looked) {
            std::cerr << "  " << place << '\n';
        }
        return 1;
    }
    return 0;
}

}  // namespace kickvane::app
