#pragma once

#include <algorithm>
#include <vector>

#include "skin/surface.h"

namespace kickvane::skin::testing {

// Records what kind of drawing the painters ask of a surface, and draws nothing.
class RecordingSurface final : public Surface {
public:
    enum class Kind { Mode, Copy, Other };

    void setStretchMode(StretchMode) override { calls.push_back(Kind::Mode); }
    Status copy(const QImage&, const Piece&, const Piece&) override { return record(Kind::Copy); }
    Status copyKeyed(const QImage&, const Piece&, const Piece&, Colour) override {
        return record(Kind::Other);
    }
    Status fill(const Rect&, Colour) override { return record(Kind::Other); }
    Status line(int, int, int, int, Colour, int) override { return record(Kind::Other); }
    Status text(const Rect&, std::string_view, Colour) override { return record(Kind::Other); }

    long count(Kind kind) const { return std::count(calls.begin(), calls.end(), kind); }

    std::vector<Kind> calls;

private:
    Status record(Kind kind) {
        calls.push_back(kind);
        return Status::Ok();
    }
};

}  // namespace kickvane::skin::testing
