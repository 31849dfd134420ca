// Windows: games run natively there, without a Linux game manager in between.
#include "game/game_managers.h"

namespace kickvane::game {

ManagerScan ScanGameManagers(const UserFolders&) {
    return {};
}

}  // namespace kickvane::game
