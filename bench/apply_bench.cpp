// Measures `kickvane apply`, the whole program as a user runs it, on generated tool folders:
// the first apply against `cp -r` of the same source folders, and a second apply with nothing
// changed against `rsync -a` with nothing to do. Three cases: a tool folder of realistic size with
// every category on; 8,000 small files (4-64 KiB) over the Face, Kit, Boots and Logo sets, where
// the cost per file counts most; and 2,000 small files spread over 400 folders of five, as a
// game's data mostly lies, where the cost per folder counts too.
//
//   apply_bench [WORK_DIR]     (default: a new folder under the system's temporary folder)
//
// WORK_DIR decides the file system measured: give one on a journaled ext4, on tmpfs, and so on.
//
// KICKVANE_BENCH_PROGRAM names another kickvane program to measure (an earlier build, say).
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <random>
#include <set>
#include <string>
#include <vector>

#include "catalog/settings.h"
#include "engine/plan.h"
#include "engine/roots.h"

namespace {

namespace fs = std::filesystem;
using Clock = std::chrono::steady_clock;
using kickvane::catalog::OptionArray;
using kickvane::catalog::PatchSelection;

struct TreeSize {
    int files = 0;
    std::uintmax_t bytes = 0;
};

// Writes `count` files into `folder`: mostly textures of 8-200 KiB, one in twenty of 1-2 MiB,
// as the game's data trees hold them; with `smallOnly`, files of 4-64 KiB.
void Fill(const fs::path& folder, int count, std::mt19937& random, TreeSize& size,
          bool smallOnly = false) {
    fs::create_directories(folder);
    std::uniform_int_distribution<int> small(8 << 10, 200 << 10);
    std::uniform_int_distribution<int> large(1 << 20, 2 << 20);
    std::uniform_int_distribution<int> tiny(4 << 10, 64 << 10);
    std::string data;
    for (int i = 0; i < count; ++i) {
        const int bytes = smallOnly ? tiny(random) : (i % 20 == 19) ? large(random) : small(random);
        data.resize(static_cast<size_t>(bytes));
        for (size_t at = 0; at < data.size(); at += 4096) {
            data[at] = static_cast<char>(random());
        }
        std::ofstream(folder / ("tex_" + std::to_string(i) + ".dds"), std::ios::binary)
            .write(data.data(), bytes);
        ++size.files;
        size.bytes += static_cast<std::uintmax_t>(bytes);
    }
}

TreeSize MakeToolFolder(const fs::path& tool) {
    std::mt19937 random(2026);
    TreeSize size;
    const fs::path base = tool / "data/data2";
    const fs::path zbase = tool / "data/zdata/data2";
    const fs::path extras = tool / "extras";
    for (const char* folder :
         {"ball", "adboard", "ingame_ad", "gui/hud/chatting", "gui/hud/DistanceToNet", "gui/hud/PK",
          "gui/hud/radar", "gui/hud/RefAdvantage", "gui/hud/watermark", "gui/loading", "gui/font",
          "teams/emblems", "cmn", "players/accessories", "net/textures", "gui/hud/Indicator"}) {
        Fill(base / folder, 40, random, size);
    }
    Fill(base / "players/heads/textures", 500, random, size);
    Fill(base / "players/bodies/textures", 200, random, size);
    Fill(base / "players/kit", 400, random, size);
    Fill(base / "pitch/textures", 30, random, size);
    for (const char* folder : {"ball/textures", "pitch", "crowd/textures", "stadiums"}) {
        Fill(zbase / folder, 60, random, size);
    }
    Fill(extras / "Ball/UCL 2011", 20, random, size);
    Fill(extras / "pitch/Caro", 30, random, size);
    Fill(extras / "pitch/_textures", 10, random, size);
    Fill(extras / "adboard/WC 2010", 40, random, size);
    Fill(extras / "scoreboard/ESPN HD/scoreboard", 20, random, size);
    Fill(extras / "scoreboard/ESPN HD/namebar", 20, random, size);
    std::ofstream(base / "pitch/textures/grass_dirt.dds") << "dirt";
    std::ofstream(base / "pitch/textures/grass_pitchlines.dds") << "lines";
    return size;
}

// 8,000 small files over the sets of the Face, Boots, Kit and Logo categories.
TreeSize MakeSmallFilesToolFolder(const fs::path& tool) {
    std::mt19937 random(2027);
    TreeSize size;
    const fs::path base = tool / "data/data2";
    Fill(base / "players/heads/textures", 2500, random, size, true);
    Fill(base / "players/bodies/textures", 1000, random, size, true);
    Fill(base / "players/accessories", 1000, random, size, true);
    Fill(base / "players/kit", 2500, random, size, true);
    Fill(base / "teams/emblems", 1000, random, size, true);
    return size;
}

// 2,000 small files in 400 folders of five, under the Kit category's set.
TreeSize MakeManyFoldersToolFolder(const fs::path& tool) {
    std::mt19937 random(2028);
    TreeSize size;
    const fs::path kits = tool / "data/data2/players/kit";
    for (int team = 0; team < 400; ++team) {
        Fill(kits / ("team_" + std::to_string(team)), 5, random, size, true);
    }
    return size;
}

void MakeGameFolder(const fs::path& game) {
    for (const char* folder :
         {"data2/gui/hud", "data2/players", "data2/pitch", "zdata/data2/crowd"}) {
        fs::create_directories(game / folder);
    }
}

PatchSelection EverythingOn() {
    PatchSelection selection = PatchSelection::Defaults();
    for (int i = 0; i < kickvane::catalog::kCategoryCount; ++i) {
        selection.SetSwitchValue(i, 1);
    }
    // The variants whose sets MakeToolFolder writes under "extras".
    selection.SetOptionValue(OptionArray::Ball, 3, true);        // UCL 2011
    selection.SetOptionValue(OptionArray::Scoreboard, 2, true);  // ESPN HD
    selection.SetOptionValue(OptionArray::Other, 3, true);       // adboard WC 2010
    selection.SetOptionValue(OptionArray::Other, 5, true);       // pitch Caro
    return selection;
}

// Only the categories of the given settings keys on.
PatchSelection OnlyCategories(std::initializer_list<std::string_view> keys) {
    PatchSelection selection = PatchSelection::Defaults();
    for (int i = 0; i < kickvane::catalog::kCategoryCount; ++i) {
        const std::string_view key = kickvane::catalog::Categories()[static_cast<size_t>(i)].key;
        const bool on = std::find(keys.begin(), keys.end(), key) != keys.end();
        selection.SetSwitchValue(i, on ? 1 : 0);
    }
    return selection;
}

double Seconds(Clock::duration elapsed) {
    return std::chrono::duration<double>(elapsed).count();
}

std::string Quote(const fs::path& path) {
    return "'" + path.string() + "'";
}

// Runs a shell command after flushing earlier writes, and returns how long it took.
double TimeCommand(const std::string& command) {
    ::sync();  // start each measurement with no writes of the previous one pending
    const auto start = Clock::now();
    const int status = std::system(command.c_str());
    const double elapsed = Seconds(Clock::now() - start);
    if (!WIFEXITED(status) || WEXITSTATUS(status) != 0) {
        std::cerr << "failed: " << command.substr(0, 300) << '\n';
        std::exit(1);
    }
    return elapsed;
}

// Every source folder and file that the plan copies.
std::vector<fs::path> PlanSources(const fs::path& tool, const PatchSelection& selection) {
    const kickvane::engine::Roots roots = kickvane::engine::ResolveRoots(tool, "/nowhere");
    std::set<fs::path> sources;
    for (const auto& step : kickvane::engine::BuildPlan(selection)) {
        if (step.kind != kickvane::engine::StepKind::MakeFolder) {
            const fs::path source = roots.Resolve(step.source);
            if (fs::exists(source)) {
                sources.insert(source);
            }
        }
    }
    return {sources.begin(), sources.end()};
}

// One `cp -r --parents` of every source into `into`, and one `rsync -a --relative` of them. One
// process each, as the program is one process.
struct Baselines {
    std::string copy;
    std::string sync;
};

Baselines BaselineCommands(const std::vector<fs::path>& sources, const fs::path& into) {
    fs::create_directories(into);
    std::string list;
    for (const fs::path& source : sources) {
        list += " " + Quote(source);
    }
    return {"cp -r --parents" + list + " " + Quote(into),
            "rsync -a --relative" + list + " " + Quote(into.string() + "/")};
}

double TimeApply(const fs::path& tool, const fs::path& game) {
    const char* other = std::getenv("KICKVANE_BENCH_PROGRAM");
    const fs::path program = other && *other ? other : KICKVANE_BINARY;
    return TimeCommand(Quote(program) + " apply --tool-folder " + Quote(tool) + " --game " +
                       Quote(game) + " > /dev/null");
}

double Median(std::vector<double> values) {
    std::sort(values.begin(), values.end());
    return values[values.size() / 2];
}

struct Ratios {
    double first;   // first apply / cp -r
    double second;  // apply with nothing changed / rsync -a with nothing to do
};

Ratios RunCase(const std::string& name, const fs::path& work, const fs::path& tool,
               const TreeSize& size, const PatchSelection& selection, size_t rounds) {
    if (!kickvane::catalog::SaveSettings(tool, {"C:\\Program Files", "F7", selection}).ok()) {
        std::cerr << "cannot write the settings of " << tool << '\n';
        std::exit(1);
    }
    const std::vector<fs::path> sources = PlanSources(tool, selection);
    std::cout << name << ": " << size.files << " files, " << size.bytes / (1 << 20) << " MiB\n";
    std::vector<double> firstRatios;
    std::vector<double> secondRatios;
    for (size_t round = 0; round < rounds; ++round) {
        const fs::path baseline = work / ("cp-" + std::to_string(round));
        const fs::path game = work / ("game-" + std::to_string(round));
        MakeGameFolder(game);
        const Baselines commands = BaselineCommands(sources, baseline);
        // cp and the first apply run back to back, each first in every other round (so the
        // rounds are even): whichever runs second is measured slower, often by far, and on ext4
        // without a journal a new file skips the inodes freed in the last minute, so the one that
        // runs after more deletions (rsync's replaced files, say) pays more per file.
        double copy = 0;
        double first = 0;
        if (round % 2 == 0) {
            copy = TimeCommand(commands.copy);
            first = TimeApply(tool, game);
        } else {
            first = TimeApply(tool, game);
            copy = TimeCommand(commands.copy);
        }
        TimeCommand(commands.sync);  // gives the copies the sources' times
        const double rsync = TimeCommand(commands.sync);
        const double second = TimeApply(tool, game);
        fs::remove_all(baseline);
        fs::remove_all(game);
        std::cout << "  round " << round + 1 << ": cp -r " << copy << " s, first apply " << first
                  << " s; rsync -a (nothing to do) " << rsync << " s, second apply " << second
                  << " s\n";
        // Ratios per round, then their median: each round's pair ran under the same load.
        firstRatios.push_back(first / copy);
        secondRatios.push_back(second / rsync);
    }
    return {Median(firstRatios), Median(secondRatios)};
}

}  // namespace

int main(int argc, char** argv) {
    const fs::path work =
        argc > 1 ? fs::path(argv[1]) / ("kickvane-bench-" + std::to_string(std::random_device()()))
                 : fs::temp_directory_path() /
                       ("kickvane-bench-" + std::to_string(std::random_device()()));
    fs::create_directories(work);
    const fs::path realistic = work / "tool";
    const fs::path small = work / "tool-small";
    const fs::path folders = work / "tool-folders";
    const std::pair<std::string, Ratios> cases[] = {
        {"every category",
         RunCase("every category", work, realistic, MakeToolFolder(realistic), EverythingOn(), 6)},
        {"8,000 small files", RunCase("8,000 small files (Face, Kit, Boots, Logo)", work, small,
                                      MakeSmallFilesToolFolder(small),
                                      OnlyCategories({"Face", "Giay", "Kit", "Logo"}), 6)},
        {"2,000 files in 400 folders",
         RunCase("2,000 small files in 400 folders (Kit)", work, folders,
                 MakeManyFoldersToolFolder(folders), OnlyCategories({"Kit"}), 6)},
    };
    for (const auto& [name, ratios] : cases) {
        std::cout << name << ": first apply / cp -r " << ratios.first
                  << " (goal <= 0.75); second apply / rsync -a " << ratios.second
                  << " (goal <= 0.25)\n";
    }
    fs::remove_all(work);
    return 0;
}
