// A stand-in for the game's Gameloader.exe: writes beside itself, in "started.txt" (UTF-8), the
// folder it was started in and whether it was asked to show its first window minimised, then
// exits without showing anything. With a file "fail.txt" beside it, it exits at once with code 3
// instead, as a launcher that cannot start the game does.
#include <windows.h>

#include <string>

#include "utf8.h"

int WINAPI WinMain(HINSTANCE, HINSTANCE, LPSTR, int) {
    wchar_t folder[MAX_PATH * 4];
    const DWORD folderLength = GetCurrentDirectoryW(MAX_PATH * 4, folder);
    wchar_t self[MAX_PATH * 4];
    const DWORD selfLength = GetModuleFileNameW(nullptr, self, MAX_PATH * 4);
    if (folderLength == 0 || selfLength == 0) {
        return 1;
    }
    std::wstring record(self, selfLength);
    record.erase(record.find_last_of(L'\\') + 1);
    if (GetFileAttributesW((record + L"fail.txt").c_str()) != INVALID_FILE_ATTRIBUTES) {
        return 3;
    }
    record += L"started.txt";

    STARTUPINFOW startup{};
    startup.cb = sizeof startup;
    GetStartupInfoW(&startup);
    const WORD show = startup.wShowWindow;
    const bool minimised =
        (startup.dwFlags & STARTF_USESHOWWINDOW) != 0 &&
        (show == SW_SHOWMINNOACTIVE || show == SW_MINIMIZE || show == SW_SHOWMINIMIZED);

    const std::string text = Utf8(std::wstring(folder, folderLength)) + "\n" +
                             (minimised ? "minimised" : "shown " + std::to_string(show)) + "\n";
    // Written under a temporary name and renamed, so a reader never sees half a record.
    const std::wstring partial = record + L".part";
    HANDLE file = CreateFileW(partial.c_str(), GENERIC_WRITE, 0, nullptr, CREATE_ALWAYS,
                              FILE_ATTRIBUTE_NORMAL, nullptr);
    if (file == INVALID_HANDLE_VALUE) {
        return 1;
    }
    DWORD written = 0;
    const BOOL ok =
        WriteFile(file, text.data(), static_cast<DWORD>(text.size()), &written, nullptr);
    CloseHandle(file);
    return ok && MoveFileExW(partial.c_str(), record.c_str(), MOVEFILE_REPLACE_EXISTING) ? 0 : 1;
}
