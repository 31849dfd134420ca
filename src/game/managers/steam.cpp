// Steam runs Windows games in compatdata/<app>/pfx of each of its libraries, which
// libraryfolders.vdf lists.
#include <set>
#include <system_error>

#include "game/formats/vdf.h"
#include "game/managers/scan_context.h"
#include "platform/filesystem.h"

namespace kickvane::game::managers {

namespace {

constexpr std::string_view kFlatpak = ".var/app/com.valvesoftware.Steam";
constexpr std::string_view kSnap = "snap/steam/common";

bool IsNumber(std::string_view text) {
    return !text.empty() && text.find_first_not_of("0123456789") == std::string_view::npos;
}

// The libraries that libraryfolders.vdf lists: "libraryfolders.<n>.path" today, and
// "LibraryFolders.<n>" with the path as the value in files older Steams wrote.
std::vector<fs::path> LibrariesIn(const FlatValues& values) {
    std::vector<fs::path> libraries;
    for (const auto& [key, value] : values.entries()) {
        const size_t dot = key.find('.');
        const std::string_view below =
            dot == std::string::npos ? std::string_view() : std::string_view(key).substr(dot + 1);
        const bool current =
            below.ends_with(".path") && IsNumber(below.substr(0, below.size() - 5));
        if ((current || IsNumber(below)) && !value.empty()) {
            libraries.emplace_back(value);
        }
    }
    return libraries;
}

}  // namespace

void ScanSteam(ScanContext& context) {
    std::vector<fs::path> libraries;
    std::set<fs::path> seen;
    auto addLibrary = [&](const fs::path& library) {
        std::error_code error;
        const fs::path canonical = fs::canonical(library, error);
        if (!error && seen.insert(canonical).second) {
            libraries.push_back(library);
        }
    };
    const fs::path roots[] = {context.folders().dataHome / "Steam",
                              context.Home(".steam/steam"),
                              context.Home(".steam/root"),
                              context.Home(kFlatpak) / "data/Steam",
                              context.Home(kFlatpak) / ".local/share/Steam",
                              context.Home(kSnap) / ".local/share/Steam"};
    for (const fs::path& root : roots) {
        if (!platform::IsDirectory(root)) {
            continue;
        }
        addLibrary(root);
        for (const char* file : {"steamapps/libraryfolders.vdf", "config/libraryfolders.vdf"}) {
            if (!platform::IsRegularFile(root / file)) {
                continue;
            }
            if (const std::optional<FlatValues> values =
                    context.ReadConfig(root / file, ParseVdf)) {
                for (const fs::path& library : LibrariesIn(*values)) {
                    addLibrary(library);
                }
            }
        }
    }
    for (const fs::path& library : libraries) {
        const fs::path compatdata = library / "steamapps/compatdata";
        context.Looked(compatdata);
        for (const fs::path& app : ListFolder(compatdata, "", true)) {
            if (IsWinePrefix(app / "pfx")) {
                ManagedPrefix entry;
                entry.manager = Manager::Steam;
                entry.flatpak = library.string().find(kFlatpak) != std::string::npos;
                entry.prefix = app / "pfx";
                entry.id = app.filename().string();
                entry.name = entry.id;
                entry.configFile = compatdata;
                context.Add(std::move(entry));
            }
        }
    }
}

}  // namespace kickvane::game::managers
