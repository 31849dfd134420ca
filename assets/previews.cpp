#include <QLinearGradient>
#include <QPainterPath>
#include <QRadialGradient>
#include <array>
#include <cmath>
#include <functional>
#include <string>

#include "artwork.h"
#include "catalog/catalog.h"
#include "drawing.h"

namespace kickvane::artwork {

namespace {

namespace fs = std::filesystem;
using catalog::GroupId;

constexpr int kWidth = 597;
constexpr int kHeight = 397;
constexpr double kCaptionTop = 337;

QString FromUtf8(std::string_view text) {
    return QString::fromUtf8(text.data(), static_cast<qsizetype>(text.size())).trimmed();
}

using Scene = std::function<void(QPainter&)>;

// Every preview: the scene, then a dark band at the bottom with the entry's heading and label.
QImage Preview(const QString& heading, const QString& label, const Scene& scene) {
    QImage image = NewCanvas(kWidth, kHeight, Qt::black);
    QPainter p(&image);
    p.setRenderHint(QPainter::Antialiasing);
    p.setRenderHint(QPainter::TextAntialiasing);
    scene(p);
    QLinearGradient band(0, kCaptionTop - 24, 0, kHeight);
    band.setColorAt(0, QColor(8, 18, 12, 0));
    band.setColorAt(0.3, QColor(8, 18, 12, 190));
    band.setColorAt(1, QColor(8, 18, 12, 235));
    p.fillRect(QRectF(0, kCaptionTop - 24, kWidth, kHeight), band);
    p.fillRect(QRectF(22, kCaptionTop + 6, 4, 44), kGold);
    p.setPen(kGold);
    p.setFont(Font(13, true));
    p.drawText(QRectF(36, kCaptionTop + 2, 500, 18), Qt::AlignLeft | Qt::AlignVCenter,
               heading.toUpper());
    p.setPen(Qt::white);
    p.setFont(Font(25, true));
    p.drawText(QRectF(36, kCaptionTop + 20, 540, 34), Qt::AlignLeft | Qt::AlignVCenter, label);
    p.setPen(QColor(255, 255, 255, 110));
    p.setFont(Font(11, true));
    p.drawText(QRectF(0, kCaptionTop + 30, kWidth - 18, 20), Qt::AlignRight | Qt::AlignVCenter,
               QStringLiteral("Kickvane"));
    return image;
}

// ---- Shared backgrounds ------------------------------------------------------------------------

// Stripes of mown grass that run towards a vanishing point above the picture.
void DrawGrassFloor(QPainter& p, double top, double bottom) {
    p.fillRect(QRectF(0, top, kWidth, bottom - top), QColor(0x3B, 0x87, 0x3C));
    p.setPen(Qt::NoPen);
    p.setBrush(QColor(0x4C, 0xA0, 0x4A));
    for (int i = -12; i <= 12; i += 2) {
        QPolygonF stripe{QPointF(298 + i * 44, top), QPointF(298 + (i + 1) * 44, top),
                         QPointF(298 + (i + 1) * 150, bottom), QPointF(298 + i * 150, bottom)};
        p.drawPolygon(stripe);
    }
    QLinearGradient haze(0, top, 0, top + 60);
    haze.setColorAt(0, QColor(0, 0, 0, 110));
    haze.setColorAt(1, QColor(0, 0, 0, 0));
    p.fillRect(QRectF(0, top, kWidth, 60), haze);
}

void DrawStudio(QPainter& p, const QColor& inner, const QColor& outer) {
    QRadialGradient light(QPointF(298, 150), 380);
    light.setColorAt(0, inner);
    light.setColorAt(1, outer);
    p.fillRect(QRectF(0, 0, kWidth, kHeight), light);
}

// A broadcast camera's view of the pitch: crowd at the top, the near half of the pitch below.
void DrawBroadcastPitch(QPainter& p, Mowing mowing = Mowing::Stripes) {
    DrawCrowd(p, QRectF(0, 0, kWidth, 58), 7, 5);
    p.fillRect(QRectF(0, 52, kWidth, 8), QColor(0x18, 0x1C, 0x24));
    p.fillRect(QRectF(0, 58, kWidth, kHeight - 58), QColor(0x3B, 0x87, 0x3C));
    static const QImage texture = PitchTexture(mowing);
    DrawInQuad(
        p, texture,
        QPolygonF{QPointF(-260, 58), QPointF(857, 58), QPointF(1900, 640), QPointF(-1303, 640)});
}

// ---- Balls --------------------------------------------------------------------------------------

BallStyle BallVariant(int index) {
    BallStyle s;
    switch (index) {
        case 1:  // orange panels with warm accents
            s.pentagon = QColor(0xE8, 0x62, 0x24);
            s.accent = QColor(0xF6, 0xC3, 0x4A);
            s.accentEvery = 4;
            s.seam = QColor(0xB0, 0xA8, 0xA0);
            break;
        case 2:  // white with blue swirls
            s.pentagon = Qt::white;
            s.band = QColor(0x1F, 0x5F, 0xC4);
            s.seam = QColor(0xC4, 0xC8, 0xD0);
            break;
        case 3:  // navy pentagons with white stars, silver hexagons
            s.pentagon = QColor(0x1A, 0x27, 0x55);
            s.star = Qt::white;
            s.accent = QColor(0xC5, 0xCD, 0xDA);
            s.accentEvery = 3;
            s.seam = QColor(0x9A, 0xA2, 0xB2);
            break;
        default:
            break;
    }
    return s;
}

void SceneBall(QPainter& p, int variant) {
    DrawStudio(p, QColor(0x2F, 0x86, 0x55), QColor(0x08, 0x24, 0x15));
    DrawGrassFloor(p, 268, kHeight);
    DrawBall(p, QPointF(298, 170), 118, BallVariant(variant));
}

void SceneAllBalls(QPainter& p) {
    DrawStudio(p, QColor(0x2F, 0x86, 0x55), QColor(0x08, 0x24, 0x15));
    DrawGrassFloor(p, 230, kHeight);
    for (int i = 0; i < 4; ++i) {
        DrawBall(p, QPointF(84 + i * 143, 196), 56, BallVariant(i));
    }
}

// ---- Pitches ------------------------------------------------------------------------------------

void ScenePitch(QPainter& p, Mowing mowing) {
    FillVertical(p, QRectF(0, 0, kWidth, 40), QColor(0x0E, 0x14, 0x20), QColor(0x1A, 0x22, 0x30));
    DrawCrowd(p, QRectF(0, 22, kWidth, 46), 11, 4);
    p.fillRect(QRectF(0, 66, kWidth, kHeight - 66), QColor(0x37, 0x7E, 0x38));
    const QImage texture = PitchTexture(mowing);
    DrawInQuad(p, texture,
               QPolygonF{QPointF(88, 66), QPointF(509, 66), QPointF(690, 372), QPointF(-93, 372)});
}

// ---- Adboards -----------------------------------------------------------------------------------

struct Board {
    QColor from, to, text;
    QString words;
    enum Motif { Plain, Stars, BigStar, Waves, Ball } motif = Plain;
};

QImage BoardImage(const Board& b) {
    QImage image = NewCanvas(320, 64);
    QPainter p(&image);
    p.setRenderHint(QPainter::Antialiasing);
    QLinearGradient fill(0, 0, 320, 0);
    fill.setColorAt(0, b.from);
    fill.setColorAt(1, b.to);
    p.fillRect(image.rect(), fill);
    double textLeft = 12;
    switch (b.motif) {
        case Board::Stars:
            p.setPen(Qt::NoPen);
            p.setBrush(QColor(255, 255, 255, 200));
            for (int i = 0; i < 5; ++i) {
                p.drawPolygon(Star(QPointF(22 + (i % 2) * 14, 12 + i * 10), 6, 2.6));
            }
            textLeft = 52;
            break;
        case Board::BigStar:
            p.setPen(Qt::NoPen);
            p.setBrush(QColor(0xFF, 0xD4, 0x00));
            p.drawPolygon(Star(QPointF(34, 33), 24, 10));
            textLeft = 64;
            break;
        case Board::Waves:
            for (int i = 0; i < 4; ++i) {
                static const std::array<QColor, 4> waves{
                    QColor(0x1F, 0x9E, 0x4B), QColor(0xF6, 0xC3, 0x2A), QColor(0xE2, 0x3A, 0x2E),
                    QColor(0x1E, 0x6F, 0xD9)};
                QPainterPath wave;
                wave.moveTo(0, 64);
                wave.cubicTo(20 + i * 12, 40 - i * 10, 40 + i * 12, 70 - i * 12, 70 + i * 16, 0);
                wave.lineTo(80 + i * 16, 0);
                wave.cubicTo(52 + i * 12, 70 - i * 12, 30 + i * 12, 40 - i * 10, 12 + i * 4, 64);
                p.fillPath(wave, waves[static_cast<size_t>(i)]);
            }
            textLeft = 120;
            break;
        case Board::Ball: {
            BallStyle ball;
            DrawBall(p, QPointF(32, 32), 22, ball, false);
            textLeft = 62;
            break;
        }
        case Board::Plain:
            break;
    }
    p.setPen(b.text);
    p.setFont(Font(30, true, true));
    p.drawText(QRectF(textLeft, 0, 320 - textLeft - 8, 64), Qt::AlignCenter, b.words);
    return image;
}

std::array<Board, 4> BoardSet(int variant) {
    const QColor white = Qt::white;
    switch (variant) {
        case 1:  // night cup: deep blue and silver with stars
            return {{{QColor(0x0A, 0x16, 0x40), QColor(0x16, 0x2C, 0x6E), white,
                      QStringLiteral("STAR CUP"), Board::Stars},
                     {QColor(0x12, 0x12, 0x1A), QColor(0x2A, 0x2E, 0x3C), QColor(0xC8, 0xCE, 0xDA),
                      QStringLiteral("FOOTBALL NIGHT"), Board::Plain},
                     {QColor(0x16, 0x2C, 0x6E), QColor(0x0A, 0x16, 0x40), white,
                      QStringLiteral("STAR CUP"), Board::Stars},
                     {QColor(0xC8, 0xCE, 0xDA), QColor(0xF2, 0xF4, 0xF8), QColor(0x0A, 0x16, 0x40),
                      QStringLiteral("RESPECT"), Board::Plain}}};
        case 2:  // red and gold
            return {{{QColor(0xC8, 0x10, 0x1E), QColor(0xDA, 0x25, 0x1D), QColor(0xFF, 0xD4, 0x00),
                      QStringLiteral("VIỆT NAM"), Board::BigStar},
                     {QColor(0xFF, 0xD4, 0x00), QColor(0xF6, 0xB8, 0x00), QColor(0xC8, 0x10, 0x1E),
                      QStringLiteral("CỐ LÊN!"), Board::Plain},
                     {QColor(0xDA, 0x25, 0x1D), QColor(0xC8, 0x10, 0x1E), QColor(0xFF, 0xD4, 0x00),
                      QStringLiteral("BÓNG ĐÁ VIỆT"), Board::BigStar},
                     {QColor(0xF7, 0xF7, 0xF7), QColor(0xE8, 0xE8, 0xE8), QColor(0xC8, 0x10, 0x1E),
                      QStringLiteral("VÔ ĐỊCH!"), Board::Plain}}};
        case 3:  // summer tournament: bright waves
            return {{{QColor(0xF4, 0xF1, 0xE8), white, QColor(0x1A, 0x1A, 0x1A),
                      QStringLiteral("2010"), Board::Waves},
                     {QColor(0x1F, 0x9E, 0x4B), QColor(0x14, 0x7A, 0x38), white,
                      QStringLiteral("KICK OFF"), Board::Plain},
                     {QColor(0xF6, 0xC3, 0x2A), QColor(0xF0, 0xA8, 0x20), QColor(0x1A, 0x1A, 0x1A),
                      QStringLiteral("WORLD FOOTBALL"), Board::Plain},
                     {white, QColor(0xF4, 0xF1, 0xE8), QColor(0xE2, 0x3A, 0x2E),
                      QStringLiteral("2010"), Board::Waves}}};
        default:
            return {{{kGreen, kDeepGreen, white, QStringLiteral("KICKVANE"), Board::Ball},
                     {QColor(0x1E, 0x5F, 0xC8), QColor(0x18, 0x4A, 0x9C), white,
                      QStringLiteral("BÓNG ĐÁ"), Board::Plain},
                     {QColor(0xF2, 0xC1, 0x4E), QColor(0xF0, 0xA8, 0x30), QColor(0x1A, 0x1A, 0x1A),
                      QStringLiteral("GOAL!"), Board::Ball},
                     {white, QColor(0xEE, 0xEE, 0xEE), kGreen, QStringLiteral("FAIR PLAY"),
                      Board::Plain}}};
    }
}

void SceneAdboards(QPainter& p, int variant) {
    DrawCrowd(p, QRectF(0, 0, kWidth, 150), 21 + static_cast<uint32_t>(variant), 7);
    // The grass in front of the boards, with the touchline.
    p.fillRect(QRectF(0, 150, kWidth, kHeight - 150), QColor(0x3B, 0x87, 0x3C));
    static const QImage grass = PitchTexture(Mowing::Stripes).copy(0, 0, 480, 160);
    DrawInQuad(
        p, grass,
        QPolygonF{QPointF(-20, 170), QPointF(640, 182), QPointF(1300, 460), QPointF(-900, 460)});
    // The row of boards recedes to the right: each is a little narrower and lower than the last.
    const std::array<Board, 4> set = BoardSet(variant);
    auto topAt = [](double x) { return 112 + (x + 20) * 0.062; };
    auto bottomAt = [](double x) { return 192 - (x + 20) * 0.0; };
    double x = -20;
    double width = 250;
    for (int i = 0; x < kWidth; ++i) {
        const QImage board = BoardImage(set[static_cast<size_t>(i % 4)]);
        const double next = x + width;
        DrawInQuad(p, board,
                   QPolygonF{QPointF(x, topAt(x)), QPointF(next, topAt(next)),
                             QPointF(next, bottomAt(next) - (next + 20) * 0.02),
                             QPointF(x, bottomAt(x) - (x + 20) * 0.02)});
        x = next + 3;
        width *= 0.8;
    }
    DrawPlayer(p, QPointF(170, 318), 124,
               Kit{QColor(0xD6, 0x3B, 0x3B), Qt::white, QColor(0xD6, 0x3B, 0x3B)});
    DrawBall(p, QPointF(232, 312), 10, BallStyle{});
    DrawPlayer(p, QPointF(430, 290), 100,
               Kit{QColor(0x2F, 0x6F, 0xC8), QColor(0x1A, 0x2A, 0x55), Qt::white, Qt::white, 4});
}

// ---- Scoreboards --------------------------------------------------------------------------------

struct Bug {
    QColor team, teamText, score, scoreText, clock, clockText, accent;
    enum Shape { Flat, Pill, Slant, Stacked } shape;
    QString tag;
};

Bug BugVariant(int index) {
    switch (index) {
        case 1:
            return {QColor(0x0E, 0x3A, 0x7A),
                    Qt::white,
                    Qt::white,
                    QColor(0x0E, 0x3A, 0x7A),
                    QColor(0x1C, 0x5D, 0xB8),
                    Qt::white,
                    QColor(0x6C, 0xC4, 0xFF),
                    Bug::Slant,
                    QStringLiteral("HD")};
        case 2:
            return {QColor(0x15, 0x15, 0x15), Qt::white, QColor(0xC8, 0x10, 0x2E), Qt::white,
                    QColor(0x2A, 0x2A, 0x2A), Qt::white, QColor(0xC8, 0x10, 0x2E), Bug::Flat,
                    QStringLiteral("HD")};
        case 3:
            return {QColor(0x0B, 0x1E, 0x4A), Qt::white,
                    QColor(0xFF, 0xC6, 0x29), QColor(0x0B, 0x1E, 0x4A),
                    QColor(0x13, 0x2E, 0x6A), QColor(0xFF, 0xC6, 0x29),
                    QColor(0xFF, 0xC6, 0x29), Bug::Pill,
                    QStringLiteral("LIVE")};
        case 4:
            return {QColor(0x00, 0x6B, 0x64),   Qt::white,
                    QColor(0xB6, 0xE0, 0x2C),   QColor(0x10, 0x30, 0x2C),
                    QColor(0x00, 0x52, 0x4C),   Qt::white,
                    QColor(0xB6, 0xE0, 0x2C),   Bug::Pill,
                    QStringLiteral("TRỰC TIẾP")};
        case 5:
            return {QColor(0x12, 0x12, 0x12), QColor(0xE8, 0xCB, 0x7A),
                    QColor(0xC9, 0xA3, 0x4A), QColor(0x12, 0x12, 0x12),
                    QColor(0x26, 0x22, 0x1A), QColor(0xE8, 0xCB, 0x7A),
                    QColor(0xC9, 0xA3, 0x4A), Bug::Slant,
                    QStringLiteral("VIP")};
        case 6:
            return {QColor(0x0A, 0x16, 0x40),   Qt::white,
                    QColor(0xC8, 0xCE, 0xD8),   QColor(0x0A, 0x16, 0x40),
                    QColor(0x16, 0x2C, 0x6E),   Qt::white,
                    QColor(0xC8, 0xCE, 0xD8),   Bug::Stacked,
                    QStringLiteral("TRỰC TIẾP")};
        case 7:
            return {QColor(0xB3, 0x12, 0x1B),
                    Qt::white,
                    Qt::white,
                    QColor(0xB3, 0x12, 0x1B),
                    QColor(0x1A, 0x1A, 0x1A),
                    Qt::white,
                    QColor(0xFF, 0xD4, 0x3A),
                    Bug::Stacked,
                    QStringLiteral("LIVE")};
        default:
            return {QColor(0xF2, 0xF2, 0xF2),
                    QColor(0x22, 0x22, 0x22),
                    QColor(0x2B, 0x2B, 0x2B),
                    Qt::white,
                    QColor(0xD4, 0xD4, 0xD4),
                    QColor(0x22, 0x22, 0x22),
                    QColor(0x9A, 0x9A, 0x9A),
                    Bug::Flat,
                    QString()};
    }
}

const QColor kHomeColour(0xD6, 0x3B, 0x3B);
const QColor kAwayColour(0x2F, 0x6F, 0xC8);

void FillSegment(QPainter& p, const QRectF& rect, const QColor& colour) {
    QLinearGradient g(rect.topLeft(), rect.bottomLeft());
    g.setColorAt(0, colour.lighter(118));
    g.setColorAt(0.5, colour);
    g.setColorAt(1, colour.darker(115));
    p.fillRect(rect, g);
}

// The score graphic in its own units: 270 wide, 34 high (the stacked form is 190 by 62).
void DrawBug(QPainter& p, const Bug& b) {
    p.save();
    p.setRenderHint(QPainter::Antialiasing);
    const QFont teamFont = Font(17, true, true);
    const QFont scoreFont = Font(19, true);
    const QFont clockFont = Font(16, true);
    QPainterPath shadow;
    if (b.shape == Bug::Stacked) {
        shadow.addRoundedRect(QRectF(2, 3, 250, 62), 6, 6);
        p.fillPath(shadow, QColor(0, 0, 0, 90));
        QPainterPath body;
        body.addRoundedRect(QRectF(0, 0, 190, 62), 6, 6);
        p.setClipPath(body);
        FillSegment(p, QRectF(0, 0, 190, 62), b.team);
        for (int row = 0; row < 2; ++row) {
            const QRectF line(0, row * 31, 190, 31);
            p.fillRect(QRectF(0, line.top() + 4, 6, 23), row == 0 ? kHomeColour : kAwayColour);
            p.setPen(b.teamText);
            p.setFont(teamFont);
            p.drawText(line.adjusted(16, 0, 0, 0), Qt::AlignLeft | Qt::AlignVCenter,
                       row == 0 ? QStringLiteral("HAN") : QStringLiteral("SGN"));
            FillSegment(p, QRectF(146, line.top(), 44, 31), b.score);
            p.setPen(b.scoreText);
            p.setFont(scoreFont);
            p.drawText(QRectF(146, line.top(), 44, 31), Qt::AlignCenter,
                       row == 0 ? QStringLiteral("2") : QStringLiteral("1"));
        }
        p.fillRect(QRectF(0, 30.5, 146, 1), QColor(255, 255, 255, 60));
        p.setClipping(false);
        QPainterPath clock;
        clock.addRoundedRect(QRectF(194, 0, 58, 30), 5, 5);
        p.fillPath(clock, b.clock);
        p.setPen(b.clockText);
        p.setFont(clockFont);
        p.drawText(QRectF(194, 0, 58, 30), Qt::AlignCenter, QStringLiteral("67:24"));
        p.setPen(Qt::NoPen);
        p.setBrush(b.accent);
        p.drawPolygon(Star(QPointF(223, 46), 9, 3.8));
        p.restore();
        return;
    }

    const double h = 34;
    QPainterPath body;
    switch (b.shape) {
        case Bug::Pill:
            body.addRoundedRect(QRectF(0, 0, 270, h), h / 2, h / 2);
            break;
        case Bug::Slant:
            body.addPolygon(
                QPolygonF{QPointF(10, 0), QPointF(270, 0), QPointF(260, h), QPointF(0, h)});
            body.closeSubpath();
            break;
        default:
            body.addRect(QRectF(0, 0, 270, h));
            break;
    }
    p.fillPath(body.translated(2, 3), QColor(0, 0, 0, 90));
    p.setClipPath(body);
    const QRectF clock(0, 0, 66, h);
    const QRectF home(66, 0, 70, h);
    const QRectF score(136, 0, 64, h);
    const QRectF away(200, 0, 70, h);
    FillSegment(p, clock, b.clock);
    FillSegment(p, home, b.team);
    FillSegment(p, score, b.score);
    FillSegment(p, away, b.team);
    p.fillRect(QRectF(home.left(), 0, 5, h), kHomeColour);
    p.fillRect(QRectF(away.right() - 5, 0, 5, h), kAwayColour);
    if (b.shape == Bug::Flat) {
        p.fillRect(QRectF(0, h - 3, 270, 3), b.accent);
    }
    p.setPen(b.clockText);
    p.setFont(clockFont);
    p.drawText(clock.adjusted(b.shape == Bug::Pill ? 6 : 2, 0, 0, 0), Qt::AlignCenter,
               QStringLiteral("67:24"));
    p.setPen(b.teamText);
    p.setFont(teamFont);
    p.drawText(home, Qt::AlignCenter, QStringLiteral("HAN"));
    p.drawText(away, Qt::AlignCenter, QStringLiteral("SGN"));
    p.setPen(b.scoreText);
    p.setFont(scoreFont);
    p.drawText(score, Qt::AlignCenter, QStringLiteral("2 – 1"));
    p.restore();
}

void DrawTag(QPainter& p, const Bug& b, const QPointF& topRight) {
    if (b.tag.isEmpty()) {
        return;
    }
    p.save();
    p.setFont(Font(15, true));
    const double width = QFontMetricsF(p.font()).horizontalAdvance(b.tag) + 34;
    const QRectF box(topRight.x() - width, topRight.y(), width, 30);
    QPainterPath path;
    path.addRoundedRect(box, 4, 4);
    p.fillPath(path, QColor(0, 0, 0, 150));
    p.setPen(Qt::NoPen);
    p.setBrush(b.accent);
    p.drawEllipse(QPointF(box.left() + 14, box.center().y()), 5, 5);
    p.setPen(Qt::white);
    p.drawText(box.adjusted(24, 0, -8, 0), Qt::AlignCenter, b.tag);
    p.restore();
}

void SceneScoreboard(QPainter& p, int variant) {
    DrawBroadcastPitch(p);
    DrawPlayer(p, QPointF(150, 250), 84, Kit{kHomeColour, Qt::white, kHomeColour});
    DrawPlayer(p, QPointF(330, 215), 70,
               Kit{kAwayColour, QColor(0x1A, 0x2A, 0x55), Qt::white, Qt::white, 5});
    DrawPlayer(p, QPointF(455, 270), 92, Kit{kHomeColour, Qt::white, kHomeColour, Qt::white, 7});
    DrawBall(p, QPointF(205, 246), 8, BallStyle{});
    p.fillRect(QRectF(0, 0, kWidth, kHeight), QColor(0, 0, 0, 40));
    const Bug bug = BugVariant(variant);
    p.save();
    p.translate(24, 22);
    p.scale(1.45, 1.45);
    DrawBug(p, bug);
    p.restore();
    DrawTag(p, bug, QPointF(kWidth - 22, 24));
}

// ---- Indicator marks ----------------------------------------------------------------------------

void SceneMark(QPainter& p, int variant) {
    DrawBroadcastPitch(p);
    DrawPlayer(p, QPointF(90, 205), 62,
               Kit{kAwayColour, QColor(0x1A, 0x2A, 0x55), Qt::white, Qt::white, 3});
    DrawPlayer(p, QPointF(505, 225), 70, Kit{kHomeColour, Qt::white, kHomeColour, Qt::white, 8});
    const QPointF feet(236, 322);
    const QColor ring = variant == 2 ? QColor(0xFF, 0xD2, 0x1F) : QColor(0x4F, 0xD2, 0xFF);
    p.setPen(QPen(ring, 4));
    p.setBrush(Qt::NoBrush);
    p.drawEllipse(feet, 46, 11);
    DrawPlayer(p, feet, 200, Kit{kHomeColour, Qt::white, kHomeColour});
    DrawBall(p, QPointF(290, 312), 14, BallStyle{});

    const QPointF tip(236, 96);  // just above the head
    p.save();
    switch (variant) {
        case 1: {  // a smiling face on a short stem
            p.setPen(QPen(QColor(0x7A, 0x50, 0x00), 2.5));
            p.setBrush(QColor(0xFF, 0xD2, 0x1F));
            p.drawPolygon(QPolygonF{tip, tip + QPointF(-9, -14), tip + QPointF(9, -14)});
            const QPointF c = tip + QPointF(0, -40);
            QRadialGradient face(c + QPointF(-8, -10), 40);
            face.setColorAt(0, QColor(0xFF, 0xEC, 0x7A));
            face.setColorAt(1, QColor(0xF7, 0xBE, 0x10));
            p.setBrush(face);
            p.drawEllipse(c, 30, 30);
            p.setBrush(QColor(0x3A, 0x26, 0x00));
            p.setPen(Qt::NoPen);
            p.drawEllipse(c + QPointF(-10, -8), 4, 6);
            p.drawEllipse(c + QPointF(10, -8), 4, 6);
            p.setPen(QPen(QColor(0x3A, 0x26, 0x00), 3.5, Qt::SolidLine, Qt::RoundCap));
            p.setBrush(Qt::NoBrush);
            p.drawArc(QRectF(c.x() - 17, c.y() - 14, 34, 30), 200 * 16, 140 * 16);
            break;
        }
        case 2: {  // a gold arrow under a name tag
            QPolygonF arrow{tip,
                            tip + QPointF(-26, -26),
                            tip + QPointF(-11, -26),
                            tip + QPointF(-11, -44),
                            tip + QPointF(11, -44),
                            tip + QPointF(11, -26),
                            tip + QPointF(26, -26)};
            QLinearGradient gold(0, tip.y() - 44, 0, tip.y());
            gold.setColorAt(0, QColor(0xFF, 0xE6, 0x5C));
            gold.setColorAt(1, QColor(0xF2, 0xA9, 0x00));
            p.setPen(QPen(QColor(0x5A, 0x40, 0x00), 2));
            p.setBrush(gold);
            p.drawPolygon(arrow);
            const QRectF tag(tip.x() - 62, tip.y() - 78, 124, 28);
            QPainterPath box;
            box.addRoundedRect(tag, 5, 5);
            p.fillPath(box, QColor(0x14, 0x14, 0x14, 220));
            p.fillRect(QRectF(tag.left() + 8, tag.bottom() - 5, (tag.width() - 16) * 0.7, 3),
                       QColor(0x6C, 0xE0, 0x5A));
            p.setPen(QColor(0xFF, 0xD2, 0x1F));
            p.setFont(Font(15, true));
            p.drawText(tag.adjusted(0, -2, 0, -4), Qt::AlignCenter, QStringLiteral("10  TIỀN ĐẠO"));
            break;
        }
        default: {  // a plain triangle
            QLinearGradient blue(0, tip.y() - 30, 0, tip.y());
            blue.setColorAt(0, QColor(0x8C, 0xE4, 0xFF));
            blue.setColorAt(1, QColor(0x1E, 0x9C, 0xE0));
            p.setPen(QPen(Qt::white, 2.5));
            p.setBrush(blue);
            p.drawPolygon(QPolygonF{tip, tip + QPointF(-19, -30), tip + QPointF(19, -30)});
            break;
        }
    }
    p.restore();
}

// ---- The other categories -----------------------------------------------------------------------

void SceneInterface(QPainter& p) {
    DrawBroadcastPitch(p);
    DrawPlayer(p, QPointF(300, 250), 96, Kit{kHomeColour, Qt::white, kHomeColour});
    DrawBall(p, QPointF(340, 246), 9, BallStyle{});
    p.fillRect(QRectF(0, 0, kWidth, kHeight), QColor(0, 0, 0, 50));
    p.save();
    p.translate(22, 20);
    DrawBug(p, BugVariant(0));
    p.restore();

    // Player panel with stamina and shot power.
    const QRectF panel(22, 234, 220, 80);
    QPainterPath box;
    box.addRoundedRect(panel, 8, 8);
    p.fillPath(box, QColor(10, 16, 24, 200));
    p.setPen(Qt::white);
    p.setFont(Font(15, true));
    p.drawText(panel.adjusted(14, 8, 0, 0), Qt::AlignLeft | Qt::AlignTop,
               QStringLiteral("10  Tiền đạo"));
    p.setFont(Font(11));
    p.setPen(QColor(255, 255, 255, 190));
    p.drawText(QRectF(panel.left() + 14, panel.top() + 34, 60, 14), Qt::AlignLeft,
               QStringLiteral("Thể lực"));
    p.drawText(QRectF(panel.left() + 14, panel.top() + 54, 60, 14), Qt::AlignLeft,
               QStringLiteral("Lực sút"));
    p.fillRect(QRectF(panel.left() + 76, panel.top() + 37, 128, 8), QColor(255, 255, 255, 40));
    p.fillRect(QRectF(panel.left() + 76, panel.top() + 37, 100, 8), QColor(0x6C, 0xE0, 0x5A));
    QLinearGradient power(panel.left() + 76, 0, panel.left() + 204, 0);
    power.setColorAt(0, QColor(0xF6, 0xD3, 0x4A));
    power.setColorAt(1, QColor(0xE2, 0x3A, 0x2E));
    p.fillRect(QRectF(panel.left() + 76, panel.top() + 57, 128, 8), QColor(255, 255, 255, 40));
    p.fillRect(QRectF(panel.left() + 76, panel.top() + 57, 82, 8), power);

    // Radar of the whole pitch.
    const QRectF radar(423, 222, 152, 96);
    QPainterPath frame;
    frame.addRoundedRect(radar, 6, 6);
    p.fillPath(frame, QColor(20, 60, 30, 200));
    p.setPen(QPen(QColor(255, 255, 255, 170), 1.2));
    p.setBrush(Qt::NoBrush);
    const QRectF field = radar.adjusted(8, 8, -8, -8);
    p.drawRect(field);
    p.drawLine(QPointF(field.center().x(), field.top()),
               QPointF(field.center().x(), field.bottom()));
    p.drawEllipse(field.center(), 11, 11);
    p.drawRect(QRectF(field.left(), field.center().y() - 18, 18, 36));
    p.drawRect(QRectF(field.right() - 18, field.center().y() - 18, 18, 36));
    Dice dice(5);
    p.setPen(Qt::NoPen);
    for (int i = 0; i < 20; ++i) {
        p.setBrush(i < 10 ? kHomeColour : kAwayColour);
        p.drawEllipse(QPointF(field.left() + 6 + dice.next() * (field.width() - 12),
                              field.top() + 6 + dice.next() * (field.height() - 12)),
                      3, 3);
    }
    p.setBrush(QColor(0xFF, 0xD2, 0x1F));
    p.drawEllipse(QPointF(field.center().x() + 14, field.center().y() + 6), 4.5, 4.5);
}

QPainterPath ShieldPath(const QRectF& r) {
    QPainterPath path;
    path.moveTo(r.left(), r.top() + r.height() * 0.08);
    path.quadTo(r.center().x(), r.top() - r.height() * 0.04, r.right(),
                r.top() + r.height() * 0.08);
    path.lineTo(r.right(), r.top() + r.height() * 0.5);
    path.cubicTo(r.right(), r.top() + r.height() * 0.8, r.center().x() + r.width() * 0.2,
                 r.bottom() - r.height() * 0.06, r.center().x(), r.bottom());
    path.cubicTo(r.center().x() - r.width() * 0.2, r.bottom() - r.height() * 0.06, r.left(),
                 r.top() + r.height() * 0.8, r.left(), r.top() + r.height() * 0.5);
    path.closeSubpath();
    return path;
}

void SceneEmblems(QPainter& p) {
    DrawStudio(p, QColor(0x2A, 0x3C, 0x66), QColor(0x0A, 0x10, 0x22));
    p.save();
    p.setPen(Qt::NoPen);
    for (int i = 0; i < 12; ++i) {  // soft rays behind the crests
        p.setBrush(QColor(255, 255, 255, 10));
        p.drawPie(QRectF(-300, -450, 1200, 1200), (i * 30) * 16, 12 * 16);
    }
    p.restore();
    const QPen gold(QColor(0xF2, 0xC1, 0x4E), 5);

    // Red and white stripes.
    {
        const QRectF r(52, 82, 136, 162);
        const QPainterPath shield = ShieldPath(r);
        p.fillPath(shield, QColor(0xC8, 0x1E, 0x2A));
        p.save();
        p.setClipPath(shield);
        for (int i = 0; i < 5; ++i) {
            p.fillRect(QRectF(r.left() + 12 + i * 26, r.top(), 12, r.height()), Qt::white);
        }
        p.fillRect(QRectF(r.left(), r.top(), r.width(), 44), QColor(0x1A, 0x1A, 0x2A));
        p.restore();
        p.setPen(Qt::white);
        p.setFont(Font(26, true));
        p.drawText(QRectF(r.left(), r.top() + 4, r.width(), 40), Qt::AlignCenter,
                   QStringLiteral("HFC"));
        p.setPen(gold);
        p.setBrush(Qt::NoBrush);
        p.drawPath(shield);
    }
    // Round badge with a star.
    {
        const QPointF c(298, 160);
        p.setPen(QPen(QColor(0xF2, 0xC1, 0x4E), 6));
        p.setBrush(QColor(0x15, 0x3C, 0x8C));
        p.drawEllipse(c, 92, 92);
        p.setPen(QPen(Qt::white, 3));
        p.setBrush(Qt::NoBrush);
        p.drawEllipse(c, 70, 70);
        p.setPen(Qt::NoPen);
        p.setBrush(QColor(0xF2, 0xC1, 0x4E));
        p.drawPolygon(Star(c + QPointF(0, -8), 42, 17));
        p.setPen(Qt::white);
        p.setFont(Font(17, true));
        p.drawText(QRectF(c.x() - 60, c.y() + 70, 120, 22), Qt::AlignCenter,
                   QStringLiteral("S.G.U"));
        p.drawText(QRectF(c.x() - 60, c.y() - 92, 120, 22), Qt::AlignCenter,
                   QStringLiteral("★ 1975 ★"));
    }
    // Green shield with a sash and a ball.
    {
        const QRectF r(410, 82, 136, 162);
        const QPainterPath shield = ShieldPath(r);
        p.fillPath(shield, QColor(0x1E, 0x7B, 0x4B));
        p.save();
        p.setClipPath(shield);
        p.translate(r.center());
        p.rotate(-35);
        p.fillRect(QRectF(-120, -16, 240, 32), Qt::white);
        p.restore();
        DrawBall(p, r.center() + QPointF(0, 6), 26, BallStyle{}, false);
        p.setPen(Qt::white);
        p.setFont(Font(22, true));
        p.drawText(QRectF(r.left(), r.top() + 14, r.width(), 30), Qt::AlignCenter,
                   QStringLiteral("RIVER"));
        p.setPen(QPen(Qt::white, 5));
        p.setBrush(Qt::NoBrush);
        p.drawPath(shield);
    }
}

void SceneSettings(QPainter& p) {
    DrawStudio(p, QColor(0x3A, 0x4A, 0x5C), QColor(0x14, 0x1A, 0x24));
    // A gear behind the card.
    p.save();
    p.translate(470, 88);
    p.setPen(Qt::NoPen);
    p.setBrush(QColor(255, 255, 255, 30));
    for (int i = 0; i < 10; ++i) {
        p.save();
        p.rotate(i * 36);
        p.drawRoundedRect(QRectF(-13, -104, 26, 34), 4, 4);
        p.restore();
    }
    QPainterPath gear;
    gear.addEllipse(QPointF(0, 0), 80, 80);
    gear.addEllipse(QPointF(0, 0), 34, 34);
    p.fillPath(gear, QColor(255, 255, 255, 30));
    p.restore();

    const QRectF card(72, 36, 380, 268);
    QPainterPath body;
    body.addRoundedRect(card, 14, 14);
    p.fillPath(body.translated(0, 5), QColor(0, 0, 0, 80));
    p.fillPath(body, QColor(0xF6, 0xF8, 0xF7));
    p.fillRect(QRectF(card.left(), card.top() + 14, card.width(), 40), kGreen);
    QPainterPath headerTop;
    headerTop.addRoundedRect(QRectF(card.left(), card.top(), card.width(), 30), 14, 14);
    p.fillPath(headerTop, kGreen);
    p.setPen(Qt::white);
    p.setFont(Font(18, true));
    p.drawText(card.adjusted(20, 8, 0, 0), Qt::AlignLeft | Qt::AlignTop,
               QStringLiteral("Tuỳ chỉnh"));

    const std::array<QString, 3> sliders{QStringLiteral("Góc máy quay"), QStringLiteral("Độ sáng"),
                                         QStringLiteral("Hiệu ứng")};
    const std::array<double, 3> values{0.65, 0.4, 0.8};
    for (size_t i = 0; i < sliders.size(); ++i) {
        const double y = card.top() + 86 + static_cast<double>(i) * 46;
        p.setPen(QColor(0x30, 0x3A, 0x40));
        p.setFont(Font(15));
        p.drawText(QRectF(card.left() + 22, y - 12, 130, 24), Qt::AlignLeft | Qt::AlignVCenter,
                   sliders[i]);
        const QRectF track(card.left() + 160, y - 3, 190, 6);
        p.setPen(Qt::NoPen);
        p.setBrush(QColor(0xD4, 0xDB, 0xD8));
        p.drawRoundedRect(track, 3, 3);
        p.setBrush(kGreen);
        p.drawRoundedRect(QRectF(track.left(), track.top(), track.width() * values[i], 6), 3, 3);
        p.setPen(QPen(kGreen, 2));
        p.setBrush(Qt::white);
        p.drawEllipse(QPointF(track.left() + track.width() * values[i], y), 10, 10);
    }
    const std::array<QString, 2> toggles{QStringLiteral("Đổ bóng"), QStringLiteral("Cờ góc")};
    for (size_t i = 0; i < toggles.size(); ++i) {
        const double x = card.left() + 22 + static_cast<double>(i) * 180;
        const double y = card.top() + 228;
        const bool on = i == 0;
        p.setPen(Qt::NoPen);
        p.setBrush(on ? kGreen : QColor(0xC4, 0xCC, 0xC8));
        p.drawRoundedRect(QRectF(x, y - 11, 42, 22), 11, 11);
        p.setBrush(Qt::white);
        p.drawEllipse(QPointF(on ? x + 31 : x + 11, y), 8, 8);
        p.setPen(QColor(0x30, 0x3A, 0x40));
        p.setFont(Font(15));
        p.drawText(QRectF(x + 52, y - 12, 120, 24), Qt::AlignLeft | Qt::AlignVCenter, toggles[i]);
    }
}

void DrawBust(QPainter& p, const QPointF& c, const QColor& skin, const QColor& hair, int style,
              const QColor& shirt) {
    p.save();
    p.setRenderHint(QPainter::Antialiasing);
    p.setPen(Qt::NoPen);
    QPainterPath shoulders;
    shoulders.moveTo(c + QPointF(-80, 150));
    shoulders.cubicTo(c + QPointF(-80, 80), c + QPointF(-50, 72), c + QPointF(0, 72));
    shoulders.cubicTo(c + QPointF(50, 72), c + QPointF(80, 80), c + QPointF(80, 150));
    shoulders.closeSubpath();
    p.fillPath(shoulders, shirt);
    p.setBrush(skin.darker(108));
    p.drawRect(QRectF(c.x() - 15, c.y() + 30, 30, 46));
    p.setBrush(shirt.lighter(130));
    p.drawChord(QRectF(c.x() - 22, c.y() + 56, 44, 32), 180 * 16, 180 * 16);
    // Hair behind the head for long styles.
    if (style == 2) {
        p.setBrush(hair);
        p.drawRoundedRect(QRectF(c.x() - 46, c.y() - 40, 92, 100), 30, 30);
    }
    p.setBrush(skin);
    p.drawEllipse(c, 40, 50);
    p.drawEllipse(c + QPointF(-40, 4), 7, 11);
    p.drawEllipse(c + QPointF(40, 4), 7, 11);
    p.setBrush(hair);
    switch (style) {
        case 0:  // short
            p.drawChord(QRectF(c.x() - 42, c.y() - 54, 84, 64), 15 * 16, 150 * 16);
            break;
        case 1:  // curls
            for (int i = 0; i < 9; ++i) {
                const double a = std::numbers::pi * (1.05 + i * 0.11);
                p.drawEllipse(c + QPointF(std::cos(a) * 36, std::sin(a) * 44 - 4), 14, 14);
            }
            break;
        default:  // long, with a fringe
            p.drawChord(QRectF(c.x() - 44, c.y() - 56, 88, 70), 0, 180 * 16);
            break;
    }
    p.setBrush(QColor(0x22, 0x1A, 0x14));
    p.drawEllipse(c + QPointF(-14, 2), 4, 4.5);
    p.drawEllipse(c + QPointF(14, 2), 4, 4.5);
    p.setPen(QPen(skin.darker(140), 2.5, Qt::SolidLine, Qt::RoundCap));
    p.setBrush(Qt::NoBrush);
    p.drawArc(QRectF(c.x() - 12, c.y() + 12, 24, 16), 200 * 16, 140 * 16);
    p.setPen(QPen(hair.lighter(120), 3, Qt::SolidLine, Qt::RoundCap));
    p.drawLine(c + QPointF(-21, -11), c + QPointF(-8, -12));
    p.drawLine(c + QPointF(8, -12), c + QPointF(21, -11));
    p.restore();
}

void SceneFaces(QPainter& p) {
    DrawStudio(p, QColor(0x6A, 0x82, 0x9A), QColor(0x20, 0x2A, 0x36));
    DrawBust(p, QPointF(120, 150), QColor(0xF0, 0xC8, 0xA0), QColor(0x2B, 0x1E, 0x16), 0,
             kHomeColour);
    DrawBust(p, QPointF(478, 150), QColor(0xE8, 0xBE, 0x94), QColor(0xD8, 0xB0, 0x5A), 2,
             kAwayColour);
    DrawBust(p, QPointF(298, 140), QColor(0x8A, 0x5A, 0x3A), QColor(0x16, 0x10, 0x0C), 1, kGreen);
}

void DrawBoot(QPainter& p, const QPointF& at, double scale, const QColor& upper,
              const QColor& accent, const QColor& sole) {
    p.save();
    p.setRenderHint(QPainter::Antialiasing);
    p.translate(at);
    p.scale(scale, scale);
    QPainterPath shape;
    shape.moveTo(0, 0);
    shape.lineTo(0, -58);
    shape.cubicTo(4, -70, 16, -76, 30, -74);
    shape.lineTo(70, -66);
    shape.cubicTo(90, -52, 130, -36, 180, -28);
    shape.cubicTo(212, -24, 226, -14, 222, 0);
    shape.closeSubpath();
    QLinearGradient fill(0, -76, 0, 0);
    fill.setColorAt(0, upper.lighter(125));
    fill.setColorAt(1, upper.darker(115));
    p.setPen(QPen(upper.darker(170), 2));
    p.setBrush(fill);
    p.drawPath(shape);
    // A zigzag flash along the side.
    p.setPen(Qt::NoPen);
    p.setBrush(accent);
    p.drawPolygon(QPolygonF{QPointF(40, -14), QPointF(92, -46), QPointF(96, -34), QPointF(150, -40),
                            QPointF(100, -10), QPointF(96, -22)});
    // Laces.
    p.setPen(QPen(Qt::white, 3, Qt::SolidLine, Qt::RoundCap));
    for (int i = 0; i < 5; ++i) {
        const double x = 82 + i * 16;
        p.drawLine(QPointF(x, -58 + i * 6), QPointF(x + 10, -52 + i * 6));
    }
    // Sole and studs.
    p.setPen(Qt::NoPen);
    p.setBrush(sole);
    p.drawRoundedRect(QRectF(-2, -6, 226, 10), 4, 4);
    for (double x : {14.0, 44.0, 120.0, 150.0, 182.0, 206.0}) {
        p.drawPolygon(QPolygonF{QPointF(x - 6, 3), QPointF(x + 6, 3), QPointF(x + 3, 14),
                                QPointF(x - 3, 14)});
    }
    p.restore();
}

void SceneBoots(QPainter& p) {
    DrawStudio(p, QColor(0xEE, 0xF1, 0xF3), QColor(0x9E, 0xA8, 0xB2));
    p.fillRect(QRectF(0, 268, kWidth, kHeight - 268), QColor(0x86, 0x90, 0x9A));
    QRadialGradient shadow(QPointF(298, 270), 260);
    shadow.setColorAt(0, QColor(0, 0, 0, 80));
    shadow.setColorAt(1, QColor(0, 0, 0, 0));
    p.setPen(Qt::NoPen);
    p.setBrush(shadow);
    p.drawEllipse(QPointF(298, 270), 260, 22);
    DrawBoot(p, QPointF(250, 200), 1.05, QColor(0x1E, 0xB4, 0xC8), Qt::white,
             QColor(0x20, 0x20, 0x24));
    DrawBoot(p, QPointF(80, 258), 1.4, QColor(0xF0, 0x5A, 0x22), QColor(0x1A, 0x1A, 0x1A),
             QColor(0xF6, 0xC3, 0x2A));
}

void DrawShirt(QPainter& p, const QPointF& c, const QColor& body, const QColor& trim, int number,
               const QColor& text) {
    p.save();
    p.setRenderHint(QPainter::Antialiasing);
    p.translate(c);
    QPainterPath shirt;
    shirt.moveTo(-30, -90);
    shirt.lineTo(-80, -66);
    shirt.lineTo(-98, -20);
    shirt.lineTo(-70, -8);
    shirt.lineTo(-60, -36);
    shirt.lineTo(-58, 90);
    shirt.lineTo(58, 90);
    shirt.lineTo(60, -36);
    shirt.lineTo(70, -8);
    shirt.lineTo(98, -20);
    shirt.lineTo(80, -66);
    shirt.lineTo(30, -90);
    shirt.quadTo(0, -70, -30, -90);
    shirt.closeSubpath();
    QLinearGradient fill(-98, 0, 98, 0);
    fill.setColorAt(0, body.darker(115));
    fill.setColorAt(0.5, body.lighter(110));
    fill.setColorAt(1, body.darker(115));
    p.setPen(QPen(body.darker(160), 2));
    p.setBrush(fill);
    p.drawPath(shirt);
    p.setPen(QPen(trim, 6));
    p.setBrush(Qt::NoBrush);
    QPainterPath collar;
    collar.moveTo(-30, -88);
    collar.quadTo(0, -68, 30, -88);
    p.drawPath(collar);
    p.drawLine(QPointF(-97, -21), QPointF(-71, -10));
    p.drawLine(QPointF(97, -21), QPointF(71, -10));
    p.setPen(text);
    p.setFont(Font(64, true));
    p.drawText(QRectF(-58, -52, 116, 110), Qt::AlignCenter, QString::number(number));
    p.restore();
}

void SceneKits(QPainter& p) {
    DrawStudio(p, QColor(0x2C, 0x5E, 0x6E), QColor(0x0C, 0x1E, 0x26));
    p.setPen(QPen(QColor(255, 255, 255, 90), 4));
    p.drawLine(QPointF(40, 48), QPointF(557, 48));  // the rail they hang from
    for (double x : {175.0, 421.0}) {
        p.drawLine(QPointF(x, 48), QPointF(x, 70));
    }
    DrawShirt(p, QPointF(175, 160), QColor(0xC8, 0x1E, 0x2A), Qt::white, 10, Qt::white);
    DrawShirt(p, QPointF(421, 160), QColor(0xF4, 0xF4, 0xF4), QColor(0x1A, 0x2A, 0x55), 7,
              QColor(0x1A, 0x2A, 0x55));
    // Shorts under each shirt.
    const std::array<std::pair<double, QColor>, 2> shorts{
        {{175.0, Qt::white}, {421.0, QColor(0x1A, 0x2A, 0x55)}}};
    for (const auto& [x, colour] : shorts) {
        QPainterPath path;
        path.moveTo(x - 40, 266);
        path.lineTo(x + 40, 266);
        path.lineTo(x + 46, 316);
        path.lineTo(x + 6, 316);
        path.lineTo(x, 296);
        path.lineTo(x - 6, 316);
        path.lineTo(x - 46, 316);
        path.closeSubpath();
        p.setPen(QPen(colour.darker(140), 2));
        p.setBrush(colour);
        p.drawPath(path);
    }
}

void SceneNet(QPainter& p) {
    DrawCrowd(p, QRectF(0, 0, kWidth, 120), 33, 6);
    p.fillRect(QRectF(0, 112, kWidth, 10), QColor(0x18, 0x1C, 0x24));
    DrawGrassFloor(p, 120, kHeight);
    const QRectF front(96, 64, 405, 236);
    const QRectF back(150, 100, 297, 180);
    p.save();
    p.setRenderHint(QPainter::Antialiasing);
    p.fillRect(back, QColor(255, 255, 255, 25));
    p.setPen(QPen(QColor(255, 255, 255, 150), 1.2));
    // Back panel: a diamond mesh.
    p.save();
    p.setClipRect(back);
    for (double d = -back.height(); d < back.width() + back.height(); d += 14) {
        p.drawLine(QPointF(back.left() + d, back.top()),
                   QPointF(back.left() + d + back.height(), back.bottom()));
        p.drawLine(QPointF(back.left() + d, back.bottom()),
                   QPointF(back.left() + d + back.height(), back.top()));
    }
    p.restore();
    // Side and roof panels: lines from the frame to the back.
    for (int i = 0; i <= 10; ++i) {
        const double t = i / 10.0;
        p.drawLine(QPointF(front.left(), front.top() + t * front.height()),
                   QPointF(back.left(), back.top() + t * back.height()));
        p.drawLine(QPointF(front.right(), front.top() + t * front.height()),
                   QPointF(back.right(), back.top() + t * back.height()));
        p.drawLine(QPointF(front.left() + t * front.width(), front.top()),
                   QPointF(back.left() + t * back.width(), back.top()));
    }
    for (int i = 1; i < 4; ++i) {
        const double t = i / 4.0;
        const QPointF a(front.left() + (back.left() - front.left()) * t,
                        front.top() + (back.top() - front.top()) * t);
        const QPointF b(front.right() + (back.right() - front.right()) * t, a.y());
        p.drawLine(a, b);
        p.drawLine(a, QPointF(a.x(), front.bottom() + (back.bottom() - front.bottom()) * t));
        p.drawLine(b, QPointF(b.x(), front.bottom() + (back.bottom() - front.bottom()) * t));
    }
    p.restore();
    DrawBall(p, QPointF(392, 262), 26, BallStyle{});
    // The frame in front of the net.
    p.setPen(QPen(QColor(0xF6, 0xF6, 0xF6), 11, Qt::SolidLine, Qt::SquareCap, Qt::MiterJoin));
    p.setBrush(Qt::NoBrush);
    p.drawPolyline(
        QPolygonF{front.bottomLeft(), front.topLeft(), front.topRight(), front.bottomRight()});
    p.setPen(QPen(QColor(0, 0, 0, 50), 3));
    p.drawLine(front.topLeft() + QPointF(4, 4), front.topRight() + QPointF(-4, 4));
}

void SceneCrowd(QPainter& p) {
    DrawCrowd(p, QRectF(0, 0, kWidth, kHeight), 44, 10);
    // A banner across the stand.
    QPainterPath banner;
    banner.moveTo(70, 200);
    banner.cubicTo(200, 180, 400, 220, 527, 196);
    banner.lineTo(527, 262);
    banner.cubicTo(400, 286, 200, 246, 70, 266);
    banner.closeSubpath();
    p.fillPath(banner.translated(0, 6), QColor(0, 0, 0, 90));
    p.fillPath(banner, QColor(0xC8, 0x1E, 0x2A));
    p.setPen(QPen(QColor(0xF2, 0xC1, 0x4E), 3));
    p.drawPath(banner);
    p.setPen(QColor(0xFF, 0xE0, 0x6A));
    p.setFont(Font(40, true));
    p.drawText(QRectF(70, 200, 457, 64), Qt::AlignCenter, QStringLiteral("CỐ LÊN!"));
    // Flags on poles.
    const std::array<QColor, 3> flags{QColor(0xF2, 0xC1, 0x4E), Qt::white,
                                      QColor(0x2F, 0x6F, 0xC8)};
    for (size_t i = 0; i < flags.size(); ++i) {
        const double x = 60 + static_cast<double>(i) * 230;
        p.setPen(QPen(QColor(0x40, 0x40, 0x40), 3));
        p.drawLine(QPointF(x, 30), QPointF(x, 150));
        QPainterPath flag;
        flag.moveTo(x, 30);
        flag.cubicTo(x + 30, 20, x + 50, 44, x + 80, 34);
        flag.lineTo(x + 80, 84);
        flag.cubicTo(x + 50, 94, x + 30, 70, x, 80);
        flag.closeSubpath();
        p.fillPath(flag, flags[i]);
    }
}

void SceneStadium(QPainter& p) {
    FillVertical(p, QRectF(0, 0, kWidth, kHeight), QColor(0x0B, 0x12, 0x2E),
                 QColor(0x2A, 0x24, 0x4E));
    Dice dice(77);
    p.setPen(Qt::NoPen);
    for (int i = 0; i < 60; ++i) {
        p.setBrush(QColor(255, 255, 255, 80 + dice.below(150)));
        p.drawEllipse(QPointF(dice.next() * kWidth, dice.next() * 110), 1.1, 1.1);
    }
    // The bowl: outer wall, stands with the crowd, the lit pitch inside.
    const QRectF outer(14, 108, 569, 256);
    const QRectF inner(92, 150, 413, 160);
    QLinearGradient wall(0, outer.top(), 0, outer.bottom());
    wall.setColorAt(0, QColor(0x5A, 0x62, 0x74));
    wall.setColorAt(1, QColor(0x22, 0x26, 0x30));
    p.setBrush(wall);
    p.drawEllipse(outer);
    QPainterPath stands;
    stands.addEllipse(outer.adjusted(16, 12, -16, -12));
    p.save();
    p.setClipPath(stands);
    DrawCrowd(p, outer, 55, 3.2);
    p.restore();
    QPainterPath field;
    field.addEllipse(inner);
    p.save();
    p.setClipPath(field);
    p.fillRect(inner, QColor(0x3B, 0x87, 0x3C));
    static const QImage texture = PitchTexture(Mowing::Stripes);
    DrawInQuad(
        p, texture,
        QPolygonF{QPointF(140, 160), QPointF(457, 160), QPointF(520, 302), QPointF(77, 302)});
    p.restore();
    p.setPen(QPen(QColor(0xE8, 0xEC, 0xF2), 5));
    p.setBrush(Qt::NoBrush);
    p.drawArc(outer.adjusted(2, 2, -2, -2), 0, 180 * 16);  // roof edge
    // Floodlights with their glow.
    for (const QPointF& mast :
         {QPointF(70, 60), QPointF(527, 60), QPointF(30, 120), QPointF(567, 120)}) {
        QRadialGradient glow(mast, 90);
        glow.setColorAt(0, QColor(255, 250, 220, 170));
        glow.setColorAt(1, QColor(255, 250, 220, 0));
        p.setPen(Qt::NoPen);
        p.setBrush(glow);
        p.drawEllipse(mast, 90, 90);
        p.setPen(QPen(QColor(0x30, 0x34, 0x40), 4));
        p.drawLine(mast + QPointF(0, 12), QPointF(mast.x(), outer.center().y()));
        p.setPen(Qt::NoPen);
        p.setBrush(QColor(0xFF, 0xFB, 0xE6));
        p.drawRoundedRect(QRectF(mast.x() - 18, mast.y() - 9, 36, 18), 3, 3);
    }
}

bool Save(const QImage& image, const fs::path& folder, int tab, int index) {
    return SaveJpeg(
        image, folder / ("t" + std::to_string(tab) + "_img_" + std::to_string(index) + ".jpg"));
}

}  // namespace

bool WritePreviews(const fs::path& toolFolder) {
    const fs::path folder = toolFolder / "img";
    bool ok = true;

    const std::array<Scene, catalog::kCategoryCount> categories{
        SceneAllBalls,
        [](QPainter& p) { ScenePitch(p, Mowing::Stripes); },
        [](QPainter& p) { SceneAdboards(p, 0); },
        SceneInterface,
        SceneEmblems,
        SceneSettings,
        SceneFaces,
        SceneBoots,
        SceneKits,
        SceneNet,
        [](QPainter& p) { SceneScoreboard(p, 1); },
        [](QPainter& p) { SceneMark(p, 0); },
        SceneCrowd,
        SceneStadium,
    };
    for (const catalog::PatchCategory& category : catalog::Categories()) {
        const QImage image = Preview(QStringLiteral("Hạng mục"), FromUtf8(category.label),
                                     categories[static_cast<size_t>(category.switchIndex)]);
        ok = Save(image, folder, 1, category.switchIndex) && ok;
    }

    const std::array<Mowing, 4> mowings{Mowing::Stripes, Mowing::Checks, Mowing::Ovals,
                                        Mowing::Plaid};
    for (const catalog::VariantGroup& group : catalog::Groups()) {
        const int first = group.options.front().index;
        for (const catalog::PatchOption& option : group.options) {
            const int n = option.index - first;  // the variant's place in its group
            QString heading;
            Scene scene;
            int tab = 4;
            switch (group.id) {
                case GroupId::Ball:
                    heading = QStringLiteral("Bóng");
                    scene = [n](QPainter& p) { SceneBall(p, n); };
                    tab = 2;
                    break;
                case GroupId::Scoreboard:
                    heading = QStringLiteral("Bảng tỉ số");
                    scene = [n](QPainter& p) { SceneScoreboard(p, n); };
                    tab = 3;
                    break;
                case GroupId::Adboard:
                    heading = QStringLiteral("Biển quảng cáo");
                    scene = [n](QPainter& p) { SceneAdboards(p, n); };
                    break;
                case GroupId::Pitch:
                    heading = QStringLiteral("Mặt cỏ");
                    scene = [&mowings, n](QPainter& p) {
                        ScenePitch(p, mowings[static_cast<size_t>(n)]);
                    };
                    break;
                case GroupId::Mark:
                    heading = QStringLiteral("Mark cầu thủ");
                    scene = [n](QPainter& p) { SceneMark(p, n); };
                    break;
            }
            ok = Save(Preview(heading, FromUtf8(option.label), scene), folder, tab, option.index) &&
                 ok;
        }
    }
    return ok;
}

}  // namespace kickvane::artwork
