#pragma once

#include <filesystem>
#include <string>
#include <string_view>

namespace kickvane::engine {

namespace fs = std::filesystem;

enum class Root { Data, ZData, ToolData, ToolZData, Extras };

// A place in one of the five trees: a root and a path below it written as on Windows, with a
// leading backslash ("\gui\hud\radar").
struct Location {
    Root root;
    std::string relative;

    friend bool operator==(const Location&, const Location&) = default;
};

// The five folder roots of one patch run, formed from the tool folder and the game folder text.
struct Roots {
    fs::path data;       // game folder + "\data2"
    fs::path zdata;      // game folder + "\zdata\data2"
    fs::path toolData;   // tool folder + "\data\data2"
    fs::path toolZData;  // tool folder + "\data\zdata\data2"
    fs::path extras;     // tool folder + "\extras"

    const fs::path& Of(Root root) const;
    // The native path of a location, its spelling matched to what exists regardless of case.
    fs::path Resolve(const Location& location) const;
};

// Joins a folder and a Windows-style relative path ("\data2", "\zdata\data2").
fs::path JoinWindowsPath(const fs::path& folder, std::string_view relative);

// The game folder is the user's text: a Windows path in the Wine prefix or a native path. It is
// joined as text first, as the user typed it, so "D:\" gives "D:\\data2", which names D:\data2.
Roots ResolveRoots(const fs::path& toolFolder, std::string_view gameFolder);

std::string_view RootName(Root root);

// Why a patch run cannot start. The checks run in this order and the first one that fails wins.
// A folder whose path the system refuses for its length is "too long", not missing.
enum class RootProblem { None, ToolDataMissing, ToolDataTooLong, DataMissing, DataTooLong };
RootProblem CheckRoots(const Roots& roots);

}  // namespace kickvane::engine
