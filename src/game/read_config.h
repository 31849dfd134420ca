#pragma once

#include <cstdint>
#include <filesystem>
#include <optional>
#include <string>

#include "game/game_managers.h"

namespace kickvane::game {

// Reads a configuration file of at most `maxBytes` (a regular file only, never a device or a
// pipe). nullopt, with the path and the reason in `skipped`, when it is missing, no file, too
// large or unreadable.
std::optional<std::string> ReadConfigText(const std::filesystem::path& path,
                                          std::uintmax_t maxBytes, SkippedFile& skipped);

}  // namespace kickvane::game
