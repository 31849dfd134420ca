#pragma once

#include <string_view>

#include "game/formats/flat_values.h"

namespace kickvane::game {

// YAML as Lutris and Bottles write it (PyYAML: plain and quoted scalars folded over several
// lines, escapes, block text, lists). The first document must be a mapping (or empty); text that
// is none, binary text, or a tree too deep or too large is refused with a reason.
Parsed ParseYaml(std::string_view text);

}  // namespace kickvane::game
