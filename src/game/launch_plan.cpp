#include "game/launch_plan.h"

#include <system_error>

#include "game/game_managers.h"
#include "platform/filesystem.h"

namespace kickvane::game {

namespace {

constexpr std::string_view kLutrisFlatpakId = "net.lutris.Lutris";
constexpr std::string_view kBottlesFlatpakId = "com.usebottles.bottles";

bool SameFile(const fs::path& a, const fs::path& b) {
    std::error_code error;
    return !a.empty() && !b.empty() && fs::equivalent(a, b, error) && !error;
}

std::string FlatpakNote(bool flatpak) {
    return flatpak ? " (Flatpak)" : "";
}

// Lutris starts its own game: only when its program is this very launcher.
std::optional<LaunchPlan> ThroughLutris(const ManagedPrefix& game, const fs::path& launcher,
                                        const ProgramLookup& findProgram) {
    if (!SameFile(platform::ResolveCaseInsensitive(game.executable), launcher)) {
        return std::nullopt;
    }
    const std::string uri =
        !game.id.empty() ? "lutris:rungameid/" + game.id : "lutris:rungame/" + game.slug;
    const std::string what = "Lutris" + FlatpakNote(game.flatpak) + ": " +
                             (game.name.empty() ? game.slug : game.name) +
                             (game.id.empty() ? "" : " (game " + game.id + ")");
    if (game.flatpak) {
        if (fs::path flatpak = findProgram("flatpak"); !flatpak.empty()) {
            return LaunchPlan{flatpak, {"run", std::string(kLutrisFlatpakId), uri}, {}, {}, what};
        }
    } else if (fs::path lutris = findProgram("lutris"); !lutris.empty()) {
        return LaunchPlan{lutris, {uri}, {}, {}, what};
    }
    return std::nullopt;
}

// Bottles runs any program of a bottle with the bottle's Wine and settings: a program inside the
// bottle, or one added to it from elsewhere.
std::optional<LaunchPlan> ThroughBottles(const ManagedPrefix& bottle, const fs::path& launcher,
                                         const ProgramLookup& findProgram) {
    const bool added = SameFile(platform::ResolveCaseInsensitive(bottle.executable), launcher);
    if (!added && !IsWithinFolder(launcher, CanonicalOrNormal(bottle.prefix))) {
        return std::nullopt;
    }
    const std::vector<std::string> run{"run", "-b", bottle.id, "-e", launcher.string()};
    const std::string what = "Bottles" + FlatpakNote(bottle.flatpak) + ": bottle " + bottle.id;
    if (bottle.flatpak) {
        if (fs::path flatpak = findProgram("flatpak"); !flatpak.empty()) {
            std::vector<std::string> arguments{"run", "--command=bottles-cli",
                                               std::string(kBottlesFlatpakId)};
            arguments.insert(arguments.end(), run.begin(), run.end());
            return LaunchPlan{flatpak, std::move(arguments), {}, {}, what};
        }
    } else if (fs::path cli = findProgram("bottles-cli"); !cli.empty()) {
        return LaunchPlan{cli, run, {}, {}, what};
    }
    return std::nullopt;
}

// The prefix that a manager's configuration names for this very launcher (Lutris's "prefix",
// Heroic's "winePrefix", the bottle of a program added to Bottles): the prefix the manager itself
// would run it in, wherever the launcher lies.
std::optional<fs::path> PrefixNamedFor(const ManagerScan& scan, const fs::path& launcher) {
    for (const ManagedPrefix& entry : scan.entries) {
        if (!entry.prefix.empty() && IsWinePrefix(entry.prefix) &&
            SameFile(platform::ResolveCaseInsensitive(entry.executable), launcher)) {
            return entry.prefix;
        }
    }
    return std::nullopt;
}

}  // namespace

LaunchDecision PlanLaunch(std::string_view gameFolder, const UserFolders& folders,
                          const ProgramLookup& findProgram) {
    LaunchDecision decision;
    const std::string folderText(gameFolder);
    const fs::path launcher = platform::ResolveCaseInsensitive(
        platform::NativePathFromUserText(folderText + "\\Gameloader.exe"));
    if (!platform::IsRegularFile(launcher)) {
        decision.problem = LaunchProblem::LauncherMissing;
        return decision;
    }
    const fs::path workingFolder =
        platform::ResolveCaseInsensitive(platform::NativePathFromUserText(folderText));
    LaunchPlan& plan = decision.plan;
    if (platform::IsNativeExecutable(launcher)) {
        plan = {launcher, {}, {}, workingFolder, "directly"};
        return decision;
    }

    const fs::path canonicalLauncher = CanonicalOrNormal(launcher);
    const ManagerScan scan = ScanGameManagers(folders);
    for (const ManagedPrefix& entry : scan.entries) {
        std::optional<LaunchPlan> managed;
        if (entry.manager == Manager::Lutris) {
            managed = ThroughLutris(entry, canonicalLauncher, findProgram);
        } else if (entry.manager == Manager::Bottles) {
            managed = ThroughBottles(entry, canonicalLauncher, findProgram);
        }
        if (managed) {
            plan = std::move(*managed);
            plan.workingFolder = workingFolder;
            return decision;
        }
    }

    // Wine in the game's own prefix: the one a manager names for this launcher, else the one
    // that holds the folder, else the one whose drive maps it, else (a folder outside every
    // prefix that no manager knows) the one of the environment.
    std::vector<fs::path> known;
    for (const ManagedPrefix& entry : scan.entries) {
        if (!entry.prefix.empty()) {
            known.push_back(entry.prefix);
        }
    }
    std::optional<fs::path> prefix = PrefixNamedFor(scan, canonicalLauncher);
    if (!prefix) {
        prefix = FindPrefixHolding(workingFolder);
    }
    if (!prefix) {
        prefix = FindPrefixMapping(workingFolder, known);
    }
    fs::path wine;
    if (prefix) {
        const fs::path canonicalPrefix = CanonicalOrNormal(*prefix);
        for (const ManagedPrefix& entry : scan.entries) {
            if (!entry.wineProgram.empty() && !entry.prefix.empty() &&
                CanonicalOrNormal(entry.prefix) == canonicalPrefix) {
                wine = entry.wineProgram;
                plan.description = std::string(ManagerName(entry.manager)) + "'s Wine ";
                break;
            }
        }
    }
    if (wine.empty()) {
        wine = findProgram("wine");
        plan.description = "Wine ";
    }
    if (wine.empty()) {
        decision.problem = LaunchProblem::WineMissing;
        return decision;
    }
    plan.program = wine;
    plan.arguments = {launcher.string()};
    plan.workingFolder = workingFolder;
    if (prefix) {
        plan.environment.emplace_back("WINEPREFIX", prefix->string());
        const std::string arch = ReadPrefixArch(*prefix);
        if (arch == "win32" || arch == "win64") {
            plan.environment.emplace_back("WINEARCH", arch);
        }
        plan.description +=
            "in prefix " + prefix->string() + (arch.empty() ? "" : " (" + arch + ")");
    } else {
        plan.description += "in the prefix of the environment";
    }
    return decision;
}

}  // namespace kickvane::game
