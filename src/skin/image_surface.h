#pragma once

#include <QImage>

#include "skin/surface.h"

namespace kickvane::skin {

// A surface that draws into a QImage the caller owns. Starts in the plain stretch mode.
// Text needs a running QGuiApplication (fonts); without one, Text fails and draws nothing.
class ImageSurface final : public Surface {
public:
    explicit ImageSurface(QImage& target) : target_(target) {}

    void setStretchMode(StretchMode mode) override { mode_ = mode; }
    StretchMode stretchMode() const { return mode_; }

    Status copy(const QImage& source, const Piece& from, const Piece& to) override;
    Status copyKeyed(const QImage& source, const Piece& from, const Piece& to, Colour key) override;
    Status fill(const Rect& area, Colour colour) override;
    Status line(int x1, int y1, int x2, int y2, Colour colour, int width) override;
    Status text(const Rect& box, std::string_view utf8, Colour colour) override;

private:
    Status checkTarget() const;
    // Checks a copy before it draws: a failure, or ok with `draw` false when nothing would show.
    Status checkCopy(const QImage& source, const Piece& from, const Piece& to, bool& draw) const;

    QImage& target_;
    StretchMode mode_ = StretchMode::Plain;
};

}  // namespace kickvane::skin
