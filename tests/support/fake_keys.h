#pragma once

#include <set>

#include "platform/keystate.h"

namespace kickvane::testing {

// Key state set by the test: a key reads as pressed once, or as held.
class FakeKeySampler final : public platform::KeySampler {
public:
    platform::KeySample Sample(int virtualKey) override {
        return {held.count(virtualKey) > 0, pressed.erase(virtualKey) > 0};
    }

    int WakeDescriptor() const override { return wake; }

    std::set<int> held;
    std::set<int> pressed;
    int wake = -1;  // a descriptor that stands for key events; -1: the state is polled
};

}  // namespace kickvane::testing
