#pragma once

#include <string>
#include <vector>

#include "skin/surface.h"

namespace kickvane::skin::testing {

// Records what the painters ask of a surface, and draws nothing.
class RecordingSurface final : public Surface {
public:
    enum class Kind { Mode, Copy, CopyKeyed, Fill, Line, Text };

    struct Call {
        Kind kind;
        StretchMode mode = StretchMode::Plain;
        const QImage* source = nullptr;
        Piece from;
        Piece to;
        Colour colour = 0;
        Rect area;
        std::string text;
    };

    void setStretchMode(StretchMode mode) override {
        calls.push_back({Kind::Mode, mode, nullptr, {}, {}, 0, {}, {}});
    }
    Status copy(const QImage& source, const Piece& from, const Piece& to) override {
        calls.push_back({Kind::Copy, {}, &source, from, to, 0, {}, {}});
        return Status::Ok();
    }
    Status copyKeyed(const QImage& source, const Piece& from, const Piece& to,
                     Colour key) override {
        calls.push_back({Kind::CopyKeyed, {}, &source, from, to, key, {}, {}});
        return Status::Ok();
    }
    Status fill(const Rect& area, Colour rgb) override {
        calls.push_back({Kind::Fill, {}, nullptr, {}, {}, rgb, area, {}});
        return Status::Ok();
    }
    Status line(int x1, int y1, int x2, int y2, Colour rgb, int) override {
        calls.push_back({Kind::Line, {}, nullptr, {}, {}, rgb, Rect{x1, y1, x2, y2}, {}});
        return Status::Ok();
    }
    Status text(const Rect& box, std::string_view utf8, Colour rgb) override {
        calls.push_back({Kind::Text, {}, nullptr, {}, {}, rgb, box, std::string(utf8)});
        return Status::Ok();
    }

    std::vector<Call> of(Kind kind) const {
        std::vector<Call> out;
        for (const Call& call : calls) {
            if (call.kind == kind) {
                out.push_back(call);
            }
        }
        return out;
    }

    // Colours of the fills in order, each run of equal colours once (a frame is four fills).
    std::vector<Colour> fillColours() const {
        std::vector<Colour> out;
        for (const Call& call : of(Kind::Fill)) {
            if (out.empty() || out.back() != call.colour) {
                out.push_back(call.colour);
            }
        }
        return out;
    }

    std::vector<Call> calls;
};

}  // namespace kickvane::skin::testing
