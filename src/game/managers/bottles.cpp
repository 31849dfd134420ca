// Bottles: each bottle is a prefix with bottle.yml (its name, its runner, the programs added to
// it, which may lie outside the bottle); a bottle kept elsewhere leaves a placeholder.yml whose
// "Path" names its real folder.
#include "game/formats/yaml.h"
#include "game/managers/scan_context.h"
#include "platform/filesystem.h"

namespace kickvane::game::managers {

namespace {

constexpr std::string_view kFlatpak = ".var/app/com.usebottles.bottles";

// `bottles` is ".../bottles/bottles"; the runners lie beside it.
void ScanInstall(ScanContext& context, const fs::path& bottles, bool flatpak) {
    context.Looked(bottles);
    const fs::path runners = bottles.parent_path() / "runners";
    for (const fs::path& folder : ListFolder(bottles, "", true)) {
        fs::path bottle = folder;
        if (platform::IsRegularFile(folder / "placeholder.yml")) {
            const std::optional<FlatValues> placeholder =
                context.ReadConfig(folder / "placeholder.yml", ParseYaml);
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
            context.ReadConfig(bottle / "bottle.yml", ParseYaml);
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
        const std::string runner = values->Find("Runner").value_or("");
        if (!runner.empty() && runner.find('/') == std::string::npos &&
            platform::IsRegularFile(runners / runner / "bin/wine")) {
            entry.wineProgram = runners / runner / "bin/wine";
        }
        context.Add(entry);
        // Programs added to the bottle: one entry each, run in the same bottle.
        for (const auto& [key, value] : values->entries()) {
            if (key.starts_with("External_Programs.") && key.ends_with(".path") && !value.empty()) {
                ManagedPrefix program = entry;
                program.executable = value;
                context.Add(std::move(program));
            }
        }
    }
}

}  // namespace

void ScanBottles(ScanContext& context) {
    ScanInstall(context, context.folders().dataHome / "bottles/bottles", false);
    ScanInstall(context, context.Home(kFlatpak) / "data/bottles/bottles", true);
}

}  // namespace kickvane::game::managers
