#pragma once

#include <string>
#include <string_view>

namespace kickvane::game {

// The value of `key` in the [Desktop Entry] group of a desktop entry (as Wine's menu entries are
// written); empty when there is none.
std::string DesktopEntryValue(std::string_view text, std::string_view key);

}  // namespace kickvane::game
