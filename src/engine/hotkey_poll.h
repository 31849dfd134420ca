#pragma once

#include <chrono>
#include <optional>
#include <string_view>

#include "platform/keystate.h"

namespace kickvane::engine {

// The virtual key of a hotkey name: "F1" to "F12", compared exactly ("f7" and "" name no key).
std::optional<int> HotkeyVirtualKey(std::string_view name);

// The hotkey poll: it keeps the key the user chose and, on every tick, asks whether the patches
// should be applied now. The key counts when it is down now or was pressed since the last
// sample, so a short press between two ticks is not missed and a held key runs on every tick.
// Where the sampler wakes on key events, ticks are needed only while the key is held: a tick on
// each wake and then every interval until the key is up again.
class HotkeyPoll {
public:
    static constexpr std::chrono::milliseconds kInterval{100};

    // Without a sampler (no global key state here) no tick ever says yes.
    explicit HotkeyPoll(platform::KeySampler* sampler) : sampler_(sampler) {}

    // Takes the key that `name` names. A name that names no key leaves the key in use as it was
    // and returns false.
    bool SetHotkey(std::string_view name);
    // The virtual key in use; none until a name that names a key has been set.
    std::optional<int> Key() const { return key_; }

    // Samples the key once; true when the patches should be applied.
    bool Tick();

    // The sampler's descriptor that becomes readable on key events; -1 where only ticks tell.
    int WakeDescriptor() const { return sampler_ ? sampler_->WakeDescriptor() : -1; }
    // Whether the next tick must come from the timer: always without a wake descriptor, else
    // while the key was down at the last tick.
    bool NeedsTicks() const { return WakeDescriptor() < 0 || heldAtLastTick_; }

private:
    platform::KeySampler* sampler_;
    std::optional<int> key_;
    bool heldAtLastTick_ = false;
};

}  // namespace kickvane::engine
