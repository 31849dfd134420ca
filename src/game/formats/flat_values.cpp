#include "game/formats/flat_values.h"

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

}  // namespace kickvane::game
