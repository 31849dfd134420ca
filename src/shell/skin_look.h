#pragma once

#include <QColor>
#include <QString>

class QWidget;

namespace kickvane::shell {

// Colours of the entries in the light skin, the look at every start.
inline const QColor kEntryBackground{0xE0, 0xE0, 0xE0};
inline const QColor kLabelBackground{0xC0, 0xC0, 0xC0};

// Gives `widget` its own background and text colour.
void paint(QWidget* widget, const QColor& background, const QColor& text = Qt::black);

// The look of one skin: its picture prefix and the colours of the entries.
struct SkinLook {
    QString name;            // "skin1" or "skin2", the prefix of its pictures
    QColor entryBackground;  // tick boxes, option buttons, the framed groups
    QColor labelText;
    QColor labelBackground;
    QColor indicatorBase;  // inside the tick boxes and option buttons
    QColor indicatorMark;  // their tick and dot
    QColor noteText;       // the red note under a hotkey that names no key
    QColor noteBackground;
};
SkinLook lightSkin();
SkinLook darkSkin();

// The contrast ratio of two colours as WCAG 2 defines it, from 1 (the same) to 21 (black on
// white); text reads well from 4.5 on.
double contrastRatio(const QColor& a, const QColor& b);

}  // namespace kickvane::shell
