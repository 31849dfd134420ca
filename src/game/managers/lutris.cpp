// Lutris: one YAML file per game ("game: exe", "game: prefix", "wine: version"), the game's
// number in its database pga.db.
#include <set>

#include "game/formats/yaml.h"
#include "game/managers/scan_context.h"
#include "platform/filesystem.h"

namespace kickvane::game::managers {

namespace {

constexpr std::string_view kFlatpak = ".var/app/net.lutris.Lutris";

// Lutris names a game's file "<slug>-<time stamp>"; the slug alone still starts it.
std::string SlugOfConfigName(const std::string& configName) {
    const size_t dash = configName.rfind('-');
    const bool stamped = dash != std::string::npos && dash + 1 < configName.size() &&
                         configName.find_first_not_of("0123456789", dash + 1) == std::string::npos;
    return stamped ? configName.substr(0, dash) : configName;
}

void ScanInstall(ScanContext& context, const fs::path& configFolder, const fs::path& dataFolder,
                 bool flatpak) {
    const fs::path database = dataFolder / "pga.db";
    std::set<std::string> seen;
    for (const fs::path& games : {configFolder / "games", dataFolder / "games"}) {
        context.Looked(games);
        for (const fs::path& file : ListFolder(games, ".yml", false)) {
            const std::string configName = file.stem().string();
            if (!seen.insert(configName).second) {
                continue;
            }
            const std::optional<FlatValues> values = context.ReadConfig(file, ParseYaml);
            if (!values) {
                continue;
            }
            ManagedPrefix entry;
            entry.manager = Manager::Lutris;
            entry.flatpak = flatpak;
            entry.configFile = file;
            entry.prefix = values->Find("game.prefix").value_or("");
            const fs::path exe = values->Find("game.exe").value_or("");
            entry.executable = exe.is_relative() && !exe.empty() && !entry.prefix.empty()
                                   ? entry.prefix / exe
                                   : exe;
            const std::string version = values->Find("wine.version").value_or("");
            if (!version.empty() && version.find('/') == std::string::npos) {
                const fs::path wine = dataFolder / "runners/wine" / version / "bin/wine";
                if (platform::IsRegularFile(wine)) {
                    entry.wineProgram = wine;
                }
            }
            std::string problem;
            if (const auto row = ReadLutrisGame(database, configName, &problem)) {
                entry.id = row->id;
                entry.slug = row->slug;
                entry.name = row->name;
            } else {
                entry.slug = SlugOfConfigName(configName);
                entry.name = values->Find("name").value_or(entry.slug);
            }
            if (!entry.prefix.empty() || !entry.executable.empty()) {
                context.Add(std::move(entry));
            }
        }
    }
}

}  // namespace

void ScanLutris(ScanContext& context) {
    const UserFolders& folders = context.folders();
    ScanInstall(context, folders.configHome / "lutris", folders.dataHome / "lutris", false);
    ScanInstall(context, context.Home(kFlatpak) / "config/lutris",
                context.Home(kFlatpak) / "data/lutris", true);
}

}  // namespace kickvane::game::managers
