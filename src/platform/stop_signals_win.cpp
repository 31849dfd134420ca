// Windows sends a windowed program no stop signals; it closes its windows instead.
#include "platform/stop_signals.h"

namespace kickvane::platform {

int WatchStopRequests() {
    return -1;
}

}  // namespace kickvane::platform
