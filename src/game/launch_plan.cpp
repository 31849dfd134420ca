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

// Lutris starts its own game: only when its program is this very launcher.
std::optional<LaunchPlan> ThroughLutris(const ManagedPrefix& game, const fs::path& launcher,
                                        const ProgramLookup& findProgram) {
    if (!SameFile(platform::ResolveCaseInsensitive(game.executable), launcher)) {
        return std::nullopt;
    }
    const std::string uri =
        !game.id.empty() ? "lutris:rungameid/" + game.id : "lutris:rungame/" + game.slug;
    LaunchPlan plan;
    plan.way = LaunchWay::Lutris;
    plan.flatpak = game.flatpak;
    plan.gameName = game.name.empty() ? game.slug : game.name;
    plan.gameId = game.id;
    if (game.flatpak) {
        plan.program = findProgram("flatpak");
        plan.arguments = {"run", std::string(kLutrisFlatpakId), uri};
    } else {
        plan.program = findProgram("lutris");
        plan.arguments = {uri};
    }
    if (plan.program.empty()) {
        return std::nullopt;
    }
    return plan;
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
    LaunchPlan plan;
    plan.way = LaunchWay::Bottles;
    plan.flatpak = bottle.flatpak;
    plan.gameId = bottle.id;
    if (bottle.flatpak) {
        plan.program = findProgram("flatpak");
        plan.arguments = {"run", "--command=bottles-cli", std::string(kBottlesFlatpakId)};
        plan.arguments.insert(plan.arguments.end(), run.begin(), run.end());
    } else {
        plan.program = findProgram("bottles-cli");
        plan.arguments = run;
    }
    if (plan.program.empty()) {
        return std::nullopt;
    }
    return plan;
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
        plan.program = launcher;
        plan.workingFolder = workingFolder;
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
                plan.wineKeptBy = entry.manager;
                break;
            }
        }
    }
    if (wine.empty()) {
        wine = findProgram("wine");
    }
    if (wine.empty()) {
        decision.problem = LaunchProblem::WineMissing;
        return decision;
    }
    plan.way = LaunchWay::Wine;
    plan.program = wine;
    plan.arguments = {launcher.string()};
    plan.workingFolder = workingFolder;
    if (prefix) {
        plan.environment.emplace_back("WINEPREFIX", prefix->string());
        const std::string arch = ReadPrefixArch(*prefix);
        if (arch == "win32" || arch == "win64") {
            plan.environment.emplace_back("WINEARCH", arch);
        }
        plan.prefix = *prefix;
        plan.arch = arch;
    }
    return decision;
}

}  // namespace kickvane::game
