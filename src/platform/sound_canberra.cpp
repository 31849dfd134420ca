// Sound on Linux through libcanberra, the event-sound library of the desktops. It plays in the
// background (ca_context_play returns at once) through whatever the session has, and fails
// quickly where there is no audio device.
#include <canberra.h>

#include "platform/sound.h"

namespace kickvane::platform {

namespace {

// The one context of the process, created on first use and kept until exit: a context plays its
// sounds on its own threads, and destroying it would cut a sound that is still playing. Null when
// libcanberra could not create one.
ca_context* SoundContext() {
    static ca_context* const context = [] {
        ca_context* created = nullptr;
        if (ca_context_create(&created) != CA_SUCCESS) {
            return static_cast<ca_context*>(nullptr);
        }
        ca_context_change_props(created, CA_PROP_APPLICATION_NAME, "Kickvane",
                                CA_PROP_APPLICATION_ID, "net.kickvane.Kickvane", nullptr);
        return created;
    }();
    return context;
}

bool PlayFile(ca_context* context, const std::filesystem::path& wav) {
    const std::optional<std::filesystem::path> file = SoundFileToPlay(wav);
    return file && ca_context_play(context, 0, CA_PROP_MEDIA_FILENAME, file->c_str(),
                                   CA_PROP_MEDIA_ROLE, "event", nullptr) == CA_SUCCESS;
}

// The desktop's default event sound from its sound theme; the first name the theme knows plays.
bool PlayDefaultSound(ca_context* context) {
    for (const char* id : {"bell", "dialog-information"}) {
        if (ca_context_play(context, 0, CA_PROP_EVENT_ID, id, CA_PROP_MEDIA_ROLE, "event",
                            nullptr) == CA_SUCCESS) {
            return true;
        }
    }
    return false;
}

}  // namespace

SoundPlayed PlaySoundAsync(const std::filesystem::path& wav) {
    ca_context* context = SoundContext();
    if (context == nullptr) {
        return SoundPlayed::Nothing;
    }
    if (PlayFile(context, wav)) {
        return SoundPlayed::File;
    }
    return PlayDefaultSound(context) ? SoundPlayed::DefaultSound : SoundPlayed::Nothing;
}

}  // namespace kickvane::platform
