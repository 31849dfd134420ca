// Measures the patch application on a generated tool folder of realistic size against `cp -r` of
// the same source folders, and a second application with nothing changed against the first.
//
//   apply_bench [WORK_DIR]     (default: a new folder under the system's temporary folder)
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

#include "engine/apply.h"

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
// as the game's data trees hold them.
void Fill(const fs::path& folder, int count, std::mt19937& random, TreeSize& size) {
    fs::create_directories(folder);
    std::uniform_int_distribution<int> small(8 << 10, 200 << 10);
    std::uniform_int_distribution<int> large(1 << 20, 2 << 20);
    std::string data;
    for (int i = 0; i < count; ++i) {
        const int bytes = (i % 20 == 19) ? large(random) : small(random);
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

void MakeGameFolder(const fs::path& game) {
    for (const char* folder :
         {"data2/gui/hud", "data2/players", "data2/pitch", "zdata/data2/crowd"}) {
        fs::create_directories(game / folder);
    }
}

PatchSelection EverythingOn() {
    PatchSelection selection = PatchSelection::Defaults();
    for (int i = 0; i < kickvane::catalog::kCategoryCount; ++i) {
        selection.setSwitchValue(i, 1);
    }
    selection.setOptionValue(OptionArray::Ball, 3, true);
    selection.setOptionValue(OptionArray::Other, 3, true);
    selection.setOptionValue(OptionArray::Other, 5, true);
    selection.setOptionValue(OptionArray::Scoreboard, 2, true);
    return selection;
}

double Seconds(Clock::duration elapsed) {
    return std::chrono::duration<double>(elapsed).count();
}

// `cp -r` of every source folder and file that the plan copies, each into its own fresh target.
double TimeCopyBaseline(const fs::path& tool, const fs::path& into,
                        const PatchSelection& selection) {
    const kickvane::engine::Roots roots = kickvane::engine::ResolveRoots(tool, into.string());
    std::set<fs::path> sources;
    for (const auto& step : kickvane::engine::BuildPlan(selection)) {
        if (step.kind != kickvane::engine::StepKind::MakeFolder) {
            const fs::path source = roots.Resolve(step.source);
            if (fs::exists(source)) {
                sources.insert(source);
            }
        }
    }
    fs::create_directories(into);
    ::sync();  // start each measurement with no writes of the previous one pending
    std::string command = "set -e";
    int n = 0;
    for (const fs::path& source : sources) {
        command +=
            "; cp -r '" + source.string() + "' '" + (into / std::to_string(n++)).string() + "'";
    }
    const auto start = Clock::now();
    const int status = std::system(command.c_str());
    const double elapsed = Seconds(Clock::now() - start);
    if (!WIFEXITED(status) || WEXITSTATUS(status) != 0) {
        std::cerr << "cp -r failed\n";
        std::exit(1);
    }
    return elapsed;
}

double TimeApply(const fs::path& tool, const fs::path& game, const PatchSelection& selection) {
    ::sync();
    const auto start = Clock::now();
    const auto outcome = kickvane::engine::ApplyPatches(tool, game.string(), selection);
    const double elapsed = Seconds(Clock::now() - start);
    if (outcome.message) {
        std::cerr << outcome.message->text << '\n';
    }
    if (outcome.stopped() || !outcome.Failures().empty()) {
        for (const auto& failure : outcome.Failures()) {
            std::cerr << "failed: " << kickvane::engine::Describe(failure.step) << ": "
                      << failure.reason << '\n';
        }
        std::exit(1);
    }
    return elapsed;
}

double Median(std::vector<double> values) {
    std::sort(values.begin(), values.end());
    return values[values.size() / 2];
}

}  // namespace

int main(int argc, char** argv) {
    const fs::path work = argc > 1
                              ? fs::path(argv[1])
                              : fs::temp_directory_path() /
                                    ("kickvane-bench-" + std::to_string(std::random_device()()));
    fs::create_directories(work);
    const fs::path tool = work / "tool";
    const TreeSize size = MakeToolFolder(tool);
    const PatchSelection selection = EverythingOn();
    std::cout << "tool folder: " << size.files << " files, " << size.bytes / (1 << 20) << " MiB\n";

    constexpr size_t kRounds = 5;
    std::vector<double> copyTimes;
    std::vector<double> firstTimes;
    std::vector<double> secondTimes;
    for (size_t round = 0; round < kRounds; ++round) {
        const fs::path baseline = work / ("cp-" + std::to_string(round));
        const fs::path game = work / ("game-" + std::to_string(round));
        MakeGameFolder(game);
        copyTimes.push_back(TimeCopyBaseline(tool, baseline, selection));
        firstTimes.push_back(TimeApply(tool, game, selection));
        secondTimes.push_back(TimeApply(tool, game, selection));
        fs::remove_all(baseline);
        fs::remove_all(game);
        std::cout << "round " << round + 1 << ": cp -r " << copyTimes.back() << " s, first apply "
                  << firstTimes.back() << " s, second apply " << secondTimes.back() << " s\n";
    }
    // Ratios per round, then their median: each round's pair ran under the same machine load.
    std::vector<double> firstRatios;
    std::vector<double> secondRatios;
    for (size_t round = 0; round < kRounds; ++round) {
        firstRatios.push_back(firstTimes[round] / copyTimes[round]);
        secondRatios.push_back(secondTimes[round] / firstTimes[round]);
    }
    std::cout << "first apply / cp -r:        " << Median(firstRatios) << "  (goal <= 1.15)\n"
              << "second apply / first apply: " << Median(secondRatios) << "  (goal <= 0.10)\n";
    fs::remove_all(work);
    return 0;
}
