#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

// Small, forgiving readers of the configuration files that Wine and the game managers keep: the
// subset of YAML, JSON and Valve's KeyValues text that those files use, Wine's registry files,
// and desktop entries. They only read; a file that does not parse gives a reason, never a crash.
namespace kickvane::game {

// Scalar values by their path of keys joined with '.' ("game.exe", "libraryfolders.0.path";
// list items count from 0). Values keep the order of the file.
class FlatValues {
public:
    void Add(std::string key, std::string value) {
        entries_.emplace_back(std::move(key), std::move(value));
    }
    // The first value of `key`, or nullopt.
    std::optional<std::string> Find(std::string_view key) const;
    const std::vector<std::pair<std::string, std::string>>& entries() const { return entries_; }

private:
    std::vector<std::pair<std::string, std::string>> entries_;
};

// A parsed file or the reason it could not be read.
struct Parsed {
    FlatValues values;
    std::string problem;  // empty when the file was read
    bool ok() const { return problem.empty(); }
};

// Reads a file of at most `maxBytes`; the reason says why not (missing, unreadable, too large).
std::optional<std::string> ReadBoundedFile(const std::filesystem::path& path, size_t maxBytes,
                                           std::string* problem);

// Block mappings, "key: value" with plain, 'single' or "double" quoted scalars, and "- item"
// lists of scalars or mappings. Anchors, multi-line flow collections and other rarities are
// skipped; text that is no mapping at all is malformed.
Parsed ParseYamlSubset(std::string_view text);

// Full JSON syntax, nested at most 64 deep; numbers and booleans are kept as their text.
Parsed ParseJson(std::string_view text);

// Valve's KeyValues text ("key" "value" and "key" { ... }), as in libraryfolders.vdf.
Parsed ParseVdf(std::string_view text);

// One string value of Wine's registry files: the key is as written between the brackets, with
// single backslashes ("Software\Microsoft\..."), and the value is decoded to UTF-8.
struct RegistryValue {
    std::string key;
    std::string name;
    std::string value;
};

struct RegistryFile {
    std::vector<RegistryValue> values;
    std::string arch;     // "win32" or "win64" when the file records it ("#arch=win64")
    std::string problem;  // empty when the file was read
};

// Reads the string values (plain and str(2)) of a Wine registry file ("WINE REGISTRY Version 2")
// whose key starts with one of `keyPrefixes` (compared without regard to case). Escapes: \\ \"
// \n \r \t \0, \xHHHH and \uHHHH for any character; a line that ends inside a value with a
// backslash continues on the next one.
RegistryFile ParseWineRegistry(std::string_view text, const std::vector<std::string>& keyPrefixes);

// The value of `key` in the [Desktop Entry] group of a desktop entry; empty when there is none.
std::string DesktopEntryValue(std::string_view text, std::string_view key);

}  // namespace kickvane::game
