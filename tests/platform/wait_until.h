#pragma once

#include <chrono>
#include <thread>

namespace kickvane::testing {

// Asks `done` every 10 ms until it holds or `limit` has passed; whether it held. The limit is
// generous: the machine may be busy, and a passing test never waits for it.
template <class Done>
bool WaitUntil(Done&& done, std::chrono::seconds limit = std::chrono::seconds(10)) {
    const auto deadline = std::chrono::steady_clock::now() + limit;
    while (!done()) {
        if (std::chrono::steady_clock::now() >= deadline) {
            return false;
        }
        std::this_thread::sleep_for(std::chrono::milliseconds(10));
    }
    return true;
}

}  // namespace kickvane::testing
