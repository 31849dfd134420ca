#pragma once

#include <QPixmap>
#include <QString>
#include <filesystem>

#include "shell/skin_look.h"

namespace kickvane::shell {

class CatalogPanels;

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
