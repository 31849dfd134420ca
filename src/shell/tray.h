#pragma once

#include <QIcon>
#include <QObject>
#include <QSystemTrayIcon>
#include <QTimer>
#include <memory>

class QMenu;

namespace kickvane::shell {

inline constexpr const char* kTrayTooltip = "Kickvane v2.0";

// The icon's tooltip: the tool's name and version, and below it a status line when there is one.
QString trayToolTip(const QString& statusLine);

// The tool's entry in the notification area. The window adds it at start-up and removes it when
// it closes or the user exits from the menu.
class TrayIcon : public QObject {
    Q_OBJECT
public:
    using QObject::QObject;
    ~TrayIcon() override = default;

    virtual void add() = 0;
    virtual void remove() = 0;
    // A tray host shows the icon now; without one the window must stay reachable on screen.
    virtual bool shown() const = 0;

    // The tooltip's second line, such as the last patch run's result; empty leaves one line.
    void setStatusLine(const QString& line);
    QString toolTip() const { return trayToolTip(statusLine_); }

signals:
    // The user clicked the icon: the window opens the menu at the mouse position.
    void menuRequested();

protected:
    // The tooltip has changed; an icon on screen shows the new one.
    virtual void toolTipChanged() {}

private:
    QString statusLine_;
};

// The tray icon of the desktop. Where no tray host runs at start-up the icon waits and appears
// as soon as one starts.
class SystemTrayIcon final : public TrayIcon {
    Q_OBJECT
public:
    SystemTrayIcon(const QIcon& icon, QMenu* menu, QObject* parent = nullptr);

    void add() override;
    void remove() override;
    bool shown() const override;

protected:
    void toolTipChanged() override;

private:
    void showWhenHostAppears();

    QSystemTrayIcon icon_;
    QTimer hostWatch_;
    bool wanted_ = false;
};

}  // namespace kickvane::shell
