#pragma once

#include <QIcon>
#include <QObject>
#include <QSystemTrayIcon>
#include <QTimer>
#include <memory>

class QMenu;

namespace kickvane::shell {

inline constexpr const char* kTrayTooltip = "Kickvane v2.0";

// The tool's entry in the notification area. The window adds it at start-up and removes it when
// it closes or the user exits from the menu.
class TrayIcon : public QObject {
    Q_OBJECT
public:
    using QObject::QObject;
    ~TrayIcon() override = default;

    virtual void Add() = 0;
    virtual void Remove() = 0;
    // A tray host shows the icon now; without one the window must stay reachable on screen.
    virtual bool Shown() const = 0;

signals:
    // The user clicked the icon: the window opens the menu at the mouse position.
    void menuRequested();
};

// The tray icon of the desktop. Where no tray host runs at start-up the icon waits and appears
// as soon as one starts.
class SystemTrayIcon final : public TrayIcon {
    Q_OBJECT
public:
    SystemTrayIcon(const QIcon& icon, QMenu* menu, QObject* parent = nullptr);

    void Add() override;
    void Remove() override;
    bool Shown() const override;

private:
    void ShowWhenHostAppears();

    QSystemTrayIcon icon_;
    QTimer hostWatch_;
    bool wanted_ = false;
};

}  // namespace kickvane::shell
