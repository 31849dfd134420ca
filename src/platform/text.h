#pragma once

#include <algorithm>
#include <string>
#include <string_view>

// Small text helpers of the whole core: ASCII case folding, as Windows compares names and keys,
// and blank trimming, as settings values are read.
namespace kickvane::platform {

constexpr char FoldAscii(char c) {
    return (c >= 'A' && c <= 'Z') ? static_cast<char>(c - 'A' + 'a') : c;
}

// ASCII letters compared without regard to case.
inline bool NamesEqualIgnoringCase(std::string_view a, std::string_view b) {
    return a.size() == b.size() && std::equal(a.begin(), a.end(), b.begin(), [](char x, char y) {
               return FoldAscii(x) == FoldAscii(y);
           });
}

inline std::string FoldCase(std::string_view name) {
    std::string folded(name);
    std::transform(folded.begin(), folded.end(), folded.begin(), FoldAscii);
    return folded;
}

// Without leading and trailing blanks: spaces and tabs unless `blanks` says otherwise.
constexpr std::string_view TrimBlanks(std::string_view text, std::string_view blanks = " \t") {
    const size_t first = text.find_first_not_of(blanks);
    if (first == std::string_view::npos) {
        return {};
    }
    return text.substr(first, text.find_last_not_of(blanks) - first + 1);
}

}  // namespace kickvane::platform
