#include "game/wine_prefix.h"

#include <deque>
#include <fstream>
#include <system_error>

#include "game/formats/wine_registry.h"
#include "game/read_config.h"
#include "platform/filesystem.h"

namespace kickvane::game {

namespace {

constexpr std::string_view kUninstallKeys[] = {
    "Software\\Microsoft\\Windows\\CurrentVersion\\Uninstall\\",
    "Software\\Wow6432Node\\Microsoft\\Windows\\CurrentVersion\\Uninstall\\",
};

// "C:\Games\FIFA\Gameloader.exe,0" or "\"C:\...\icon.ico\"": the folder of the file named.
std::string FolderOfIconValue(std::string value) {
    if (value.size() >= 2 && value.front() == '"') {
        const size_t close = value.find('"', 1);
        value = value.substr(1, close == std::string::npos ? std::string::npos : close - 1);
    } else if (const size_t comma = value.rfind(','); comma != std::string::npos) {
        value.resize(comma);
    }
    const size_t slash = value.find_last_of("\\/");
    return slash == std::string::npos ? std::string() : value.substr(0, slash);
}

}  // namespace

fs::path CanonicalOrNormal(const fs::path& path) {
    std::error_code error;
    fs::path canonical = fs::weakly_canonical(path, error);
    return error ? path.lexically_normal() : canonical;
}

bool IsWithinFolder(const fs::path& folder, const fs::path& parent) {
    if (parent.empty()) {
        return false;
    }
    auto f = folder.begin();
    for (auto p = parent.begin(); p != parent.end(); ++p, ++f) {
        if (p->empty()) {
            continue;  // a trailing separator
        }
        if (f == folder.end() || *f != *p) {
            return false;
        }
    }
    return true;
}

UserFolders UserFolders::FromEnvironment() {
    UserFolders folders;
    folders.home = platform::GetEnv("HOME");
    const std::string config = platform::GetEnv("XDG_CONFIG_HOME");
    const std::string data = platform::GetEnv("XDG_DATA_HOME");
    // Relative values are invalid by the base directory rules and are ignored.
    folders.configHome =
        !config.empty() && config.front() == '/' ? fs::path(config) : folders.home / ".config";
    folders.dataHome =
        !data.empty() && data.front() == '/' ? fs::path(data) : folders.home / ".local/share";
    folders.winePrefix = platform::GetEnv("WINEPREFIX");
    return folders;
}

bool IsWinePrefix(const fs::path& folder) {
    return platform::IsDirectory(folder / "drive_c") &&
           (platform::IsRegularFile(folder / "system.reg") ||
            platform::IsRegularFile(folder / "user.reg"));
}

std::optional<fs::path> FindPrefixHolding(const fs::path& folder) {
    fs::path current = CanonicalOrNormal(folder);
    while (true) {
        if (IsWinePrefix(current)) {
            return current;
        }
        if (!current.has_relative_path()) {
            return std::nullopt;
        }
        current = current.parent_path();
    }
}

std::optional<fs::path> FindPrefixMapping(const fs::path& folder,
                                          const std::vector<fs::path>& prefixes) {
    const fs::path target = CanonicalOrNormal(folder);
    for (const fs::path& prefix : prefixes) {
        std::error_code error;
        fs::directory_iterator drives(prefix / "dosdevices", error);
        for (; !error && drives != fs::directory_iterator(); drives.increment(error)) {
            const std::string name = platform::FoldCase(drives->path().filename().string());
            if (name.size() != 2 || name[1] != ':' || name == "z:") {
                continue;
            }
            const fs::path mapped = CanonicalOrNormal(drives->path());
            if (mapped.has_relative_path() && IsWithinFolder(target, mapped)) {
                return prefix;
            }
        }
    }
    return std::nullopt;
}

std::string ReadPrefixArch(const fs::path& prefix) {
    for (const char* name : {"system.reg", "user.reg", "userdef.reg"}) {
        // The arch line sits in the header; the first few kilobytes are enough.
        if (!platform::IsRegularFile(prefix / name)) {
            continue;
        }
        std::ifstream in(prefix / name, std::ios::binary);
        std::string head(4096, '\0');
        in.read(head.data(), static_cast<std::streamsize>(head.size()));
        head.resize(static_cast<size_t>(in.gcount()));
        if (std::string arch = RegistryArch(head); !arch.empty()) {
            return arch;
        }
    }
    return {};
}

std::vector<RecordedInstall> ReadRecordedInstalls(const fs::path& prefix,
                                                  std::vector<SkippedFile>& skipped) {
    std::vector<RecordedInstall> installs;
    const std::vector<std::string> keys(std::begin(kUninstallKeys), std::end(kUninstallKeys));
    for (const char* name : {"system.reg", "user.reg"}) {
        const fs::path file = prefix / name;
        if (!platform::IsRegularFile(file)) {
            continue;
        }
        SkippedFile unread;
        const std::optional<std::string> text = ReadConfigText(file, kMaxRegistryBytes, unread);
        if (!text) {
            skipped.push_back(std::move(unread));
            continue;
        }
        const RegistryFile registry = ParseWineRegistry(*text, keys);
        if (!registry.problem.empty()) {
            skipped.push_back({file, SkipReason::NotRegistry, 0, {}, registry.problem});
            continue;
        }
        for (const RegistryValue& value : registry.values) {
            const bool location = platform::NamesEqualIgnoringCase(value.name, "InstallLocation");
            const bool icon = platform::NamesEqualIgnoringCase(value.name, "DisplayIcon");
            if (!location && !icon) {
                continue;
            }
            const std::string folder = location ? value.value : FolderOfIconValue(value.value);
            if (folder.empty()) {
                continue;
            }
            installs.push_back({folder, name, value.key, value.name});
        }
    }
    return installs;
}

TreeSearch SearchTreeForFile(const fs::path& root, std::string_view fileName,
                             const SearchLimits& limits, const std::atomic<bool>* cancel) {
    TreeSearch search;
    const auto deadline = std::chrono::steady_clock::now() + limits.maxTime;
    std::deque<std::pair<fs::path, int>> queue{{root, 0}};
    while (!queue.empty()) {
        auto [folder, depth] = std::move(queue.front());
        queue.pop_front();
        std::error_code error;
        fs::directory_iterator entries(folder, fs::directory_options::skip_permission_denied,
                                       error);
        bool found = false;
        for (; !error && entries != fs::directory_iterator(); entries.increment(error)) {
            if (++search.entriesSeen > limits.maxEntries ||
                (cancel != nullptr && cancel->load(std::memory_order_relaxed)) ||
                ((search.entriesSeen & 255) == 0 && std::chrono::steady_clock::now() > deadline)) {
                search.cutShort = true;
                return search;
            }
            const fs::directory_entry& entry = *entries;
            std::error_code typeError;
            if (entry.is_symlink(typeError)) {
                if (!found && entry.is_regular_file(typeError) &&
                    platform::NamesEqualIgnoringCase(entry.path().filename().string(), fileName)) {
                    found = true;
                    search.folders.push_back(folder);
                }
                continue;
            }
            if (entry.is_directory(typeError)) {
                const bool systemFolder =
                    depth == 0 &&
                    platform::NamesEqualIgnoringCase(entry.path().filename().string(), "windows");
                if (depth + 1 < limits.maxDepth && !systemFolder) {
                    queue.emplace_back(entry.path(), depth + 1);
                }
            } else if (!found && platform::NamesEqualIgnoringCase(entry.path().filename().string(),
                                                                  fileName)) {
                found = true;
                search.folders.push_back(folder);
            }
        }
        if (std::chrono::steady_clock::now() > deadline) {
            search.cutShort = !queue.empty();
            return search;
        }
    }
    return search;
}

}  // namespace kickvane::game
