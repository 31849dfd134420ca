// One running copy per user on Linux and other POSIX systems.
//
// The running copy holds an flock on "<name>.lock"; the kernel drops the lock when the process
// ends in any way, so a crash leaves no stale lock behind. Later starts send their command over
// the Unix socket "<name>.sock". Both live in the user's runtime folder: $XDG_RUNTIME_DIR when it
// is set and private to the user, else /tmp/kickvane-<uid>, created with mode 0700. Another local
// user can neither take the lock nor send commands, and cannot plant either file for us.
#include <fcntl.h>
#include <poll.h>
#include <sys/file.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <chrono>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <string_view>

#include "platform/posix_fd.h"
#include "platform/single_instance.h"

namespace kickvane::platform {

namespace fs = std::filesystem;

namespace {

constexpr size_t kMaxCommandLength = 256;
// How long TakeCommand waits for the line of a client that has connected: the client writes it
// right after connecting, and a silent one must not hold up the user interface.
constexpr auto kCommandReadTimeout = std::chrono::milliseconds(200);
// How long a sender waits for a running copy that does not accept.
constexpr int kSendTimeoutSeconds = 2;
// Connections the running copy holds while it is busy. Each waiting trigger is kept, and the
// copy runs once for all of them when it is free.
constexpr int kBacklog = 64;
// What the running copy answers once it has read a command.
constexpr std::string_view kTakenAnswer = "ok\n";

// True when `st` describes a folder that only the current user can change.
bool IsPrivateFolder(const struct stat& st) {
    return S_ISDIR(st.st_mode) && st.st_uid == ::getuid() &&
           (st.st_mode & (S_IWGRP | S_IWOTH)) == 0;
}

// The folder /tmp/kickvane-<uid>, created when missing. Refused when it is a symbolic link or
// belongs to someone else (another user could have created it first to catch our socket); group
// and others lose any rights a previous run may have left.
fs::path PrivateTempFolder() {
    const fs::path folder = "/tmp/kickvane-" + std::to_string(::getuid());
    if (::mkdir(folder.c_str(), 0700) != 0 && errno != EEXIST) {
        return {};
    }
    Fd fd(::open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC));
    struct stat st {};
    if (!fd.valid() || ::fstat(fd.get(), &st) != 0 || !S_ISDIR(st.st_mode) ||
        st.st_uid != ::getuid()) {
        return {};
    }
    if ((st.st_mode & 077) != 0 && ::fchmod(fd.get(), 0700) != 0) {
        return {};
    }
    return folder;
}

// Where the lock and the socket live; empty when no safe folder is available.
fs::path RuntimeFolder() {
    if (const char* runtime = std::getenv("XDG_RUNTIME_DIR"); runtime != nullptr) {
        const fs::path folder = runtime;
        struct stat st {};
        if (folder.is_absolute() && ::stat(folder.c_str(), &st) == 0 && IsPrivateFolder(st) &&
            ::access(folder.c_str(), W_OK | X_OK) == 0) {
            return folder;
        }
    }
    return PrivateTempFolder();
}

// The name becomes part of two file names; anything but letters, digits, '-', '_' and '.' is
// replaced so that a name can never point outside the runtime folder.
std::string SafeName(std::string_view name) {
    std::string safe;
    for (char c : name) {
        const bool plain = (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') ||
                           (c >= '0' && c <= '9') || c == '-' || c == '_' || c == '.';
        safe += plain ? c : '_';
    }
    return safe.empty() ? std::string("kickvane") : safe;
}

// Fills `address` with the socket path; false when the path is too long for a socket address.
bool SocketAddress(const fs::path& path, sockaddr_un& address) {
    address = {};
    address.sun_family = AF_UNIX;
    const std::string& text = path.native();
    if (text.size() >= sizeof address.sun_path) {
        return false;
    }
    std::memcpy(address.sun_path, text.c_str(), text.size() + 1);
    return true;
}

// True when the peer of a connected socket runs as the current user. The private folder keeps
// others out already; this also covers a runtime folder that was made reachable later.
bool PeerIsCurrentUser(int fd) {
#if defined(SO_PEERCRED)
    struct ucred credentials {};
    socklen_t size = sizeof credentials;
    return ::getsockopt(fd, SOL_SOCKET, SO_PEERCRED, &credentials, &size) == 0 &&
           credentials.uid == ::getuid();
#else
    uid_t uid = 0;
    gid_t gid = 0;
    return ::getpeereid(fd, &uid, &gid) == 0 && uid == ::getuid();
#endif
}

// Reads one line of at most kMaxCommandLength bytes from a connected client, waiting no longer
// than kCommandReadTimeout in all. nullopt for a silent client, an over-long line or an empty one.
std::optional<std::string> ReadCommandLine(int fd) {
    const auto deadline = std::chrono::steady_clock::now() + kCommandReadTimeout;
    std::string line;
    char buffer[kMaxCommandLength + 1];
    for (;;) {
        const auto left = std::chrono::duration_cast<std::chrono::milliseconds>(
            deadline - std::chrono::steady_clock::now());
        if (left.count() <= 0) {
            return std::nullopt;
        }
        pollfd readable{fd, POLLIN, 0};
        const int ready = ::poll(&readable, 1, static_cast<int>(left.count()));
        if (ready < 0 && errno == EINTR) {
            continue;
        }
        if (ready <= 0) {
            return std::nullopt;
        }
        const ssize_t got = ::recv(fd, buffer, sizeof buffer, MSG_DONTWAIT);
        if (got < 0 && (errno == EINTR || errno == EAGAIN || errno == EWOULDBLOCK)) {
            continue;
        }
        if (got <= 0) {
            break;  // The client closed without a newline: take what it sent.
        }
        line.append(buffer, static_cast<size_t>(got));
        if (const size_t end = line.find('\n'); end != std::string::npos) {
            line.resize(end);
            break;
        }
        if (line.size() > kMaxCommandLength) {
            return std::nullopt;
        }
    }
    if (!line.empty() && line.back() == '\r') {
        line.pop_back();
    }
    if (line.empty() || line.size() > kMaxCommandLength) {
        return std::nullopt;
    }
    return line;
}

class PosixSingleInstance final : public SingleInstance {
public:
    PosixSingleInstance(Fd lock, Fd listener, fs::path socketPath)
        : lock_(std::move(lock)),
          listener_(std::move(listener)),
          socketPath_(std::move(socketPath)) {}
    PosixSingleInstance(const PosixSingleInstance&) = delete;
    PosixSingleInstance& operator=(const PosixSingleInstance&) = delete;

    ~PosixSingleInstance() override {
        // The socket file goes while the lock is still held, so no new copy can have bound a
        // socket of its own under that name yet. The lock file stays: removing it would let two
        // copies lock two different files.
        if (listener_.valid()) {
            listener_.Reset();
            ::unlink(socketPath_.c_str());
        }
    }

    int CommandDescriptor() const override { return listener_.get(); }

    std::optional<std::string> TakeCommand() override {
        if (!listener_.valid()) {
            return std::nullopt;
        }
        // A few bad connections in a row are dropped; the rest wait for the next call.
        for (int attempt = 0; attempt < 8; ++attempt) {
            Fd client(::accept4(listener_.get(), nullptr, nullptr, SOCK_CLOEXEC));
            if (!client.valid()) {
                if (errno == EINTR || errno == ECONNABORTED) {
                    continue;
                }
                return std::nullopt;  // EAGAIN: nothing waiting
            }
            if (!PeerIsCurrentUser(client.get())) {
                continue;
            }
            if (auto command = ReadCommandLine(client.get())) {
                // The sender may have gone already (it stops waiting when the copy is busy).
                (void)::send(client.get(), kTakenAnswer.data(), kTakenAnswer.size(),
                             MSG_NOSIGNAL | MSG_DONTWAIT);
                return command;
            }
        }
        return std::nullopt;
    }

private:
    Fd lock_;
    Fd listener_;
    fs::path socketPath_;
};

// Binds and listens on the socket; an invalid Fd when that fails.
Fd Listen(const fs::path& socketPath) {
    sockaddr_un address;
    if (!SocketAddress(socketPath, address)) {
        return {};
    }
    Fd fd(::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0));
    if (!fd.valid()) {
        return {};
    }
    // A socket file left by a copy that died. Removing it is safe: we hold the lock, so no other
    // copy is listening on it.
    ::unlink(socketPath.c_str());
    if (::bind(fd.get(), reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0 ||
        ::listen(fd.get(), kBacklog) != 0) {
        return {};
    }
    return fd;
}

}  // namespace

std::unique_ptr<SingleInstance> AcquireSingleInstance(const std::string& name) {
    const fs::path folder = RuntimeFolder();
    if (folder.empty()) {
        // No private place for the lock: run unguarded rather than refuse to start with a message
        // that another copy runs.
        return std::make_unique<PosixSingleInstance>(Fd(), Fd(), fs::path());
    }
    const std::string base = SafeName(name);
    Fd lock(::open((folder / (base + ".lock")).c_str(), O_RDWR | O_CREAT | O_CLOEXEC | O_NOFOLLOW,
                   0600));
    if (lock.valid() && ::flock(lock.get(), LOCK_EX | LOCK_NB) != 0) {
        if (errno == EWOULDBLOCK) {
            return nullptr;  // another copy holds it
        }
        lock.Reset();
    }
    if (!lock.valid()) {
        return std::make_unique<PosixSingleInstance>(Fd(), Fd(), fs::path());
    }
    const fs::path socketPath = folder / (base + ".sock");
    Fd listener = Listen(socketPath);
    return std::make_unique<PosixSingleInstance>(std::move(lock), std::move(listener), socketPath);
}

Delivery SendToRunningInstance(const std::string& command, const std::string& name,
                               std::chrono::milliseconds answerWait) {
    if (command.empty() || command.size() > kMaxCommandLength ||
        command.find_first_of("\r\n") != std::string::npos) {
        return Delivery::Refused;
    }
    const fs::path folder = RuntimeFolder();
    sockaddr_un address;
    if (folder.empty() || !SocketAddress(folder / (SafeName(name) + ".sock"), address)) {
        return Delivery::NotRunning;
    }
    Fd fd(::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0));
    if (!fd.valid()) {
        return Delivery::NotRunning;
    }
    // Bounds connect (a full backlog) and send (a copy that never reads) alike.
    timeval timeout{kSendTimeoutSeconds, 0};
    ::setsockopt(fd.get(), SOL_SOCKET, SO_SNDTIMEO, &timeout, sizeof timeout);
    if (::connect(fd.get(), reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0) {
        // No socket, or nothing listening on it: no copy runs. A connection that timed out
        // found a copy whose queue of waiting connections is full.
        return errno == EAGAIN || errno == EWOULDBLOCK || errno == EINTR ? Delivery::NoAnswer
                                                                         : Delivery::NotRunning;
    }
    const std::string line = command + "\n";
    size_t sent = 0;
    while (sent < line.size()) {
        // MSG_NOSIGNAL: a copy that closes the connection early gives an error, not SIGPIPE.
        const ssize_t n = ::send(fd.get(), line.data() + sent, line.size() - sent, MSG_NOSIGNAL);
        if (n < 0 && errno == EINTR) {
            continue;
        }
        if (n <= 0) {
            return Delivery::NoAnswer;
        }
        sent += static_cast<size_t>(n);
    }
    // The line waits in the connection until the copy reads it; it answers then. A copy that is
    // busy (applying the sets, or stopped) reads it once it is free.
    const auto deadline = std::chrono::steady_clock::now() + answerWait;
    for (;;) {
        const auto left = std::chrono::duration_cast<std::chrono::milliseconds>(
            deadline - std::chrono::steady_clock::now());
        pollfd readable{fd.get(), POLLIN, 0};
        const int ready =
            ::poll(&readable, 1, static_cast<int>(std::max<long long>(0, left.count())));
        if (ready < 0 && errno == EINTR) {
            continue;
        }
        if (ready <= 0) {
            return Delivery::Queued;
        }
        char answer[8];
        const ssize_t got = ::recv(fd.get(), answer, sizeof answer, 0);
        if (got < 0 && errno == EINTR) {
            continue;
        }
        // An answer means taken. A copy that closed without one dropped a connection it
        // could not read in time: a full line was sent, so it went to a copy that is gone or
        // refused it.
        return got > 0 ? Delivery::Delivered : Delivery::NoAnswer;
    }
}

}  // namespace kickvane::platform
