#pragma once

#include <QPushButton>
#include <QStringList>
#include <atomic>
#include <functional>
#include <thread>

#include "session/session.h"

class QLineEdit;

namespace kickvane::shell {

// The "Tìm" button: looks for the game's launcher off the window's thread and fills the game
// folder box with what it found (the user still saves). Several finds open a list to pick from,
// none a message that says where it looked.
class GameFinderButton final : public QPushButton {
    Q_OBJECT
public:
    // `search` is the session's game search; it runs on a thread of the button's.
    GameFinderButton(QLineEdit* gameFolderBox, session::GameSearch search);
    ~GameFinderButton() override;

    bool searching() const { return worker_.joinable() && !finished_; }

signals:
    // The search has ended and its result is shown (box filled, list or message opened).
    void searchFinished();

private:
    void start();
    void finish(const session::GameSearchOutcome& outcome);
    void stopWorker();

    QLineEdit* gameFolderBox_;
    session::GameSearch search_;
    std::thread worker_;
    std::atomic<bool> cancel_{false};
    bool finished_ = true;
};

// A path in lines no wider than `width` (as `measure` gives a text's width) that break only
// after a folder separator, never inside a name; a name wider than the width keeps a line of its
// own.
QStringList pathLines(const QString& path, int width,
                      const std::function<int(const QString&)>& measure);

// Puts a "Tìm" button between the game folder box and the change-folder button (the box gives
// up the room) and returns it.
GameFinderButton* addGameFinder(QLineEdit* gameFolderBox, QPushButton* browseButton,
                                session::GameSearch search);

}  // namespace kickvane::shell
