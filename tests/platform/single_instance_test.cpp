#include "platform/single_instance.h"

#include <gtest/gtest.h>
#include <poll.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <cstring>
#include <filesystem>
#include <optional>
#include <thread>

#include "platform/scoped_env.h"
#include "support/temp_dir.h"

namespace kickvane::platform {
namespace {

namespace fs = std::filesystem;
using testing::ScopedEnv;
using testing::TempDir;

// Sends without waiting for the copy to take the command: the test takes it itself afterwards.
Delivery SendWithoutWaiting(const std::string& command, const std::string& name) {
    return SendToRunningInstance(command, name, std::chrono::milliseconds(0));
}

// Every test gets its own private runtime folder, so none touches the user's real one or meets a
// copy of the tool that runs on this machine.
class SingleInstanceTest : public ::testing::Test {
protected:
    SingleInstanceTest() { fs::permissions(runtime_.path(), fs::perms::owner_all); }

    // Connects to the running copy as a client and sends `bytes` as they are; the socket, or -1.
    int SendRaw(const std::string& bytes) {
        sockaddr_un address{};
        address.sun_family = AF_UNIX;
        const std::string path = (runtime_ / "kv-test.sock").string();
        std::strncpy(address.sun_path, path.c_str(), sizeof address.sun_path - 1);
        const int fd = ::socket(AF_UNIX, SOCK_STREAM, 0);
        if (::connect(fd, reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0 ||
            ::send(fd, bytes.data(), bytes.size(), MSG_NOSIGNAL) !=
                static_cast<ssize_t>(bytes.size())) {
            ::close(fd);
            return -1;
        }
        return fd;
    }

    TempDir runtime_;
    ScopedEnv xdgRuntime_{"XDG_RUNTIME_DIR", runtime_.path().string()};
};

TEST_F(SingleInstanceTest, RefusesSecondCopy_AndDeliversSentCommandsInOrderThroughADescriptor) {
    auto first = AcquireSingleInstance("kv-test");
    ASSERT_NE(first, nullptr);
    EXPECT_EQ(AcquireSingleInstance("kv-test"), nullptr);
    EXPECT_NE(AcquireSingleInstance("kv-other"), nullptr);  // another name, another use
    EXPECT_EQ(first->TakeCommand(), std::nullopt);          // nothing waiting: returns at once

    ASSERT_EQ(SendWithoutWaiting("show", "kv-test"), Delivery::Queued);
    ASSERT_EQ(SendWithoutWaiting("trigger", "kv-test"), Delivery::Queued);
    pollfd readable{first->CommandDescriptor(), POLLIN, 0};
    ASSERT_EQ(::poll(&readable, 1, 10000), 1);
    EXPECT_EQ(first->TakeCommand(), "show");
    EXPECT_EQ(first->TakeCommand(), "trigger");
    EXPECT_EQ(first->TakeCommand(), std::nullopt);

    first.reset();
    EXPECT_NE(AcquireSingleInstance("kv-test"), nullptr);
}

TEST_F(SingleInstanceTest, SendFails_WhenNoCopyRuns_AndACopyThatDiedLeavesNothingStale) {
    EXPECT_EQ(SendWithoutWaiting("trigger", "kv-test"), Delivery::NotRunning);
    const pid_t child = ::fork();
    ASSERT_GE(child, 0);
    if (child == 0) {
        // Ends without destructors, as a crash would: the socket file stays behind.
        auto instance = AcquireSingleInstance("kv-test");
        ::_exit(instance != nullptr ? 0 : 1);
    }
    int status = 0;
    ASSERT_EQ(::waitpid(child, &status, 0), child);
    ASSERT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0);
    ASSERT_TRUE(fs::exists(runtime_ / "kv-test.sock"));

    EXPECT_EQ(SendWithoutWaiting("trigger", "kv-test"), Delivery::NotRunning);
    auto next = AcquireSingleInstance("kv-test");
    ASSERT_NE(next, nullptr);
    ASSERT_EQ(SendWithoutWaiting("trigger", "kv-test"), Delivery::Queued);
    EXPECT_EQ(next->TakeCommand(), "trigger");
}

// The sender hears when the running copy takes its command; a copy that is busy keeps it for
// later, and the sender says so instead of taking the copy for gone.
TEST_F(SingleInstanceTest, ATakenCommandIsAnswered_ABusyCopyKeepsItForLater) {
    auto running = AcquireSingleInstance("kv-test");
    ASSERT_NE(running, nullptr);
    std::optional<Delivery> delivery;
    std::thread sender(
        [&] { delivery = SendToRunningInstance("trigger", "kv-test", std::chrono::minutes(1)); });
    pollfd readable{running->CommandDescriptor(), POLLIN, 0};
    ASSERT_EQ(::poll(&readable, 1, 10000), 1);
    EXPECT_EQ(running->TakeCommand(), "trigger");
    sender.join();
    EXPECT_EQ(delivery, Delivery::Delivered);

    // Busy: nothing takes the command while the sender waits.
    EXPECT_EQ(SendToRunningInstance("trigger", "kv-test", std::chrono::milliseconds(100)),
              Delivery::Queued);
    EXPECT_EQ(running->TakeCommand(), "trigger");  // its sender is gone; the command is kept
    EXPECT_EQ(running->TakeCommand(), std::nullopt);
}

TEST_F(SingleInstanceTest, SilentOverlongAndMultiLineClients_CannotBlockOrAddCommands) {
    auto running = AcquireSingleInstance("kv-test");
    ASSERT_NE(running, nullptr);
    // A client that connects and never writes must not hold the user interface.
    const int silent = SendRaw("");
    const int overlong = SendRaw(std::string(4096, 'x'));
    ASSERT_TRUE(silent >= 0 && overlong >= 0);
    EXPECT_EQ(running->TakeCommand(), std::nullopt);

    // One command per connection: a second line is not taken as another command.
    const int twoLines = SendRaw("show\r\nquit\n");
    ASSERT_GE(twoLines, 0);
    EXPECT_EQ(running->TakeCommand(), "show");
    EXPECT_EQ(running->TakeCommand(), std::nullopt);

    for (const std::string& bad :
         {std::string("show\nquit"), std::string(1000, 'x'), std::string()}) {
        EXPECT_EQ(SendWithoutWaiting(bad, "kv-test"), Delivery::Refused) << bad;
    }
    ASSERT_EQ(SendWithoutWaiting("trigger", "kv-test"), Delivery::Queued);
    EXPECT_EQ(running->TakeCommand(), "trigger");
    for (int fd : {silent, overlong, twoLines}) {
        ::close(fd);
    }
}

TEST_F(SingleInstanceTest, NameCannotReachOutsideRuntimeFolder) {
    fs::create_directories(runtime_ / "sub");
    auto running = AcquireSingleInstance("sub/x");
    ASSERT_NE(running, nullptr);
    EXPECT_TRUE(fs::is_empty(runtime_ / "sub"));
    ASSERT_EQ(SendWithoutWaiting("trigger", "sub/x"), Delivery::Queued);
    EXPECT_EQ(running->TakeCommand(), "trigger");
}

TEST(SingleInstanceFallback, UsesPrivateTmpFolder_WhenRuntimeFolderIsSharedWithOthers) {
    TempDir shared;
    fs::permissions(shared.path(), fs::perms::all);  // writable by every user
    ScopedEnv xdgRuntime("XDG_RUNTIME_DIR", shared.path().string());
    const std::string name = "kv-test-fallback-" + std::to_string(::getpid());

    auto running = AcquireSingleInstance(name);
    ASSERT_NE(running, nullptr);
    EXPECT_FALSE(fs::exists(shared / (name + ".lock")));

    const fs::path folder = "/tmp/kickvane-" + std::to_string(::getuid());
    struct stat st {};
    ASSERT_EQ(::lstat(folder.c_str(), &st), 0);
    EXPECT_TRUE(S_ISDIR(st.st_mode) && st.st_uid == ::getuid() && (st.st_mode & 077) == 0);
    EXPECT_TRUE(fs::exists(folder / (name + ".lock")));
    ASSERT_EQ(SendWithoutWaiting("trigger", name), Delivery::Queued);
    EXPECT_EQ(running->TakeCommand(), "trigger");

    running.reset();
    fs::remove(folder / (name + ".lock"));
}

}  // namespace
}  // namespace kickvane::platform
