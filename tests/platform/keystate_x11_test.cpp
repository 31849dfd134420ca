// Global key state against a real X server: each test starts its own Xvfb and presses keys with
// xdotool, which sends them through XTEST like a keyboard would.
#include <fcntl.h>
#include <gtest/gtest.h>
#include <poll.h>
#include <signal.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <string>
#include <thread>
#include <vector>

#include "platform/keystate.h"
#include "platform/process.h"
#include "platform/scoped_env.h"

// Xlib last: its macros (Status, None, Bool) would clash with the project's names.
#include <X11/Xlib.h>

extern char** environ;

namespace kickvane::platform {
namespace {

using testing::ScopedEnv;

constexpr int kF7 = 0x76;

// Runs a program with arguments and waits for it; its exit code, or -1.
int RunProgram(const std::vector<std::string>& command) {
    std::vector<char*> argv;
    for (const std::string& part : command) {
        argv.push_back(const_cast<char*>(part.c_str()));
    }
    argv.push_back(nullptr);
    pid_t pid = 0;
    if (::posix_spawnp(&pid, argv[0], nullptr, nullptr, argv.data(), environ) != 0) {
        return -1;
    }
    int status = 0;
    ::waitpid(pid, &status, 0);
    return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

// An Xvfb of this test's own. -displayfd lets the server choose a free display and tell its
// number once it accepts connections, so parallel runs never race for a display.
class VirtualXServer {
public:
    VirtualXServer() {
        int fds[2];
        if (::pipe(fds) != 0) {
            return;
        }
        const std::string fd = std::to_string(fds[1]);
        std::vector<std::string> command = {"Xvfb", "-displayfd", fd,  "-nolisten",
                                            "tcp",  "-screen",    "0", "320x240x24"};
        std::vector<char*> argv;
        for (std::string& part : command) {
            argv.push_back(part.data());
        }
        argv.push_back(nullptr);
        posix_spawn_file_actions_t actions;
        posix_spawn_file_actions_init(&actions);
        posix_spawn_file_actions_addclose(&actions, fds[0]);
        posix_spawn_file_actions_addopen(&actions, STDERR_FILENO, "/dev/null", O_WRONLY, 0);
        const int spawned = ::posix_spawnp(&pid_, "Xvfb", &actions, nullptr, argv.data(), environ);
        posix_spawn_file_actions_destroy(&actions);
        ::close(fds[1]);
        if (spawned != 0) {
            pid_ = -1;
            ::close(fds[0]);
            return;
        }
        std::string number;
        pollfd readable{fds[0], POLLIN, 0};
        char c = 0;
        while (::poll(&readable, 1, 30000) == 1 && ::read(fds[0], &c, 1) == 1 && c != '\n') {
            number += c;
        }
        ::close(fds[0]);
        if (!number.empty() && c == '\n') {
            display_ = ":" + number;
        }
    }
    VirtualXServer(const VirtualXServer&) = delete;
    VirtualXServer& operator=(const VirtualXServer&) = delete;
    ~VirtualXServer() {
        if (pid_ > 0) {
            ::kill(pid_, SIGTERM);
            ::waitpid(pid_, nullptr, 0);
        }
    }

    // Empty when the server did not come up.
    const std::string& display() const { return display_; }

private:
    pid_t pid_ = -1;
    std::string display_;
};

class KeySamplerX11Test : public ::testing::Test {
protected:
    void SetUp() override {
        if (FindOnPath("Xvfb").empty() || FindOnPath("xdotool").empty()) {
            GTEST_SKIP() << "Xvfb and xdotool are needed for this test";
        }
        server_ = std::make_unique<VirtualXServer>();
        ASSERT_FALSE(server_->display().empty()) << "Xvfb did not start";
        display_ = std::make_unique<ScopedEnv>("DISPLAY", server_->display());
        sampler_ = CreateKeySampler();
        ASSERT_NE(sampler_, nullptr);
    }

    void TearDown() override {
        sampler_.reset();
        display_.reset();
        server_.reset();
    }

    static void Xdotool(const std::string& action) {
        ASSERT_EQ(RunProgram({"xdotool", action, "--delay", "0", "F7"}), 0) << "xdotool " << action;
    }

    // Samples F7 until a press shows; the events of xdotool reach the sampler's connection
    // shortly after xdotool ends. The first sample that sees the press is returned.
    KeySample SampleUntilPressed() {
        const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(10);
        KeySample sample = sampler_->Sample(kF7);
        while (!sample.pressedSinceLast && std::chrono::steady_clock::now() < deadline) {
            std::this_thread::sleep_for(std::chrono::milliseconds(10));
            sample = sampler_->Sample(kF7);
        }
        return sample;
    }

    std::unique_ptr<KeySampler> sampler_;

private:
    std::unique_ptr<VirtualXServer> server_;
    std::unique_ptr<ScopedEnv> display_;
};

TEST_F(KeySamplerX11Test, ReportsShortPressOnce_ThenClearsIt) {
    EXPECT_FALSE(sampler_->Sample(kF7).any());

    Xdotool("key");
    const KeySample pressed = SampleUntilPressed();
    EXPECT_TRUE(pressed.pressedSinceLast);
    EXPECT_FALSE(pressed.down);  // already released again

    EXPECT_FALSE(sampler_->Sample(kF7).any());
    // Another key's press is not F7's.
    ASSERT_EQ(RunProgram({"xdotool", "key", "--delay", "0", "F8"}), 0);
    EXPECT_FALSE(sampler_->Sample(kF7).any());
    EXPECT_FALSE(sampler_->Sample(0x41).any());  // not a function key: never reported
}

TEST_F(KeySamplerX11Test, ReportsDown_WhileKeyIsHeld) {
    Xdotool("keydown");
    const KeySample held = SampleUntilPressed();
    EXPECT_TRUE(held.down);
    EXPECT_TRUE(sampler_->Sample(kF7).down);  // still held on the next sample

    Xdotool("keyup");
    const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(10);
    while (sampler_->Sample(kF7).down && std::chrono::steady_clock::now() < deadline) {
        std::this_thread::sleep_for(std::chrono::milliseconds(10));
    }
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
    int grab = GrabNotViewable;
    const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(10);
    while (grab != GrabSuccess && std::chrono::steady_clock::now() < deadline) {
        grab = XGrabKeyboard(game, window, False, GrabModeAsync, GrabModeAsync, CurrentTime);
        if (grab != GrabSuccess) {
            std::this_thread::sleep_for(std::chrono::milliseconds(10));
        }
    }
    ASSERT_EQ(grab, GrabSuccess);
    XSync(game, False);

    Xdotool("key");
    EXPECT_TRUE(SampleUntilPressed().pressedSinceLast);

    // The grabbing program received the key as well.
    bool gameGotKey = false;
    const auto keyDeadline = std::chrono::steady_clock::now() + std::chrono::seconds(10);
    while (!gameGotKey && std::chrono::steady_clock::now() < keyDeadline) {
        XEvent event;
        if (XCheckTypedWindowEvent(game, window, KeyPress, &event)) {
            gameGotKey = true;
        } else {
            std::this_thread::sleep_for(std::chrono::milliseconds(10));
        }
    }
    EXPECT_TRUE(gameGotKey);
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
