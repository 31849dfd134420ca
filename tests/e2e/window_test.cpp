// The real program on a virtual display: the hotkey pressed while another window has the focus,
// a hotkey text that names no key, a second start, the trigger command and the tray.
#include <gtest/gtest.h>

#include <netinet/in.h>
#include <signal.h>
#include <sys/socket.h>
#include <unistd.h>

#include <atomic>
#include <sstream>
#include <thread>

#include "platform/scoped_env.h"
#include "support/temp_dir.h"
#include "support/trees.h"
#include "support/x_server.h"

namespace kickvane::testing {
namespace {

const std::string kWindowTitle = "Kickvane v2.0";
const std::string kNoticeTitle = "Thông báo";  // the corner popups' and the boxes' title

// The tool and game folders, with the hotkey F7 in the settings.
class WindowTest : public ToolAndGameTest {
protected:
    static void SetUpTestSuite() { display_ = XServer::Start().release(); }
    static void TearDownTestSuite() {
        delete display_;
        display_ = nullptr;
    }

    void SetUp() override {
        if (!display_) {
            GTEST_SKIP() << "no Xvfb here";
        }
        ::setenv("DISPLAY", display_->display().c_str(), 1);
        ::setenv("XDG_RUNTIME_DIR", (dir_ / "runtime").c_str(), 1);
        fs::create_directories(dir_ / "runtime");
        fs::permissions(dir_ / "runtime", fs::perms::owner_all, fs::perm_options::replace);
        ::unsetenv("WAYLAND_DISPLAY");
        ToolAndGameTest::SetUp();
        WriteSettings("F7");
    }

    fs::path applied() const { return game() / "data2/cmn/base.dds"; }
    std::string Log() const { return ReadText(dir_ / "kickvane.log"); }  // the window's output

    std::unique_ptr<ChildProcess> StartKickvane(const std::string& log = "kickvane.log") {
        return std::make_unique<ChildProcess>(
            std::vector<std::string>{KICKVANE_BINARY, "--tool-folder", tool().string()},
            (dir_ / log).string());
    }

    // A window by its title and, where given, the process that shows it (_NET_WM_PID), so that
    // another program's window of the same title is never taken for it. xmessage names no
    // process: its window goes by title alone.
    static std::string FindWindow(const std::string& title, const ChildProcess* owner) {
        const std::string byOwner =
            owner ? " --pid " + std::to_string(owner->pid()) : std::string();
        std::string ids =
            Capture("xdotool search --all" + byOwner + " --name '^" + title + "$' 2>/dev/null");
        return ids.substr(0, ids.find('\n'));
    }

    // The corner popup and a box share their title; the popup is told apart by its window type,
    // a tool window's.
    static std::string FindNotice(const ChildProcess& owner, bool popup) {
        std::istringstream ids(Capture("xdotool search --all --pid " + std::to_string(owner.pid()) +
                                       " --name '^" + kNoticeTitle + "$' 2>/dev/null"));
        for (std::string id; std::getline(ids, id);) {
            const bool utility = Capture("xprop -id " + id + " _NET_WM_WINDOW_TYPE")
                                     .find("_NET_WM_WINDOW_TYPE_UTILITY") != std::string::npos;
            if (utility == popup) {
                return id;
            }
        }
        return {};
    }
    static std::string FindPopup(const ChildProcess& owner) { return FindNotice(owner, true); }
    static std::string FindBox(const ChildProcess& owner) { return FindNotice(owner, false); }

    static bool WindowShown(const std::string& title, const ChildProcess* owner) {
        return WaitFor([&] { return !FindWindow(title, owner).empty(); });
    }

    // Another program's window takes the keyboard focus, as the game would.
    std::unique_ptr<ChildProcess> FocusOtherWindow() {
        auto other = std::make_unique<ChildProcess>(
            std::vector<std::string>{"xmessage", "-title", "the game", "at the login screen"});
        EXPECT_TRUE(WindowShown("the game", nullptr));
        Capture("xdotool windowfocus --sync " + FindWindow("the game", nullptr));
        return other;
    }

    static void SaveScreenshot(const std::string& window, const std::string& name) {
        fs::create_directories(KICKVANE_ARTIFACTS);
        Capture("import -window " + window + " '" + std::string(KICKVANE_ARTIFACTS) + "/" + name +
                "'");
    }

    static XServer* display_;
};

XServer* WindowTest::display_ = nullptr;

// The hotkey pressed while the game has the focus runs the steps; those that fail are reported
// in the corner alert, which leaves the focus with the game; a click on the alert opens the list.
TEST_F(WindowTest, HotkeyInAnotherWindowApplies_FailedStepsShowTheAlertAndItsClickTheList) {
    fs::remove_all(game() / "zdata");  // the ball's copy has nowhere to go
    auto kickvane = StartKickvane();
    ASSERT_TRUE(WindowShown(kWindowTitle, kickvane.get())) << Log();
    SaveScreenshot(FindWindow(kWindowTitle, kickvane.get()), "window-after-start.png");
    auto focused = FocusOtherWindow();
    const std::string gameWindow = FindWindow("the game", nullptr);
    Capture("xdotool key F7");
    ASSERT_TRUE(WaitFor([&] { return !FindPopup(*kickvane).empty(); })) << Log();
    EXPECT_TRUE(fs::exists(applied())) << Log();  // the others went through
    EXPECT_EQ(Capture("xdotool getwindowfocus"), gameWindow + "\n");
    EXPECT_TRUE(FindBox(*kickvane).empty());
    // Once it has risen into its place.
    std::this_thread::sleep_for(std::chrono::milliseconds(1500));
    SaveScreenshot(FindPopup(*kickvane), "failure-alert.png");

    Capture("xdotool mousemove --window " + FindPopup(*kickvane) + " 20 20 click 1");
    ASSERT_TRUE(WaitFor([&] { return !FindBox(*kickvane).empty(); })) << Log();
    SaveScreenshot(FindBox(*kickvane), "failure-list.png");
    EXPECT_TRUE(kickvane->Running());
}

TEST_F(WindowTest, HotkeyTextThatNamesNoKeyTriggersNothing) {
    WriteSettings("f7");  // names are compared exactly: "f7" is no key
    auto kickvane = StartKickvane();
    ASSERT_TRUE(WindowShown(kWindowTitle, kickvane.get())) << Log();
    auto focused = FocusOtherWindow();
    Capture("xdotool key F7 F1 F12");
    // Several ticks of the 100 ms poll go by; none may react.
    std::this_thread::sleep_for(std::chrono::milliseconds(800));
    EXPECT_FALSE(fs::exists(applied()));
    EXPECT_TRUE(kickvane->Running());
}

TEST_F(WindowTest, TriggerRunsThePatchesInTheRunningCopyAndASecondStartIsRefused) {
    const std::string before = ReadText(tool() / "ThietLap.ini");
    EXPECT_NE(ChildProcess({KICKVANE_BINARY, "trigger"}).Wait(), 0);  // nothing runs yet
    auto first = StartKickvane();
    ASSERT_TRUE(WindowShown(kWindowTitle, first.get())) << Log();
    EXPECT_EQ(ChildProcess({KICKVANE_BINARY, "trigger"}).Wait(), 0);
    EXPECT_TRUE(WaitFor([&] { return fs::exists(applied()); }));

    auto second = StartKickvane("second.log");
    ASSERT_TRUE(WindowShown(kNoticeTitle, second.get()));
    SaveScreenshot(FindWindow(kNoticeTitle, second.get()), "second-start-refused.png");
    Capture("xdotool windowfocus --sync " + FindWindow(kNoticeTitle, second.get()) + " key Return");
    EXPECT_EQ(second->Wait(), 0);
    EXPECT_TRUE(first->Running());
    EXPECT_FALSE(FindWindow(kWindowTitle, first.get()).empty());
    EXPECT_EQ(ReadText(tool() / "ThietLap.ini"), before);
}

// A window that cannot answer (stopped here, as a busy one is) keeps the trigger and runs it once
// it goes on; the trigger says it is busy, not that nothing runs.
TEST_F(WindowTest, TriggerToABusyWindowIsQueuedAndRunsWhenItGoesOn) {
    auto kickvane = StartKickvane();
    ASSERT_TRUE(WindowShown(kWindowTitle, kickvane.get())) << Log();
    ASSERT_EQ(::kill(kickvane->pid(), SIGSTOP), 0);
    const CommandResult busy =
        RunCommand(std::string("'") + KICKVANE_BINARY + "' trigger", dir_.path());
    const CommandResult again =
        RunCommand(std::string("'") + KICKVANE_BINARY + "' trigger", dir_.path());
    ::kill(kickvane->pid(), SIGCONT);
    EXPECT_EQ(busy.exitCode, 0) << busy.err;
    EXPECT_EQ(busy.out, "Kickvane đang bận, lần chép sẽ chạy khi xong.\n");
    EXPECT_EQ(again.exitCode, 0) << again.err;
    EXPECT_TRUE(WaitFor([&] { return fs::exists(applied()); }));
    EXPECT_TRUE(kickvane->Running());
}

// SIGTERM, SIGINT and SIGHUP end the window as "Thoát" does: a clean exit, the command socket
// gone, nothing saved.
TEST_F(WindowTest, StopSignalsEndTheWindowCleanly) {
    const std::string settings = ReadText(tool() / "ThietLap.ini");
    const fs::path socket = dir_ / "runtime/kickvane.sock";
    for (const int signal : {SIGTERM, SIGINT, SIGHUP}) {
        auto kickvane = StartKickvane();
        ASSERT_TRUE(WindowShown(kWindowTitle, kickvane.get())) << Log();
        ASSERT_TRUE(fs::exists(socket));
        ::kill(kickvane->pid(), signal);
        EXPECT_EQ(kickvane->Wait(), 0) << "signal " << signal;
        EXPECT_FALSE(fs::exists(socket)) << "signal " << signal;
    }
    EXPECT_EQ(ReadText(tool() / "ThietLap.ini"), settings);
    EXPECT_NE(ChildProcess({KICKVANE_BINARY, "trigger"}).Wait(), 0);
}

// The tray icon: the tool's window of 22 pixels square.
std::string FindTrayIcon() {
    return Capture(
        "for id in $(xdotool search --classname '^kickvane$' 2>/dev/null); do "
        "xdotool getwindowgeometry $id | grep -q 'Geometry: 22x22' && printf %s $id && "
        "break; done");
}

// Clicks the second of the five entries in the open tray menu, a visible window of the tool that
// is neither the main window nor a corner popup ("Thông báo") of about the same size.
bool ClickSecondTrayMenuEntry() {
    return !Capture(
                "for id in $(xdotool search --onlyvisible --classname '^kickvane$' "
                "2>/dev/null); do eval $(xdotool getwindowgeometry --shell $id); "
                "[ $HEIGHT -gt 60 ] && [ $HEIGHT -lt 300 ] && [ $WIDTH -lt 400 ] && "
                "! xdotool getwindowname $id | grep -q -e '" +
                kWindowTitle + "' -e '^" + kNoticeTitle +
                "$' && "
                "xdotool mousemove --window $id $((WIDTH / 2)) $((HEIGHT * 3 / 10)) "
                "click 1 && echo $id && break; done")
                .empty();
}

bool WindowVisible(const std::string& title) {
    return !Capture("xdotool search --onlyvisible --name '^" + title + "$' 2>/dev/null").empty();
}

TEST_F(WindowTest, TrayIconAppearsWhenATrayStartsAndBringsTheHiddenWindowBack) {
    if (Capture("command -v trayer").empty()) {
        GTEST_SKIP() << "no tray host here";
    }
    auto kickvane = StartKickvane();
    ASSERT_TRUE(WindowShown(kWindowTitle, kickvane.get())) << Log();
    // The tray host starts after the tool, as it may when the desktop comes up.
    ChildProcess trayer(
        {"trayer", "--edge", "top", "--align", "right", "--width", "10", "--height", "24"});
    ASSERT_TRUE(WaitFor([] { return !FindTrayIcon().empty(); })) << Capture("xwininfo -root -tree");

    // "Chạy ẩn" under the tab heads hides the window; the hotkey still works meanwhile.
    Capture("xdotool mousemove --window " + FindWindow(kWindowTitle, kickvane.get()) +
            " 50 275 click 1");
    ASSERT_TRUE(WaitFor([] { return !WindowVisible(kWindowTitle); }));
    Capture("xdotool key F7");
    EXPECT_TRUE(WaitFor([&] { return fs::exists(applied()); }));

    // The tray menu's second entry, "Hiện chương trình", brings it back. A click that reaches the
    // icon while the tray host is still busy with it can go unanswered: then it clicks again.
    ASSERT_TRUE(WaitFor([] {
        Capture("xdotool mousemove --window " + FindTrayIcon() + " 10 10 click 3");
        return WaitFor(ClickSecondTrayMenuEntry, std::chrono::seconds(3));
    }))
        << Capture(
               "for id in $(xdotool search --onlyvisible --classname '^kickvane$'); do "
               "xdotool getwindowname $id; xdotool getwindowgeometry $id; done");
    EXPECT_TRUE(WaitFor([] { return WindowVisible(kWindowTitle); }));
    EXPECT_TRUE(kickvane->Running());
}

// A set the player dropped beside the catalog's balls shows after them on the ball tab; clicked
// and saved, it is what the hotkey copies.
TEST_F(WindowTest, AddedBallIsChosenSavedAndApplied) {
    WriteFile(tool() / u8"extras/Ball/Bóng Mới/textures/ball10.dds", "new ball");
    auto kickvane = StartKickvane();
    ASSERT_TRUE(WindowShown(kWindowTitle, kickvane.get())) << Log();
    const std::string window = FindWindow(kWindowTitle, kickvane.get());
    // The ball tab's head, then the fifth row's button (after the four catalog balls).
    Capture("xdotool mousemove --window " + window + " 50 125 click 1");
    Capture("xdotool mousemove --window " + window + " 131 243 click 1");
    SaveScreenshot(window, "window-added-ball-chosen.png");
    Capture("xdotool mousemove --window " + window + " 178 457 click 1");  // "Lưu thiết lập"
    EXPECT_TRUE(WaitFor([&] {
        return ReadText(tool() / "ThietLap.ini").find("Bóng Mới=True") != std::string::npos;
    })) << ReadText(tool() / "ThietLap.ini");
    EXPECT_EQ(ChildProcess({KICKVANE_BINARY, "trigger"}).Wait(), 0);
    EXPECT_TRUE(WaitFor([&] {
        return fs::exists(game() / "zdata/data2/ball/textures/ball10.dds") &&
               ReadText(game() / "zdata/data2/ball/textures/ball10.dds") == "new ball";
    }));
}

// A loopback web server that answers every request with `body`, until it goes.
class OneAnswerServer {
public:
    explicit OneAnswerServer(std::string body) : body_(std::move(body)) {
        listener_ = ::socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);
        sockaddr_in address{};
        address.sin_family = AF_INET;
        address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
        socklen_t length = sizeof address;
        if (::bind(listener_, reinterpret_cast<sockaddr*>(&address), length) != 0 ||
            ::listen(listener_, 4) != 0 ||
            ::getsockname(listener_, reinterpret_cast<sockaddr*>(&address), &length) != 0) {
            return;
        }
        port_ = ntohs(address.sin_port);
        thread_ = std::jthread([this] { Serve(); });
    }
    ~OneAnswerServer() { ::shutdown(listener_, SHUT_RDWR); }

    std::string Root() const { return "http://127.0.0.1:" + std::to_string(port_) + "/"; }
    int requests() const { return requests_; }

private:
    void Serve() {
        for (int client; (client = ::accept(listener_, nullptr, nullptr)) >= 0; ::close(client)) {
            char request[4096];
            if (::read(client, request, sizeof request) <= 0) {
                continue;
            }
            ++requests_;
            const std::string answer =
                "HTTP/1.0 200 OK\r\nContent-Length: " + std::to_string(body_.size()) + "\r\n\r\n" +
                body_;
            (void)!::write(client, answer.data(), answer.size());
        }
        ::close(listener_);
    }

    std::string body_;
    int listener_ = -1;
    int port_ = 0;
    std::atomic<int> requests_{0};
    std::jthread thread_;
};

// The update check's network code is a module of its own, loaded by the first check: a newer
// version on the host is recorded in the settings.
TEST_F(WindowTest, UpdateCheckLoadsItsNetworkCodeAndRecordsANewerVersion) {
    OneAnswerServer host("v9.9");
    ::setenv("KICKVANE_UPDATE_HOST", host.Root().c_str(), 1);
    auto kickvane = StartKickvane();
    ::unsetenv("KICKVANE_UPDATE_HOST");
    ASSERT_TRUE(WindowShown(kWindowTitle, kickvane.get())) << Log();
    const std::string window = FindWindow(kWindowTitle, kickvane.get());
    Capture("xdotool mousemove --window " + window + " 264 23 click 1");  // "Kiểm tra cập nhật"
    EXPECT_TRUE(WaitFor([&] {
        return ReadText(tool() / "ThietLap.ini").find("PhienBan=v9.9") != std::string::npos;
    })) << ReadText(tool() / "ThietLap.ini")
        << Log();
    EXPECT_GE(host.requests(), 1);
}

// "Khởi động FIFA" with a Wine that ends at once with an error: the window stays and a box says
// why (its words are the window test's), with no "Ẩn xuống khay hệ thống!".
TEST_F(WindowTest, LaunchWhoseWineFailsAtOnceSaysSoAndTheWindowStays) {
    WriteFile(game() / "Gameloader.exe", "MZ");
    WriteProgram(dir_ / "bin/wine",
                 "#!/bin/sh\necho 'wine: could not load kernel32.dll' >&2\nexit 3\n");
    const ScopedEnv path("PATH", (dir_ / "bin").string() + ":/usr/bin:/bin");
    const ScopedEnv home("HOME", (dir_ / "home").string());
    const ScopedEnv prefix("WINEPREFIX", std::nullopt);
    auto kickvane = StartKickvane();
    ASSERT_TRUE(WindowShown(kWindowTitle, kickvane.get())) << Log();
    const std::string window = FindWindow(kWindowTitle, kickvane.get());
    Capture("xdotool mousemove --window " + window + " 278 457 click 1");  // "Khởi động FIFA"
    ASSERT_TRUE(WaitFor([&] { return !FindBox(*kickvane).empty(); })) << Log();
    const std::string box = FindBox(*kickvane);
    SaveScreenshot(box, "launch-failed.png");
    EXPECT_TRUE(WindowVisible(kWindowTitle));
    EXPECT_TRUE(FindPopup(*kickvane).empty());  // no "Ẩn xuống khay hệ thống!"
    Capture("xdotool windowfocus --sync " + box + " key Return");
    EXPECT_TRUE(WaitFor([&] { return FindBox(*kickvane).empty(); }));
    EXPECT_TRUE(WindowVisible(kWindowTitle));
    EXPECT_TRUE(kickvane->Running());
}

}  // namespace
}  // namespace kickvane::testing
