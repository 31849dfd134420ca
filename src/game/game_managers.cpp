#include "game/game_managers.h"

#include <algorithm>
#include <system_error>

#include "game/managers/scan_context.h"
#include "game/read_config.h"

namespace kickvane::game {

namespace managers {

std::optional<std::string> ScanContext::ReadText(const fs::path& file) {
    SkippedFile skipped;
    std::optional<std::string> text = ReadConfigText(file, kMaxConfigBytes, skipped);
    if (!text) {
        scan_.skipped.push_back(std::move(skipped));
    }
    return text;
}

std::optional<FlatValues> ScanContext::ReadConfig(const fs::path& file,
                                                  Parsed (*parse)(std::string_view)) {
    const std::optional<std::string> text = ReadText(file);
    if (!text) {
        return std::nullopt;
    }
    Parsed parsed = parse(*text);
    if (!parsed.ok()) {
        SkippedFile skipped{file, SkipReason::Malformed, parsed.line, {}, parsed.problem};
        if (parsed.fault == ParseFault::NotText) {
            skipped.reason = SkipReason::NotText;
        } else if (parsed.fault == ParseFault::TooComplex) {
            skipped.reason = SkipReason::TooComplex;
        }
        scan_.skipped.push_back(std::move(skipped));
        return std::nullopt;
    }
    return std::move(parsed.values);
}

void ScanContext::AddPlainPrefix(const fs::path& prefix, Manager manager, std::string name) {
    if (prefix.empty()) {
        return;
    }
    Looked(prefix);
    if (IsWinePrefix(prefix)) {
        ManagedPrefix entry;
        entry.manager = manager;
        entry.prefix = prefix;
        entry.name = std::move(name);
        entry.configFile = prefix;
        Add(std::move(entry));
    }
}

std::vector<fs::path> ListFolder(const fs::path& folder, std::string_view suffix, bool folders) {
    std::vector<fs::path> found;
    std::error_code error;
    fs::directory_iterator entries(folder, fs::directory_options::skip_permission_denied, error);
    for (; !error && entries != fs::directory_iterator() && found.size() < kMaxFilesPerFolder;
         entries.increment(error)) {
        std::error_code typeError;
        const bool isFolder = entries->is_directory(typeError);
        if (isFolder == folders && entries->path().filename().string().ends_with(suffix)) {
            found.push_back(entries->path());
        }
    }
    std::sort(found.begin(), found.end());
    return found;
}

}  // namespace managers

ManagerScan ScanGameManagers(const UserFolders& folders) {
    managers::ScanContext context(folders);
    context.AddPlainPrefix(folders.winePrefix, Manager::Wine, "WINEPREFIX");
    if (folders.home.empty()) {
        return context.Take();  // no home folder (HOME unset): nothing more to read
    }
    context.AddPlainPrefix(folders.home / ".wine", Manager::Wine, "~/.wine");
    managers::ScanLutris(context);
    managers::ScanBottles(context);
    managers::ScanHeroic(context);
    managers::ScanPlayOnLinux(context);
    managers::ScanSteam(context);
    managers::ScanWineMenus(context);
    return context.Take();
}

}  // namespace kickvane::game
