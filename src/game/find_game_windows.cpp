// Windows: the game's folder is not looked for yet; the window's folder box and the settings
// name it. A search of the Windows drives belongs here.
#include "game/find_game.h"

namespace kickvane::game {

FindOutcome FindGame(const UserFolders&, const SearchLimits&, const std::atomic<bool>* cancel) {
    FindOutcome outcome;
    outcome.cancelled = cancel != nullptr && cancel->load();
    return outcome;
}

}  // namespace kickvane::game
