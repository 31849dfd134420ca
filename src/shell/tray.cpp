#include "shell/tray.h"

#include <QMenu>

namespace kickvane::shell {

SystemTrayIcon::SystemTrayIcon(const QIcon& icon, QMenu* menu, QObject* parent)
    : TrayIcon(parent), icon_(icon) {
    icon_.setToolTip(QString::fromLatin1(kTrayTooltip));
    icon_.setContextMenu(menu);
    // A left click opens the same menu; the right click opens it through the context menu.
    connect(&icon_, &QSystemTrayIcon::activated, this,
            [this](QSystemTrayIcon::ActivationReason reason) {
                if (reason == QSystemTrayIcon::Trigger) {
                    emit menuRequested();
                }
            });
    hostWatch_.setInterval(1000);
    connect(&hostWatch_, &QTimer::timeout, this, &SystemTrayIcon::ShowWhenHostAppears);
}

void SystemTrayIcon::Add() {
    wanted_ = true;
    icon_.show();
    if (!QSystemTrayIcon::isSystemTrayAvailable()) {
        hostWatch_.start();
    }
}

void SystemTrayIcon::Remove() {
    wanted_ = false;
    hostWatch_.stop();
    icon_.hide();
}

bool SystemTrayIcon::Shown() const {
    return wanted_ && icon_.isVisible() && QSystemTrayIcon::isSystemTrayAvailable();
}

void SystemTrayIcon::ShowWhenHostAppears() {
    if (!wanted_ || !QSystemTrayIcon::isSystemTrayAvailable()) {
        return;
    }
    hostWatch_.stop();
    // Dock again now that a host exists.
    icon_.hide();
    icon_.show();
}

}  // namespace kickvane::shell
