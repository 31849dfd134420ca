#include "shell/tray_menu.h"

#include <QCursor>

namespace kickvane::shell {

TrayMenu::TrayMenu(const QIcon& icon, const TrayFactory& makeTray, QObject* parent)
    : QObject(parent) {
    // Captions are kept as "[utf8]" and the text; the menu shows the text.
    const auto add = [this](const char* stored, void (TrayMenu::*signal)()) {
        const QString caption = QString::fromUtf8(stored).remove(0, 6);
        connect(menu_.addAction(caption), &QAction::triggered, this, signal);
    };
    add("[utf8]Khởi động FIFA", &TrayMenu::launchRequested);
    add("[utf8]Hiện chương trình", &TrayMenu::showRequested);
    add("[utf8]Nạp nhanh", &TrayMenu::quickLoadRequested);
    add("[utf8]Thông tin", &TrayMenu::aboutRequested);
    failures_ = menu_.addAction(QString::fromUtf8(kFailuresEntryText));
    failures_->setVisible(false);
    connect(failures_, &QAction::triggered, this, &TrayMenu::failuresRequested);
    add("[utf8]Thoát", &TrayMenu::exitRequested);

    icon_ = makeTray ? makeTray(icon, &menu_) : std::make_unique<SystemTrayIcon>(icon, &menu_);
    connect(icon_.get(), &TrayIcon::menuRequested, this, [this] { menu_.popup(QCursor::pos()); });
}

void TrayMenu::showFailuresEntry(bool shown) {
    failures_->setVisible(shown);
}

QAction* TrayMenu::entry(const QString& text) const {
    for (QAction* action : menu_.actions()) {
        if (action->text() == text) {
            return action;
        }
    }
    return nullptr;
}

}  // namespace kickvane::shell
