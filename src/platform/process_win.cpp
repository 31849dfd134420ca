// Starting programs on Windows.
#include <windows.h>

#include <array>
#include <cwchar>
#include <fstream>
#include <string_view>
#include <system_error>

#include "platform/filesystem.h"
#include "platform/process.h"
#include "platform/win_text.h"

namespace kickvane::platform {

namespace fs = std::filesystem;

namespace {

// Appends one argument quoted so that the program's command-line parser (CommandLineToArgvW and
// the C runtime) gives it back unchanged: backslashes are literal except before a quote.
void AppendQuoted(std::wstring& line, const std::wstring& argument) {
    if (!argument.empty() && argument.find_first_of(L" \t\n\v\"") == std::wstring::npos) {
        line += argument;
        return;
    }
    line += L'"';
    size_t backslashes = 0;
    for (wchar_t c : argument) {
        if (c == L'\\') {
            ++backslashes;
            continue;
        }
        if (c == L'"') {
            line.append(backslashes * 2 + 1, L'\\');
        } else {
            line.append(backslashes, L'\\');
        }
        backslashes = 0;
        line += c;
    }
    line.append(backslashes * 2, L'\\');
    line += L'"';
}

// The tool's environment block with the additions put in (a variable named there is replaced;
// names compare without regard to case, as Windows does). Empty when there is nothing to add, so
// the program inherits the tool's block unchanged.
std::wstring EnvironmentBlockWith(const EnvironmentAdditions& additions) {
    std::wstring block;
    if (additions.empty()) {
        return block;
    }
    auto sameName = [](std::wstring_view a, std::wstring_view b) {
        return CompareStringOrdinal(a.data(), static_cast<int>(a.size()), b.data(),
                                    static_cast<int>(b.size()), TRUE) == CSTR_EQUAL;
    };
    if (wchar_t* current = GetEnvironmentStringsW()) {
        for (const wchar_t* entry = current; *entry != L'\0'; entry += wcslen(entry) + 1) {
            const std::wstring_view text(entry);
            // Entries such as "=C:=C:\\" name a drive's folder; their name starts after the '='.
            const std::wstring_view name = text.substr(0, text.find(L'=', 1));
            bool replaced = false;
            for (const auto& [addedName, value] : additions) {
                replaced = replaced || sameName(Utf8ToWide(addedName), name);
            }
            if (!replaced) {
                block.append(text);
                block += L'\0';
            }
        }
        FreeEnvironmentStringsW(current);
    }
    for (const auto& [name, value] : additions) {
        block += Utf8ToWide(name) + L"=" + Utf8ToWide(value);
        block += L'\0';
    }
    block += L'\0';
    return block;
}

}  // namespace

namespace {

// Polls the process's handle without waiting; the handle is closed when the watch goes, which
// leaves the program running on its own.
class WindowsWatch final : public ProgramWatch {
public:
    explicit WindowsWatch(HANDLE process) : process_(process) {
        state_.kind = ProgramState::Kind::Running;
    }
    ~WindowsWatch() override { Close(); }
    WindowsWatch(const WindowsWatch&) = delete;
    WindowsWatch& operator=(const WindowsWatch&) = delete;

    ProgramState Poll() override {
        if (process_ == nullptr || WaitForSingleObject(process_, 0) != WAIT_OBJECT_0) {
            return state_;
        }
        DWORD code = 0;
        if (GetExitCodeProcess(process_, &code)) {
            state_.kind = ProgramState::Kind::Exited;
            state_.code = static_cast<int>(code);
        }
        Close();
        return state_;
    }

private:
    void Close() {
        if (process_ != nullptr) {
            CloseHandle(process_);
            process_ = nullptr;
        }
    }

    HANDLE process_;
    ProgramState state_;
};

std::unique_ptr<ProgramWatch> NotRun(const fs::path& program, std::error_code code) {
    return NotRunWatch({FailedAction::Run, program, code, {}});
}

}  // namespace

std::unique_ptr<ProgramWatch> StartWatched(const fs::path& program,
                                           const std::vector<std::string>& arguments,
                                           const fs::path& workingFolder, bool minimised,
                                           const EnvironmentAdditions& environment) {
    std::error_code error;
    const fs::path absoluteProgram = fs::absolute(program, error);
    if (program.empty() || error) {
        return NotRun(program, error ? error : std::make_error_code(std::errc::invalid_argument));
    }
    std::wstring commandLine;
    AppendQuoted(commandLine, absoluteProgram.wstring());
    for (const std::string& argument : arguments) {
        commandLine += L' ';
        AppendQuoted(commandLine, Utf8ToWide(argument));
    }

    STARTUPINFOW startup{};
    startup.cb = sizeof startup;
    if (minimised) {
        startup.dwFlags = STARTF_USESHOWWINDOW;
        startup.wShowWindow = SW_SHOWMINIMIZED;
    }
    PROCESS_INFORMATION process{};
    const std::wstring folder = workingFolder.wstring();
    std::wstring environmentBlock = EnvironmentBlockWith(environment);
    if (!CreateProcessW(absoluteProgram.c_str(), commandLine.data(), nullptr, nullptr, FALSE,
                        CREATE_NEW_PROCESS_GROUP | CREATE_UNICODE_ENVIRONMENT,
                        environmentBlock.empty() ? nullptr : environmentBlock.data(),
                        folder.empty() ? nullptr : folder.c_str(), &startup, &process)) {
        return NotRun(program,
                      std::error_code(static_cast<int>(GetLastError()), std::system_category()));
    }
    CloseHandle(process.hThread);
    return std::make_unique<WindowsWatch>(process.hProcess);
}

fs::path FindOnPath(const std::string& name) {
    if (name.empty()) {
        return {};
    }
    const std::wstring wide = Utf8ToWide(name);
    std::array<wchar_t, MAX_PATH> found{};
    const DWORD size = SearchPathW(nullptr, wide.c_str(), L".exe", static_cast<DWORD>(found.size()),
                                   found.data(), nullptr);
    if (size == 0 || size >= found.size()) {
        return {};
    }
    return fs::path(found.data());
}

bool IsNativeExecutable(const fs::path& file) {
    std::error_code error;
    if (!fs::is_regular_file(file, error)) {
        return false;
    }
    std::ifstream in(file, std::ios::binary);
    std::array<char, 2> head{};
    return in.read(head.data(), head.size()) && head[0] == 'M' && head[1] == 'Z';
}

}  // namespace kickvane::platform
