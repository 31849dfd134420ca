// Sound on Linux through libcanberra, the event-sound library of the desktops. It plays in the
// background (ca_context_play returns at once) through whatever the session has, and fails
// quickly where there is no audio device. The library (and the audio libraries it brings) is
// loaded at the first sound, not when the window starts.
#include <canberra.h>
#include <dlfcn.h>

#include "platform/sound.h"

namespace kickvane::platform {

namespace {

struct Canberra {
    decltype(&ca_context_create) create = nullptr;
    decltype(&ca_context_change_props) changeProps = nullptr;
    decltype(&ca_context_play) play = nullptr;
};

// libcanberra's functions, loaded once; null members when the library is not installed.
const Canberra& Library() {
    static const Canberra library = [] {
        Canberra found;
        void* handle = ::dlopen("libcanberra.so.0", RTLD_NOW | RTLD_LOCAL);
        if (handle == nullptr) {
            return found;
        }
        found.create =
            reinterpret_cast<decltype(found.create)>(::dlsym(handle, "ca_context_create"));
        found.changeProps = reinterpret_cast<decltype(found.changeProps)>(
            ::dlsym(handle, "ca_context_change_props"));
        found.play = reinterpret_cast<decltype(found.play)>(::dlsym(handle, "ca_context_play"));
        if (!found.create || !found.changeProps || !found.play) {
            return Canberra{};
        }
        return found;
    }();
    return library;
}

// The one context of the process, created on first use and kept until exit: a context plays its
// sounds on its own threads, and destroying it would cut a sound that is still playing. Null when
// libcanberra could not create one.
ca_context* SoundContext() {
    static ca_context* const context = [] {
        const Canberra& library = Library();
        ca_context* created = nullptr;
        if (!library.create || library.create(&created) != CA_SUCCESS) {
            return static_cast<ca_context*>(nullptr);
        }
        library.changeProps(created, CA_PROP_APPLICATION_NAME, "Kickvane", CA_PROP_APPLICATION_ID,
                            "net.kickvane.Kickvane", nullptr);
        return created;
    }();
    return context;
}

bool PlayFile(ca_context* context, const std::filesystem::path& wav) {
    const std::optional<std::filesystem::path> file = SoundFileToPlay(wav);
    return file && Library().play(context, 0, CA_PROP_MEDIA_FILENAME, file->c_str(),
                                  CA_PROP_MEDIA_ROLE, "event", nullptr) == CA_SUCCESS;
}

// The desktop's default event sound from its sound theme; the first name the theme knows plays.
bool PlayDefaultSound(ca_context* context) {
    for (const char* id : {"bell", "dialog-information"}) {
        if (Library().play(context, 0, CA_PROP_EVENT_ID, id, CA_PROP_MEDIA_ROLE, "event",
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
