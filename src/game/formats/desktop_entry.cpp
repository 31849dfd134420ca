#include "game/formats/desktop_entry.h"

#include "game/formats/text_lines.h"

namespace kickvane::game {

std::string DesktopEntryValue(std::string_view text, std::string_view key) {
    bool inMainGroup = false;
    size_t start = 0;
    while (start < text.size()) {
        const std::string_view line = TrimLine(NextLine(text, start));
        if (line.starts_with("[")) {
            inMainGroup = line == "[Desktop Entry]";
            continue;
        }
        const size_t equals = line.find('=');
        if (inMainGroup && equals != std::string_view::npos &&
            TrimLine(line.substr(0, equals)) == key) {
            return std::string(TrimLine(line.substr(equals + 1)));
        }
    }
    return {};
}

}  // namespace kickvane::game
