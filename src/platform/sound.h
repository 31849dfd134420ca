#pragma once

#include <filesystem>
#include <optional>

namespace kickvane::platform {

// What was handed to the sound system.
enum class SoundPlayed {
    File,          // the file itself
    DefaultSound,  // the desktop's default event sound, for a missing or unplayable file
    Nothing,       // no audio here, or the sound system refused both
};

// Plays a WAV file without waiting for it. A missing or unplayable file plays the desktop's
// default event sound instead; a machine without audio plays nothing. Never fails: the result
// only says which of these happened.
SoundPlayed PlaySoundAsync(const std::filesystem::path& wav);

// The file handed to the sound system for `wav`: its absolute path when it is a regular file;
// nullopt when the default event sound plays instead.
std::optional<std::filesystem::path> SoundFileToPlay(const std::filesystem::path& wav);

}  // namespace kickvane::platform
