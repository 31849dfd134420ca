// Sound on Windows. Without SND_NODEFAULT, PlaySoundW plays the system's default sound when the
// file is missing or cannot be played; SND_ASYNC returns at once.
#include "platform/sound.h"

#include <windows.h>
// mmsystem.h needs the types of windows.h first.
#include <mmsystem.h>

namespace kickvane::platform {

void PlaySoundAsync(const std::filesystem::path& wav) {
    PlaySoundW(wav.c_str(), nullptr, SND_ASYNC | SND_FILENAME);
}

}  // namespace kickvane::platform
