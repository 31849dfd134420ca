// Global key state against a real X server: each test starts its own Xvfb and presses keys with
// xdotool, which sends them through XTEST like a keyboard would.
#include <fcntl.h>
#include <gtest/gtest.h>
#include <poll.h>
#include <signal.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstdlib>
#include <optional>
#include <string>
#include <vector>

#include "platform/keystate.h"
#include "platform/process.h"
#include "platform/scoped_env.h"
#include "platform/wait_until.h"

// Xlib last: its macros (Status, None, Bool) would clash with the project's names.
#include <X11/Xlib.h>

extern char** environ;

namespace kickvane::platform {
namespace {

using testing::ScopedEnv;
using testing::WaitUntil;

constexpr int kF7 = 0x76;

// Starts a program found on PATH, its errors discarded; its pid, or -1.
pid_t Spawn(std::vector<std::string> command) {
    std::vector<char*> argv;
    for (std::string& part : command) {
        argv.push_back(part.data());
    }
    argv.push_back(nullptr);
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_addopen(&actions, STDERR_FILENO, "/dev/null", O_WRONLY, 0);
    pid_t pid = -1;
    const int spawned = ::posix_spawnp(&pid, argv[0], &actions, nullptr, argv.data(), environ);
    posix_spawn_file_actions_destroy(&actions);
    return spawned == 0 ? pid : -1;
}

void Xdotool(const std::string& action, const std::string& key = "F7") {
    const std::string command = "xdotool " + action + " --delay 0 " + key;
    ASSERT_EQ(std::system(command.c_str()), 0) << command;
}

class KeySamplerX11Test : public ::testing::Test {
protected:
    // Starts an Xvfb of this test's own. -displayfd lets the server choose a free display and
    // write its number once it accepts connections, so parallel runs never race for a display.
    void SetUp() override {
        if (FindOnPath("Xvfb").empty() || FindOnPath("xdotool").empty()) {
            GTEST_SKIP() << "Xvfb and xdotool are needed for this test";
        }
        int fds[2];
        ASSERT_EQ(::pipe(fds), 0);
        xvfb_ = Spawn({"Xvfb", "-displayfd", std::to_string(fds[1]), "-nolisten", "tcp", "-screen",
                       "0", "320x240x24"});
        ::close(fds[1]);
        std::string number;
        pollfd readable{fds[0], POLLIN, 0};
        char c = 0;
        while (xvfb_ > 0 && ::poll(&readable, 1, 30000) == 1 && ::read(fds[0], &c, 1) == 1 &&
               c != '\n') {
            number += c;
        }
        ::close(fds[0]);
        ASSERT_TRUE(c == '\n' && !number.empty()) << "Xvfb did not start";
        display_.emplace("DISPLAY", ":" + number);
        sampler_ = CreateKeySampler();
        ASSERT_NE(sampler_, nullptr);
    }

    void TearDown() override {
        sampler_.reset();
        display_.reset();
        if (xvfb_ > 0) {
            ::kill(xvfb_, SIGTERM);
            ::waitpid(xvfb_, nullptr, 0);
        }
    }

    // Samples F7 until a press shows (xdotool's events reach the sampler shortly after it ends);
    // the first sample that sees the press.
    KeySample SampleUntilPressed() {
        KeySample sample;
        WaitUntil([&] { return (sample = sampler_->Sample(kF7)).pressedSinceLast; });
        return sample;
    }

    pid_t xvfb_ = -1;
    std::optional<ScopedEnv> display_;
    std::unique_ptr<KeySampler> sampler_;
};

TEST_F(KeySamplerX11Test, ReportsShortPressOnce_ThenClearsIt) {
    EXPECT_FALSE(sampler_->Sample(kF7).any());

    Xdotool("key");
    const KeySample pressed = SampleUntilPressed();
    EXPECT_TRUE(pressed.pressedSinceLast);
    EXPECT_FALSE(pressed.down);  // already released again
    EXPECT_FALSE(sampler_->Sample(kF7).any());

    Xdotool("key", "F8");  // another key's press is not F7's
    EXPECT_FALSE(sampler_->Sample(kF7).any());
    EXPECT_FALSE(sampler_->Sample(0x41).any());  // not a function key: never reported
}

TEST_F(KeySamplerX11Test, ReportsDown_WhileKeyIsHeld) {
    Xdotool("keydown");
    EXPECT_TRUE(SampleUntilPressed().down);
    EXPECT_TRUE(sampler_->Sample(kF7).down);  // still held on the next sample

    Xdotool("keyup");
    WaitUntil([&] { return !sampler_->Sample(kF7).down; });
    EXPECT_FALSE(sampler_->Sample(kF7).any());
}

// A full-screen game grabs the keyboard; the press must still be seen, and not be taken from it.
TEST_F(KeySamplerX11Test, SeesPress_WhileAnotherProgramGrabsTheKeyboard) {
    Display* game = XOpenDisplay(nullptr);
    ASSERT_NE(game, nullptr);
    const Window window =
        XCreateSimpleWindow(game, DefaultRootWindow(game), 0, 0, 100, 100, 0, 0, 0);
    XSelectInput(game, window, KeyPressMask);
    XMapRaised(game, window);
    XSync(game, False);
    ASSERT_TRUE(WaitUntil([&] {
        return XGrabKeyboard(game, window, False, GrabModeAsync, GrabModeAsync, CurrentTime) ==
               GrabSuccess;
    }));
    XSync(game, False);

    Xdotool("key");
    EXPECT_TRUE(SampleUntilPressed().pressedSinceLast);
    XEvent event;
    EXPECT_TRUE(WaitUntil([&] { return XCheckTypedWindowEvent(game, window, KeyPress, &event); }))
        << "the grabbing program received the key as well";
    XCloseDisplay(game);
}

TEST(KeySamplerX11, IsNull_WithoutReachableXServer) {
    ScopedEnv display("DISPLAY", ":65000");  // nothing listens there
    ScopedEnv wayland("WAYLAND_DISPLAY", "wayland-0");
    EXPECT_EQ(CreateKeySampler(), nullptr);

    ScopedEnv noDisplay("DISPLAY", std::nullopt);
    EXPECT_EQ(CreateKeySampler(), nullptr);
}

}  // namespace
}  // namespace kickvane::platform
