#pragma once

#include <filesystem>
#include <iosfwd>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

// The subcommands of the kickvane program. Each takes the arguments after its name and returns
// the process exit code.
namespace kickvane::app {

using Args = std::span<const std::string_view>;

// The options that commands share: "--tool-folder DIR" (else the default tool folder) and, where
// the command allows it, "--game DIR"; the rest is positional, exactly `positional` arguments.
// nullopt for an unknown option (said on standard error), one without its folder, or another
// number of positional arguments; the default tool folder is then left alone.
struct Options {
    std::filesystem::path toolFolder;
    std::optional<std::string> game;
    std::vector<std::string_view> positional;
};
std::optional<Options> ParseOptions(Args args, bool allowGame, size_t positional);

int RunApply(Args args);
int RunPlan(Args args);
int RunList(Args args);
int RunQuickLoad(Args args);
int RunVni(Args args);
int RunIni(Args args);
int RunTrigger(Args args);
int RunLaunch(Args args);
int RunFindGame(Args args);

// The tool folder when none is given: beside the program when it may write there, else the
// user's own data folder, set up from the installed sets on first use.
std::filesystem::path DefaultToolFolder();

// Commands that need the window system; in a build without it they say so.
int RunWindowCommand(int& argc, char** argv, Args args);
int RunSkinGallery(Args args);

void PrintUsage(std::ostream& out);

}  // namespace kickvane::app
