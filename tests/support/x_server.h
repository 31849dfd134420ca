#pragma once

#include <poll.h>
#include <unistd.h>

#include <memory>
#include <string>

#include "support/process.h"

namespace kickvane::testing {

// A virtual X server of a test's own. -displayfd lets Xvfb choose a free display and write its
// number once it accepts connections, so parallel tests never race for a display. -noreset keeps
// it from resetting when its last client leaves: a program that connects while a short-lived
// xdotool disconnects would otherwise be refused. Null where Xvfb is not installed; the tests
// then skip.
class XServer {
public:
    static std::unique_ptr<XServer> Start(const std::string& screen = "1280x800x24") {
        if (Capture("command -v Xvfb").empty()) {
            return nullptr;
        }
        int fds[2];
        if (::pipe(fds) != 0) {
            return nullptr;
        }
        auto server = std::unique_ptr<XServer>(
            new XServer({"Xvfb", "-displayfd", std::to_string(fds[1]), "-nolisten", "tcp",
                         "-noreset", "-screen", "0", screen}));
        ::close(fds[1]);
        std::string number;
        char c = 0;
        pollfd readable{fds[0], POLLIN, 0};
        while (::poll(&readable, 1, 30000) == 1 && ::read(fds[0], &c, 1) == 1 && c != '\n') {
            number += c;
        }
        ::close(fds[0]);
        if (c != '\n' || number.empty()) {
            return nullptr;
        }
        server->display_ = ":" + number;
        return server;
    }

    const std::string& display() const { return display_; }

private:
    explicit XServer(const std::vector<std::string>& argv) : process_(argv) {}

    ChildProcess process_;
    std::string display_;
};

}  // namespace kickvane::testing
