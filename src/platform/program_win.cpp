// The command line and the console of a windowed (GUI subsystem) program on Windows.
#include <windows.h>
// shellapi.h needs the types of windows.h first.
#include <fcntl.h>
#include <io.h>
#include <shellapi.h>

#include <cstdio>

#include "platform/program.h"
#include "platform/win_text.h"

namespace kickvane::platform {

namespace {

bool IsUsable(DWORD which) {
    const HANDLE handle = GetStdHandle(which);
    return handle != nullptr && handle != INVALID_HANDLE_VALUE &&
           GetFileType(handle) != FILE_TYPE_UNKNOWN;
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
    // A windowed program gets no console of its own. Started from a console (cmd, PowerShell),
    // it joins that one for the streams that were not redirected.
    const bool outUsable = IsUsable(STD_OUTPUT_HANDLE);
    const bool errUsable = IsUsable(STD_ERROR_HANDLE);
    if ((!outUsable || !errUsable) && AttachConsole(ATTACH_PARENT_PROCESS)) {
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
        SetConsoleOutputCP(CP_UTF8);
        SetConsoleCP(CP_UTF8);
    }
    // The text is UTF-8 with "\n" line ends, byte for byte what the same command prints on Linux.
    _setmode(_fileno(stdout), _O_BINARY);
    _setmode(_fileno(stderr), _O_BINARY);
    _setmode(_fileno(stdin), _O_BINARY);
}

bool GameRunsUnderWine() {
    return false;
}

}  // namespace kickvane::platform
