#include "engine/hotkey_poll.h"

#include <array>

namespace kickvane::engine {

std::optional<int> HotkeyVirtualKey(std::string_view name) {
    static constexpr std::array<std::string_view, 12> kNames{"F1", "F2", "F3", "F4",  "F5",  "F6",
                                                             "F7", "F8", "F9", "F10", "F11", "F12"};
    for (size_t i = 0; i < kNames.size(); ++i) {
        if (kNames[i] == name) {
            return platform::kVirtualKeyF1 + static_cast<int>(i);
        }
    }
    return std::nullopt;
}

bool HotkeyPoll::SetHotkey(std::string_view name) {
    const std::optional<int> key = HotkeyVirtualKey(name);
    if (!key) {
        return false;
    }
    key_ = key;
    return true;
}

bool HotkeyPoll::Tick() {
    if (!key_ || !sampler_) {
        heldAtLastTick_ = false;
        return false;
    }
    const platform::KeySample sample = sampler_->Sample(*key_);
    heldAtLastTick_ = sample.down;
    return sample.any();
}

}  // namespace kickvane::engine
