#pragma once

#include <QIcon>
#include <QMenu>
#include <QObject>
#include <functional>
#include <memory>

#include "shell/tray.h"

namespace kickvane::shell {

// The tray entry that lists the failures of the last run.
inline constexpr const char* kFailuresEntryText = "Xem lỗi lần chép trước";

using TrayFactory = std::function<std::unique_ptr<TrayIcon>(const QIcon&, QMenu*)>;

// The tray icon and its menu: start the game, show the window, quick load, information, exit.
// A click on the icon opens the menu at the mouse.
class TrayMenu final : public QObject {
    Q_OBJECT
public:
    // `makeTray` null: the desktop's tray.
    TrayMenu(const QIcon& icon, const TrayFactory& makeTray, QObject* parent = nullptr);

    QMenu& menu() { return menu_; }
    TrayIcon& icon() { return *icon_; }
    // The entry whose caption is `text`; null when there is none.
    QAction* entry(const QString& text) const;
    // Shows the entry that lists the last run's failures while there are some.
    void showFailuresEntry(bool shown);

signals:
    void launchRequested();
    void showRequested();
    void quickLoadRequested();
    void aboutRequested();
    void failuresRequested();
    void exitRequested();

private:
    QMenu menu_;
    QAction* failures_ = nullptr;
    std::unique_ptr<TrayIcon> icon_;
};

}  // namespace kickvane::shell
