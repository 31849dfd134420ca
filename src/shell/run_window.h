#pragma once

#include <filesystem>

namespace kickvane::shell {

// Runs the tool with its window until the user ends it; returns the process exit code.
// A second start while a copy runs shows a notice and ends without touching anything.
int runWindow(int& argc, char** argv, const std::filesystem::path& toolFolder);

// Gives the fonts the interface asks for by name (the system's own and the popups' Tahoma)
// readable stand-ins for systems that lack them. Called once the application exists.
void useReadableFonts();

inline constexpr const char* kTriggerCommand = "trigger";

}  // namespace kickvane::shell
