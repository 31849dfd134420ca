#pragma once

#include <vector>

#include "skin/surface.h"

namespace kickvane::skin::testing {

// Records what the painters ask of a surface, and draws nothing.
class RecordingSurface final : public Surface {
public:
    enum class Kind { Mode, Copy, Other };

    struct Call {
        Kind kind;
        StretchMode mode = StretchMode::Plain;
        const QImage* source = nullptr;
        Piece from;
        Piece to;
    };

    void setStretchMode(StretchMode mode) override {
        calls.push_back({Kind::Mode, mode, nullptr, {}, {}});
    }
    Status copy(const QImage& source, const Piece& from, const Piece& to) override {
        calls.push_back({Kind::Copy, {}, &source, from, to});
        return Status::Ok();
    }
    Status copyKeyed(const QImage&, const Piece&, const Piece&, Colour) override { return other(); }
    Status fill(const Rect&, Colour) override { return other(); }
    Status line(int, int, int, int, Colour, int) override { return other(); }
    Status text(const Rect&, std::string_view, Colour) override { return other(); }

    std::vector<Call> of(Kind kind) const {
        std::vector<Call> out;
        for (const Call& call : calls) {
            if (call.kind == kind) {
                out.push_back(call);
            }
        }
        return out;
    }

    std::vector<Call> calls;

private:
    Status other() {
        calls.push_back({Kind::Other, {}, nullptr, {}, {}});
        return Status::Ok();
    }
};

}  // namespace kickvane::skin::testing
