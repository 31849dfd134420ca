// The kickvane program: the window by default, or one of the command-line subcommands.
#include <iostream>
#include <string>
#include <string_view>
#include <vector>

#include "commands.h"
#include "platform/program.h"

int main(int argc, char** argv) {
    using namespace kickvane::app;
    const std::vector<std::string> arguments = kickvane::platform::ProgramArguments(argc, argv);
    const std::vector<std::string_view> args(arguments.begin(), arguments.end());
    const std::string_view command = args.empty() ? std::string_view() : args[0];
    if (args.empty() || command == "--tool-folder") {
        return RunWindowCommand(argc, argv, Args(args.data(), args.size()));
    }
    kickvane::platform::UseParentConsole();
    const Args rest(args.data() + 1, args.size() - 1);
    if (command == "apply") {
        return RunApply(rest);
    }
    if (command == "plan") {
        return RunPlan(rest);
    }
    if (command == "list") {
        return RunList(rest);
    }
    if (command == "quick-load") {
        return RunQuickLoad(rest);
    }
    if (command == "vni") {
        return RunVni(rest);
    }
    if (command == "ini") {
        return RunIni(rest);
    }
    if (command == "trigger") {
        return RunTrigger(rest);
    }
    if (command == "launch") {
        return RunLaunch(rest);
    }
    if (command == "find-game") {
        return RunFindGame(rest);
    }
    if (command == "skin-gallery") {
        return RunSkinGallery(rest);
    }
    if (command == "--help" || command == "-h" || command == "help") {
        PrintUsage(std::cout);
        return 0;
    }
    std::cerr << "kickvane: không có lệnh " << command << "\n\n";
    PrintUsage(std::cerr);
    return 2;
}
