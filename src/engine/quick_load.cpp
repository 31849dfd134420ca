#include "engine/quick_load.h"

#include <array>
#include <optional>

#include "engine/file_ops.h"
#include "engine/roots.h"
#include "platform/filesystem.h"
#include "platform/text.h"
#include "text/vni.h"

namespace kickvane::engine {

namespace {

namespace fs = std::filesystem;

struct Pattern {
    std::string_view direct;
    std::string_view nestedFolder;  // empty when the pattern has no nested form
    std::string_view target;        // below the tool's "data" folder
};

constexpr std::array<Pattern, 7> kPatterns{{
    {"cm_*.dds", "heads\\textures", "\\data2\\players\\heads\\textures"},
    {"face*.dds", "heads\\textures", "\\data2\\players\\heads\\textures"},
    {"cmbhair_*.dds", "heads\\textures", "\\data2\\players\\heads\\textures"},
    {"skin*.dds", "bodies\\textures", "\\data2\\players\\bodies\\textures"},
    {"hhead*.pc.ea3.em", "heads", "\\data2\\players\\heads"},
    {"ball10_*.ea3.em", "", "\\zdata\\data2\\ball"},
    {"ball10.dds", "textures", "\\zdata\\data2\\ball\\textures"},
}};

std::vector<fs::path> MatchingFiles(const fs::path& folder, std::string_view pattern) {
    std::vector<fs::path> matches;
    for (const fs::path& file : platform::ListPlainFiles(folder)) {
        if (MatchesWildcard(platform::PathToUtf8(file.filename()), pattern)) {
            matches.push_back(file);
        }
    }
    return matches;
}

}  // namespace

bool MatchesWildcard(std::string_view name, std::string_view pattern) {
    // Iterative match with one backtrack point for the last '*'. A '*' of the pattern is always
    // the wildcard, even facing a '*' in the name.
    size_t n = 0;
    size_t p = 0;
    std::optional<size_t> star;
    size_t starName = 0;
    while (n < name.size()) {
        if (p < pattern.size() && pattern[p] == '*') {
            star = p++;
            starName = n;
        } else if (p < pattern.size() && (pattern[p] == '?' || platform::FoldAscii(pattern[p]) ==
                                                                   platform::FoldAscii(name[n]))) {
            ++n;
            ++p;
        } else if (star) {
            p = *star + 1;
            n = ++starName;
        } else {
            return false;
        }
    }
    while (p < pattern.size() && pattern[p] == '*') {
        ++p;
    }
    return p == pattern.size();
}

QuickLoadOutcome QuickLoad(const fs::path& toolFolder, const fs::path& source) {
    QuickLoadOutcome outcome;
    const auto stop = [&outcome](std::string text) {
        outcome.stopped = true;
        outcome.message = text::Message{text::Message::Kind::Component, std::move(text), {}};
        return outcome;
    };
    if (source.empty()) {
        return stop(text::VniToUnicodeUtf8(kNoFolderChosenVni));
    }
    const fs::path from = platform::ResolveCaseInsensitive(source);
    // A folder with no plain file at its top is not taken for a player folder, whatever its
    // subfolders hold.
    if (platform::ListPlainFiles(from).empty()) {
        return stop(std::string(kNoMatchingFileText));
    }
    // Every pattern's files are found first: a folder where none matches is told apart from a
    // load whose copies failed.
    std::vector<std::vector<fs::path>> filesOf;
    bool anyFile = false;
    for (const Pattern& pattern : kPatterns) {
        std::vector<fs::path> files = MatchingFiles(from, pattern.direct);
        if (files.empty() && !pattern.nestedFolder.empty()) {
            files = MatchingFiles(
                platform::ResolveCaseInsensitive(JoinWindowsPath(from, pattern.nestedFolder)),
                pattern.direct);
        }
        anyFile = anyFile || !files.empty();
        filesOf.push_back(std::move(files));
    }
    if (!anyFile) {
        return stop(std::string(kNoMatchingFileText));
    }
    const fs::path dataFolder = toolFolder / "data";
    for (size_t i = 0; i < kPatterns.size(); ++i) {
        const Pattern& pattern = kPatterns[i];
        const std::vector<fs::path>& files = filesOf[i];
        const fs::path target = JoinWindowsPath(dataFolder, pattern.target);
        if (!files.empty()) {
            platform::RemoveStaleTemporaries(platform::ResolveCaseInsensitive(target));
        }
        for (const fs::path& file : files) {
            if (Status copied = CopyFileInto(file, target); !copied) {
                outcome.failures.push_back({std::string(pattern.direct), copied.failure()});
                break;
            }
            outcome.copied.push_back(fs::relative(file, from).generic_string());
        }
    }
    return outcome;
}

}  // namespace kickvane::engine
