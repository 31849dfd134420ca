#pragma once

#include <string_view>

#include "game/formats/flat_values.h"

namespace kickvane::game {

// Valve's KeyValues text ("key" "value" and "key" { ... }), as in Steam's libraryfolders.vdf.
// Nested at most kMaxNesting deep; unbalanced text is refused with a reason.
Parsed ParseVdf(std::string_view text);

}  // namespace kickvane::game
