// Subcommands that find the game and start it, and the choice of the tool folder.
#include <iostream>
#include <thread>

#include "commands.h"
#include "game/find_game.h"
#include "platform/filesystem.h"
#include "session/game_words.h"
#include "session/session.h"
#include "session/tool_folder.h"
#include "text/failure_text.h"

namespace kickvane::app {

namespace fs = std::filesystem;

fs::path DefaultToolFolder() {
    const session::ToolFolderChoice choice = session::ChooseToolFolder(
        platform::ProgramFolder(), game::UserFolders::FromEnvironment().dataHome);
    if (!choice.seedFrom.empty()) {
        if (const Status seeded = session::SeedToolFolder(choice.seedFrom, choice.folder);
            !seeded) {
            std::cerr << "kickvane: không chuẩn bị được thư mục công cụ "
                      << platform::PathToUtf8(choice.folder) << ": "
                      << text::FailureText(seeded.failure(), {}) << '\n';
        }
    }
    return choice.folder;
}

int RunLaunch(Args args) {
    const std::optional<Options> options = ParseOptions(args, false, 0);
    if (!options) {
        PrintUsage(std::cerr);
        return 2;
    }
    session::Session session(options->toolFolder);
    if (const std::optional<text::Message> problem = session.SettingsProblem()) {
        std::cerr << "kickvane: " << problem->text << '\n';
        return 2;
    }
    session::LaunchRun run = session.Launch(session::LaunchFrom::Tray);
    // The program that starts the launcher is watched for a moment: one that fails at once (a
    // missing prefix, a manager that cannot find its game) is reported as a failure.
    while (run.watching()) {
        std::this_thread::sleep_for(session::kLaunchWatchInterval);
        if (std::optional<session::LaunchRun> decided = session.TickLaunch()) {
            run = std::move(*decided);
        }
    }
    if (!run.started()) {
        for (const text::Message& message : run.shown.messages) {
            std::cerr << "kickvane: " << message.text << " (" << session.Settings().gameFolder
                      << ")\n";
        }
        return 1;
    }
    std::cout << "đã khởi động Gameloader.exe " << run.way << '\n';
    return 0;
}

int RunFindGame(Args args) {
    if (!args.empty()) {
        PrintUsage(std::cerr);
        return 2;
    }
    const game::FindOutcome outcome =
        game::FindGame(game::UserFolders::FromEnvironment(), game::SearchLimits{});
    for (const game::FoundGame& game : outcome.games) {
        std::cout << platform::PathToUtf8(game.folder) << '\t' << session::SourceText(game.source)
                  << '\n';
    }
    for (const game::SkippedFile& skipped : outcome.skipped) {
        std::cerr << "bỏ qua: " << platform::PathToUtf8(skipped.path) << ": "
                  << session::SkippedReasonText(skipped) << '\n';
    }
    if (outcome.games.empty()) {
        std::cerr << "kickvane: không tìm thấy Gameloader.exe; đã tìm trong:\n";
        for (const std::string& place : outcome.looked) {
            std::cerr << "  " << place << '\n';
        }
        return 1;
    }
    return 0;
}

}  // namespace kickvane::app
