#include "skin/shape_helper.h"

#include <algorithm>
#include <array>
#include <limits>

namespace kickvane::skin {
namespace {

constexpr Colour kSystemFlag = 0x80000000u;

// The theme's system colours, by index: a soft blue-grey desktop to match the pictures.
constexpr std::array<Colour, 31> kSystemColours = {
    Rgb(200, 208, 220),  //  0 scroll bar
    Rgb(58, 110, 165),   //  1 desktop
    Rgb(74, 128, 204),   //  2 active caption
    Rgb(160, 176, 200),  //  3 inactive caption
    Rgb(250, 251, 253),  //  4 menu
    Rgb(255, 255, 255),  //  5 window
    Rgb(0, 0, 0),        //  6 window frame
    Rgb(0, 0, 0),        //  7 menu text
    Rgb(0, 0, 0),        //  8 window text
    Rgb(255, 255, 255),  //  9 caption text
    Rgb(212, 218, 228),  // 10 active border
    Rgb(212, 218, 228),  // 11 inactive border
    Rgb(171, 171, 171),  // 12 application workspace
    Rgb(74, 128, 204),   // 13 highlight
    Rgb(255, 255, 255),  // 14 highlight text
    Rgb(236, 239, 244),  // 15 button face
    Rgb(160, 172, 190),  // 16 button shadow
    Rgb(150, 156, 166),  // 17 grey text
    Rgb(0, 0, 0),        // 18 button text
    Rgb(230, 234, 240),  // 19 inactive caption text
    Rgb(255, 255, 255),  // 20 button highlight
    Rgb(96, 106, 122),   // 21 dark shadow
    Rgb(246, 248, 251),  // 22 light
    Rgb(0, 0, 0),        // 23 tooltip text
    Rgb(255, 255, 225),  // 24 tooltip background
    Rgb(184, 184, 184),  // 25 (unused by the desktop; kept grey)
    Rgb(0, 102, 204),    // 26 hot link
    Rgb(150, 180, 228),  // 27 active caption gradient
    Rgb(200, 210, 226),  // 28 inactive caption gradient
    Rgb(74, 128, 204),   // 29 menu highlight
    Rgb(236, 239, 244),  // 30 menu bar
};

Status BadColour() {
    return Status::Fail("not a colour value");
}

}  // namespace

std::optional<Colour> ShapeHelper::TranslateColor(Colour colour) {
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

std::optional<Colour> ShapeHelper::ShadeColor(Colour colour, int amount) {
    const auto rgb = TranslateColor(colour);
    if (!rgb) {
        return std::nullopt;
    }
    const auto shade = [amount](int channel) {
        return static_cast<int>(
            std::clamp<long long>(static_cast<long long>(channel) + amount, 0, 255));
    };
    return Rgb(shade(RedOf(*rgb)), shade(GreenOf(*rgb)), shade(BlueOf(*rgb)));
}

Status ShapeHelper::FillBox(Surface& dc, int left, int top, int right, int bottom,
                            Colour colour) const {
    const auto rgb = TranslateColor(colour);
    if (!rgb) {
        return BadColour();
    }
    return dc.Fill(Rect{left, top, right, bottom}, *rgb);
}

Status ShapeHelper::FrameBox(Surface& dc, int left, int top, int right, int bottom,
                             Colour colour) const {
    const auto rgb = TranslateColor(colour);
    if (!rgb) {
        return BadColour();
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
        if (Status s = dc.Fill(strip, *rgb); !s) {
            return s;
        }
    }
    return Status::Ok();
}

Status ShapeHelper::SunkenEdge(Surface& dc, const Rect& box) const {
    const long long width = static_cast<long long>(box.right) - box.left;
    const long long height = static_cast<long long>(box.bottom) - box.top;
    if (width < 4 || height < 4) {
        return FrameBox(dc, box.left, box.top, box.right, box.bottom, kSysButtonShadow);
    }
    // Outer ring: shadow / highlight; inner ring: dark shadow / light.
    const auto ring = [&](const Rect& r, Colour topLeft, Colour bottomRight) -> Status {
        const Colour tl = *TranslateColor(topLeft);
        const Colour br = *TranslateColor(bottomRight);
        for (const auto& [strip, c] :
             {std::pair{Rect{r.left, r.top, r.right - 1, r.top + 1}, tl},
              std::pair{Rect{r.left, r.top + 1, r.left + 1, r.bottom - 1}, tl},
              std::pair{Rect{r.left, r.bottom - 1, r.right, r.bottom}, br},
              std::pair{Rect{r.right - 1, r.top, r.right, r.bottom - 1}, br}}) {
            if (Status s = dc.Fill(strip, c); !s) {
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

Status ShapeHelper::DrawLine(Surface& dc, int x1, int y1, int x2, int y2, Colour colour,
                             int width) const {
    const auto rgb = TranslateColor(colour);
    if (!rgb) {
        return BadColour();
    }
    return dc.Line(x1, y1, x2, y2, *rgb, width);
}

Status ShapeHelper::DrawText(Surface& dc, const Rect& box, std::string_view utf8,
                             Colour colour) const {
    const auto rgb = TranslateColor(colour);
    if (!rgb) {
        return BadColour();
    }
    return dc.Text(box, utf8, *rgb);
}

Status ShapeHelper::DrawThemePart(Surface& dc, std::string_view className, int part, int state,
                                  const Rect& box) const {
    (void)state;
    if (className == "Status" && part == 3) {
        // Size grip: three diagonal rows of two-pixel dots in the bottom-right corner.
        const Colour dot = *TranslateColor(kSysButtonShadow);
        const Colour glint = *TranslateColor(kSysButtonHighlight);
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
                if (Status s = dc.Fill(Rect{xi + 1, yi + 1, xi + 3, yi + 3}, glint); !s) {
                    return s;
                }
                if (Status s = dc.Fill(Rect{xi, yi, xi + 2, yi + 2}, dot); !s) {
                    return s;
                }
            }
        }
        return Status::Ok();
    }
    if (Status s = FillBox(dc, box.left, box.top, box.right, box.bottom, kSysButtonFace); !s) {
        return s;
    }
    return FrameBox(dc, box.left, box.top, box.right, box.bottom, kSysButtonShadow);
}

}  // namespace kickvane::skin
