#include "shell/skins.h"

#include "platform/filesystem.h"
#include "shell/catalog_panels.h"
#include "shell/qt_text.h"
#include "shell/widgets.h"

namespace kickvane::shell {

WindowSkins::WindowSkins(std::filesystem::path toolFolder, CatalogPanels& panels)
    : toolFolder_(std::move(toolFolder)), panels_(panels) {}

QString WindowSkins::skinFile(const QString& skin, const QString& suffix) const {
    return pathToQString(
        platform::ResolveCaseInsensitive(toolFolder_ / "skin" / qStringToPath(skin + suffix)));
}

void WindowSkins::initialise() {
    panels_.layoutPanels(skinFile(lightSkin().name, QStringLiteral("_panel.jpg")));
    loadPicture(background_, skinFile(activeSkin_, QStringLiteral("_bg.jpg")));
    paintTabs();
}

void WindowSkins::paintTabs() {
    panels_.paintTabs(skinFile(activeSkin_, QStringLiteral("_selected.jpg")),
                      skinFile(activeSkin_, QStringLiteral("_unselect.jpg")));
}

void WindowSkins::apply(const SkinLook& look) {
    loadPicture(background_, skinFile(look.name, QStringLiteral("_bg.jpg")));
    panels_.layoutPanels(skinFile(look.name, QStringLiteral("_panel.jpg")));
    panels_.recolour(look);
    activeSkin_ = look.name;
    paintTabs();
}

}  // namespace kickvane::shell
