#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

// Windows paths with a drive letter, as players type them and as Windows programs record them,
// and where they lie in a Wine prefix.
namespace kickvane::platform {

namespace fs = std::filesystem;

// A Windows path that starts with a drive ("C:\Games\..\FIFA", '/' separators too), read as
// Windows reads it: "." and ".." resolved, never above the drive's root, empty names dropped.
struct DrivePath {
    char drive = 0;                  // 'a' to 'z'
    std::vector<std::string> names;  // below the drive's root
};
std::optional<DrivePath> ParseDrivePath(std::string_view text);

// The folder that stands for `drive` in a Wine prefix: its link "dosdevices/<drive>:", else
// "drive_c" for C: (a prefix without its links, or not made yet). nullopt for another drive
// without a link.
std::optional<fs::path> PrefixDriveFolder(const fs::path& prefix, char drive);

// `folder` with the names of `path` below it.
fs::path JoinDrivePath(fs::path folder, const DrivePath& path);

// Where a Windows path lies in a Wine prefix (letter case as given); nullopt when the text names
// no drive or the prefix does not map its drive.
std::optional<fs::path> WindowsPathInPrefix(const fs::path& prefix, std::string_view text);

}  // namespace kickvane::platform
