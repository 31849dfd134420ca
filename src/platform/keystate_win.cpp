// Global key state on Windows. GetAsyncKeyState reads the state whichever window has the focus
// and takes nothing away from it.
#include "platform/keystate.h"

#include <windows.h>

namespace kickvane::platform {

namespace {

class WinKeySampler final : public KeySampler {
public:
    KeySample Sample(int virtualKey) override {
        // High bit: down now. Low bit: pressed since the previous call for this key. Both are bits
        // of a signed 16-bit value, so they are tested with masks: a held key reads as a negative
        // number, never as 1.
        const auto state = static_cast<unsigned short>(GetAsyncKeyState(virtualKey));
        KeySample sample;
        sample.down = (state & 0x8000) != 0;
        sample.pressedSinceLast = (state & 0x0001) != 0;
        return sample;
    }
};

}  // namespace

std::unique_ptr<KeySampler> CreateKeySampler() {
    return std::make_unique<WinKeySampler>();
}

}  // namespace kickvane::platform
