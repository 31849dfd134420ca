// One running copy per user on Windows: a named mutex in the session's namespace marks the running
// copy (the system releases it when the process ends), and a named pipe carries the commands of
// later starts. The pipe is non-blocking, so TakeCommand is polled from a timer; there is no
// descriptor for an event loop.
#include <windows.h>

#include <string_view>
#include <utility>

#include "platform/single_instance.h"

namespace kickvane::platform {

namespace {

constexpr size_t kMaxCommandLength = 256;
// Calls of TakeCommand that a connected client may stay silent before it is dropped.
constexpr int kMaxSilentPolls = 20;

std::wstring SafeName(std::string_view name) {
    std::wstring safe;
    for (char c : name) {
        const bool plain = (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') ||
                           (c >= '0' && c <= '9') || c == '-' || c == '_' || c == '.';
        safe += plain ? static_cast<wchar_t>(c) : L'_';
    }
    return safe.empty() ? std::wstring(L"kickvane") : safe;
}

std::wstring MutexName(const std::string& name) {
    return L"Local\\kickvane-" + SafeName(name);
}

// Pipe names are machine-wide; the session number keeps the copies of different users apart.
std::wstring PipeName(const std::string& name) {
    DWORD session = 0;
    ProcessIdToSessionId(GetCurrentProcessId(), &session);
    return L"\\\\.\\pipe\\kickvane-" + std::to_wstring(session) + L"-" + SafeName(name);
}

class WinSingleInstance final : public SingleInstance {
public:
    WinSingleInstance(HANDLE mutex, std::wstring pipeName)
        : mutex_(mutex), pipeName_(std::move(pipeName)) {
        // FIRST_PIPE_INSTANCE: a pipe of that name made by someone else is refused, not joined.
        pipe_ = CreateNamedPipeW(
            pipeName_.c_str(), PIPE_ACCESS_INBOUND | FILE_FLAG_FIRST_PIPE_INSTANCE,
            PIPE_TYPE_BYTE | PIPE_READMODE_BYTE | PIPE_NOWAIT | PIPE_REJECT_REMOTE_CLIENTS, 1, 0,
            static_cast<DWORD>(kMaxCommandLength * 2), 0, nullptr);
    }
    WinSingleInstance(const WinSingleInstance&) = delete;
    WinSingleInstance& operator=(const WinSingleInstance&) = delete;
    ~WinSingleInstance() override {
        if (pipe_ != INVALID_HANDLE_VALUE) {
            CloseHandle(pipe_);
        }
        if (mutex_ != nullptr) {
            CloseHandle(mutex_);
        }
    }

    int CommandDescriptor() const override { return -1; }

    std::optional<std::string> TakeCommand() override {
        if (pipe_ == INVALID_HANDLE_VALUE) {
            return std::nullopt;
        }
        // In no-wait mode ConnectNamedPipe returns at once: ERROR_PIPE_CONNECTED when a client
        // is there, ERROR_NO_DATA when it wrote and closed already (what it wrote can still be
        // read), ERROR_PIPE_LISTENING when none came.
        if (!ConnectNamedPipe(pipe_, nullptr)) {
            const DWORD error = GetLastError();
            if (error != ERROR_PIPE_CONNECTED && error != ERROR_NO_DATA) {
                return std::nullopt;
            }
        }
        char buffer[kMaxCommandLength + 1];
        DWORD got = 0;
        while (ReadFile(pipe_, buffer, sizeof buffer, &got, nullptr) && got > 0) {
            line_.append(buffer, got);
            if (line_.size() > kMaxCommandLength + 1) {
                break;
            }
        }
        const DWORD error = GetLastError();
        const size_t end = line_.find('\n');
        const bool clientGone = error == ERROR_BROKEN_PIPE || error == ERROR_PIPE_NOT_CONNECTED;
        if (end == std::string::npos && !clientGone && line_.size() <= kMaxCommandLength &&
            ++silentPolls_ < kMaxSilentPolls) {
            return std::nullopt;  // The line is not complete yet; look again at the next call.
        }
        std::string line = end == std::string::npos ? line_ : line_.substr(0, end);
        Disconnect();
        if (!line.empty() && line.back() == '\r') {
            line.pop_back();
        }
        if (line.empty() || line.size() > kMaxCommandLength) {
            return std::nullopt;
        }
        return line;
    }

private:
    void Disconnect() {
        DisconnectNamedPipe(pipe_);
        line_.clear();
        silentPolls_ = 0;
    }

    HANDLE mutex_;
    std::wstring pipeName_;
    HANDLE pipe_ = INVALID_HANDLE_VALUE;
    std::string line_;
    int silentPolls_ = 0;
};

}  // namespace

std::unique_ptr<SingleInstance> AcquireSingleInstance(const std::string& name) {
    HANDLE mutex = CreateMutexW(nullptr, FALSE, MutexName(name).c_str());
    if (mutex != nullptr && GetLastError() == ERROR_ALREADY_EXISTS) {
        CloseHandle(mutex);
        return nullptr;
    }
    // Without a mutex the copy runs unguarded rather than refusing to start.
    return std::make_unique<WinSingleInstance>(mutex, PipeName(name));
}

Delivery SendToRunningInstance(const std::string& command, const std::string& name,
                               std::chrono::milliseconds) {
    if (command.empty() || command.size() > kMaxCommandLength ||
        command.find_first_of("\r\n") != std::string::npos) {
        return Delivery::Refused;
    }
    const std::wstring pipeName = PipeName(name);
    HANDLE pipe = INVALID_HANDLE_VALUE;
    for (int attempt = 0; attempt < 2 && pipe == INVALID_HANDLE_VALUE; ++attempt) {
        pipe = CreateFileW(pipeName.c_str(), GENERIC_WRITE, 0, nullptr, OPEN_EXISTING, 0, nullptr);
        if (pipe == INVALID_HANDLE_VALUE) {
            if (GetLastError() != ERROR_PIPE_BUSY) {
                return Delivery::NotRunning;
            }
            // The copy's one pipe instance holds another sender: it has not taken that yet.
            if (!WaitNamedPipeW(pipeName.c_str(), 2000)) {
                return Delivery::NoAnswer;
            }
        }
    }
    if (pipe == INVALID_HANDLE_VALUE) {
        return Delivery::NoAnswer;
    }
    const std::string line = command + "\n";
    // What was written stays readable after the handle closes; no flush, which would wait for
    // the running copy to read.
    DWORD written = 0;
    const bool ok =
        WriteFile(pipe, line.data(), static_cast<DWORD>(line.size()), &written, nullptr) &&
        written == line.size();
    CloseHandle(pipe);
    return ok ? Delivery::Delivered : Delivery::NoAnswer;
}

}  // namespace kickvane::platform
