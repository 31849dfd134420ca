#pragma once

#include <filesystem>
#include <string>
#include <vector>

#include <optional>
#include <string_view>

#include "platform/status.h"
#include "text/message.h"

namespace kickvane::engine {

inline constexpr std::string_view kNoFolderChosenVni = "Ba5n chu7a cho5n thu7 mu5c na2o!";
// The chosen folder holds no plain file at its top, or none that any pattern takes.
inline constexpr std::string_view kNoMatchingFileText =
    "Thư mục này không có file Face hay Ball nào";

// A name pattern whose copy stopped, and why.
struct QuickLoadFailure {
    std::string pattern;
    Failure failure;
};

struct QuickLoadOutcome {
    bool stopped = false;                  // no folder, or no matching file in it: nothing copied
    std::optional<text::Message> message;  // why it stopped
    std::vector<std::string> copied;       // source files copied, relative to the source folder
    std::vector<QuickLoadFailure> failures;

    bool Ok() const { return !stopped && failures.empty(); }
};

// Copies face and ball files from `source` into the tool's base set by seven name patterns, in
// order. For each pattern the files at the top of `source` are taken; only when there are none,
// the files of the pattern's subfolder. Names match regardless of letter case. When a copy fails
// that pattern stops, the others go on, and the outcome names it.
QuickLoadOutcome QuickLoad(const std::filesystem::path& toolFolder,
                           const std::filesystem::path& source);

// Windows wildcard match of a file name: '*' any run, '?' one character, letters in any case.
bool MatchesWildcard(std::string_view name, std::string_view pattern);

}  // namespace kickvane::engine
