// PlayOnLinux: one prefix per program in ~/.PlayOnLinux/wineprefix.
#include "game/managers/scan_context.h"

namespace kickvane::game::managers {

void ScanPlayOnLinux(ScanContext& context) {
    const fs::path prefixes = context.Home(".PlayOnLinux/wineprefix");
    context.Looked(prefixes);
    for (const fs::path& prefix : ListFolder(prefixes, "", true)) {
        if (IsWinePrefix(prefix)) {
            ManagedPrefix entry;
            entry.manager = Manager::PlayOnLinux;
            entry.prefix = prefix;
            entry.name = prefix.filename().string();
            entry.configFile = prefix;
            context.Add(std::move(entry));
        }
    }
}

}  // namespace kickvane::game::managers
