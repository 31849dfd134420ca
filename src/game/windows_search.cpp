#include "game/windows_search.h"

#include <algorithm>

#include "platform/text.h"

namespace kickvane::game {

namespace {

std::string FolderOf(std::string_view file) {
    const size_t slash = file.find_last_of("\\/");
    if (slash == std::string_view::npos) {
        return {};
    }
    // "C:\Gameloader.exe" lies in the drive's root, "C:\".
    return std::string(file.substr(0, slash == 2 && file[1] == ':' ? 3 : slash));
}

}  // namespace

std::string FolderOfProgramValue(std::string_view value) {
    value = platform::TrimBlanks(value);
    if (value.empty()) {
        return {};
    }
    if (value.front() == '"') {
        const size_t close = value.find('"', 1);
        return FolderOf(value.substr(1, close == std::string_view::npos ? value.npos : close - 1));
    }
    // Unquoted: the program ends at its ".exe", whatever spaces its folder names hold.
    const std::string folded = platform::FoldCase(value);
    if (const size_t exe = folded.find(".exe"); exe != std::string::npos) {
        return FolderOf(value.substr(0, exe + 4));
    }
    if (const size_t comma = value.rfind(','); comma != std::string_view::npos) {
        value = platform::TrimBlanks(value.substr(0, comma));
    }
    return FolderOf(value);
}

int DriveFolderRank(std::string_view name) {
    const std::string folded = platform::FoldCase(name);
    if (folded.empty() || folded == "windows" || folded.front() == '$' ||
        folded == "system volume information") {
        return -1;
    }
    if (folded == "program files" || folded == "program files (x86)" ||
        folded.find("game") != std::string::npos) {
        return 0;
    }
    return 1;
}

std::vector<std::string> OrderDriveFolders(std::vector<std::string> names) {
    std::erase_if(names, [](const std::string& name) { return DriveFolderRank(name) < 0; });
    std::stable_sort(names.begin(), names.end(), [](const std::string& a, const std::string& b) {
        return DriveFolderRank(a) < DriveFolderRank(b);
    });
    return names;
}

}  // namespace kickvane::game
