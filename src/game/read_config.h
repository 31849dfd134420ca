#pragma once

#include <cstdint>
#include <filesystem>
#include <optional>
#include <string>

namespace kickvane::game {

// Reads a configuration file of at most `maxBytes` (a regular file only, never a device or a
// pipe). nullopt, with the reason in `problem`, when it is missing, no file, too large or
// unreadable.
std::optional<std::string> ReadConfigText(const std::filesystem::path& path,
                                          std::uintmax_t maxBytes, std::string& problem);

}  // namespace kickvane::game
