// The game search on Windows: the install folders that the registry's uninstall entries record,
// the shortcuts on the desktop and in the Start menu that start a Gameloader.exe, then a bounded
// search of every fixed drive.
#include <windows.h>
// The shell's headers need the types of windows.h first.
#include <knownfolders.h>
#include <objbase.h>
#include <shlobj.h>
#include <shobjidl.h>

#include <algorithm>
#include <array>
#include <chrono>
#include <deque>
#include <set>

#include "game/find_game.h"
#include "game/windows_search.h"
#include "platform/filesystem.h"
#include "platform/text.h"
#include "platform/win_text.h"

namespace kickvane::game {

namespace {

constexpr std::string_view kLauncherName = "Gameloader.exe";
constexpr wchar_t kUninstallKey[] = L"Software\\Microsoft\\Windows\\CurrentVersion\\Uninstall";
constexpr int kDriveDepth = 4;
constexpr int kStartMenuDepth = 6;

// The text of a string value (expanded where it is REG_EXPAND_SZ); empty when missing.
std::wstring ReadString(HKEY key, const wchar_t* name) {
    DWORD type = 0;
    DWORD bytes = 0;
    if (RegQueryValueExW(key, name, nullptr, &type, nullptr, &bytes) != ERROR_SUCCESS ||
        (type != REG_SZ && type != REG_EXPAND_SZ) || bytes == 0 || bytes > 64 * 1024) {
        return {};
    }
    std::wstring value(bytes / sizeof(wchar_t) + 1, L'\0');
    if (RegQueryValueExW(key, name, nullptr, &type, reinterpret_cast<BYTE*>(value.data()),
                         &bytes) != ERROR_SUCCESS) {
        return {};
    }
    value.resize(wcsnlen(value.c_str(), value.size()));
    if (type == REG_EXPAND_SZ) {
        std::wstring expanded(32768, L'\0');
        const DWORD length = ExpandEnvironmentStringsW(value.c_str(), expanded.data(),
                                                       static_cast<DWORD>(expanded.size()));
        if (length > 0 && length <= expanded.size()) {
            expanded.resize(length - 1);
            return expanded;
        }
    }
    return value;
}

std::wstring KnownFolder(REFKNOWNFOLDERID id) {
    PWSTR path = nullptr;
    std::wstring folder;
    if (SUCCEEDED(SHGetKnownFolderPath(id, KF_FLAG_DEFAULT, nullptr, &path))) {
        folder = path;
    }
    CoTaskMemFree(path);
    return folder;
}

bool IsLink(const WIN32_FIND_DATAW& entry) {
    return (entry.dwFileAttributes & FILE_ATTRIBUTE_REPARSE_POINT) != 0;
}

bool IsFolder(const WIN32_FIND_DATAW& entry) {
    return (entry.dwFileAttributes & FILE_ATTRIBUTE_DIRECTORY) != 0;
}

bool IsDotName(const wchar_t* name) {
    return name[0] == L'.' && (name[1] == L'\0' || (name[1] == L'.' && name[2] == L'\0'));
}

// Calls `visit` for every entry of `folder` but "." and ".."; stops when it returns false.
template <typename Visit>
void ForEachEntry(const fs::path& folder, Visit&& visit) {
    WIN32_FIND_DATAW entry;
    const std::wstring pattern = (folder / L"*").wstring();
    HANDLE find = FindFirstFileExW(pattern.c_str(), FindExInfoBasic, &entry, FindExSearchNameMatch,
                                   nullptr, FIND_FIRST_EX_LARGE_FETCH);
    if (find == INVALID_HANDLE_VALUE) {
        return;
    }
    do {
        if (!IsDotName(entry.cFileName) && !visit(entry)) {
            break;
        }
    } while (FindNextFileW(find, &entry));
    FindClose(find);
}

// COM for the shell's link interface, on the thread that searches.
class ComScope {
public:
    ComScope() : ok_(SUCCEEDED(CoInitializeEx(nullptr, COINIT_APARTMENTTHREADED))) {}
    ~ComScope() {
        if (ok_) {
            CoUninitialize();
        }
    }
    ComScope(const ComScope&) = delete;
    ComScope& operator=(const ComScope&) = delete;

private:
    bool ok_;
};

// The program a shortcut starts; empty when it cannot be read. The link's item list comes first:
// it holds the whole name, where the path text that some shells keep beside it is in the ANSI
// code page (Wine's GetPath answers with that one, "?" for each Vietnamese letter).
fs::path LinkTarget(const fs::path& link) {
    IShellLinkW* shellLink = nullptr;
    if (FAILED(CoCreateInstance(CLSID_ShellLink, nullptr, CLSCTX_INPROC_SERVER, IID_IShellLinkW,
                                reinterpret_cast<void**>(&shellLink)))) {
        return {};
    }
    fs::path target;
    IPersistFile* file = nullptr;
    if (SUCCEEDED(shellLink->QueryInterface(IID_IPersistFile, reinterpret_cast<void**>(&file)))) {
        std::array<wchar_t, 32768> path{};
        PIDLIST_ABSOLUTE items = nullptr;
        if (SUCCEEDED(file->Load(link.c_str(), STGM_READ))) {
            if (SUCCEEDED(shellLink->GetIDList(&items)) && items != nullptr &&
                SHGetPathFromIDListEx(items, path.data(), static_cast<DWORD>(path.size()),
                                      GPFIDL_DEFAULT)) {
                target = path.data();
            } else if (shellLink->GetPath(path.data(), static_cast<int>(path.size()), nullptr, 0) ==
                       S_OK) {
                target = path.data();
            }
        }
        CoTaskMemFree(items);
        file->Release();
    }
    shellLink->Release();
    return target;
}

class Finder {
public:
    Finder(const SearchLimits& limits, const std::atomic<bool>* cancel)
        : limits_(limits), cancel_(cancel) {}

    FindOutcome Run() {
        ReadUninstallEntries();
        if (!Cancelled()) {
            const ComScope com;
            ReadShortcuts();
        }
        if (!Cancelled()) {
            SearchDrives();
        }
        outcome_.cancelled = Cancelled();
        return std::move(outcome_);
    }

private:
    bool Cancelled() const { return cancel_ != nullptr && cancel_->load(); }

    static GameSource DriveSource(const fs::path& root) {
        GameSource source;
        source.kind = GameSource::Kind::Drive;
        source.place = platform::PathToUtf8(root);
        return source;
    }

    bool HoldsLauncher(const fs::path& folder) const {
        return !folder.empty() && platform::IsRegularFile(folder / kLauncherName);
    }

    void Add(const fs::path& folder, GameSource source) {
        std::error_code error;
        fs::path canonical = fs::canonical(folder, error);
        if (error) {
            canonical = folder.lexically_normal();
        }
        // Windows names differ in letter case only in spelling: one find per folder.
        if (found_.insert(platform::FoldCase(platform::PathToUtf8(canonical))).second) {
            outcome_.games.push_back({canonical, {}, std::move(source)});
        }
    }

    void ReadUninstallEntries() {
        struct Root {
            HKEY key;
            const char* name;
        };
        for (const Root root : {Root{HKEY_LOCAL_MACHINE, "HKEY_LOCAL_MACHINE"},
                                Root{HKEY_CURRENT_USER, "HKEY_CURRENT_USER"}}) {
            // The 64-bit view, then the 32-bit programs' one (WOW6432Node).
            for (const REGSAM view : {KEY_WOW64_64KEY, KEY_WOW64_32KEY}) {
                const std::string place =
                    std::string(root.name) +
                    (view == KEY_WOW64_32KEY && root.key == HKEY_LOCAL_MACHINE
                         ? "\\Software\\WOW6432Node\\Microsoft\\Windows\\CurrentVersion\\Uninstall"
                         : "\\" + platform::WideToUtf8(kUninstallKey));
                HKEY uninstall = nullptr;
                if (RegOpenKeyExW(root.key, kUninstallKey, 0, KEY_READ | view, &uninstall) !=
                    ERROR_SUCCESS) {
                    continue;
                }
                if (std::find(outcome_.looked.begin(), outcome_.looked.end(), place) ==
                    outcome_.looked.end()) {
                    outcome_.looked.push_back(place);
                }
                ReadEntries(uninstall, place);
                RegCloseKey(uninstall);
            }
        }
    }

    void ReadEntries(HKEY uninstall, const std::string& place) {
        std::array<wchar_t, 256> name{};
        for (DWORD index = 0; !Cancelled(); ++index) {
            DWORD length = static_cast<DWORD>(name.size());
            const LSTATUS status = RegEnumKeyExW(uninstall, index, name.data(), &length, nullptr,
                                                 nullptr, nullptr, nullptr);
            if (status == ERROR_MORE_DATA) {
                continue;  // no uninstall entry has a name that long
            }
            if (status != ERROR_SUCCESS) {
                break;
            }
            HKEY entry = nullptr;
            if (RegOpenKeyExW(uninstall, name.data(), 0, KEY_QUERY_VALUE, &entry) !=
                ERROR_SUCCESS) {
                continue;
            }
            const std::string entryName = platform::WideToUtf8(name.data());
            for (const wchar_t* value : {L"InstallLocation", L"DisplayIcon", L"UninstallString"}) {
                const std::string text = platform::WideToUtf8(ReadString(entry, value));
                const std::string folder = value == std::wstring_view(L"InstallLocation")
                                               ? std::string(platform::TrimBlanks(text, " \t\""))
                                               : FolderOfProgramValue(text);
                const fs::path path = platform::PathFromUtf8(folder);
                if (HoldsLauncher(path)) {
                    GameSource source;
                    source.kind = GameSource::Kind::RegistryEntry;
                    source.place = place + "\\" + entryName;
                    source.value = platform::WideToUtf8(value);
                    Add(path, std::move(source));
                }
            }
            RegCloseKey(entry);
        }
    }

    void ReadShortcuts() {
        const std::array<std::pair<const KNOWNFOLDERID*, int>, 4> folders{{
            {&FOLDERID_Desktop, 1},
            {&FOLDERID_PublicDesktop, 1},
            {&FOLDERID_StartMenu, kStartMenuDepth},
            {&FOLDERID_CommonStartMenu, kStartMenuDepth},
        }};
        for (const auto& [id, depth] : folders) {
            const std::wstring folder = KnownFolder(*id);
            if (folder.empty()) {
                continue;
            }
            outcome_.looked.push_back(platform::WideToUtf8(folder));
            ReadShortcutsIn(folder, depth);
        }
    }

    void ReadShortcutsIn(const fs::path& folder, int depth) {
        ForEachEntry(folder, [&](const WIN32_FIND_DATAW& entry) {
            if (Cancelled()) {
                return false;
            }
            const fs::path path = folder / entry.cFileName;
            if (IsFolder(entry)) {
                if (depth > 1 && !IsLink(entry)) {
                    ReadShortcutsIn(path, depth - 1);
                }
                return true;
            }
            if (!platform::NamesEqualIgnoringCase(platform::PathToUtf8(path.extension()), ".lnk")) {
                return true;
            }
            const fs::path target = LinkTarget(path);
            if (platform::NamesEqualIgnoringCase(platform::PathToUtf8(target.filename()),
                                                 kLauncherName) &&
                platform::IsRegularFile(target)) {
                GameSource source;
                source.kind = GameSource::Kind::Shortcut;
                source.place = platform::PathToUtf8(path);
                Add(target.parent_path(), std::move(source));
            }
            return true;
        });
    }

    void SearchDrives() {
        deadline_ = std::chrono::steady_clock::now() + limits_.maxTime;
        const DWORD drives = GetLogicalDrives();
        for (int letter = 0; letter < 26 && !Cancelled(); ++letter) {
            if ((drives & (1u << letter)) == 0) {
                continue;
            }
            const std::wstring root = {static_cast<wchar_t>(L'A' + letter), L':', L'\\'};
            if (GetDriveTypeW(root.c_str()) != DRIVE_FIXED) {
                continue;
            }
            outcome_.looked.push_back(platform::WideToUtf8(root));
            if (!SearchDrive(root)) {
                outcome_.cutShort = !Cancelled();
                if (outcome_.cutShort) {
                    outcome_.skipped.push_back(
                        {fs::path(root), SkipReason::SearchCut, entriesSeen_, {}, {}});
                }
                break;
            }
        }
    }

    // Breadth-first below the drive's root, its preferred top folders first. False when the time,
    // the number of entries or a cancel stopped it.
    bool SearchDrive(const fs::path& root) {
        if (HoldsLauncher(root)) {
            Add(root, DriveSource(root));
        }
        std::vector<std::string> top;
        bool within = VisitFolders(
            root, [&](const std::wstring& name) { top.push_back(platform::WideToUtf8(name)); });
        std::deque<std::pair<fs::path, int>> queue;
        for (const std::string& name : OrderDriveFolders(std::move(top))) {
            queue.emplace_back(root / platform::PathFromUtf8(name), 1);
        }
        while (within && !queue.empty()) {
            auto [folder, depth] = std::move(queue.front());
            queue.pop_front();
            bool holds = false;
            within = ForEachWithin(folder, [&](const WIN32_FIND_DATAW& entry) {
                if (IsFolder(entry)) {
                    if (depth < kDriveDepth && !IsLink(entry)) {
                        queue.emplace_back(folder / entry.cFileName, depth + 1);
                    }
                } else if (!holds && platform::NamesEqualIgnoringCase(
                                         platform::WideToUtf8(entry.cFileName), kLauncherName)) {
                    holds = true;
                }
            });
            if (holds) {
                Add(folder, DriveSource(root));
            }
        }
        return within;
    }

    template <typename Visit>
    bool VisitFolders(const fs::path& folder, Visit&& visit) {
        return ForEachWithin(folder, [&](const WIN32_FIND_DATAW& entry) {
            if (IsFolder(entry) && !IsLink(entry)) {
                visit(entry.cFileName);
            }
        });
    }

    // ForEachEntry within the limits; false when one was reached.
    template <typename Visit>
    bool ForEachWithin(const fs::path& folder, Visit&& visit) {
        bool within = true;
        ForEachEntry(folder, [&](const WIN32_FIND_DATAW& entry) {
            if (++entriesSeen_ > limits_.maxEntries || Cancelled() ||
                ((entriesSeen_ & 255) == 0 && std::chrono::steady_clock::now() > deadline_)) {
                within = false;
                return false;
            }
            visit(entry);
            return true;
        });
        return within && std::chrono::steady_clock::now() <= deadline_;
    }

    const SearchLimits& limits_;
    const std::atomic<bool>* cancel_;
    std::chrono::steady_clock::time_point deadline_;
    size_t entriesSeen_ = 0;
    FindOutcome outcome_;
    std::set<std::string> found_;
};

}  // namespace

FindOutcome FindGame(const UserFolders&, const SearchLimits& limits,
                     const std::atomic<bool>* cancel) {
    return Finder(limits, cancel).Run();
}

}  // namespace kickvane::game
