// The console companion of the windowed program on Windows. cmd and PowerShell run kickvane.com
// before kickvane.exe when the user types "kickvane", so a subcommand runs as a console program:
// the prompt waits for it and pipes get all of its output. The companion starts kickvane.exe from
// its own folder with the same arguments and its own standard streams, waits for it and ends with
// its exit code; kickvane.exe joins the console and does the work.
#include <windows.h>
// shellapi.h needs the types of windows.h first.
#include <shellapi.h>

#include <string>

namespace {

// The command line after the program's own name, as the system passed it.
const wchar_t* ArgumentsOf(const wchar_t* commandLine) {
    const wchar_t* at = commandLine;
    if (*at == L'"') {
        ++at;
        while (*at != L'\0' && *at != L'"') {
            ++at;
        }
        if (*at == L'"') {
            ++at;
        }
    } else {
        while (*at != L'\0' && *at != L' ' && *at != L'\t') {
            ++at;
        }
    }
    return at;
}

// Without a subcommand the window opens; the prompt does not wait for it to close.
bool OpensTheWindow() {
    int count = 0;
    LPWSTR* arguments = CommandLineToArgvW(GetCommandLineW(), &count);
    const bool window = arguments == nullptr || count < 2 ||
                        std::wstring(arguments[1]).starts_with(L"--tool-folder");
    LocalFree(arguments);
    return window;
}

std::wstring WindowedProgram() {
    std::wstring path(MAX_PATH, L'\0');
    for (;;) {
        const DWORD length =
            GetModuleFileNameW(nullptr, path.data(), static_cast<DWORD>(path.size()));
        if (length == 0) {
            return L"kickvane.exe";
        }
        if (length < path.size()) {
            path.resize(length);
            break;
        }
        path.resize(path.size() * 2);
    }
    const size_t dot = path.find_last_of(L'.');
    const size_t slash = path.find_last_of(L"\\/");
    if (dot != std::wstring::npos && (slash == std::wstring::npos || dot > slash)) {
        path.resize(dot);
    }
    return path + L".exe";
}

void PrintError(const std::wstring& text) {
    const HANDLE err = GetStdHandle(STD_ERROR_HANDLE);
    DWORD mode = 0;
    DWORD written = 0;
    if (GetConsoleMode(err, &mode)) {
        WriteConsoleW(err, text.data(), static_cast<DWORD>(text.size()), &written, nullptr);
        return;
    }
    const int bytes = WideCharToMultiByte(CP_UTF8, 0, text.data(), static_cast<int>(text.size()),
                                          nullptr, 0, nullptr, nullptr);
    std::string utf8(static_cast<size_t>(bytes), '\0');
    WideCharToMultiByte(CP_UTF8, 0, text.data(), static_cast<int>(text.size()), utf8.data(), bytes,
                        nullptr, nullptr);
    WriteFile(err, utf8.data(), static_cast<DWORD>(utf8.size()), &written, nullptr);
}

// Ctrl+C reaches every program of the console; the one in front decides, the companion waits.
BOOL WINAPI KeepWaiting(DWORD) {
    return TRUE;
}

}  // namespace

int main() {
    const std::wstring program = WindowedProgram();
    std::wstring commandLine = L"\"" + program + L"\"" + ArgumentsOf(GetCommandLineW());
    STARTUPINFOW startup{};
    startup.cb = sizeof startup;
    startup.dwFlags = STARTF_USESTDHANDLES;
    startup.hStdInput = GetStdHandle(STD_INPUT_HANDLE);
    startup.hStdOutput = GetStdHandle(STD_OUTPUT_HANDLE);
    startup.hStdError = GetStdHandle(STD_ERROR_HANDLE);
    PROCESS_INFORMATION process{};
    if (!CreateProcessW(program.c_str(), commandLine.data(), nullptr, nullptr, TRUE, 0, nullptr,
                        nullptr, &startup, &process)) {
        const DWORD error = GetLastError();
        PrintError(L"kickvane: không chạy được " + program + L": lỗi hệ thống (mã " +
                   std::to_wstring(error) + L")\n");
        return 2;
    }
    CloseHandle(process.hThread);
    if (OpensTheWindow()) {
        CloseHandle(process.hProcess);
        return 0;
    }
    SetConsoleCtrlHandler(KeepWaiting, TRUE);
    WaitForSingleObject(process.hProcess, INFINITE);
    DWORD code = 1;
    GetExitCodeProcess(process.hProcess, &code);
    CloseHandle(process.hProcess);
    return static_cast<int>(code);
}
