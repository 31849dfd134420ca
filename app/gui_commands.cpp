// Subcommands that use the window system.
#include <iostream>

#include "commands.h"
#include "platform/filesystem.h"
#include "shell/run_window.h"
#include "skin/gallery.h"

namespace kickvane::app {

int RunWindowCommand(int& argc, char** argv, Args args) {
    std::filesystem::path toolFolder;
    if (args.size() == 2 && args[0] == "--tool-folder") {
        toolFolder = std::filesystem::absolute(platform::PathFromUtf8(args[1]));
    } else if (!args.empty()) {
        PrintUsage(std::cerr);
        return 2;
    } else {
        toolFolder = DefaultToolFolder();
    }
    return shell::RunWindow(argc, argv, toolFolder);
}

int RunSkinGallery(Args args) {
    if (args.size() != 1) {
        PrintUsage(std::cerr);
        return 2;
    }
    return skin::RunSkinGallery(platform::PathFromUtf8(args[0]), std::cerr);
}

}  // namespace kickvane::app
