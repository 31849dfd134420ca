#pragma once

#include <chrono>
#include <optional>
#include <string_view>

#include "platform/keystate.h"

namespace kickvane::engine {

// The virtual key of a hotkey name: "F1" to "F12", compared exactly ("f7" and "" name no key).
std::optional<int> HotkeyVirtualKey(std::string_view name);

// The hotkey poll: on every tick the window reads its hotkey box and asks whether the patches
// should be applied now. The key counts when it is down now or was pressed since the last
// sample, so a short press between two ticks is not missed and a held key runs on every tick.
class HotkeyPoll {
public:
    static constexpr std::chrono::milliseconds kInterval{100};

    explicit HotkeyPoll(platform::KeySampler& sampler) : sampler_(sampler) {}

    // Samples the key named `hotkeyText` once; true when the patches should be applied.
    bool Tick(std::string_view hotkeyText);

private:
    platform::KeySampler& sampler_;
};

}  // namespace kickvane::engine
