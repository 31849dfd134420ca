#pragma once

#include <string_view>

#include "platform/text.h"

// Line by line reading shared by the readers of line-based files.
namespace kickvane::game {

// The line that starts at `start` (without its line break, also a "\r\n" one); `start` moves to
// the next line.
inline std::string_view NextLine(std::string_view text, size_t& start) {
    size_t end = text.find('\n', start);
    if (end == std::string_view::npos) {
        end = text.size();
    }
    std::string_view line = text.substr(start, end - start);
    start = end + 1;
    if (!line.empty() && line.back() == '\r') {
        line.remove_suffix(1);
    }
    return line;
}

// Blanks and the CR of a file written with CR LF line ends.
inline std::string_view TrimLine(std::string_view text) {
    return platform::TrimBlanks(text, " \t\r");
}

}  // namespace kickvane::game
