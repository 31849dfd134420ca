#pragma once

#include <limits>
#include <optional>

#include "skin/surface.h"

// Rectangle arithmetic for the painters, done in 64 bits: callers pass any 32-bit coordinates,
// and an edge that would leave the 32-bit range makes the step draw nothing instead of wrapping.
namespace kickvane::skin::rect_math {

inline bool fitsInt(long long v) {
    return v >= std::numeric_limits<int>::min() && v <= std::numeric_limits<int>::max();
}

inline std::optional<Rect> makeRect(long long l, long long t, long long r, long long b) {
    if (!fitsInt(l) || !fitsInt(t) || !fitsInt(r) || !fitsInt(b)) {
        return std::nullopt;
    }
    return Rect{static_cast<int>(l), static_cast<int>(t), static_cast<int>(r), static_cast<int>(b)};
}

// `box` with each edge moved by the given amount (positive is right or down).
inline std::optional<Rect> moved(const Rect& box, long long dl, long long dt, long long dr,
                                 long long db) {
    return makeRect(box.left + dl, box.top + dt, box.right + dr, box.bottom + db);
}

// Half of `v`, rounded down (also for negative values).
inline long long floorHalf(long long v) {
    return v >= 0 ? v / 2 : -((-v + 1) / 2);
}

}  // namespace kickvane::skin::rect_math
