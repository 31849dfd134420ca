#include "game/game_managers.h"

#include <algorithm>
#include <set>
#include <system_error>

#include "game/formats/config_formats.h"
#include "platform/filesystem.h"

namespace kickvane::game {

namespace {

constexpr std::string_view kLutrisFlatpak = ".var/app/net.lutris.Lutris";
constexpr std::string_view kBottlesFlatpak = ".var/app/com.usebottles.bottles";
constexpr std::string_view kHeroicFlatpak = ".var/app/com.heroicgameslauncher.hgl";
constexpr std::string_view kSteamFlatpak = ".var/app/com.valvesoftware.Steam";
constexpr std::string_view kSteamSnap = "snap/steam/common";
constexpr size_t kMaxFilesPerFolder = 2000;

// The entries of a folder whose names end with `suffix` (all when empty), sorted, at most
// kMaxFilesPerFolder of them.
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

class Scanner {
public:
    explicit Scanner(const UserFolders& folders) : folders_(folders) {}

    ManagerScan Run() {
        AddPlainPrefix(folders_.winePrefix, Manager::Wine, "WINEPREFIX");
        if (folders_.home.empty()) {
            return std::move(scan_);  // no home folder (HOME unset): nothing more to read
        }
        AddPlainPrefix(folders_.home / ".wine", Manager::Wine, "~/.wine");
        ScanLutris(folders_.configHome / "lutris", folders_.dataHome / "lutris", false);
        ScanLutris(Home(kLutrisFlatpak) / "config/lutris", Home(kLutrisFlatpak) / "data/lutris",
                   true);
        ScanBottles(folders_.dataHome / "bottles/bottles", false);
        ScanBottles(Home(kBottlesFlatpak) / "data/bottles/bottles", true);
        ScanHeroic(folders_.configHome / "heroic", false);
        ScanHeroic(Home(kHeroicFlatpak) / "config/heroic", true);
        ScanPlayOnLinux(folders_.home / ".PlayOnLinux/wineprefix");
        ScanSteam();
        ScanWineMenus(folders_.dataHome / "applications/wine");
        return std::move(scan_);
    }

private:
    fs::path Home(std::string_view relative) const { return folders_.home / relative; }

    // Reads and parses one configuration file; a problem is recorded and gives nullopt.
    template <typename Parse>
    std::optional<FlatValues> ReadConfig(const fs::path& file, Parse parse) {
        std::string problem;
        const std::optional<std::string> text = ReadBoundedFile(file, kMaxConfigBytes, &problem);
        if (!text) {
            scan_.skipped.push_back(file.string() + ": " + problem);
            return std::nullopt;
        }
        Parsed parsed = parse(*text);
        if (!parsed.ok()) {
            scan_.skipped.push_back(file.string() + ": " + parsed.problem);
            return std::nullopt;
        }
        return std::move(parsed.values);
    }

    void AddPlainPrefix(const fs::path& prefix, Manager manager, std::string name) {
        if (prefix.empty()) {
            return;
        }
        scan_.looked.push_back(prefix.string());
        if (IsWinePrefix(prefix)) {
            ManagedPrefix entry;
            entry.manager = manager;
            entry.prefix = prefix;
            entry.name = std::move(name);
            entry.configFile = prefix;
            scan_.entries.push_back(std::move(entry));
        }
    }

    // Lutris: one YAML file per game ("game: exe", "game: prefix"), the game's number in pga.db.
    void ScanLutris(const fs::path& configFolder, const fs::path& dataFolder, bool flatpak) {
        const fs::path database = dataFolder / "pga.db";
        std::set<std::string> seen;
        for (const fs::path& games : {configFolder / "games", dataFolder / "games"}) {
            scan_.looked.push_back(games.string());
            for (const fs::path& file : ListFolder(games, ".yml", false)) {
                const std::string configName = file.stem().string();
                if (!seen.insert(configName).second) {
                    continue;
                }
                const std::optional<FlatValues> values = ReadConfig(file, ParseYamlSubset);
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
                    // Lutris names the file "<slug>-<time stamp>"; the slug alone still starts it.
                    const size_t dash = configName.rfind('-');
                    const bool stamped =
                        dash != std::string::npos && dash + 1 < configName.size() &&
                        configName.find_first_not_of("0123456789", dash + 1) == std::string::npos;
                    entry.slug = stamped ? configName.substr(0, dash) : configName;
                    entry.name = values->Find("name").value_or(entry.slug);
                }
                if (!entry.prefix.empty() || !entry.executable.empty()) {
                    scan_.entries.push_back(std::move(entry));
                }
            }
        }
    }

    // Bottles: each bottle is a prefix with bottle.yml; a bottle kept elsewhere leaves a
    // placeholder.yml whose "Path" names its real folder.
    void ScanBottles(const fs::path& bottles, bool flatpak) {
        scan_.looked.push_back(bottles.string());
        for (const fs::path& folder : ListFolder(bottles, "", true)) {
            fs::path bottle = folder;
            if (platform::IsRegularFile(folder / "placeholder.yml")) {
                const std::optional<FlatValues> placeholder =
                    ReadConfig(folder / "placeholder.yml", ParseYamlSubset);
                const std::string path =
                    placeholder ? placeholder->Find("Path").value_or("") : std::string();
                if (path.empty()) {
                    continue;
                }
                bottle = path;
            }
            if (!platform::IsRegularFile(bottle / "bottle.yml")) {
                continue;
            }
            const std::optional<FlatValues> values =
                ReadConfig(bottle / "bottle.yml", ParseYamlSubset);
            if (!values) {
                continue;
            }
            ManagedPrefix entry;
            entry.manager = Manager::Bottles;
            entry.flatpak = flatpak;
            entry.configFile = bottle / "bottle.yml";
            entry.prefix = bottle;
            entry.id = values->Find("Name").value_or(bottle.filename().string());
            entry.name = entry.id;
            scan_.entries.push_back(entry);
            // Programs added to the bottle: one entry each, in the same prefix.
            for (const auto& [key, value] : values->entries()) {
                if (key.starts_with("External_Programs.") && key.ends_with(".path")) {
                    ManagedPrefix program = entry;
                    program.executable = value;
                    scan_.entries.push_back(std::move(program));
                }
            }
        }
    }

    // Heroic: GamesConfig/<app>.json holds each game's prefix and Wine; sideloaded programs are
    // listed in sideload_apps/library.json.
    void ScanHeroic(const fs::path& heroic, bool flatpak) {
        scan_.looked.push_back(heroic.string());
        std::vector<ManagedPrefix> games;
        for (const fs::path& file : ListFolder(heroic / "GamesConfig", ".json", false)) {
            const std::optional<FlatValues> values = ReadConfig(file, ParseJson);
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
            const fs::path wine = values->Find(app + ".wineVersion.bin").value_or("");
            if (!wine.empty() && platform::IsRegularFile(wine)) {
                entry.wineProgram = wine;
            }
            if (!entry.prefix.empty()) {
                games.push_back(std::move(entry));
            }
        }
        const fs::path library = heroic / "sideload_apps/library.json";
        if (platform::IsRegularFile(library)) {
            if (const std::optional<FlatValues> values = ReadConfig(library, ParseJson)) {
                for (int i = 0;; ++i) {
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
        scan_.entries.insert(scan_.entries.end(), games.begin(), games.end());
    }

    void ScanPlayOnLinux(const fs::path& prefixes) {
        scan_.looked.push_back(prefixes.string());
        for (const fs::path& prefix : ListFolder(prefixes, "", true)) {
            if (IsWinePrefix(prefix)) {
                ManagedPrefix entry;
                entry.manager = Manager::PlayOnLinux;
                entry.prefix = prefix;
                entry.name = prefix.filename().string();
                entry.configFile = prefix;
                scan_.entries.push_back(std::move(entry));
            }
        }
    }

    // Steam runs Windows games in compatdata/<app>/pfx of each of its libraries.
    void ScanSteam() {
        std::vector<fs::path> libraries;
        std::set<fs::path> seen;
        auto addLibrary = [&](const fs::path& library) {
            std::error_code error;
            const fs::path canonical = fs::canonical(library, error);
            if (!error && seen.insert(canonical).second) {
                libraries.push_back(library);
            }
        };
        const fs::path roots[] = {folders_.dataHome / "Steam",
                                  Home(".steam/steam"),
                                  Home(".steam/root"),
                                  Home(kSteamFlatpak) / "data/Steam",
                                  Home(kSteamFlatpak) / ".local/share/Steam",
                                  Home(kSteamSnap) / ".local/share/Steam"};
        for (const fs::path& root : roots) {
            if (!platform::IsDirectory(root)) {
                continue;
            }
            addLibrary(root);
            for (const char* file : {"steamapps/libraryfolders.vdf", "config/libraryfolders.vdf"}) {
                if (!platform::IsRegularFile(root / file)) {
                    continue;
                }
                if (const std::optional<FlatValues> values = ReadConfig(root / file, ParseVdf)) {
                    for (const auto& [key, value] : values->entries()) {
                        if (key.ends_with(".path")) {
                            addLibrary(value);
                        }
                    }
                }
            }
        }
        for (const fs::path& library : libraries) {
            const fs::path compatdata = library / "steamapps/compatdata";
            scan_.looked.push_back(compatdata.string());
            for (const fs::path& app : ListFolder(compatdata, "", true)) {
                if (IsWinePrefix(app / "pfx")) {
                    ManagedPrefix entry;
                    entry.manager = Manager::Steam;
                    entry.flatpak = library.string().find(kSteamFlatpak) != std::string::npos;
                    entry.prefix = app / "pfx";
                    entry.id = app.filename().string();
                    entry.name = entry.id;
                    entry.configFile = compatdata;
                    scan_.entries.push_back(std::move(entry));
                }
            }
        }
    }

    // Wine's menu entries start programs with "env WINEPREFIX=... wine ..."; each names a prefix.
    void ScanWineMenus(const fs::path& menus) {
        scan_.looked.push_back(menus.string());
        std::set<std::string> prefixes;
        std::error_code error;
        fs::recursive_directory_iterator entries(
            menus, fs::directory_options::skip_permission_denied, error);
        size_t count = 0;
        for (;
             !error && entries != fs::recursive_directory_iterator() && count < kMaxFilesPerFolder;
             entries.increment(error), ++count) {
            if (entries.depth() > 6) {
                entries.disable_recursion_pending();
            }
            if (entries->path().extension() != ".desktop") {
                continue;
            }
            std::string problem;
            const std::optional<std::string> text =
                ReadBoundedFile(entries->path(), kMaxConfigBytes, &problem);
            if (!text) {
                scan_.skipped.push_back(entries->path().string() + ": " + problem);
                continue;
            }
            const std::string exec = DesktopEntryValue(*text, "Exec");
            const size_t at = exec.find("WINEPREFIX=");
            if (at == std::string::npos) {
                continue;
            }
            std::string prefix = exec.substr(at + 11);
            if (!prefix.empty() && prefix.front() == '"') {
                prefix = prefix.substr(1, prefix.find('"', 1) - 1);
            } else {
                prefix = prefix.substr(0, prefix.find(' '));
            }
            if (IsWinePrefix(prefix) && prefixes.insert(prefix).second) {
                ManagedPrefix entry;
                entry.manager = Manager::WineMenu;
                entry.prefix = prefix;
                entry.name = DesktopEntryValue(*text, "Name");
                entry.configFile = entries->path();
                scan_.entries.push_back(std::move(entry));
            }
        }
    }

    const UserFolders& folders_;
    ManagerScan scan_;
};

}  // namespace

std::string_view ManagerName(Manager manager) {
    switch (manager) {
        case Manager::Wine:
            return "Wine";
        case Manager::Lutris:
            return "Lutris";
        case Manager::Bottles:
            return "Bottles";
        case Manager::Heroic:
            return "Heroic";
        case Manager::PlayOnLinux:
            return "PlayOnLinux";
        case Manager::Steam:
            return "Steam";
        case Manager::WineMenu:
            break;
    }
    return "Wine menu";
}

ManagerScan ScanGameManagers(const UserFolders& folders) {
    return Scanner(folders).Run();
}

}  // namespace kickvane::game
