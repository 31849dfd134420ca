#pragma once

#include <filesystem>

namespace kickvane::shell {

// Runs the tool with its window until the user ends it; returns the process exit code.
// A second start while a copy runs shows a notice and ends without touching anything.
int RunWindow(int& argc, char** argv, const std::filesystem::path& toolFolder);

inline constexpr const char* kTriggerCommand = "trigger";

}  // namespace kickvane::shell
