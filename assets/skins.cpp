#include <QFontMetricsF>
#include <QPainterPath>
#include <array>
#include <cmath>
#include <numbers>
#include <string>

#include "artwork.h"
#include "drawing.h"

namespace kickvane::artwork {

namespace {

namespace fs = std::filesystem;

// Where the window puts things over the background (pixels of the client area).
const QRectF kHeader(0, 0, 425, 44);
const QRectF kTabRail(4, 58, 92, 182);  // behind the tab heads at x 9-91, y 65-233
const QRectF kFooter(0, 430, 425, 48);  // behind the button row at y 440-474

struct SkinColours {
    const char* name;
    QColor headerTop, headerBottom, wordmark, tagline;
    QColor bodyTop, bodyBottom, motif;
    QColor rail, railEdge, footer, footerEdge;
    QColor panelTop, panelBottom, panelLine, panelEdge;
    QColor selectedTop, selectedBottom, selectedEdge, accent;
    QColor unselectTop, unselectBottom, unselectEdge;
};

// Skin 1 is light; skin 2 is dark. The tab heads stay light in both, since the window writes their
// captions in dark text.
const std::array<SkinColours, 2> kSkins{{
    {"skin1",
     QColor(0x23, 0x86, 0x52),
     QColor(0x15, 0x5E, 0x38),
     Qt::white,
     QColor(255, 255, 255, 170),
     QColor(0xF3, 0xF5, 0xF6),
     QColor(0xE2, 0xE7, 0xEA),
     QColor(0xD6, 0xDD, 0xE1),
     QColor(0xE4, 0xE9, 0xEC),
     QColor(0xCF, 0xD7, 0xDC),
     QColor(0xDA, 0xE0, 0xE4),
     QColor(0xC4, 0xCD, 0xD3),
     QColor(0xFB, 0xFC, 0xFB),
     QColor(0xEA, 0xEF, 0xEC),
     QColor(0xDC, 0xE5, 0xDF),
     QColor(0xC6, 0xD1, 0xCA),
     QColor(0xFF, 0xFF, 0xFF),
     QColor(0xE4, 0xF1, 0xE8),
     QColor(0x9C, 0xB8, 0xA6),
     kGreen,
     QColor(0xF1, 0xF3, 0xF5),
     QColor(0xD9, 0xDF, 0xE3),
     QColor(0xBE, 0xC8, 0xCF)},
    {"skin2",
     QColor(0x15, 0x3B, 0x27),
     QColor(0x0B, 0x22, 0x16),
     QColor(0xF1, 0xF5, 0xF2),
     QColor(255, 255, 255, 140),
     QColor(0x2C, 0x31, 0x37),
     QColor(0x1E, 0x22, 0x27),
     QColor(0x35, 0x3B, 0x42),
     QColor(0x25, 0x2A, 0x30),
     QColor(0x3A, 0x41, 0x49),
     QColor(0x19, 0x1C, 0x20),
     QColor(0x3A, 0x41, 0x49),
     QColor(0x35, 0x3B, 0x41),
     QColor(0x28, 0x2D, 0x32),
     QColor(0x40, 0x48, 0x50),
     QColor(0x4A, 0x53, 0x5C),
     QColor(0xEA, 0xF4, 0xEE),
     QColor(0xC3, 0xDE, 0xCD),
     QColor(0x1A, 0x3A, 0x28),
     QColor(0x2F, 0xA8, 0x66),
     QColor(0xB9, 0xC0, 0xC7),
     QColor(0x9B, 0xA3, 0xAC),
     QColor(0x4A, 0x52, 0x5B)},
}};

// Faint pitch markings: a centre circle and a penalty area, cut by the picture's edges.
void DrawPitchMotif(QPainter& p, const QRectF& area, const QColor& colour, double width) {
    p.save();
    p.setRenderHint(QPainter::Antialiasing);
    p.setClipRect(area);
    p.setPen(QPen(colour, width));
    p.setBrush(Qt::NoBrush);
    const double cx = area.center().x();
    p.drawEllipse(QPointF(cx, area.top() - 10), 70, 70);
    p.drawLine(QPointF(area.left(), area.top() - 10), QPointF(area.right(), area.top() - 10));
    const QRectF box(cx - 110, area.bottom() - 78, 220, 90);
    p.drawRect(box);
    p.drawRect(QRectF(cx - 48, area.bottom() - 30, 96, 40));
    p.drawArc(QRectF(cx - 42, box.top() - 28, 84, 84), 30 * 16, 120 * 16);
    p.restore();
}

QImage Background(const SkinColours& s) {
    QImage image = NewCanvas(425, 478);
    QPainter p(&image);
    p.setRenderHint(QPainter::Antialiasing);
    FillVertical(p, QRectF(0, 44, 425, 434), s.bodyTop, s.bodyBottom);

    // A quiet corner motif below the tab column.
    p.setPen(QPen(s.motif, 2));
    p.setBrush(Qt::NoBrush);
    p.drawEllipse(QPointF(52, 345), 40, 40);
    p.drawLine(QPointF(0, 345), QPointF(100, 345));

    p.setPen(QPen(s.railEdge, 1));
    p.setBrush(s.rail);
    p.drawRoundedRect(kTabRail.adjusted(0.5, 0.5, -0.5, -0.5), 6, 6);

    FillVertical(p, kFooter, s.footer.lighter(104), s.footer);
    p.setPen(QPen(s.footerEdge, 1));
    p.drawLine(QPointF(0, kFooter.top() + 0.5), QPointF(425, kFooter.top() + 0.5));

    // Header strip with the wordmark.
    FillVertical(p, kHeader, s.headerTop, s.headerBottom);
    p.save();
    p.setClipRect(kHeader);
    p.setBrush(Qt::NoBrush);
    p.setPen(QPen(QColor(255, 255, 255, 28), 2));
    p.drawEllipse(QPointF(360, 22), 38, 38);
    p.drawLine(QPointF(360, 0), QPointF(360, 44));
    p.drawRect(QRectF(398, 6, 40, 32));
    p.restore();
    p.fillRect(QRectF(0, 42, 425, 2), kGold);
    DrawEmblem(p, QRectF(11, 6, 31, 31));
    p.setPen(s.wordmark);
    const QFont wordmark = Font(23, true);
    p.setFont(wordmark);
    const QString name = QStringLiteral("Kickvane");
    p.drawText(QRectF(50, 4, 200, 36), Qt::AlignLeft | Qt::AlignVCenter, name);
    p.setPen(s.tagline);
    p.setFont(Font(11));
    const double after = 50 + QFontMetricsF(wordmark).horizontalAdvance(name) + 7;
    p.drawText(QRectF(after, 13, 60, 24), Qt::AlignLeft | Qt::AlignVCenter, QStringLiteral("v2.0"));
    return image;
}

QImage Panel(const SkinColours& s) {
    QImage image = NewCanvas(321, 357);
    QPainter p(&image);
    FillVertical(p, QRectF(0, 0, 321, 357), s.panelTop, s.panelBottom);
    DrawPitchMotif(p, QRectF(0, 0, 321, 357), s.panelLine, 2);
    p.setPen(QPen(s.panelEdge, 1));
    p.setBrush(Qt::NoBrush);
    p.drawRect(QRectF(0.5, 0.5, 320, 356));
    return image;
}

QImage TabHead(const SkinColours& s, bool selected) {
    QImage image = NewCanvas(82, 31, s.rail);
    QPainter p(&image);
    p.setRenderHint(QPainter::Antialiasing);
    QPainterPath shape;
    shape.addRoundedRect(QRectF(0.5, 0.5, 81, 30), 4, 4);
    QLinearGradient fill(0, 0, 0, 31);
    fill.setColorAt(0, selected ? s.selectedTop : s.unselectTop);
    fill.setColorAt(1, selected ? s.selectedBottom : s.unselectBottom);
    p.fillPath(shape, fill);
    if (selected) {
        p.save();
        p.setClipPath(shape);
        p.fillRect(QRectF(0, 0, 5, 31), s.accent);
        p.restore();
    }
    p.setPen(QPen(selected ? s.selectedEdge : s.unselectEdge, 1));
    p.drawPath(shape);
    // A highlight along the top edge.
    p.setPen(QPen(QColor(255, 255, 255, selected ? 200 : 120), 1));
    p.drawLine(QPointF(selected ? 6 : 4, 1.5), QPointF(77, 1.5));
    return image;
}

bool SavePng(const QImage& image, const fs::path& file) {
    return image.save(QString::fromStdString(file.string()), "PNG");
}

// The icon at its own size: drawn per size rather than scaled, so that 16 pixels stay crisp.
QImage Icon(int size) {
    QImage image = NewCanvas(size, size);
    QPainter p(&image);
    p.setRenderHint(QPainter::Antialiasing);
    if (size >= 32) {
        DrawEmblem(p, QRectF(0, 0, size, size));
        return image;
    }
    // At 16 pixels: a bold roundel, a white ball and a few dark patches; seams would only blur.
    const QPointF c(size / 2.0, size / 2.0);
    p.setPen(Qt::NoPen);
    p.setBrush(QColor(0x1F, 0x8A, 0x4F));
    p.drawEllipse(c, size / 2.0, size / 2.0);
    QPainterPath ball;
    ball.addEllipse(c, size * 0.36, size * 0.36);
    p.fillPath(ball, Qt::white);
    p.setClipPath(ball);
    const QColor patch(0x1A, 0x1A, 0x1A);
    QPolygonF pentagon;
    for (int i = 0; i < 5; ++i) {
        const double a = -std::numbers::pi / 2 + i * 2 * std::numbers::pi / 5;
        pentagon << c + QPointF(std::cos(a), std::sin(a)) * (size * 0.14);
        p.setBrush(patch);
        p.drawEllipse(
            c + QPointF(std::cos(a + std::numbers::pi / 5), std::sin(a + std::numbers::pi / 5)) *
                    (size * 0.38),
            size * 0.1, size * 0.1);
    }
    p.setBrush(patch);
    p.drawPolygon(pentagon);
    return image;
}

}  // namespace

bool WriteSkins(const fs::path& toolFolder) {
    bool ok = true;
    for (const SkinColours& s : kSkins) {
        const fs::path folder = toolFolder / "skin";
        const std::string name = s.name;
        ok = SaveJpeg(Background(s), folder / (name + "_bg.jpg")) && ok;
        ok = SaveJpeg(Panel(s), folder / (name + "_panel.jpg")) && ok;
        ok = SaveJpeg(TabHead(s, true), folder / (name + "_selected.jpg")) && ok;
        ok = SaveJpeg(TabHead(s, false), folder / (name + "_unselect.jpg")) && ok;
    }
    return ok;
}

bool WriteIcons(const fs::path& toolFolder) {
    bool ok = true;
    for (int size : {16, 32, 64}) {
        ok = SavePng(Icon(size),
                     toolFolder / "icons" / ("kickvane-" + std::to_string(size) + ".png")) &&
             ok;
    }
    return ok;
}

}  // namespace kickvane::artwork
