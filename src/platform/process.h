#pragma once

#include <filesystem>
#include <string>
#include <utility>
#include <vector>

#include "platform/status.h"

namespace kickvane::platform {

// Variables set for a started program on top of the tool's own environment (name, value); a name
// that the environment has already gets the new value.
using EnvironmentAdditions = std::vector<std::pair<std::string, std::string>>;

// Starts a program in `workingFolder` and returns without waiting for it. Arguments are passed
// as they are, never through a shell. On Windows `minimised` asks for a minimised first window.
Status StartDetached(const std::filesystem::path& program,
                     const std::vector<std::string>& arguments,
                     const std::filesystem::path& workingFolder, bool minimised = false,
                     const EnvironmentAdditions& environment = {});

// The full path of a program found on PATH; empty when there is none.
std::filesystem::path FindOnPath(const std::string& name);

// True when `file` can be run directly by this system (on Linux: executable, as an ELF program
// or a script with a #! line). A Windows program on Linux needs Wine instead.
bool IsNativeExecutable(const std::filesystem::path& file);

}  // namespace kickvane::platform
