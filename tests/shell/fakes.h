#pragma once

#include <QStringList>
#include <deque>

#include "shell/dialogs.h"
#include "shell/tray.h"
#include "support/fake_keys.h"

namespace kickvane::testing {

// Records what the window would show, and answers folder pickers from a queue.
class RecordingDialogs final : public shell::Dialogs {
public:
    std::optional<QString> pickFolder(QWidget*, const QString&, const QString& start) override {
        starts << start;
        if (folders.empty()) {
            return std::nullopt;
        }
        std::optional<QString> folder = folders.front();
        folders.pop_front();
        return folder;
    }
    void showMessage(QWidget*, const QString& title, const QString& text, Icon) override {
        messages << title + QLatin1Char('|') + text;
    }
    void showNotice(QWidget*, const QString&, const QString& text) override { notices << text; }
    void showPopup(const QString& text, int seconds) override {
        popups << text + QLatin1Char('|') + QString::number(seconds);
    }
    void showFailureAlert(const QString& text, int seconds,
                          std::function<void()> onClick) override {
        alerts << text + QLatin1Char('|') + QString::number(seconds);
        alertClick = std::move(onClick);
    }

    std::deque<std::optional<QString>> folders;  // nullopt: the user cancels
    QStringList starts;                          // where each folder picker was asked to open
    QStringList messages;
    QStringList notices;
    QStringList popups;
    QStringList alerts;
    std::function<void()> alertClick;  // the last failure alert's click
};

// A tray that records whether its icon is there; `hostRunning` says whether a tray host shows it.
class FakeTray final : public shell::TrayIcon {
public:
    void add() override { added = true; }
    void remove() override { added = false; }
    bool shown() const override { return added && hostRunning; }

    bool added = false;
    bool hostRunning = true;
};

}  // namespace kickvane::testing
