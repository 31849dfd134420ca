// Parts of the file system layer that the standard library covers on every platform.
#include <algorithm>
#include <cstdlib>
#include <fstream>
#include <sstream>

#include "platform/filesystem.h"
#include "platform/sound.h"

namespace kickvane::platform {

std::unordered_map<std::string, std::string> EntriesByFoldedName(const fs::path& folder) {
    std::unordered_map<std::string, std::string> names;
    std::error_code ec;
    for (fs::directory_iterator it(folder.empty() ? fs::path(".") : folder, ec), end;
         !ec && it != end; it.increment(ec)) {
        std::string name = it->path().filename().string();
        auto [pos, inserted] = names.emplace(FoldCase(name), name);
        if (!inserted && name < pos->second) {
            pos->second = std::move(name);
        }
    }
    return names;
}

std::optional<fs::path> FindEntryIgnoringCase(const fs::path& folder, std::string_view name) {
    std::error_code ec;
    fs::path exact = folder / fs::path(std::string(name));
    if (fs::exists(fs::symlink_status(exact, ec))) {
        return exact;
    }
    const auto names = EntriesByFoldedName(folder);
    const auto found = names.find(FoldCase(name));
    if (found == names.end()) {
        return std::nullopt;
    }
    return folder / found->second;
}

bool IsDirectory(const fs::path& path) {
    std::error_code ec;
    return fs::is_directory(path, ec);
}

bool IsRegularFile(const fs::path& path) {
    std::error_code ec;
    return fs::is_regular_file(path, ec);
}

std::optional<std::string> ReadFile(const fs::path& path) {
    std::ifstream in(path, std::ios::binary);
    if (!in) {
        return std::nullopt;
    }
    std::ostringstream content;
    content << in.rdbuf();
    if (in.bad()) {
        return std::nullopt;
    }
    return std::move(content).str();
}

std::vector<fs::path> ListPlainFiles(const fs::path& folder) {
    std::vector<fs::path> files;
    std::error_code ec;
    for (fs::directory_iterator it(folder, ec), end; !ec && it != end; it.increment(ec)) {
        const std::string name = it->path().filename().string();
        std::error_code typeError;
        if (!name.empty() && name.front() != '.' && it->is_regular_file(typeError)) {
            files.push_back(it->path());
        }
    }
    std::sort(files.begin(), files.end());
    return files;
}

std::string GetEnv(const char* name) {
    const char* value = std::getenv(name);
    return value ? std::string(value) : std::string();
}

std::optional<fs::path> SoundFileToPlay(const fs::path& wav) {
    std::error_code error;
    if (!fs::is_regular_file(wav, error)) {
        return std::nullopt;
    }
    fs::path absolute = fs::absolute(wav, error);
    if (error) {
        return std::nullopt;
    }
    return absolute;
}

}  // namespace kickvane::platform
