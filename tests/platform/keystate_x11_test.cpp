// Global key state against a real X server: each test starts its own Xvfb and presses keys with
// xdotool, which sends them through XTEST like a keyboard would.
#include <gtest/gtest.h>
#include <poll.h>
#include <unistd.h>

#include <cstdlib>
#include <optional>
#include <string>
#include <vector>

#include "platform/keystate.h"
#include "platform/process.h"
#include "platform/scoped_env.h"
#include "support/x_server.h"

// Xlib last: its macros (Status, None, Bool) would clash with the project's names.
#include <X11/Xlib.h>

namespace kickvane::platform {
namespace {

using testing::ScopedEnv;
using testing::WaitFor;
using testing::XServer;

constexpr int kF7 = 0x76;

void Xdotool(const std::string& action, const std::string& key = "F7") {
    const std::string command = "xdotool " + action + " --delay 0 " + key;
    ASSERT_EQ(std::system(command.c_str()), 0) << command;
}

class KeySamplerX11Test : public ::testing::Test {
protected:
    void SetUp() override {
        if (FindOnPath("xdotool").empty() || !(server_ = XServer::Start("320x240x24"))) {
            GTEST_SKIP() << "Xvfb and xdotool are needed for this test";
        }
        display_.emplace("DISPLAY", server_->display());
        sampler_ = CreateKeySampler();
        ASSERT_NE(sampler_, nullptr);
    }

    void TearDown() override {
        sampler_.reset();
        display_.reset();
        server_.reset();
    }

    // Samples F7 until a press shows (xdotool's events reach the sampler shortly after it ends);
    // the first sample that sees the press.
    KeySample SampleUntilPressed() {
        KeySample sample;
        WaitFor([&] { return (sample = sampler_->Sample(kF7)).pressedSinceLast; });
        return sample;
    }

    std::unique_ptr<XServer> server_;
    std::optional<ScopedEnv> display_;
    std::unique_ptr<KeySampler> sampler_;
};

TEST_F(KeySamplerX11Test, ReportsAShortPressOnce_AndAHeldKeyWhileItIsDown) {
    EXPECT_FALSE(sampler_->Sample(kF7).any());

    Xdotool("key");
    const KeySample pressed = SampleUntilPressed();
    EXPECT_TRUE(pressed.pressedSinceLast);
    EXPECT_FALSE(pressed.down);  // already released again
    EXPECT_FALSE(sampler_->Sample(kF7).any());

    Xdotool("key", "F8");  // another key's press is not F7's
    EXPECT_FALSE(sampler_->Sample(kF7).any());
    EXPECT_FALSE(sampler_->Sample(0x41).any());  // not a function key: never reported

    Xdotool("keydown");
    EXPECT_TRUE(SampleUntilPressed().down);
    EXPECT_TRUE(sampler_->Sample(kF7).down);  // still held on the next sample
    Xdotool("keyup");
    WaitFor([&] { return !sampler_->Sample(kF7).down; });
    EXPECT_FALSE(sampler_->Sample(kF7).any());
}

// An idle tool sleeps until a key event makes the wake descriptor readable; a sample drains it.
TEST_F(KeySamplerX11Test, WakeDescriptorTurnsReadableOnAKeyAndQuietAfterTheSample) {
    const int wake = sampler_->WakeDescriptor();
    ASSERT_GE(wake, 0);
    auto readable = [wake] {
        pollfd fd{wake, POLLIN, 0};
        return ::poll(&fd, 1, 0) == 1;
    };
    sampler_->Sample(kF7);
    EXPECT_FALSE(readable());
    Xdotool("key", "F3");  // any key wakes; the sample then tells whether it was the hotkey
    ASSERT_TRUE(WaitFor(readable));
    WaitFor([&] { return sampler_->Sample(kF7).any() || !readable(); });
    EXPECT_FALSE(readable());
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
    ASSERT_TRUE(WaitFor([&] {
        return XGrabKeyboard(game, window, False, GrabModeAsync, GrabModeAsync, CurrentTime) ==
               GrabSuccess;
    }));
    XSync(game, False);

    Xdotool("key");
    EXPECT_TRUE(SampleUntilPressed().pressedSinceLast);
    XEvent event;
    EXPECT_TRUE(WaitFor([&] { return XCheckTypedWindowEvent(game, window, KeyPress, &event); }))
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
