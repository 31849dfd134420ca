// Starting programs on Linux and other POSIX systems.
#include <fcntl.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <csignal>
#include <cstdlib>
#include <cstring>
#include <string_view>
#include <system_error>

#include "platform/process.h"

extern char** environ;

namespace kickvane::platform {

namespace fs = std::filesystem;

namespace {

// What the program's process reports to the watching process when it cannot run the program.
struct StartFailure {
    int step;  // one of the values below
    int error;
};
constexpr int kStepFork = 1;
constexpr int kStepFolder = 2;
constexpr int kStepInput = 3;
constexpr int kStepExec = 4;

// What the watching process reports to the tool, in order: Running or NotRun, then (for a program
// that ran) Exited or Killed. Each report is one write smaller than PIPE_BUF, so it arrives whole.
struct Report {
    int kind;
    int step;   // NotRun: which step failed
    int value;  // NotRun: errno; Exited: exit code; Killed: signal
};
constexpr int kReportRunning = 1;
constexpr int kReportNotRun = 2;
constexpr int kReportExited = 3;
constexpr int kReportKilled = 4;

Failure FailureOf(int step, int error, const fs::path& program, const fs::path& folder) {
    const std::error_code code(error, std::system_category());
    if (step == kStepFolder) {
        return {FailedAction::EnterFolder, folder, code, {}};
    }
    return {FailedAction::Run, program, code, {}};
}

void WriteReport(int fd, int kind, int step, int value) {
    const Report report{kind, step, value};
    ssize_t written = 0;
    do {
        written = ::write(fd, &report, sizeof report);
    } while (written < 0 && errno == EINTR);
}

// Runs in the program's process: only async-signal-safe calls until exec, since the tool may have
// other threads whose locks were copied in whatever state they were.
[[noreturn]] void RunProgram(const char* program, char* const* argv, char* const* envp,
                             const char* folder, int failureFd) {
    auto fail = [failureFd](int step) {
        const StartFailure failure{step, errno};
        ssize_t ignored = ::write(failureFd, &failure, sizeof failure);
        (void)ignored;
        ::_exit(127);
    };

    // Signal handling starts afresh: ignored signals (SIGPIPE, say) and a blocked mask would
    // otherwise be inherited by the program.
    for (int signal = 1; signal < NSIG; ++signal) {
        struct sigaction action {};
        action.sa_handler = SIG_DFL;
        ::sigaction(signal, &action, nullptr);  // fails harmlessly for SIGKILL and SIGSTOP
    }
    sigset_t none;
    sigemptyset(&none);
    ::sigprocmask(SIG_SETMASK, &none, nullptr);

    if (::chdir(folder) != 0) {
        fail(kStepFolder);
    }
    const int input = ::open("/dev/null", O_RDONLY);
    if (input < 0 || ::dup2(input, STDIN_FILENO) < 0) {
        fail(kStepInput);
    }
    if (input != STDIN_FILENO) {
        ::close(input);
    }
#if defined(__linux__) && defined(CLOSE_RANGE_CLOEXEC)
    // Descriptors the tool opened without close-on-exec (by a library, say) must not stay open
    // in the game for its whole life; the failure pipe is close-on-exec already.
    ::close_range(3, ~0u, CLOSE_RANGE_CLOEXEC);
#endif

    ::execve(program, argv, envp);
    fail(kStepExec);
    ::_exit(127);  // not reached: fail() exits
}

// Runs in the tool's child, the watching process: it starts the program in a process of its
// own, learns through a close-on-exec pipe whether the exec worked, then waits for the program
// and reports its end to the tool. Async-signal-safe calls only, as above.
[[noreturn]] void RunWatcher(const char* program, char* const* argv, char* const* envp,
                             const char* folder, int reportFd) {
    // A session of its own: the program outlives the tool and gets no signal meant for the
    // tool's terminal or process group.
    ::setsid();
    // The tool may ignore SIGCHLD (then its children are never waitable) or SIGPIPE; here the
    // first must be the default and the second ignored, so that a report to a tool that went
    // away fails instead of killing this process early.
    struct sigaction action {};
    action.sa_handler = SIG_DFL;
    ::sigaction(SIGCHLD, &action, nullptr);
    action.sa_handler = SIG_IGN;
    ::sigaction(SIGPIPE, &action, nullptr);

    std::array<int, 2> failurePipe{};
    if (::pipe2(failurePipe.data(), O_CLOEXEC) != 0) {
        WriteReport(reportFd, kReportNotRun, kStepFork, errno);
        ::_exit(0);
    }
    const pid_t programPid = ::fork();
    if (programPid < 0) {
        WriteReport(reportFd, kReportNotRun, kStepFork, errno);
        ::_exit(0);
    }
    if (programPid == 0) {
        ::close(failurePipe[0]);
        ::close(reportFd);
        RunProgram(program, argv, envp, folder, failurePipe[1]);
    }
    ::close(failurePipe[1]);

    // A successful exec closes the pipe's other end and the read sees its end.
    StartFailure failure{};
    ssize_t got = 0;
    do {
        got = ::read(failurePipe[0], &failure, sizeof failure);
    } while (got < 0 && errno == EINTR);
    ::close(failurePipe[0]);
    int status = 0;
    if (got == static_cast<ssize_t>(sizeof failure)) {
        while (::waitpid(programPid, &status, 0) < 0 && errno == EINTR) {
        }
        WriteReport(reportFd, kReportNotRun, failure.step, failure.error);
        ::_exit(0);
    }
    WriteReport(reportFd, kReportRunning, 0, 0);

    // Nor the tool's standard streams: a caller that reads the tool's output to its end would
    // otherwise wait for the game to end.
    if (const int nothing = ::open("/dev/null", O_RDWR); nothing >= 0) {
        ::dup2(nothing, STDIN_FILENO);
        ::dup2(nothing, STDOUT_FILENO);
        ::dup2(nothing, STDERR_FILENO);
        if (nothing > STDERR_FILENO) {
            ::close(nothing);
        }
    }

#if defined(__linux__) && defined(CLOSE_RANGE_CLOEXEC)
    // While it waits (as long as the game runs, if the tool ends first) this process keeps no
    // descriptor of the tool's but its report pipe: not the single-instance lock, say.
    if (reportFd != 3 && ::dup2(reportFd, 3) == 3) {
        reportFd = 3;
    }
    ::close_range(static_cast<unsigned>(reportFd) + 1, ~0u, 0);
    if (reportFd > 3) {
        ::close_range(3, static_cast<unsigned>(reportFd) - 1, 0);
    }
#endif

    while (::waitpid(programPid, &status, 0) < 0) {
        if (errno != EINTR) {
            ::_exit(0);  // the end cannot be learnt: the tool takes the program as running
        }
    }
    if (WIFSIGNALED(status)) {
        WriteReport(reportFd, kReportKilled, 0, WTERMSIG(status));
    } else {
        WriteReport(reportFd, kReportExited, 0, WEXITSTATUS(status));
    }
    ::_exit(0);
}

// The tool's side: reads the watching process's reports without waiting.
class PosixWatch final : public ProgramWatch {
public:
    PosixWatch(pid_t watcher, int reportFd, fs::path program, fs::path folder)
        : watcher_(watcher),
          fd_(reportFd),
          program_(std::move(program)),
          folder_(std::move(folder)) {}

    ~PosixWatch() override {
        if (watcher_ <= 0) {
            return;
        }
        if (state_.kind == ProgramState::Kind::Starting) {
            // The watching process may not have started the program yet: ending it now could
            // prevent the start, so wait for its first report (the exec takes moments).
            const int flags = ::fcntl(fd_, F_GETFL);
            ::fcntl(fd_, F_SETFL, flags & ~O_NONBLOCK);
            Report report{};
            while (::read(fd_, &report, sizeof report) < 0 && errno == EINTR) {
            }
        }
        // The program is left to itself: it is the watching process's child, which ends now, so
        // init (or the session's subreaper) adopts the program and reaps it when it ends.
        ::close(fd_);
        ::kill(watcher_, SIGKILL);
        Reap();
    }

    PosixWatch(const PosixWatch&) = delete;
    PosixWatch& operator=(const PosixWatch&) = delete;

    ProgramState Poll() override {
        while (watcher_ > 0) {
            Report report{};
            const ssize_t got = ::read(fd_, &report, sizeof report);
            if (got < 0 && errno == EINTR) {
                continue;
            }
            if (got < 0 && (errno == EAGAIN || errno == EWOULDBLOCK)) {
                break;
            }
            if (got != static_cast<ssize_t>(sizeof report)) {
                // The watching process ended without a last word: the program's end cannot be
                // learnt, so it counts as running.
                if (state_.kind == ProgramState::Kind::Starting) {
                    state_.kind = ProgramState::Kind::Running;
                }
                Finish();
                break;
            }
            Take(report);
        }
        return state_;
    }

private:
    void Take(const Report& report) {
        switch (report.kind) {
            case kReportRunning:
                state_.kind = ProgramState::Kind::Running;
                return;
            case kReportNotRun:
                state_.kind = ProgramState::Kind::NotRun;
                state_.failure = FailureOf(report.step, report.value, program_, folder_);
                break;
            case kReportKilled:
                state_.kind = ProgramState::Kind::Killed;
                state_.code = report.value;
                break;
            default:
                state_.kind = ProgramState::Kind::Exited;
                state_.code = report.value;
                break;
        }
        Finish();  // the watching process ends right after its last report
    }

    void Finish() {
        ::close(fd_);
        Reap();
    }

    void Reap() {
        while (::waitpid(watcher_, nullptr, 0) < 0 && errno == EINTR) {
        }
        watcher_ = -1;
    }

    pid_t watcher_;
    int fd_;
    fs::path program_;
    fs::path folder_;
    ProgramState state_;
};

bool IsExecutableFile(const fs::path& path) {
    struct stat st {};
    return ::stat(path.c_str(), &st) == 0 && S_ISREG(st.st_mode) &&
           ::access(path.c_str(), X_OK) == 0;
}

// The tool's environment with the additions put in: a variable named there is replaced, the others
// are kept in their order.
std::vector<std::string> EnvironmentWith(const EnvironmentAdditions& additions) {
    std::vector<std::string> entries;
    for (char** entry = environ; entry != nullptr && *entry != nullptr; ++entry) {
        const std::string_view text(*entry);
        const std::string_view name = text.substr(0, text.find('='));
        bool replaced = false;
        for (const auto& [addedName, value] : additions) {
            replaced = replaced || addedName == name;
        }
        if (!replaced) {
            entries.emplace_back(text);
        }
    }
    for (const auto& [name, value] : additions) {
        entries.push_back(name + "=" + value);
    }
    return entries;
}

}  // namespace

std::unique_ptr<ProgramWatch> StartWatched(const fs::path& program,
                                           const std::vector<std::string>& arguments,
                                           const fs::path& workingFolder,
                                           bool /*minimised: no such state here*/,
                                           const EnvironmentAdditions& environment) {
    for (const auto& [name, value] : environment) {
        if (name.empty() || name.find('=') != std::string::npos) {
            return NotRunWatch({FailedAction::Run, program,
                                std::make_error_code(std::errc::invalid_argument),
                                "tên biến môi trường không hợp lệ: " + name});
        }
    }
    if (program.empty()) {
        return NotRunWatch(
            {FailedAction::Run, program, std::make_error_code(std::errc::invalid_argument), {}});
    }
    // The program's process changes into the working folder before exec, so a relative program
    // path is made absolute against the tool's current folder first.
    std::error_code error;
    const fs::path absoluteProgram = fs::absolute(program, error);
    if (error) {
        return NotRunWatch({FailedAction::Run, program, error, {}});
    }
    const fs::path folder = workingFolder.empty() ? fs::path(".") : workingFolder;

    // Everything the children need is prepared here: after fork they may not allocate.
    const std::string programText = absoluteProgram.string();
    const std::string folderText = folder.string();
    std::vector<std::string> argumentTexts;
    argumentTexts.reserve(arguments.size() + 1);
    argumentTexts.push_back(programText);
    argumentTexts.insert(argumentTexts.end(), arguments.begin(), arguments.end());
    std::vector<char*> argv;
    argv.reserve(argumentTexts.size() + 1);
    for (std::string& text : argumentTexts) {
        argv.push_back(text.data());
    }
    argv.push_back(nullptr);
    std::vector<std::string> environmentTexts = EnvironmentWith(environment);
    std::vector<char*> envp;
    envp.reserve(environmentTexts.size() + 1);
    for (std::string& text : environmentTexts) {
        envp.push_back(text.data());
    }
    envp.push_back(nullptr);

    std::array<int, 2> pipe{};
    if (::pipe2(pipe.data(), O_CLOEXEC) != 0) {
        return NotRunWatch({FailedAction::Run, program, LastSystemError(), {}});
    }
    const pid_t watcher = ::fork();
    if (watcher < 0) {
        const std::error_code forkError = LastSystemError();
        ::close(pipe[0]);
        ::close(pipe[1]);
        return NotRunWatch({FailedAction::Run, program, forkError, {}});
    }
    if (watcher == 0) {
        ::close(pipe[0]);
        RunWatcher(programText.c_str(), argv.data(), envp.data(), folderText.c_str(), pipe[1]);
    }
    ::close(pipe[1]);
    ::fcntl(pipe[0], F_SETFL, ::fcntl(pipe[0], F_GETFL) | O_NONBLOCK);
    return std::make_unique<PosixWatch>(watcher, pipe[0], program, folder);
}

fs::path FindOnPath(const std::string& name) {
    if (name.empty()) {
        return {};
    }
    if (name.find('/') != std::string::npos) {
        return IsExecutableFile(name) ? fs::path(name) : fs::path();
    }
    const char* pathVariable = std::getenv("PATH");
    const std::string_view path =
        pathVariable != nullptr ? pathVariable : "/usr/local/bin:/usr/bin:/bin";
    size_t begin = 0;
    while (begin <= path.size()) {
        size_t end = path.find(':', begin);
        if (end == std::string_view::npos) {
            end = path.size();
        }
        const std::string_view folder = path.substr(begin, end - begin);
        // An empty entry would mean the current folder; a program is never taken from there.
        if (!folder.empty() && folder.front() == '/') {
            fs::path candidate = fs::path(folder) / name;
            if (IsExecutableFile(candidate)) {
                return candidate;
            }
        }
        begin = end + 1;
    }
    return {};
}

bool IsNativeExecutable(const fs::path& file) {
    if (!IsExecutableFile(file)) {
        return false;
    }
    const int fd = ::open(file.c_str(), O_RDONLY | O_CLOEXEC);
    if (fd < 0) {
        return false;
    }
    std::array<char, 4> head{};
    ssize_t got = 0;
    do {
        got = ::read(fd, head.data(), head.size());
    } while (got < 0 && errno == EINTR);
    ::close(fd);
    const std::string_view start(head.data(), got > 0 ? static_cast<size_t>(got) : 0);
    return start == std::string_view(
                        "\x7f"
                        "ELF",
                        4) ||
           start.starts_with("#!");
}

}  // namespace kickvane::platform
