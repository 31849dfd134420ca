#include "skin/shape_helper.h"

#include <algorithm>
#include <array>
#include <limits>

namespace kickvane::skin {
namespace {

constexpr Colour kSystemFlag = 0x80000000u;

// The theme's system colours, by index: a soft blue-grey desktop to match the pictures.
constexpr std::array<Colour, 31> kSystemColours = {
    rgb(200, 208, 220),  //  0 scroll bar
    rgb(58, 110, 165),   //  1 desktop
    rgb(74, 128, 204),   //  2 active caption
    rgb(160, 176, 200),  //  3 inactive caption
    rgb(250, 251, 253),  //  4 menu
    rgb(255, 255, 255),  //  5 window
    rgb(0, 0, 0),        //  6 window frame
    rgb(0, 0, 0),        //  7 menu text
    rgb(0, 0, 0),        //  8 window text
    rgb(255, 255, 255),  //  9 caption text
    rgb(212, 218, 228),  // 10 active border
    rgb(212, 218, 228),  // 11 inactive border
    rgb(171, 171, 171),  // 12 application workspace
    rgb(74, 128, 204),   // 13 highlight
    rgb(255, 255, 255),  // 14 highlight text
    rgb(236, 239, 244),  // 15 button face
    rgb(160, 172, 190),  // 16 button shadow
    rgb(150, 156, 166),  // 17 grey text
    rgb(0, 0, 0),        // 18 button text
    rgb(230, 234, 240),  // 19 inactive caption text
    rgb(255, 255, 255),  // 20 button highlight
    rgb(96, 106, 122),   // 21 dark shadow
    rgb(246, 248, 251),  // 22 light
    rgb(0, 0, 0),        // 23 tooltip text
    rgb(255, 255, 225),  // 24 tooltip background
    rgb(184, 184, 184),  // 25 (unused by the desktop; kept grey)
    rgb(0, 102, 204),    // 26 hot link
    rgb(150, 180, 228),  // 27 active caption gradient
    rgb(200, 210, 226),  // 28 inactive caption gradient
    rgb(74, 128, 204),   // 29 menu highlight
    rgb(236, 239, 244),  // 30 menu bar
};

Status badColour() {
    return Status::Fail("not a colour value");
}

}  // namespace

std::optional<Colour> ShapeHelper::translateColor(Colour colour) {
    if ((colour & 0xFF000000u) == 0) {
        return colour;
    }
    if ((colour & 0xFF000000u) == kSystemFlag) {
        const Colour index = colour & 0x00FFFFFFu;
        if (index < kSystemColours.size()) {
            return kSystemColours[index];
        }
    }
    return std::nullopt;
}

std::optional<Colour> ShapeHelper::shadeColor(Colour colour, int amount) {
    const auto plain = translateColor(colour);
    if (!plain) {
        return std::nullopt;
    }
    const auto shade = [amount](int channel) {
        return static_cast<int>(
            std::clamp<long long>(static_cast<long long>(channel) + amount, 0, 255));
    };
    return rgb(shade(redOf(*plain)), shade(greenOf(*plain)), shade(blueOf(*plain)));
}

Status ShapeHelper::fillBox(Surface& dc, int left, int top, int right, int bottom,
                            Colour colour) const {
    const auto plain = translateColor(colour);
    if (!plain) {
        return badColour();
    }
    return dc.fill(Rect{left, top, right, bottom}, *plain);
}

Status ShapeHelper::frameBox(Surface& dc, int left, int top, int right, int bottom,
                             Colour colour) const {
    const auto plain = translateColor(colour);
    if (!plain) {
        return badColour();
    }
    if (right <= left || bottom <= top) {
        return Status::Ok();
    }
    // Four one-pixel strips; 64-bit edges so that the box can touch the coordinate limits.
    const auto inner = [](int edge, int step) {
        return static_cast<int>(std::clamp<long long>(static_cast<long long>(edge) + step,
                                                      std::numeric_limits<int>::min(),
                                                      std::numeric_limits<int>::max()));
    };
    const int top1 = inner(top, 1);
    const int bottom1 = inner(bottom, -1);
    const int left1 = inner(left, 1);
    const int right1 = inner(right, -1);
    for (const Rect& strip :
         {Rect{left, top, right, top1}, Rect{left, bottom1, right, bottom},
          Rect{left, top1, left1, bottom1}, Rect{right1, top1, right, bottom1}}) {
        if (Status s = dc.fill(strip, *plain); !s) {
            return s;
        }
    }
    return Status::Ok();
}

Status ShapeHelper::sunkenEdge(Surface& dc, const Rect& box) const {
    const long long width = static_cast<long long>(box.right) - box.left;
    const long long height = static_cast<long long>(box.bottom) - box.top;
    if (width < 4 || height < 4) {
        return frameBox(dc, box.left, box.top, box.right, box.bottom, kSysButtonShadow);
    }
    // Outer ring: shadow / highlight; inner ring: dark shadow / light.
    const auto ring = [&](const Rect& r, Colour topLeft, Colour bottomRight) -> Status {
        const Colour tl = *translateColor(topLeft);
        const Colour br = *translateColor(bottomRight);
        for (const auto& [strip, c] :
             {std::pair{Rect{r.left, r.top, r.right - 1, r.top + 1}, tl},
              std::pair{Rect{r.left, r.top + 1, r.left + 1, r.bottom - 1}, tl},
              std::pair{Rect{r.left, r.bottom - 1, r.right, r.bottom}, br},
              std::pair{Rect{r.right - 1, r.top, r.right, r.bottom - 1}, br}}) {
            if (Status s = dc.fill(strip, c); !s) {
                return s;
            }
        }
        return Status::Ok();
    };
    if (Status s = ring(box, kSysButtonShadow, kSysButtonHighlight); !s) {
        return s;
    }
    return ring(Rect{box.left + 1, box.top + 1, box.right - 1, box.bottom - 1}, kSysDarkShadow,
                kSysLight);
}

Status ShapeHelper::drawLine(Surface& dc, int x1, int y1, int x2, int y2, Colour colour,
                             int width) const {
    const auto plain = translateColor(colour);
    if (!plain) {
        return badColour();
    }
    return dc.line(x1, y1, x2, y2, *plain, width);
}

Status ShapeHelper::drawText(Surface& dc, const Rect& box, std::string_view utf8,
                             Colour colour) const {
    const auto plain = translateColor(colour);
    if (!plain) {
        return badColour();
    }
    return dc.text(box, utf8, *plain);
}

Status ShapeHelper::drawSizeGrip(Surface& dc, const Rect& box) const {
    // Three diagonal rows of two-pixel dots in the bottom-right corner.
    const Colour dot = *translateColor(kSysButtonShadow);
    const Colour glint = *translateColor(kSysButtonHighlight);
    const long long right = static_cast<long long>(box.right);
    const long long bottom = static_cast<long long>(box.bottom);
    for (int row = 0; row < 3; ++row) {
        for (int col = 0; col <= row; ++col) {
            const long long x = right - 4 - 4LL * col;
            const long long y = bottom - 4 - 4LL * (2 - row);
            if (x < box.left || y < box.top || x < std::numeric_limits<int>::min()) {
                continue;
            }
            const int xi = static_cast<int>(x);
            const int yi = static_cast<int>(y);
            if (Status s = dc.fill(Rect{xi + 1, yi + 1, xi + 3, yi + 3}, glint); !s) {
                return s;
            }
            if (Status s = dc.fill(Rect{xi, yi, xi + 2, yi + 2}, dot); !s) {
                return s;
            }
        }
    }
    return Status::Ok();
}

}  // namespace kickvane::skin
