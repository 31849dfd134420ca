// Makes or removes a shortcut in the user's Start menu for the Wine test of the game search,
// through the shell's link interface as Windows' own tools do.
// Usage: make_shortcut create NAME TARGET   (prints the shortcut's path)
//        make_shortcut remove NAME
#include <windows.h>
// The shell's headers need the types of windows.h first.
#include <knownfolders.h>
#include <objbase.h>
#include <shellapi.h>
#include <shlobj.h>
#include <shobjidl.h>

#include <cstdio>
#include <string>

#include "utf8.h"

int main() {
    int count = 0;
    LPWSTR* args = CommandLineToArgvW(GetCommandLineW(), &count);
    if (args == nullptr || count < 3) {
        return 2;
    }
    const std::wstring action = args[1];
    PWSTR programs = nullptr;
    if (FAILED(SHGetKnownFolderPath(FOLDERID_Programs, KF_FLAG_CREATE, nullptr, &programs))) {
        return 1;
    }
    const std::wstring link = std::wstring(programs) + L"\\" + args[2] + L".lnk";
    CoTaskMemFree(programs);
    if (action == L"remove") {
        return DeleteFileW(link.c_str()) ? 0 : 1;
    }
    if (action != L"create" || count < 4) {
        return 2;
    }
    CoInitializeEx(nullptr, COINIT_APARTMENTTHREADED);
    IShellLinkW* shellLink = nullptr;
    IPersistFile* file = nullptr;
    const bool saved =
        SUCCEEDED(CoCreateInstance(CLSID_ShellLink, nullptr, CLSCTX_INPROC_SERVER, IID_IShellLinkW,
                                   reinterpret_cast<void**>(&shellLink))) &&
        SUCCEEDED(shellLink->SetPath(args[3])) &&
        SUCCEEDED(shellLink->QueryInterface(IID_IPersistFile, reinterpret_cast<void**>(&file))) &&
        SUCCEEDED(file->Save(link.c_str(), TRUE));
    if (file != nullptr) {
        file->Release();
    }
    if (shellLink != nullptr) {
        shellLink->Release();
    }
    CoUninitialize();
    if (saved) {
        std::printf("%s\n", Utf8(link).c_str());
    }
    LocalFree(args);
    return saved ? 0 : 1;
}
