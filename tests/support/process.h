#pragma once

#include <fcntl.h>
#include <signal.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <functional>
#include <optional>
#include <sstream>
#include <string>
#include <thread>
#include <vector>

extern char** environ;

namespace kickvane::testing {

// Waits until `condition` holds, checking every 50 ms, for at most `limit`. The limit only keeps
// a broken test from hanging; nothing is measured.
inline bool WaitFor(const std::function<bool()>& condition,
                    std::chrono::milliseconds limit = std::chrono::seconds(20)) {
    const auto end = std::chrono::steady_clock::now() + limit;
    while (!condition()) {
        if (std::chrono::steady_clock::now() > end) {
            return false;
        }
        std::this_thread::sleep_for(std::chrono::milliseconds(50));
    }
    return true;
}

// A program started by a test, killed at the end unless it has exited.
class ChildProcess {
public:
    explicit ChildProcess(const std::vector<std::string>& argv,
                          const std::string& output = "/dev/null") {
        std::vector<char*> args;
        for (const std::string& arg : argv) {
            args.push_back(const_cast<char*>(arg.c_str()));
        }
        args.push_back(nullptr);
        posix_spawn_file_actions_t actions;
        posix_spawn_file_actions_init(&actions);
        posix_spawn_file_actions_addopen(&actions, 0, "/dev/null", O_RDONLY, 0);
        posix_spawn_file_actions_addopen(&actions, 1, output.c_str(), O_WRONLY | O_CREAT | O_TRUNC,
                                         0644);
        posix_spawn_file_actions_adddup2(&actions, 1, 2);
        if (posix_spawnp(&pid_, args[0], &actions, nullptr, args.data(), environ) != 0) {
            pid_ = -1;
        }
        posix_spawn_file_actions_destroy(&actions);
    }
    ChildProcess(const ChildProcess&) = delete;
    ChildProcess& operator=(const ChildProcess&) = delete;
    ~ChildProcess() { Kill(); }

    bool started() const { return pid_ > 0; }
    pid_t pid() const { return pid_; }

    bool Running() {
        Reap(WNOHANG);
        return pid_ > 0 && !exitCode_;
    }

    // The exit code once the program has ended within `limit`.
    std::optional<int> Wait(std::chrono::milliseconds limit = std::chrono::seconds(20)) {
        WaitFor([this] { return !Running(); }, limit);
        return exitCode_;
    }

    // Asks the program to end (an X server then removes its socket), and kills it if it does not.
    void Kill() {
        if (Running()) {
            ::kill(pid_, SIGTERM);
            if (!Wait(std::chrono::seconds(3))) {
                ::kill(pid_, SIGKILL);
                Reap(0);
            }
        }
    }

private:
    void Reap(int options) {
        if (pid_ <= 0 || exitCode_) {
            return;
        }
        int status = 0;
        if (::waitpid(pid_, &status, options) == pid_) {
            exitCode_ = WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status);
        }
    }

    pid_t pid_ = -1;
    std::optional<int> exitCode_;
};

// Runs a shell command line and returns its standard output.
inline std::string Capture(const std::string& command) {
    std::string output;
    if (FILE* pipe = ::popen(command.c_str(), "r")) {
        char buffer[256];
        while (size_t n = std::fread(buffer, 1, sizeof buffer, pipe)) {
            output.append(buffer, n);
        }
        ::pclose(pipe);
    }
    return output;
}

// What a finished command printed and how it ended.
struct CommandResult {
    int exitCode;
    std::string out;
    std::string err;
};

// Runs the shell command line `command` with `input` on its standard input; the streams pass
// through files in `scratch`.
inline CommandResult RunCommand(const std::string& command, const std::filesystem::path& scratch,
                                const std::string& input = "") {
    const auto file = [&scratch](const char* name) { return (scratch / name).string(); };
    std::ofstream(file("stdin"), std::ios::binary) << input;
    const int status = std::system((command + " < '" + file("stdin") + "' > '" + file("stdout") +
                                    "' 2> '" + file("stderr") + "'")
                                       .c_str());
    const auto read = [&file](const char* name) {
        std::ostringstream text;
        text << std::ifstream(file(name), std::ios::binary).rdbuf();
        return text.str();
    };
    return {WIFEXITED(status) ? WEXITSTATUS(status) : -1, read("stdout"), read("stderr")};
}

}  // namespace kickvane::testing
