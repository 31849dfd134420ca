#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

// What the readers of the game managers' structured files (YAML, JSON, Valve's KeyValues) give:
// the scalar values by their path of keys, so that a manager's code asks for "game.exe" without
// walking a tree of its own.
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
    size_t size() const { return entries_.size(); }

private:
    std::vector<std::pair<std::string, std::string>> entries_;
};

// Why a structured file could not be read.
enum class ParseFault {
    None,
    NotText,     // it holds bytes no text has
    NotMapping,  // its top is no mapping of keys
    TooComplex,  // nested too deep or too many values
    Syntax,      // it breaks its format's rules
};

// A parsed file or the reason it could not be read.
struct Parsed {
    FlatValues values;
    ParseFault fault = ParseFault::None;
    size_t line = 0;      // Syntax: the line of the fault (from 1), where the reader knows it
    std::string problem;  // the reader's own words (English), for logs and tests
    bool ok() const { return fault == ParseFault::None; }
};

// The line (from 1) that the byte at `offset` of `text` lies on.
size_t LineAt(std::string_view text, size_t offset);

// Structured files nest no deeper than this and hold no more values; deeper or larger text is
// refused (a YAML file's aliases could otherwise repeat a tree without end).
inline constexpr int kMaxNesting = 64;
inline constexpr size_t kMaxValues = 100000;

std::string JoinKey(const std::string& parent, std::string_view key);

}  // namespace kickvane::game
