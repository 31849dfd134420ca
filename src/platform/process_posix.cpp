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

// What the child reports through the pipe when it cannot run the program.
struct StartFailure {
    int step;  // one of the values below
    int error;
};
constexpr int kStepFork = 1;
constexpr int kStepFolder = 2;
constexpr int kStepInput = 3;
constexpr int kStepExec = 4;

Status FailureOf(const StartFailure& failure, const fs::path& program, const fs::path& folder) {
    const std::error_code code(failure.error, std::system_category());
    if (failure.step == kStepFolder) {
        return Status::Fail(FailedAction::EnterFolder, folder, code);
    }
    return Status::Fail(FailedAction::Run, program, code);
}

// Runs in the forked child: only async-signal-safe calls until exec, since the parent may have
// other threads whose locks were copied in whatever state they were.
[[noreturn]] void RunChild(const char* program, char* const* argv, char* const* envp,
                           const char* folder, int reportFd) {
    auto report = [reportFd](int step) {
        const StartFailure failure{step, errno};
        ssize_t ignored = ::write(reportFd, &failure, sizeof failure);
        (void)ignored;
        ::_exit(127);
    };

    // A session of its own: the program outlives the tool and gets no signal meant for the
    // tool's terminal or process group.
    ::setsid();

    // Fork once more and let the middle process exit at once. The grandchild is then adopted by
    // init (or the session's subreaper), which reaps it when it ends, so a game started from a
    // tray tool that runs for days never lingers as a zombie, and no process-wide SIGCHLD
    // handling is needed that could disturb other code waiting for its own children.
    const pid_t grandchild = ::fork();
    if (grandchild < 0) {
        report(kStepFork);
    }
    if (grandchild > 0) {
        ::_exit(0);
    }

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
        report(kStepFolder);
    }
    const int input = ::open("/dev/null", O_RDONLY);
    if (input < 0 || ::dup2(input, STDIN_FILENO) < 0) {
        report(kStepInput);
    }
    if (input != STDIN_FILENO) {
        ::close(input);
    }
#if defined(__linux__) && defined(CLOSE_RANGE_CLOEXEC)
    // Descriptors the tool opened without close-on-exec (by a library, say) must not stay open
    // in the game for its whole life; the report pipe is close-on-exec already.
    ::close_range(3, ~0u, CLOSE_RANGE_CLOEXEC);
#endif

    ::execve(program, argv, envp);
    report(kStepExec);
    ::_exit(127);  // not reached: report() exits
}

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

Status StartDetached(const fs::path& program, const std::vector<std::string>& arguments,
                     const fs::path& workingFolder, bool /*minimised: no such state here*/,
                     const EnvironmentAdditions& environment) {
    for (const auto& [name, value] : environment) {
        if (name.empty() || name.find('=') != std::string::npos) {
            return Status::Fail("cannot start " + program.string() + ": bad variable name " + name);
        }
    }
    if (program.empty()) {
        return Status::Fail("no program given");
    }
    // The child changes into the working folder before exec, so a relative program path is made
    // absolute against the tool's current folder first.
    std::error_code error;
    const fs::path absoluteProgram = fs::absolute(program, error);
    if (error) {
        return Status::Fail(FailedAction::Run, program, error);
    }
    const fs::path folder = workingFolder.empty() ? fs::path(".") : workingFolder;

    // Everything the child needs is prepared here: after fork it may not allocate.
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

    // The grandchild writes a StartFailure here when it cannot exec; a successful exec closes
    // the pipe (close-on-exec) and the parent reads end-of-file.
    std::array<int, 2> pipe{};
    if (::pipe2(pipe.data(), O_CLOEXEC) != 0) {
        return Status::Fail(FailedAction::Run, program, LastSystemError());
    }

    const pid_t child = ::fork();
    if (child < 0) {
        const int forkError = errno;
        ::close(pipe[0]);
        ::close(pipe[1]);
        return FailureOf({kStepFork, forkError}, program, folder);
    }
    if (child == 0) {
        ::close(pipe[0]);
        RunChild(programText.c_str(), argv.data(), envp.data(), folderText.c_str(), pipe[1]);
    }

    ::close(pipe[1]);
    // The middle process exits right after its fork; reaping it here takes no time.
    int childStatus = 0;
    while (::waitpid(child, &childStatus, 0) < 0 && errno == EINTR) {
    }

    StartFailure failure{};
    ssize_t got = 0;
    do {
        got = ::read(pipe[0], &failure, sizeof failure);
    } while (got < 0 && errno == EINTR);
    ::close(pipe[0]);

    if (got == static_cast<ssize_t>(sizeof failure)) {
        return FailureOf(failure, program, folder);
    }
    if (!WIFEXITED(childStatus) || WEXITSTATUS(childStatus) != 0) {
        return Status::Fail(FailedAction::Run, program,
                            std::make_error_code(std::errc::resource_unavailable_try_again));
    }
    return Status::Ok();
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
