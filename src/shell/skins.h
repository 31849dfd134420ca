#pragma once

#include <QColor>
#include <QPixmap>
#include <QString>
#include <filesystem>

class QWidget;

namespace kickvane::shell {

class CatalogPanels;

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

// The window's two skins: the active one's background picture, tab and panel pictures and the
// colours of the entries. The window starts in the light skin.
class WindowSkins {
public:
    WindowSkins(std::filesystem::path toolFolder, CatalogPanels& panels);

    // Lays out the panels with the light skin's panel picture and loads the background.
    void initialise();
    // Switches to `look`: background, panels, entries and tab heads.
    void apply(const SkinLook& look);
    // Draws the tab heads with the active skin's pictures.
    void paintTabs();

    const QString& activeSkin() const { return activeSkin_; }
    const QPixmap& background() const { return background_; }

private:
    QString skinFile(const QString& skin, const QString& suffix) const;

    std::filesystem::path toolFolder_;
    CatalogPanels& panels_;
    QString activeSkin_ = QStringLiteral("skin1");
    QPixmap background_;
};

}  // namespace kickvane::shell
