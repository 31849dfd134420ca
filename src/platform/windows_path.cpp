#include "platform/windows_path.h"

#include "platform/filesystem.h"

namespace kickvane::platform {

std::optional<DrivePath> ParseDrivePath(std::string_view text) {
    if (text.size() < 2 || text[1] != ':') {
        return std::nullopt;
    }
    const char drive = FoldAscii(text[0]);
    if (drive < 'a' || drive > 'z') {
        return std::nullopt;
    }
    DrivePath path{drive, {}};
    size_t start = 2;
    while (start <= text.size()) {
        size_t end = text.find_first_of("\\/", start);
        if (end == std::string_view::npos) {
            end = text.size();
        }
        const std::string_view name = text.substr(start, end - start);
        if (name == "..") {
            if (!path.names.empty()) {
                path.names.pop_back();  // at the root, ".." stays there
            }
        } else if (!name.empty() && name != ".") {
            path.names.emplace_back(name);
        }
        start = end + 1;
    }
    return path;
}

std::optional<fs::path> PrefixDriveFolder(const fs::path& prefix, char drive) {
    const fs::path link = prefix / "dosdevices" / (std::string(1, drive) + ":");
    if (IsDirectory(link)) {
        return link;
    }
    if (drive == 'c') {
        return prefix / "drive_c";
    }
    return std::nullopt;
}

fs::path JoinDrivePath(fs::path folder, const DrivePath& path) {
    for (const std::string& name : path.names) {
        folder /= PathFromUtf8(name);
    }
    return folder;
}

std::optional<fs::path> WindowsPathInPrefix(const fs::path& prefix, std::string_view text) {
    const std::optional<DrivePath> path = ParseDrivePath(text);
    if (!path) {
        return std::nullopt;
    }
    const std::optional<fs::path> drive = PrefixDriveFolder(prefix, path->drive);
    if (!drive) {
        return std::nullopt;
    }
    return JoinDrivePath(*drive, *path);
}

}  // namespace kickvane::platform
