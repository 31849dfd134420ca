#pragma once

#include <chrono>
#include <deque>
#include <functional>
#include <memory>

#include "platform/process.h"

namespace kickvane::testing {

// A program watch that answers from a script: each Poll takes the next state, and the last one
// stays. `released` is set when the watch is dropped.
class FakeProgramWatch final : public platform::ProgramWatch {
public:
    FakeProgramWatch(std::deque<platform::ProgramState> states, bool* released = nullptr)
        : states_(std::move(states)), released_(released) {}
    ~FakeProgramWatch() override {
        if (released_ != nullptr) {
            *released_ = true;
        }
    }
    platform::ProgramState Poll() override {
        platform::ProgramState state = states_.front();
        if (states_.size() > 1) {
            states_.pop_front();
        }
        return state;
    }

private:
    std::deque<platform::ProgramState> states_;
    bool* released_;
};

inline platform::ProgramState ProgramIs(platform::ProgramState::Kind kind, int code = 0) {
    return {kind, code, {}};
}

// A clock that moves only when told.
struct FakeClock {
    std::chrono::steady_clock::time_point now{};
    std::function<std::chrono::steady_clock::time_point()> function() {
        return [this] { return now; };
    }
};

}  // namespace kickvane::testing
