// Heroic: GamesConfig/<app>.json holds each game's prefix and Wine (or Proton); sideloaded
// programs are listed in sideload_apps/library.json.
#include <algorithm>

#include "game/formats/json.h"
#include "game/managers/scan_context.h"
#include "platform/filesystem.h"

namespace kickvane::game::managers {

namespace {

constexpr std::string_view kFlatpak = ".var/app/com.heroicgameslauncher.hgl";

// The Wine program for a game's settings. Proton's "bin" is its own launch script, which wants
// Steam's environment; the Wine build inside Proton's folder runs the game instead.
fs::path WineOf(const FlatValues& values, const std::string& app, bool proton) {
    const fs::path bin = values.Find(app + ".wineVersion.bin").value_or("");
    if (bin.empty()) {
        return {};
    }
    if (!proton) {
        return platform::IsRegularFile(bin) ? bin : fs::path();
    }
    for (const char* inside : {"files/bin/wine", "dist/bin/wine"}) {
        if (platform::IsRegularFile(bin.parent_path() / inside)) {
            return bin.parent_path() / inside;
        }
    }
    return {};
}

void ScanInstall(ScanContext& context, const fs::path& heroic, bool flatpak) {
    context.Looked(heroic);
    std::vector<ManagedPrefix> games;
    for (const fs::path& file : ListFolder(heroic / "GamesConfig", ".json", false)) {
        const std::optional<FlatValues> values = context.ReadConfig(file, ParseJson);
        if (!values) {
            continue;
        }
        const std::string app = file.stem().string();
        ManagedPrefix entry;
        entry.manager = Manager::Heroic;
        entry.flatpak = flatpak;
        entry.configFile = file;
        entry.id = app;
        entry.name = app;
        entry.prefix = values->Find(app + ".winePrefix").value_or("");
        // Proton keeps the Wine prefix in "pfx" below the folder that Heroic names.
        const bool proton = values->Find(app + ".wineVersion.type") == "proton";
        if (!entry.prefix.empty() && (proton || !IsWinePrefix(entry.prefix)) &&
            IsWinePrefix(entry.prefix / "pfx")) {
            entry.prefix /= "pfx";
        }
        entry.wineProgram = WineOf(*values, app, proton);
        if (!entry.prefix.empty()) {
            games.push_back(std::move(entry));
        }
    }
    const fs::path library = heroic / "sideload_apps/library.json";
    if (platform::IsRegularFile(library)) {
        if (const std::optional<FlatValues> values = context.ReadConfig(library, ParseJson)) {
            for (size_t i = 0; i < kMaxFilesPerFolder; ++i) {
                const std::string item = "games." + std::to_string(i);
                const std::optional<std::string> app = values->Find(item + ".app_name");
                if (!app) {
                    break;
                }
                const std::string exe = values->Find(item + ".install.executable").value_or("");
                auto known =
                    std::find_if(games.begin(), games.end(),
                                 [&](const ManagedPrefix& game) { return game.id == *app; });
                if (known != games.end()) {
                    known->executable = exe;
                    known->name = values->Find(item + ".title").value_or(known->name);
                } else if (!exe.empty()) {
                    ManagedPrefix entry;
                    entry.manager = Manager::Heroic;
                    entry.flatpak = flatpak;
                    entry.configFile = library;
                    entry.id = *app;
                    entry.name = values->Find(item + ".title").value_or(*app);
                    entry.executable = exe;
                    games.push_back(std::move(entry));
                }
            }
        }
    }
    for (ManagedPrefix& game : games) {
        context.Add(std::move(game));
    }
}

}  // namespace

void ScanHeroic(ScanContext& context) {
    ScanInstall(context, context.folders().configHome / "heroic", false);
    ScanInstall(context, context.Home(kFlatpak) / "config/heroic", true);
}

}  // namespace kickvane::game::managers
