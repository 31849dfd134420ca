// Quick load's name matching against a plain table of which prefix of the name each prefix of
// the pattern can match.
#include <cstddef>
#include <cstdint>
#include <string_view>
#include <vector>

#include "engine/quick_load.h"
#include "fuzz_check.h"

namespace {

char Fold(char c) {
    return (c >= 'A' && c <= 'Z') ? static_cast<char>(c - 'A' + 'a') : c;
}

bool ReferenceMatch(std::string_view name, std::string_view pattern) {
    // matched[n] after pattern[0..p): whether name[0..n) is matched.
    std::vector<char> matched(name.size() + 1, 0);
    matched[0] = 1;
    for (const char p : pattern) {
        std::vector<char> next(name.size() + 1, 0);
        for (size_t n = 0; n <= name.size(); ++n) {
            if (p == '*') {
                next[n] = matched[n] || (n > 0 && next[n - 1]);
            } else if (n > 0 && matched[n - 1] && (p == '?' || Fold(p) == Fold(name[n - 1]))) {
                next[n] = 1;
            }
        }
        matched.swap(next);
    }
    return matched[name.size()] != 0;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const std::string_view input(reinterpret_cast<const char*>(data), size);
    // "pattern NUL name"; without a NUL, one of the tool's own patterns.
    const size_t split = input.find('\0');
    const std::string_view pattern =
        split == std::string_view::npos ? std::string_view("cm_*.dds") : input.substr(0, split);
    const std::string_view name = split == std::string_view::npos ? input : input.substr(split + 1);
    if (pattern.size() > 256 || name.size() > 1024) {
        return 0;
    }
    FUZZ_CHECK(kickvane::engine::MatchesWildcard(name, pattern) == ReferenceMatch(name, pattern));
    FUZZ_CHECK(kickvane::engine::MatchesWildcard(name, "*"));
    return 0;
}
