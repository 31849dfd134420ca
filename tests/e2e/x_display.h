#pragma once

#include <sys/stat.h>
#include <unistd.h>

#include <memory>
#include <random>
#include <string>

#include "support/process.h"

namespace kickvane::testing {

// A virtual X server of our own for tests that need a real display. Unavailable when Xvfb is not
// installed; then the tests skip.
class XDisplay {
public:
    static std::unique_ptr<XDisplay> Start(int width = 1280, int height = 800) {
        if (::access("/usr/bin/Xvfb", X_OK) != 0) {
            return nullptr;
        }
        std::random_device random;
        for (int attempt = 0; attempt < 20; ++attempt) {
            const int number = 200 + static_cast<int>(random() % 500);
            const std::string socket = "/tmp/.X11-unix/X" + std::to_string(number);
            struct stat st {};
            if (::stat(socket.c_str(), &st) == 0) {
                continue;
            }
            auto display = std::unique_ptr<XDisplay>(new XDisplay(number, width, height));
            if (WaitFor([&] { return ::stat(socket.c_str(), &st) == 0; }) &&
                display->server_.Running()) {
                return display;
            }
        }
        return nullptr;
    }

    std::string name() const { return ":" + std::to_string(number_); }

private:
    XDisplay(int number, int width, int height)
        : number_(number),
          server_({"Xvfb", ":" + std::to_string(number), "-screen", "0",
                   std::to_string(width) + "x" + std::to_string(height) + "x24", "-nolisten",
                   "tcp"}) {}

    int number_;
    ChildProcess server_;
};

}  // namespace kickvane::testing
