#include "shell/tray.h"

#include <QMenu>
#include <utility>

namespace kickvane::shell {

QString trayToolTip(const QString& statusLine) {
    QString tip = QString::fromLatin1(kTrayTooltip);
    if (!statusLine.isEmpty()) {
        tip += QLatin1Char('\n') + statusLine;
    }
    return tip;
}

void TrayIcon::setStatusLine(const QString& line) {
    // One line only: a line break in it would push the name off a short tooltip.
    QString single = line.simplified();
    if (single == statusLine_) {
        return;
    }
    statusLine_ = std::move(single);
    toolTipChanged();
}

SystemTrayIcon::SystemTrayIcon(const QIcon& icon, QMenu* menu, QObject* parent)
    : TrayIcon(parent), icon_(icon) {
    icon_.setToolTip(toolTip());
    icon_.setContextMenu(menu);
    // A left click opens the same menu; the right click opens it through the context menu.
    connect(&icon_, &QSystemTrayIcon::activated, this,
            [this](QSystemTrayIcon::ActivationReason reason) {
                if (reason == QSystemTrayIcon::Trigger) {
                    emit menuRequested();
                }
            });
    hostWatch_.setInterval(1000);
    connect(&hostWatch_, &QTimer::timeout, this, &SystemTrayIcon::showWhenHostAppears);
}

void SystemTrayIcon::add() {
    wanted_ = true;
    icon_.show();
    if (!QSystemTrayIcon::isSystemTrayAvailable()) {
        hostWatch_.start();
    }
}

void SystemTrayIcon::remove() {
    wanted_ = false;
    hostWatch_.stop();
    icon_.hide();
}

bool SystemTrayIcon::shown() const {
    return wanted_ && icon_.isVisible() && QSystemTrayIcon::isSystemTrayAvailable();
}

void SystemTrayIcon::toolTipChanged() {
    icon_.setToolTip(toolTip());
}

void SystemTrayIcon::showWhenHostAppears() {
    if (!wanted_ || !QSystemTrayIcon::isSystemTrayAvailable()) {
        return;
    }
    hostWatch_.stop();
    // Dock again now that a host exists.
    icon_.hide();
    icon_.show();
}

}  // namespace kickvane::shell
