#include "game/formats/flat_values.h"

#include <algorithm>

namespace kickvane::game {

std::optional<std::string> FlatValues::Find(std::string_view key) const {
    for (const auto& [name, value] : entries_) {
        if (name == key) {
            return value;
        }
    }
    return std::nullopt;
}

std::string JoinKey(const std::string& parent, std::string_view key) {
    return parent.empty() ? std::string(key) : parent + "." + std::string(key);
}

size_t LineAt(std::string_view text, size_t offset) {
    const std::string_view before = text.substr(0, std::min(offset, text.size()));
    return 1 + static_cast<size_t>(std::count(before.begin(), before.end(), '\n'));
}

}  // namespace kickvane::game
