// Wine's menu entries start programs with "env WINEPREFIX=... wine ..."; each names a prefix.
#include <set>
#include <system_error>

#include "game/formats/desktop_entry.h"
#include "game/managers/scan_context.h"

namespace kickvane::game::managers {

namespace {

// The prefix that an entry's command line sets: WINEPREFIX="..." or WINEPREFIX=... up to a blank.
std::string PrefixOfCommand(const std::string& exec) {
    const size_t at = exec.find("WINEPREFIX=");
    if (at == std::string::npos) {
        return {};
    }
    std::string prefix = exec.substr(at + 11);
    if (!prefix.empty() && prefix.front() == '"') {
        return prefix.substr(1, prefix.find('"', 1) - 1);
    }
    return prefix.substr(0, prefix.find(' '));
}

}  // namespace

void ScanWineMenus(ScanContext& context) {
    const fs::path menus = context.folders().dataHome / "applications/wine";
    context.Looked(menus);
    std::set<std::string> prefixes;
    std::error_code error;
    fs::recursive_directory_iterator entries(menus, fs::directory_options::skip_permission_denied,
                                             error);
    size_t count = 0;
    for (; !error && entries != fs::recursive_directory_iterator() && count < kMaxFilesPerFolder;
         entries.increment(error), ++count) {
        if (entries.depth() > 6) {
            entries.disable_recursion_pending();
        }
        if (entries->path().extension() != ".desktop") {
            continue;
        }
        const std::optional<std::string> text = context.ReadText(entries->path());
        if (!text) {
            continue;
        }
        const std::string prefix = PrefixOfCommand(DesktopEntryValue(*text, "Exec"));
        if (!prefix.empty() && IsWinePrefix(prefix) && prefixes.insert(prefix).second) {
            ManagedPrefix entry;
            entry.manager = Manager::WineMenu;
            entry.prefix = prefix;
            entry.name = DesktopEntryValue(*text, "Name");
            entry.configFile = entries->path();
            context.Add(std::move(entry));
        }
    }
}

}  // namespace kickvane::game::managers
