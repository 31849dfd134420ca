#pragma once

#include <string_view>

#include "game/formats/flat_values.h"

namespace kickvane::game {

// JSON as Heroic writes it. Strings are kept as they are, numbers and booleans as JSON writes
// them, nulls left out. Malformed text or a tree too deep or too large is refused with a reason.
Parsed ParseJson(std::string_view text);

}  // namespace kickvane::game
