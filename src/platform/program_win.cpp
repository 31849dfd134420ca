// The command line and the console of a windowed (GUI subsystem) program on Windows.
#include <windows.h>
// shellapi.h needs the types of windows.h first.
#include <fcntl.h>
#include <io.h>
#include <shellapi.h>

#include <algorithm>
#include <array>
#include <cstdio>
#include <cstring>
#include <iostream>
#include <streambuf>

#include "platform/program.h"
#include "platform/win_text.h"

namespace kickvane::platform {

namespace {

bool IsUsable(DWORD which) {
    const HANDLE handle = GetStdHandle(which);
    return handle != nullptr && handle != INVALID_HANDLE_VALUE &&
           GetFileType(handle) != FILE_TYPE_UNKNOWN;
}

bool IsConsole(HANDLE handle) {
    DWORD mode = 0;
    return handle != nullptr && handle != INVALID_HANDLE_VALUE && GetConsoleMode(handle, &mode);
}

// Writes the UTF-8 text of a stream to a console as UTF-16 (WriteConsoleW): the console shows
// every letter whatever its code page, which a byte-wise write would read in that code page. A
// sequence cut at the end of the buffer waits there for its remaining bytes.
class ConsoleBuffer : public std::streambuf {
public:
    explicit ConsoleBuffer(HANDLE console) : console_(console) {
        setp(buffer_.data(), buffer_.data() + buffer_.size());
    }

protected:
    int_type overflow(int_type ch) override {
        if (!WriteComplete()) {
            return traits_type::eof();
        }
        if (!traits_type::eq_int_type(ch, traits_type::eof())) {
            *pptr() = traits_type::to_char_type(ch);
            pbump(1);
        }
        return traits_type::not_eof(ch);
    }

    int sync() override { return WriteComplete() ? 0 : -1; }

private:
    bool WriteComplete() {
        const std::string_view pending(pbase(), static_cast<size_t>(pptr() - pbase()));
        const size_t complete = CompleteUtf8Length(pending);
        const std::wstring wide = Utf8ToWide(pending.substr(0, complete));
        bool ok = true;
        for (size_t done = 0; done < wide.size();) {
            DWORD written = 0;
            const auto chunk = static_cast<DWORD>(std::min<size_t>(wide.size() - done, 8192));
            if (!WriteConsoleW(console_, wide.data() + done, chunk, &written, nullptr) ||
                written == 0) {
                ok = false;
                break;
            }
            done += written;
        }
        const size_t rest = pending.size() - complete;
        std::memmove(buffer_.data(), pending.data() + complete, rest);
        setp(buffer_.data(), buffer_.data() + buffer_.size());
        pbump(static_cast<int>(rest));
        return ok;
    }

    HANDLE console_;
    std::array<char, 4096> buffer_{};
};

// Points `stream` at the console when `file` (its C counterpart) writes to one. The buffer lives
// until the program's end, when the standard streams are flushed for the last time.
void WriteToConsoleIfOne(std::ostream& stream, FILE* file) {
    const auto handle = reinterpret_cast<HANDLE>(_get_osfhandle(_fileno(file)));
    if (IsConsole(handle)) {
        stream.flush();
        stream.rdbuf(new ConsoleBuffer(handle));
    }
}

}  // namespace

std::vector<std::string> ProgramArguments(int, char**) {
    std::vector<std::string> arguments;
    int count = 0;
    LPWSTR* wide = CommandLineToArgvW(GetCommandLineW(), &count);
    if (wide == nullptr) {
        return arguments;
    }
    for (int i = 1; i < count; ++i) {
        arguments.push_back(WideToUtf8(wide[i]));
    }
    LocalFree(wide);
    return arguments;
}

void UseParentConsole() {
    // A windowed program gets no console of its own. Started from a console (cmd, PowerShell, or
    // the console companion that passes its own streams on), it joins that one; the streams that
    // were not redirected then write there.
    const bool outUsable = IsUsable(STD_OUTPUT_HANDLE);
    const bool errUsable = IsUsable(STD_ERROR_HANDLE);
    if (GetConsoleWindow() == nullptr && AttachConsole(ATTACH_PARENT_PROCESS)) {
        if (!outUsable) {
            std::freopen("CONOUT$", "w", stdout);
        }
        if (!errUsable) {
            std::freopen("CONOUT$", "w", stderr);
        }
        if (!IsUsable(STD_INPUT_HANDLE)) {
            std::freopen("CONIN$", "r", stdin);
        }
    }
    if (GetConsoleWindow() != nullptr) {
        // Typed input arrives as UTF-8; output does not depend on the code page (below).
        SetConsoleCP(CP_UTF8);
    }
    // The text is UTF-8 with "\n" line ends, byte for byte what the same command prints on Linux.
    _setmode(_fileno(stdout), _O_BINARY);
    _setmode(_fileno(stderr), _O_BINARY);
    _setmode(_fileno(stdin), _O_BINARY);
    WriteToConsoleIfOne(std::cout, stdout);
    WriteToConsoleIfOne(std::cerr, stderr);
}

bool GameRunsUnderWine() {
    return false;
}

}  // namespace kickvane::platform
