// Measures the game search on a generated home with a big Wine prefix (a Windows folder and a
// program tree of about 120,000 entries, the game deep inside it) against `find -iname` over the
// same drive_c, and prints the ratio (median of five rounds each).
//
//   find_game_bench [WORK_DIR]     (default: a new folder under the system's temporary folder)
#include <algorithm>
#include <chrono>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <random>
#include <string>
#include <vector>

#include "game/find_game.h"

namespace {

namespace fs = std::filesystem;
using Clock = std::chrono::steady_clock;

void Touch(const fs::path& file) {
    std::ofstream(file) << 'x';
}

// Folders `width` wide and `depth` deep with `files` files each.
void Tree(const fs::path& root, int width, int depth, int files) {
    fs::create_directories(root);
    for (int f = 0; f < files; ++f) {
        Touch(root / ("file" + std::to_string(f) + ".dll"));
    }
    if (depth > 0) {
        for (int w = 0; w < width; ++w) {
            Tree(root / ("Folder " + std::to_string(w)), width, depth - 1, files);
        }
    }
}

double Median(std::vector<double> values) {
    std::sort(values.begin(), values.end());
    return values[values.size() / 2];
}

}  // namespace

int main(int argc, char** argv) {
    std::random_device random;
    const fs::path work =
        argc > 1 ? fs::path(argv[1])
                 : fs::temp_directory_path() / ("kickvane-find-bench-" + std::to_string(random()));
    const fs::path home = work / "home";
    const fs::path prefix = home / ".wine";
    std::cout << "generating a prefix in " << prefix << "...\n";
    Tree(prefix / "drive_c/windows", 6, 3, 20);           // ~5,400 entries, skipped
    Tree(prefix / "drive_c/Program Files", 8, 4, 20);     // ~100,000 entries
    Tree(prefix / "drive_c/users/me/AppData", 5, 3, 30);  // ~5,000 entries
    fs::create_directories(prefix / "drive_c/Games/Garena/FIFA Online 2");
    Touch(prefix / "drive_c/Games/Garena/FIFA Online 2/GameLoader.exe");
    std::ofstream(prefix / "system.reg") << "WINE REGISTRY Version 2\n#arch=win64\n";

    const kickvane::game::UserFolders folders{home, home / ".config", home / ".local/share", {}};
    std::vector<double> search;
    std::vector<double> find;
    size_t found = 0;
    bool cutShort = false;
    for (int round = 0; round < 5; ++round) {
        auto start = Clock::now();
        const auto outcome = kickvane::game::FindGame(folders, kickvane::game::SearchLimits{});
        search.push_back(std::chrono::duration<double, std::milli>(Clock::now() - start).count());
        found = outcome.games.size();
        cutShort = outcome.cutShort;

        start = Clock::now();
        const std::string command =
            "find '" + (prefix / "drive_c").string() + "' -iname gameloader.exe > /dev/null";
        if (std::system(command.c_str()) != 0) {
            std::cerr << "find failed\n";
        }
        find.push_back(std::chrono::duration<double, std::milli>(Clock::now() - start).count());
    }
    std::cout << "found " << found << " game folder(s)" << (cutShort ? ", search cut short" : "")
              << "\nfind-game: " << Median(search) << " ms, find -iname: " << Median(find)
              << " ms, ratio " << Median(search) / Median(find) << '\n';
    if (argc <= 1) {
        fs::remove_all(work);
    }
    return found == 1 ? 0 : 1;
}
