#include "shell/skin_look.h"

#include <algorithm>
#include <cmath>

#include <QApplication>
#include <QPalette>
#include <QWidget>

namespace kickvane::shell {

void paint(QWidget* widget, const QColor& background, const QColor& text) {
    QPalette palette = widget->palette();
    palette.setColor(QPalette::Window, background);
    palette.setColor(QPalette::WindowText, text);
    widget->setPalette(palette);
    widget->setAutoFillBackground(true);
}

SkinLook lightSkin() {
    return {QStringLiteral("skin1"),
            kEntryBackground,
            Qt::black,
            kLabelBackground,
            Qt::white,
            Qt::black,
            QColor(0xC0, 0x00, 0x00),
            QColor(0xF0, 0xF0, 0xF0)};
}

SkinLook darkSkin() {
    // The labels take the system's menu text colour as their background. The tick boxes and
    // option buttons are drawn on the entries' own dark colour, not on light squares.
    const QColor entry(0x40, 0x40, 0x40);
    return {QStringLiteral("skin2"),
            entry,
            Qt::white,
            QApplication::palette().color(QPalette::Active, QPalette::WindowText),
            entry,
            Qt::white,
            QColor(0xFF, 0x80, 0x80),
            QColor(0x30, 0x30, 0x30)};
}

double contrastRatio(const QColor& a, const QColor& b) {
    const auto luminance = [](const QColor& colour) {
        const auto linear = [](double channel) {
            return channel <= 0.04045 ? channel / 12.92 : std::pow((channel + 0.055) / 1.055, 2.4);
        };
        return 0.2126 * linear(colour.redF()) + 0.7152 * linear(colour.greenF()) +
               0.0722 * linear(colour.blueF());
    };
    const double first = luminance(a);
    const double second = luminance(b);
    return (std::max(first, second) + 0.05) / (std::min(first, second) + 0.05);
}

}  // namespace kickvane::shell
