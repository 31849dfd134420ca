#pragma once

#include <QImage>

#include "skin/surface.h"

namespace kickvane::skin {

// A surface that draws into a QImage the caller owns. Starts in the plain stretch mode.
// Text needs a running QGuiApplication (fonts); without one, Text fails and draws nothing.
class ImageSurface final : public Surface {
public:
    explicit ImageSurface(QImage& target) : target_(target) {}

    void SetStretchMode(StretchMode mode) override { mode_ = mode; }
    StretchMode stretchMode() const { return mode_; }

    Status Copy(const QImage& source, const Piece& from, const Piece& to) override;
    Status CopyKeyed(const QImage& source, const Piece& from, const Piece& to, Colour key) override;
    Status Fill(const Rect& area, Colour rgb) override;
    Status Line(int x1, int y1, int x2, int y2, Colour rgb, int width) override;
    Status Text(const Rect& box, std::string_view utf8, Colour rgb) override;

private:
    Status CheckTarget() const;
    // Checks a copy before it draws: a failure, or ok with `draw` false when nothing would show.
    Status CheckCopy(const QImage& source, const Piece& from, const Piece& to, bool& draw) const;

    QImage& target_;
    StretchMode mode_ = StretchMode::Plain;
};

}  // namespace kickvane::skin
