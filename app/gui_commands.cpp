// Subcommands that use the window system.
#include <iostream>

#include "commands.h"
#include "platform/filesystem.h"
#include "window_entry.h"

namespace kickvane::app {

namespace {

std::optional<WindowEntry> WindowOrSayWhy() {
    std::string error;
    std::optional<WindowEntry> entry = FindWindowEntry(error);
    if (!entry) {
        std::cerr << "kickvane: cannot load the window: " << error << '\n';
    }
    return entry;
}

}  // namespace

int RunWindowCommand(int& argc, char** argv, Args args) {
    const std::optional<Options> options = ParseOptions(args, false, 0);
    if (!options) {
        PrintUsage(std::cerr);
        return 2;
    }
    const std::optional<WindowEntry> window = WindowOrSayWhy();
    return window
               ? window->openWindow(&argc, argv, platform::PathToUtf8(options->toolFolder).c_str())
               : 2;
}

int RunSkinGallery(Args args) {
    if (args.size() != 1) {
        PrintUsage(std::cerr);
        return 2;
    }
    const std::optional<WindowEntry> window = WindowOrSayWhy();
    return window ? window->drawSkinGallery(std::string(args[0]).c_str()) : 2;
}

}  // namespace kickvane::app
