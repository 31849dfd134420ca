// Sound on Windows. Without SND_NODEFAULT, PlaySoundW plays the system's default sound when the
// file is missing or cannot be played; SND_ASYNC returns at once.
#include "platform/sound.h"

#include <windows.h>
// mmsystem.h needs the types of windows.h first.
#include <mmsystem.h>

namespace kickvane::platform {

SoundPlayed PlaySoundAsync(const std::filesystem::path& wav) {
    // A file that exists but does not play is found out only after this returns; the system then
    // plays its default sound by itself.
    if (!PlaySoundW(wav.c_str(), nullptr, SND_ASYNC | SND_FILENAME)) {
        return SoundPlayed::Nothing;
    }
    return SoundFileToPlay(wav) ? SoundPlayed::File : SoundPlayed::DefaultSound;
}

}  // namespace kickvane::platform
