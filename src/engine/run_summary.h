#pragma once

#include <string>

#include "engine/apply.h"

namespace kickvane::engine {

// A time of day on the user's clock, as the summary shows it.
struct ClockTime {
    int hour = 0;
    int minute = 0;
};

// One line that tells the user what the last patch run did, for places without room for more
// (the tray icon's tooltip): when it ran, how many sets it copied and how many steps failed, or
// why it stopped before copying anything. "Lần chạy lúc 20:15: đã chép 12 bộ, 0 lỗi".
std::string RunSummary(const ApplyOutcome& outcome, ClockTime at);

}  // namespace kickvane::engine
