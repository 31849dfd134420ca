#pragma once

#include <algorithm>
#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

#include "game/launch_plan.h"
#include "game/wine_prefix.h"
#include "support/temp_dir.h"

namespace kickvane::testing {

// A home folder of a test's own, with Wine prefixes and game managers' files laid out in it.
class FakeHome {
public:
    FakeHome() { fs::create_directories(home()); }

    fs::path home() const { return dir_ / "home"; }
    fs::path operator/(std::string_view relative) const { return home() / relative; }

    game::UserFolders folders() const {
        return {home(), home() / ".config", home() / ".local/share", {}};
    }

    // A prefix with drive_c, registry files and the usual drive links (c: to drive_c, z: to /).
    fs::path MakePrefix(std::string_view relative, std::string_view arch = "win64",
                        std::string_view systemRegBody = "") const {
        const fs::path prefix = home() / relative;
        fs::create_directories(prefix / "drive_c/windows/system32");
        fs::create_directories(prefix / "dosdevices");
        WriteFile(prefix / "system.reg",
                  "WINE REGISTRY Version 2\n;; All keys relative to "
                  "\\\\Machine\n\n#arch=" +
                      std::string(arch) + "\n\n" + std::string(systemRegBody));
        WriteFile(prefix / "user.reg",
                  "WINE REGISTRY Version 2\n#arch=" + std::string(arch) + "\n");
        std::error_code error;
        fs::create_directory_symlink("../drive_c", prefix / "dosdevices/c:", error);
        fs::create_directory_symlink("/", prefix / "dosdevices/z:", error);
        return prefix;
    }

    // A game folder with its launcher (a Windows program: not runnable here).
    static fs::path MakeGame(const fs::path& folder,
                             std::string_view launcherName = "Gameloader.exe") {
        WriteFile(folder / launcherName, "MZ not really a program");
        return folder;
    }

private:
    TempDir dir_;
};

// A program lookup that "finds" the named programs, and no others, in a fake bin folder.
inline game::ProgramLookup Installed(std::vector<std::string> names) {
    return [names = std::move(names)](const std::string& name) {
        return std::find(names.begin(), names.end(), name) != names.end()
                   ? fs::path("/fake/bin") / name
                   : fs::path();
    };
}

}  // namespace kickvane::testing
