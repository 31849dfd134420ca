#include "drawing.h"

#include <QFontDatabase>
#include <QLinearGradient>
#include <QPainterPath>
#include <QRadialGradient>
#include <QStringList>
#include <QTransform>
#include <algorithm>
#include <array>
#include <cmath>
#include <numbers>
#include <vector>

namespace kickvane::artwork {

namespace {

QString gSans;
QString gCondensed;

struct Vec {
    double x, y, z;
    Vec operator+(const Vec& o) const { return {x + o.x, y + o.y, z + o.z}; }
    Vec operator-(const Vec& o) const { return {x - o.x, y - o.y, z - o.z}; }
    Vec operator*(double k) const { return {x * k, y * k, z * k}; }
    double dot(const Vec& o) const { return x * o.x + y * o.y + z * o.z; }
    Vec cross(const Vec& o) const {
        return {y * o.z - z * o.y, z * o.x - x * o.z, x * o.y - y * o.x};
    }
    Vec unit() const { return *this * (1.0 / std::sqrt(dot(*this))); }
};

// The truncated icosahedron: its pentagons sit on the vertices of an icosahedron and its
// hexagons on the faces, each cut at a third of the icosahedron's edges.
struct BallGeometry {
    std::vector<std::vector<Vec>> pentagons;
    std::vector<std::vector<Vec>> hexagons;
};

const BallGeometry& Geometry() {
    static const BallGeometry geometry = [] {
        constexpr double phi = std::numbers::phi;
        std::vector<Vec> v;
        for (double a : {-1.0, 1.0}) {
            for (double b : {-phi, phi}) {
                v.push_back({0, a, b});
                v.push_back({a, b, 0});
                v.push_back({b, 0, a});
            }
        }
        auto adjacent = [&](size_t i, size_t j) {
            const Vec d = v[i] - v[j];
            return std::abs(d.dot(d) - 4.0) < 1e-6;
        };
        auto third = [&](size_t from, size_t to) {
            return v[from] + (v[to] - v[from]) * (1.0 / 3);
        };

        BallGeometry g;
        for (size_t i = 0; i < v.size(); ++i) {
            const Vec axis = v[i].unit();
            const Vec u = (std::abs(axis.x) < 0.9 ? Vec{1, 0, 0} : Vec{0, 1, 0}).cross(axis).unit();
            const Vec w = axis.cross(u);
            std::vector<std::pair<double, Vec>> around;
            for (size_t j = 0; j < v.size(); ++j) {
                if (j != i && adjacent(i, j)) {
                    const Vec p = third(i, j);
                    around.push_back({std::atan2((p - v[i]).dot(w), (p - v[i]).dot(u)), p});
                }
            }
            std::sort(around.begin(), around.end(),
                      [](const auto& a, const auto& b) { return a.first < b.first; });
            std::vector<Vec> face;
            for (const auto& [angle, p] : around) {
                face.push_back(p.unit());
            }
            g.pentagons.push_back(face);
        }
        for (size_t a = 0; a < v.size(); ++a) {
            for (size_t b = a + 1; b < v.size(); ++b) {
                for (size_t c = b + 1; c < v.size(); ++c) {
                    if (adjacent(a, b) && adjacent(b, c) && adjacent(a, c)) {
                        g.hexagons.push_back({third(a, b).unit(), third(b, a).unit(),
                                              third(b, c).unit(), third(c, b).unit(),
                                              third(c, a).unit(), third(a, c).unit()});
                    }
                }
            }
        }
        return g;
    }();
    return geometry;
}

Vec Rotate(const Vec& p, double tiltX, double tiltY) {
    const Vec a{p.x, p.y * std::cos(tiltX) - p.z * std::sin(tiltX),
                p.y * std::sin(tiltX) + p.z * std::cos(tiltX)};
    return {a.x * std::cos(tiltY) + a.z * std::sin(tiltY), a.y,
            -a.x * std::sin(tiltY) + a.z * std::cos(tiltY)};
}

// Projects a point of the unit sphere onto the disc; points behind it are pulled onto the rim.
QPointF Project(const Vec& p, const QPointF& centre, double radius) {
    double x = p.x;
    double y = p.y;
    if (p.z < 0) {
        const double length = std::hypot(x, y);
        if (length > 1e-9) {
            x /= length;
            y /= length;
        }
    }
    return {centre.x() + x * radius, centre.y() - y * radius};
}

// A face outline whose edges follow the sphere's curvature.
QPolygonF FaceOutline(const std::vector<Vec>& face, const BallStyle& style, const QPointF& centre,
                      double radius) {
    QPolygonF outline;
    for (size_t i = 0; i < face.size(); ++i) {
        const Vec& a = face[i];
        const Vec& b = face[(i + 1) % face.size()];
        for (int step = 0; step < 6; ++step) {
            const Vec p = (a + (b - a) * (step / 6.0)).unit();
            outline << Project(Rotate(p, style.tiltX, style.tiltY), centre, radius);
        }
    }
    return outline;
}

double Depth(const std::vector<Vec>& face, const BallStyle& style) {
    Vec sum{0, 0, 0};
    for (const Vec& p : face) {
        sum = sum + p;
    }
    return Rotate(sum.unit(), style.tiltX, style.tiltY).z;
}

}  // namespace

double Dice::next() {
    state_ = state_ * 1664525u + 1013904223u;
    return static_cast<double>(state_ >> 8) / static_cast<double>(1u << 24);
}

bool LoadFonts() {
    const QString folder = QStringLiteral("/usr/share/fonts/truetype/dejavu/");
    const QStringList faces{QStringLiteral("DejaVuSans.ttf"), QStringLiteral("DejaVuSans-Bold.ttf"),
                            QStringLiteral("DejaVuSansCondensed.ttf"),
                            QStringLiteral("DejaVuSansCondensed-Bold.ttf")};
    QStringList families;
    for (const QString& face : faces) {
        const int id = QFontDatabase::addApplicationFont(folder + face);
        if (id < 0 || QFontDatabase::applicationFontFamilies(id).isEmpty()) {
            return false;
        }
        families << QFontDatabase::applicationFontFamilies(id).first();
    }
    gSans = families[0];
    gCondensed = families[2];
    return true;
}

QFont Font(int pixelSize, bool bold, bool condensed) {
    QFont font(condensed ? gCondensed : gSans);
    if (condensed && gCondensed == gSans) {
        font.setStretch(QFont::SemiCondensed);
    }
    font.setPixelSize(pixelSize);
    font.setBold(bold);
    font.setHintingPreference(QFont::PreferNoHinting);
    return font;
}

QImage NewCanvas(int width, int height, const QColor& fill) {
    QImage image(width, height, QImage::Format_ARGB32_Premultiplied);
    image.fill(fill);
    return image;
}

bool SaveJpeg(const QImage& image, const std::filesystem::path& file) {
    return image.convertToFormat(QImage::Format_RGB32)
        .save(QString::fromStdString(file.string()), "JPG", 92);
}

void FillVertical(QPainter& painter, const QRectF& rect, const QColor& top, const QColor& bottom) {
    QLinearGradient gradient(rect.topLeft(), rect.bottomLeft());
    gradient.setColorAt(0, top);
    gradient.setColorAt(1, bottom);
    painter.fillRect(rect, gradient);
}

void DrawBall(QPainter& painter, const QPointF& centre, double radius, const BallStyle& style,
              bool withShadow) {
    painter.save();
    painter.setRenderHint(QPainter::Antialiasing);
    if (withShadow) {
        QRadialGradient shadow(QPointF(centre.x(), centre.y() + radius * 0.96), radius);
        shadow.setColorAt(0, QColor(0, 0, 0, 110));
        shadow.setColorAt(1, QColor(0, 0, 0, 0));
        painter.setPen(Qt::NoPen);
        painter.setBrush(shadow);
        painter.drawEllipse(QPointF(centre.x(), centre.y() + radius * 0.96), radius * 1.05,
                            radius * 0.22);
    }

    QPainterPath disc;
    disc.addEllipse(centre, radius, radius);
    painter.setClipPath(disc);
    painter.fillPath(disc, style.hexagon);

    struct Face {
        double depth;
        QPolygonF outline;
        QColor fill;
        bool pentagon;
    };
    std::vector<Face> faces;
    const BallGeometry& g = Geometry();
    for (size_t i = 0; i < g.hexagons.size(); ++i) {
        const bool accent =
            style.accentEvery > 0 && i % static_cast<size_t>(style.accentEvery) == 0;
        faces.push_back({Depth(g.hexagons[i], style),
                         FaceOutline(g.hexagons[i], style, centre, radius),
                         accent ? style.accent : style.hexagon, false});
    }
    for (const auto& pentagon : g.pentagons) {
        faces.push_back({Depth(pentagon, style), FaceOutline(pentagon, style, centre, radius),
                         style.pentagon, true});
    }
    std::sort(faces.begin(), faces.end(),
              [](const Face& a, const Face& b) { return a.depth < b.depth; });
    const double seamWidth = std::max(0.6, radius / 70);
    for (const Face& face : faces) {
        if (face.depth < -0.35) {
            continue;
        }
        painter.setPen(QPen(style.seam, seamWidth));
        painter.setBrush(face.fill);
        painter.drawPolygon(face.outline);
        if (face.pentagon && style.star.alpha() > 0 && face.depth > 0.2) {
            const QPointF mid = face.outline.boundingRect().center();
            const double size = face.outline.boundingRect().width() * 0.28 * face.depth;
            painter.setPen(Qt::NoPen);
            painter.setBrush(style.star);
            painter.drawPolygon(Star(mid, size, size * 0.42));
        }
    }

    // Two bands along great circles, like the printed swirls of some match balls.
    if (style.band.alpha() > 0) {
        for (int b = 0; b < 2; ++b) {
            QPainterPath path;
            bool drawing = false;
            const Vec n = b == 0 ? Vec{0.3, 1, 0.2}.unit() : Vec{1, -0.2, 0.5}.unit();
            const Vec u = (std::abs(n.x) < 0.9 ? Vec{1, 0, 0} : Vec{0, 1, 0}).cross(n).unit();
            const Vec w = n.cross(u);
            for (int s = 0; s <= 180; ++s) {
                const double t = s * 2 * std::numbers::pi / 180;
                const Vec p = Rotate(u * std::cos(t) + w * std::sin(t), style.tiltX, style.tiltY);
                const QPointF at = Project(p, centre, radius);
                if (p.z < -0.05) {
                    drawing = false;
                    continue;
                }
                drawing ? path.lineTo(at) : path.moveTo(at);
                drawing = true;
            }
            painter.setBrush(Qt::NoBrush);
            painter.setPen(QPen(style.band, radius * (b == 0 ? 0.16 : 0.07), Qt::SolidLine,
                                Qt::FlatCap, Qt::RoundJoin));
            painter.drawPath(path);
        }
    }

    // Light from the upper left and a darker rim give the sphere its volume.
    QRadialGradient light(centre + QPointF(-radius * 0.38, -radius * 0.42), radius * 1.45);
    light.setColorAt(0, QColor(255, 255, 255, 120));
    light.setColorAt(0.35, QColor(255, 255, 255, 0));
    light.setColorAt(0.7, QColor(0, 0, 0, 30));
    light.setColorAt(1, QColor(0, 0, 0, 150));
    painter.fillPath(disc, light);
    painter.setClipping(false);
    painter.setPen(QPen(QColor(0, 0, 0, 90), std::max(0.8, radius / 60)));
    painter.setBrush(Qt::NoBrush);
    painter.drawEllipse(centre, radius, radius);
    painter.restore();
}

void DrawPlayer(QPainter& painter, const QPointF& feet, double height, const Kit& kit,
                const QColor& skin, const QColor& hair) {
    painter.save();
    painter.setRenderHint(QPainter::Antialiasing);
    painter.translate(feet);
    const double k = height / 100.0;  // the figure is drawn on a 100-unit tall grid
    painter.scale(k, k);
    const QPen outline(QColor(0, 0, 0, 70), 0.8);

    QRadialGradient shadow(QPointF(0, 0), 22);
    shadow.setColorAt(0, QColor(0, 0, 0, 100));
    shadow.setColorAt(1, QColor(0, 0, 0, 0));
    painter.setPen(Qt::NoPen);
    painter.setBrush(shadow);
    painter.drawEllipse(QPointF(0, 0), 22, 5);

    // Legs: skin above the socks, boots at the bottom.
    painter.setPen(outline);
    for (double side : {-1.0, 1.0}) {
        painter.setBrush(skin);
        painter.drawRoundedRect(QRectF(side * 6.5 - 3.5, -50, 7, 20), 3, 3);
        painter.setBrush(kit.socks);
        painter.drawRoundedRect(QRectF(side * 7 - 3.8, -32, 7.6, 29), 3, 3);
        painter.setBrush(QColor(0x1B, 0x1B, 0x1B));
        painter.drawRoundedRect(QRectF(side * 7 - 4.2 + side * 1.5, -5, 9, 5), 2.5, 2.5);
    }
    // Shorts.
    painter.setBrush(kit.shorts);
    QPainterPath shorts;
    shorts.moveTo(-13, -62);
    shorts.lineTo(13, -62);
    shorts.lineTo(15, -45);
    shorts.lineTo(2, -45);
    shorts.lineTo(0, -52);
    shorts.lineTo(-2, -45);
    shorts.lineTo(-15, -45);
    shorts.closeSubpath();
    painter.drawPath(shorts);
    // Arms, then the shirt over them.
    for (double side : {-1.0, 1.0}) {
        painter.save();
        painter.translate(side * 14, -84);
        painter.rotate(side * -14);
        painter.setBrush(skin);
        painter.drawRoundedRect(QRectF(-3.2, 6, 6.4, 24), 3, 3);
        painter.setBrush(kit.shirt);
        painter.drawRoundedRect(QRectF(-4.5, -1, 9, 12), 3, 3);
        painter.restore();
    }
    QPainterPath shirt;
    shirt.moveTo(-14, -86);
    shirt.quadTo(0, -90, 14, -86);
    shirt.lineTo(13, -60);
    shirt.lineTo(-13, -60);
    shirt.closeSubpath();
    painter.setBrush(kit.shirt);
    painter.drawPath(shirt);
    painter.setPen(QPen(kit.trim, 1.6));
    painter.drawArc(QRectF(-5, -92, 10, 8), 200 * 16, 140 * 16);
    painter.setPen(kit.trim);
    painter.setFont(Font(13, true));
    painter.drawText(QRectF(-12, -84, 24, 20), Qt::AlignCenter, QString::number(kit.number));
    // Head.
    painter.setPen(outline);
    painter.setBrush(skin);
    painter.drawRoundedRect(QRectF(-2.5, -91, 5, 5), 1, 1);
    painter.drawEllipse(QPointF(0, -96), 6.5, 7.5);
    painter.setBrush(hair);
    painter.setPen(Qt::NoPen);
    painter.drawChord(QRectF(-6.8, -104, 13.6, 14), 10 * 16, 160 * 16);
    painter.restore();
}

QImage PitchTexture(Mowing mowing, int ppm) {
    const double margin = 5;
    const double length = 105;
    const double width = 68;
    QImage image = NewCanvas(static_cast<int>((length + 2 * margin) * ppm),
                             static_cast<int>((width + 2 * margin) * ppm));
    QPainter p(&image);
    p.setRenderHint(QPainter::Antialiasing);
    p.scale(ppm, ppm);
    const QColor light(0x4C, 0xA0, 0x4A);
    const QColor dark(0x3B, 0x87, 0x3C);
    const QRectF all(0, 0, length + 2 * margin, width + 2 * margin);
    p.fillRect(all, dark);
    const double cx = all.center().x();
    const double cy = all.center().y();
    switch (mowing) {
        case Mowing::Stripes:
            for (int i = 0; i < 20; i += 2) {
                p.fillRect(QRectF(margin + i * length / 20, 0, length / 20, all.height()), light);
            }
            break;
        case Mowing::Checks:
            for (int i = 0; i * 6.0 < all.width(); ++i) {
                for (int j = 0; j * 6.0 < all.height(); ++j) {
                    if ((i + j) % 2 == 0) {
                        p.fillRect(QRectF(i * 6.0, j * 6.0, 6.0, 6.0), light);
                    }
                }
            }
            break;
        case Mowing::Ovals:
            p.setPen(Qt::NoPen);
            for (int ring = 14; ring >= 1; --ring) {
                p.setBrush(ring % 2 ? light : dark);
                p.drawEllipse(QPointF(cx, cy), ring * 4.6, ring * 3.1);
            }
            break;
        case Mowing::Plaid: {
            // Mown in both directions: four shades where the passes cross.
            const double cell = 7;
            for (int i = 0; i * cell < all.width(); ++i) {
                for (int j = 0; j * cell < all.height(); ++j) {
                    const int tone = (i % 2) + (j % 2);
                    const QColor c = tone == 0   ? dark.darker(106)
                                     : tone == 1 ? QColor(0x45, 0x95, 0x44)
                                                 : light.lighter(106);
                    p.fillRect(QRectF(i * cell, j * cell, cell, cell), c);
                }
            }
            break;
        }
    }

    p.setPen(QPen(QColor(255, 255, 255, 235), 0.35));
    p.setBrush(Qt::NoBrush);
    const QRectF field(margin, margin, length, width);
    p.drawRect(field);
    p.drawLine(QPointF(cx, margin), QPointF(cx, margin + width));
    p.drawEllipse(QPointF(cx, cy), 9.15, 9.15);
    p.setBrush(Qt::white);
    p.drawEllipse(QPointF(cx, cy), 0.4, 0.4);
    for (double side : {-1.0, 1.0}) {
        const double goalLine = side < 0 ? margin : margin + length;
        p.setBrush(Qt::NoBrush);
        p.drawRect(QRectF(side < 0 ? goalLine : goalLine - 16.5, cy - 20.15, 16.5, 40.3));
        p.drawRect(QRectF(side < 0 ? goalLine : goalLine - 5.5, cy - 9.15, 5.5, 18.3));
        const QPointF spot(goalLine - side * 11, cy);
        p.setBrush(Qt::white);
        p.drawEllipse(spot, 0.35, 0.35);
        p.setBrush(Qt::NoBrush);
        const QRectF arc(spot.x() - 9.15, cy - 9.15, 18.3, 18.3);
        p.drawArc(arc, side < 0 ? -53 * 16 : 127 * 16, 106 * 16);
        p.setBrush(QColor(255, 255, 255, 200));
        p.drawRect(QRectF(side < 0 ? goalLine - 1.6 : goalLine, cy - 3.66, 1.6, 7.32));
    }
    return image;
}

void DrawInQuad(QPainter& painter, const QImage& texture, const QPolygonF& quad) {
    QTransform transform;
    const QPolygonF source(QRectF(texture.rect()));
    QPolygonF corners{source[0], source[1], source[2], source[3]};
    if (!QTransform::quadToQuad(corners, quad, transform)) {
        return;
    }
    painter.save();
    painter.setRenderHint(QPainter::SmoothPixmapTransform);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setTransform(transform, true);
    painter.drawImage(0, 0, texture);
    painter.restore();
}

QPolygonF Star(const QPointF& centre, double outer, double inner, double rotation) {
    QPolygonF star;
    for (int i = 0; i < 10; ++i) {
        const double angle = rotation - std::numbers::pi / 2 + i * std::numbers::pi / 5;
        const double r = i % 2 ? inner : outer;
        star << centre + QPointF(r * std::cos(angle), r * std::sin(angle));
    }
    return star;
}

void DrawCrowd(QPainter& painter, const QRectF& area, uint32_t seed, double headSize) {
    painter.save();
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setClipRect(area);
    FillVertical(painter, area, QColor(0x1C, 0x22, 0x2E), QColor(0x2A, 0x31, 0x3F));
    Dice dice(seed);
    const std::array<QColor, 8> shirts{QColor(0xD6, 0x3B, 0x3B), QColor(0xF2, 0xF2, 0xF2),
                                       QColor(0x2F, 0x6F, 0xC8), QColor(0xF2, 0xC1, 0x4E),
                                       QColor(0x3A, 0x3A, 0x44), QColor(0x3F, 0xA3, 0x5B),
                                       QColor(0xE8, 0x84, 0x2F), QColor(0x8E, 0x5B, 0xC4)};
    const std::array<QColor, 4> skins{QColor(0xF0, 0xC8, 0xA0), QColor(0xD9, 0xA7, 0x7C),
                                      QColor(0xB0, 0x7A, 0x50), QColor(0x7A, 0x4E, 0x32)};
    painter.setPen(Qt::NoPen);
    const double rowStep = headSize * 2.2;
    int row = 0;
    for (double y = area.top() + headSize; y < area.bottom() + headSize; y += rowStep, ++row) {
        const double shift = (row % 2) * headSize * 1.1;
        painter.fillRect(QRectF(area.left(), y + headSize * 1.6, area.width(), headSize * 0.35),
                         QColor(0, 0, 0, 60));
        for (double x = area.left() - shift; x < area.right() + headSize; x += headSize * 2.2) {
            const double jitter = (dice.next() - 0.5) * headSize * 0.6;
            const QColor shirt = shirts[static_cast<size_t>(dice.below(8))];
            painter.setBrush(shirt.darker(110 + dice.below(30)));
            painter.drawRoundedRect(QRectF(x - headSize * 0.95, y + headSize * 0.55 + jitter,
                                           headSize * 1.9, headSize * 1.6),
                                    headSize * 0.5, headSize * 0.5);
            painter.setBrush(skins[static_cast<size_t>(dice.below(4))]);
            painter.drawEllipse(QPointF(x, y + jitter), headSize * 0.62, headSize * 0.7);
            if (dice.next() < 0.08) {  // a raised scarf
                painter.setBrush(shirt);
                painter.drawRect(QRectF(x + headSize * 0.6, y - headSize * 1.8 + jitter,
                                        headSize * 0.45, headSize * 2.2));
            }
        }
    }
    painter.restore();
}

void DrawEmblem(QPainter& painter, const QRectF& rect) {
    painter.save();
    painter.setRenderHint(QPainter::Antialiasing);
    const QPointF c = rect.center();
    const double r = rect.width() / 2;
    QRadialGradient roundel(c + QPointF(-r * 0.3, -r * 0.4), r * 1.5);
    roundel.setColorAt(0, QColor(0x3F, 0xB0, 0x6A));
    roundel.setColorAt(1, QColor(0x14, 0x5E, 0x37));
    painter.setPen(QPen(QColor(255, 255, 255, 230), std::max(1.0, r * 0.08)));
    painter.setBrush(roundel);
    painter.drawEllipse(c, r - r * 0.04, r - r * 0.04);
    BallStyle ball;
    ball.seam = QColor(0x60, 0x60, 0x60);
    DrawBall(painter, c, r * 0.6, ball, false);
    painter.restore();
}

}  // namespace kickvane::artwork
