#pragma once

#include <QImage>

#include "platform/status.h"
#include "skin/surface.h"

namespace kickvane::skin {

// One frame of a picture: the full-width band of `height` rows that starts at row `top`.
struct Frame {
    int width = 0;
    int height = 0;
    int top = 0;
};

// Frame `index` of a picture cut into `count` equal bands from the top down. The band height is
// the picture height divided by `count`, rounded to a whole pixel.
Frame frameOf(const QImage& picture, int count, int index);

// Draws `frame` of `source` stretched to `target`: the four corners keep their size, the four
// sides stretch along their length and the middle along both axes. Sets the halftone stretch mode
// and copies nine pieces, in the order: top-left, top-right, bottom-left, bottom-right corner, top,
// left, right, bottom side, middle. Pieces of zero size are skipped (a margin of 0 empties its
// side). A target narrower than left + right margin or lower than top + bottom margin draws
// nothing and is no error. Fails, without drawing, on negative margins, margins that do not fit
// the frame, and a frame outside the picture; stops at the first failing copy.
Status paintNine(Surface& target, const QImage& source, const Margins& margins,
                 const Rect& targetRect, const Frame& frame);

// The same with keyed copies: target pixels stay where the frame has the colour `key`.
Status paintNineKeyed(Surface& target, const QImage& source, const Margins& margins,
                      const Rect& targetRect, const Frame& frame, Colour key);

// PaintNine's pieces copied in the surface's current stretch mode, for parts drawn with plain
// stretching copies.
Status paintNineInCurrentMode(Surface& target, const QImage& source, const Margins& margins,
                              const Rect& targetRect, const Frame& frame);

}  // namespace kickvane::skin
