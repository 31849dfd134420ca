#pragma once

#include <QColor>
#include <QFont>
#include <QImage>
#include <QPainter>
#include <QPolygonF>
#include <QString>
#include <cstdint>
#include <filesystem>

// Shared pieces of the artwork: fonts, colours and the small drawings that several pictures use.
namespace kickvane::artwork {

// Loads the DejaVu faces from their Debian folder so that the pictures never depend on which
// font fontconfig would pick. False when a face is missing.
bool LoadFonts();
QFont Font(int pixelSize, bool bold = false, bool condensed = false);

// The brand colours: pitch green and a warm gold accent.
inline const QColor kGreen(0x1E, 0x7B, 0x4B);
inline const QColor kDeepGreen(0x12, 0x4D, 0x2F);
inline const QColor kGold(0xF2, 0xC1, 0x4E);

// Small deterministic random numbers, so that every build draws the same crowd.
class Dice {
public:
    explicit Dice(uint32_t seed) : state_(seed) {}
    double next();  // in [0, 1)
    int below(int n) { return static_cast<int>(next() * n); }

private:
    uint32_t state_;
};

QImage NewCanvas(int width, int height, const QColor& fill = Qt::transparent);
bool SaveJpeg(const QImage& image, const std::filesystem::path& file);

void FillVertical(QPainter& painter, const QRectF& rect, const QColor& top, const QColor& bottom);

// A stitched football seen in three dimensions: twelve pentagons and twenty hexagons, with
// optional coloured bands along great circles and small stars in the pentagons.
struct BallStyle {
    QColor pentagon = QColor(0x1A, 0x1A, 0x1A);
    QColor hexagon = Qt::white;
    QColor seam = QColor(0x8C, 0x8C, 0x8C);
    QColor accent = Qt::white;  // fill of every accentEvery-th hexagon, when accentEvery > 0
    int accentEvery = 0;
    QColor band = Qt::transparent;  // two crossing bands when opaque
    QColor star = Qt::transparent;  // a star in each pentagon when opaque
    double tiltX = 0.35;
    double tiltY = -0.45;
};
void DrawBall(QPainter& painter, const QPointF& centre, double radius, const BallStyle& style,
              bool withShadow = true);

// A standing footballer seen from the front; `feet` is the point between the boots.
struct Kit {
    QColor shirt;
    QColor shorts;
    QColor socks;
    QColor trim = Qt::white;
    int number = 10;
};
void DrawPlayer(QPainter& painter, const QPointF& feet, double height, const Kit& kit,
                const QColor& skin = QColor(0xE0, 0xAC, 0x82),
                const QColor& hair = QColor(0x2B, 0x1E, 0x16));

// Mown patterns of the pitch variants.
enum class Mowing { Stripes, Checks, Ovals, Plaid };

// A top-down pitch with its white markings and a margin of grass around it.
QImage PitchTexture(Mowing mowing, int pixelsPerMetre = 8);

// Draws `texture` into the four corners of `quad` (top-left, top-right, bottom-right,
// bottom-left), which gives the pitch its camera perspective.
void DrawInQuad(QPainter& painter, const QImage& texture, const QPolygonF& quad);

// A five-pointed star centred on `centre`.
QPolygonF Star(const QPointF& centre, double outer, double inner, double rotation = 0);

// Rows of supporters in the stands, in front of a dark stand.
void DrawCrowd(QPainter& painter, const QRectF& area, uint32_t seed, double headSize);

// The football roundel of the wordmark and the icons.
void DrawEmblem(QPainter& painter, const QRectF& rect);

}  // namespace kickvane::artwork
