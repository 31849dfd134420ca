#pragma once

#include <optional>
#include <string_view>

#include "platform/status.h"
#include "skin/surface.h"

namespace kickvane::skin {

// System colour values: 0x80000000 + index. Only the ones the painters name are listed.
inline constexpr Colour kSysWindow = 0x80000005;
inline constexpr Colour kSysWindowText = 0x80000008;
inline constexpr Colour kSysHighlight = 0x8000000D;
inline constexpr Colour kSysButtonFace = 0x8000000F;
inline constexpr Colour kSysButtonShadow = 0x80000010;
inline constexpr Colour kSysGrayText = 0x80000011;
inline constexpr Colour kSysButtonHighlight = 0x80000014;
inline constexpr Colour kSysDarkShadow = 0x80000015;
inline constexpr Colour kSysLight = 0x80000016;

// Plain shapes for the painters: boxes, edges, lines, text and a few parts of the system's visual
// style, drawn in the theme's own flat look. Every colour argument may name a system colour; the
// system colours are the theme's, not the desktop's, so a skin looks the same everywhere.
class ShapeHelper {
public:
    // The RGB value of `colour`; nullopt for an unknown system colour or a colour value that is
    // neither RGB nor a system colour.
    static std::optional<Colour> translateColor(Colour colour);

    // `colour` with `amount` added to each channel, clamped to 0..255 (negative darkens).
    static std::optional<Colour> shadeColor(Colour colour, int amount);

    Status fillBox(Surface& dc, int left, int top, int right, int bottom, Colour colour) const;

    // A one-pixel outline along the inside of the rectangle.
    Status frameBox(Surface& dc, int left, int top, int right, int bottom, Colour colour) const;

    // A sunken two-pixel edge along the inside of the rectangle: shadow above and left, light
    // below and right.
    Status sunkenEdge(Surface& dc, const Rect& box) const;

    Status drawLine(Surface& dc, int x1, int y1, int x2, int y2, Colour colour, int width) const;

    // One line of text, left aligned and vertically centred in `box`.
    Status drawText(Surface& dc, const Rect& box, std::string_view utf8, Colour colour) const;

    // The size grip of a status bar, in the bottom-right corner of `box`.
    Status drawSizeGrip(Surface& dc, const Rect& box) const;
};

}  // namespace kickvane::skin
