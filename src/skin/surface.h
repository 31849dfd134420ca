#pragma once

#include <cstdint>
#include <string_view>

#include <QImage>

#include "platform/status.h"

namespace kickvane::skin {

// A colour as 0x00RRGGBB (QRgb without its alpha), or 0x80000000 + n for the system colour n
// (see ShapeHelper).
using Colour = std::uint32_t;

constexpr Colour rgb(int red, int green, int blue) {
    return static_cast<Colour>(((red & 0xFF) << 16) | ((green & 0xFF) << 8) | (blue & 0xFF));
}
constexpr int redOf(Colour c) {
    return static_cast<int>((c >> 16) & 0xFF);
}
constexpr int greenOf(Colour c) {
    return static_cast<int>((c >> 8) & 0xFF);
}
constexpr int blueOf(Colour c) {
    return static_cast<int>(c & 0xFF);
}

// Pixels of this colour in a keyed picture are not copied.
constexpr Colour kMagentaKey = rgb(255, 0, 255);

// The window being painted. The painters only compare it with the window under the cursor and
// ask for its text; they never draw into it.
using WindowHandle = std::uintptr_t;

// A rectangle by its edges; right and bottom are exclusive (10 to 30 is 20 pixels wide).
struct Rect {
    int left = 0;
    int top = 0;
    int right = 0;
    int bottom = 0;

    friend bool operator==(const Rect&, const Rect&) = default;
};

// A rectangle by its origin and size, as the copy operations take it.
struct Piece {
    int x = 0;
    int y = 0;
    int width = 0;
    int height = 0;

    bool isEmpty() const { return width <= 0 || height <= 0; }
    friend bool operator==(const Piece&, const Piece&) = default;
};

// Widths of the parts of a frame that keep their size when the frame is stretched.
struct Margins {
    int left = 0;
    int top = 0;
    int right = 0;
    int bottom = 0;

    friend bool operator==(const Margins&, const Margins&) = default;
};

enum class StretchMode {
    Plain,     // nearest pixel, like a fresh device context
    Halftone,  // smooth: each target pixel blends the source pixels it covers
};

// Where the painters draw. Colours passed to a surface are plain RGB values; system colours are
// translated before (ShapeHelper). Operations fail on invalid input (a source piece outside its
// picture, a negative size) and leave the surface unchanged then.
class Surface {
public:
    virtual ~Surface() = default;

    // Applies to the stretching copies that follow.
    virtual void setStretchMode(StretchMode mode) = 0;

    // Copies the piece `from` of `source` to `to`, stretching it to the size of `to`.
    virtual Status copy(const QImage& source, const Piece& from, const Piece& to) = 0;

    // Like Copy, but target pixels stay unchanged where the source pixel has the colour `key`.
    // Always stretches by nearest pixel, so the key never blends into its neighbours.
    virtual Status copyKeyed(const QImage& source, const Piece& from, const Piece& to,
                             Colour key) = 0;

    virtual Status fill(const Rect& area, Colour rgb) = 0;

    // A line from `from` to `to` (the end point included), `width` pixels thick.
    virtual Status line(int x1, int y1, int x2, int y2, Colour rgb, int width) = 0;

    // One line of UTF-8 text, left aligned and vertically centred in `box`, cut at its edges.
    virtual Status text(const Rect& box, std::string_view utf8, Colour rgb) = 0;
};

}  // namespace kickvane::skin
