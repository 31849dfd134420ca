#include "skin/paint_nine.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>
#include <optional>

namespace kickvane::skin {
namespace {

struct NinePieces {
    std::array<Piece, 9> to;
    std::array<Piece, 9> from;
};

bool fitsInt(long long v) {
    return v >= std::numeric_limits<int>::min() && v <= std::numeric_limits<int>::max();
}

std::optional<Piece> makePiece(long long x, long long y, long long w, long long h) {
    if (!fitsInt(x) || !fitsInt(y) || !fitsInt(w) || !fitsInt(h)) {
        return std::nullopt;
    }
    return Piece{static_cast<int>(x), static_cast<int>(y), static_cast<int>(w),
                 static_cast<int>(h)};
}

enum class Layout { Pieces, Nothing, Invalid };

// Works out the nine target and source pieces in 64 bits, so that extreme coordinates cannot
// overflow.
Layout lay(const QImage& source, const Margins& m, const Rect& t, const Frame& f, NinePieces& out) {
    if (m.left < 0 || m.top < 0 || m.right < 0 || m.bottom < 0) {
        return Layout::Invalid;
    }
    const long long ml = m.left, mt = m.top, mr = m.right, mb = m.bottom;
    const long long W = f.width, H = f.height, Y0 = f.top;
    if (W < ml + mr || H < mt + mb || Y0 < 0 || W > source.width() || Y0 + H > source.height()) {
        return Layout::Invalid;
    }
    const long long L = t.left, T = t.top, R = t.right, B = t.bottom;
    const long long innerW = R - L - ml - mr;
    const long long innerH = B - T - mt - mb;
    if (innerW < 0 || innerH < 0) {
        return Layout::Nothing;
    }
    const long long srcW = W - ml - mr;
    const long long srcH = H - mt - mb;
    const std::array<std::array<long long, 4>, 9> to = {{
        {L, T, ml, mt},
        {R - mr, T, mr, mt},
        {L, B - mb, ml, mb},
        {R - mr, B - mb, mr, mb},
        {L + ml, T, innerW, mt},
        {L, T + mt, ml, innerH},
        {R - mr, T + mt, mr, innerH},
        {L + ml, B - mb, innerW, mb},
        {L + ml, T + mt, innerW, innerH},
    }};
    const std::array<std::array<long long, 4>, 9> from = {{
        {0, Y0, ml, mt},
        {W - mr, Y0, mr, mt},
        {0, Y0 + H - mb, ml, mb},
        {W - mr, Y0 + H - mb, mr, mb},
        {ml, Y0, srcW, mt},
        {0, Y0 + mt, ml, srcH},
        {W - mr, Y0 + mt, mr, srcH},
        {ml, Y0 + H - mb, srcW, mb},
        {ml, Y0 + mt, srcW, srcH},
    }};
    for (std::size_t i = 0; i < 9; ++i) {
        const auto target = makePiece(to[i][0], to[i][1], to[i][2], to[i][3]);
        const auto src = makePiece(from[i][0], from[i][1], from[i][2], from[i][3]);
        if (!target || !src) {
            return Layout::Invalid;
        }
        out.to[i] = *target;
        out.from[i] = *src;
    }
    return Layout::Pieces;
}

template <typename CopyFn>
Status paintPieces(Surface& target, const QImage& source, const Margins& margins,
                   const Rect& targetRect, const Frame& frame, bool halftone, CopyFn copy) {
    NinePieces pieces;
    switch (lay(source, margins, targetRect, frame, pieces)) {
        case Layout::Invalid:
            return Status::Fail("frame margins or position do not fit the picture");
        case Layout::Nothing:
            return Status::Ok();
        case Layout::Pieces:
            break;
    }
    if (halftone) {
        target.setStretchMode(StretchMode::Halftone);
    }
    for (std::size_t i = 0; i < 9; ++i) {
        if (pieces.to[i].isEmpty() || pieces.from[i].isEmpty()) {
            continue;
        }
        if (Status s = copy(pieces.from[i], pieces.to[i]); !s) {
            return s;
        }
    }
    return Status::Ok();
}

}  // namespace

Frame frameOf(const QImage& picture, int count, int index) {
    if (count <= 0) {
        return Frame{picture.width(), 0, 0};
    }
    const int height = static_cast<int>(std::lround(static_cast<double>(picture.height()) / count));
    return Frame{picture.width(), height,
                 static_cast<int>(std::clamp<long long>(static_cast<long long>(index) * height,
                                                        std::numeric_limits<int>::min(),
                                                        std::numeric_limits<int>::max()))};
}

Status paintNine(Surface& target, const QImage& source, const Margins& margins,
                 const Rect& targetRect, const Frame& frame) {
    return paintPieces(
        target, source, margins, targetRect, frame, true,
        [&](const Piece& from, const Piece& to) { return target.copy(source, from, to); });
}

Status paintNineInCurrentMode(Surface& target, const QImage& source, const Margins& margins,
                              const Rect& targetRect, const Frame& frame) {
    return paintPieces(
        target, source, margins, targetRect, frame, false,
        [&](const Piece& from, const Piece& to) { return target.copy(source, from, to); });
}

Status paintNineKeyed(Surface& target, const QImage& source, const Margins& margins,
                      const Rect& targetRect, const Frame& frame, Colour key) {
    return paintPieces(target, source, margins, targetRect, frame, true,
                       [&](const Piece& from, const Piece& to) {
                           return target.copyKeyed(source, from, to, key);
                       });
}

}  // namespace kickvane::skin
