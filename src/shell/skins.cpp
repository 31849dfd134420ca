#include "shell/skins.h"

#include <QApplication>
#include <QPalette>
#include <QWidget>

#include "platform/filesystem.h"
#include "shell/catalog_panels.h"
#include "shell/qt_text.h"
#include "shell/widgets.h"

namespace kickvane::shell {

void Paint(QWidget* widget, const QColor& background, const QColor& text) {
    QPalette palette = widget->palette();
    palette.setColor(QPalette::Window, background);
    palette.setColor(QPalette::WindowText, text);
    widget->setPalette(palette);
    widget->setAutoFillBackground(true);
}

SkinLook LightSkin() {
    return {QStringLiteral("skin1"), kEntryBackground, Qt::black, kLabelBackground};
}

SkinLook DarkSkin() {
    // The labels take the system's menu text colour as their background.
    return {QStringLiteral("skin2"), QColor(0x40, 0x40, 0x40), Qt::white,
            QApplication::palette().color(QPalette::Active, QPalette::WindowText)};
}

WindowSkins::WindowSkins(std::filesystem::path toolFolder, CatalogPanels& panels)
    : toolFolder_(std::move(toolFolder)), panels_(panels) {}

QString WindowSkins::skinFile(const QString& skin, const QString& suffix) const {
    return PathToQString(
        platform::ResolveCaseInsensitive(toolFolder_ / "skin" / ToUtf8(skin + suffix)));
}

void WindowSkins::initialise() {
    panels_.layoutPanels(skinFile(LightSkin().name, QStringLiteral("_panel.jpg")));
    LoadPicture(background_, skinFile(activeSkin_, QStringLiteral("_bg.jpg")));
    paintTabs();
}

void WindowSkins::paintTabs() {
    panels_.paintTabs(skinFile(activeSkin_, QStringLiteral("_selected.jpg")),
                      skinFile(activeSkin_, QStringLiteral("_unselect.jpg")));
}

void WindowSkins::apply(const SkinLook& look) {
    LoadPicture(background_, skinFile(look.name, QStringLiteral("_bg.jpg")));
    panels_.layoutPanels(skinFile(look.name, QStringLiteral("_panel.jpg")));
    panels_.recolour(look);
    activeSkin_ = look.name;
    paintTabs();
}

}  // namespace kickvane::shell
