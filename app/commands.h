#pragma once

#include <iosfwd>
#include <span>
#include <string_view>

// The subcommands of the kickvane program. Each takes the arguments after its name and returns
// the process exit code.
namespace kickvane::app {

using Args = std::span<const std::string_view>;

int RunApply(Args args);
int RunPlan(Args args);
int RunQuickLoad(Args args);
int RunVni(Args args);
int RunIni(Args args);
int RunTrigger(Args args);

// Commands that need the window system; in a build without it they say so.
int RunWindowCommand(int& argc, char** argv, Args args);
int RunSkinGallery(Args args);

void PrintUsage(std::ostream& out);

}  // namespace kickvane::app
