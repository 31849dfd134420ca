#pragma once

#include <memory>

namespace kickvane::platform {

// Windows virtual-key codes of the function keys; the hotkey names map to these.
inline constexpr int kVirtualKeyF1 = 0x70;
inline constexpr int kVirtualKeyF12 = 0x7B;

struct KeySample {
    bool down = false;              // held now
    bool pressedSinceLast = false;  // went down since the previous sample of this key

    bool any() const { return down || pressedSinceLast; }
};

// Samples the global state of a key, whichever program has the keyboard focus, without taking
// the key away from that program.
class KeySampler {
public:
    virtual ~KeySampler() = default;
    virtual KeySample Sample(int virtualKey) = 0;

    // A descriptor that becomes readable when a key event arrives, so that an event loop can
    // sample on events instead of on a timer; -1 where the state can only be polled.
    virtual int WakeDescriptor() const { return -1; }
};

// The sampler of this session, or null where no global key state can be read (a Wayland session
// without an X server).
std::unique_ptr<KeySampler> CreateKeySampler();

}  // namespace kickvane::platform
