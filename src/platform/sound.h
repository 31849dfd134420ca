#pragma once

#include <filesystem>

namespace kickvane::platform {

// Plays a WAV file without waiting for it. A missing or unplayable file plays the desktop's
// default event sound instead; a machine without audio plays nothing. Never fails.
void PlaySoundAsync(const std::filesystem::path& wav);

}  // namespace kickvane::platform
