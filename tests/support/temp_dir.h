#pragma once

#include <filesystem>
#include <fstream>
#include <random>
#include <sstream>
#include <string>
#include <string_view>

namespace kickvane::testing {

namespace fs = std::filesystem;

// A fresh folder under the system's temporary folder, removed with everything in it at the end.
class TempDir {
public:
    TempDir() {
        std::random_device random;
        path_ = fs::temp_directory_path() /
                ("kickvane-test-" + std::to_string(random()) + std::to_string(random()));
        fs::create_directories(path_);
    }
    TempDir(const TempDir&) = delete;
    TempDir& operator=(const TempDir&) = delete;
    ~TempDir() {
        std::error_code ec;
        fs::permissions(path_, fs::perms::owner_all, fs::perm_options::add, ec);
        fs::remove_all(path_, ec);
    }

    const fs::path& path() const { return path_; }
    // `relative` is UTF-8, also on Windows (where a plain string is read in the ANSI code page).
    fs::path operator/(std::string_view relative) const {
        return path_ / fs::path(std::u8string(relative.begin(), relative.end()));
    }

private:
    fs::path path_;
};

// Writes a file, creating its folders.
inline void WriteFile(const fs::path& path, std::string_view content) {
    fs::create_directories(path.parent_path());
    std::ofstream(path, std::ios::binary) << content;
}

// Writes a file that its owner may run, as a script or program.
inline void WriteProgram(const fs::path& path, std::string_view content) {
    WriteFile(path, content);
    fs::permissions(path, fs::perms::owner_all);
}

inline std::string ReadText(const fs::path& path) {
    std::ifstream in(path, std::ios::binary);
    std::ostringstream content;
    content << in.rdbuf();
    return content.str();
}

}  // namespace kickvane::testing
