// Builds without a way to read the global key state: the hotkey is unavailable.
#include "platform/keystate.h"

namespace kickvane::platform {

std::unique_ptr<KeySampler> CreateKeySampler() {
    return nullptr;
}

}  // namespace kickvane::platform
