// A build without SQLite: Lutris games are then started by their short name.
#include "game/game_managers.h"

namespace kickvane::game {

std::optional<LutrisGameRow> ReadLutrisGame(const fs::path&, std::string_view,
                                            std::string* problem) {
    *problem = "this build reads no Lutris database";
    return std::nullopt;
}

}  // namespace kickvane::game
