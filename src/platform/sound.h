#pragma once

#include <filesystem>
#include <optional>

namespace kickvane::platform {

// Plays a WAV file without waiting for it. A missing or unplayable file plays the desktop's
// default event sound instead; a machine without audio plays nothing. Never fails.
void PlaySoundAsync(const std::filesystem::path& wav);

// The file handed to the sound system for `wav`: its absolute path when it is a regular file;
// nullopt when the default event sound plays instead.
std::optional<std::filesystem::path> SoundFileToPlay(const std::filesystem::path& wav);

}  // namespace kickvane::platform
