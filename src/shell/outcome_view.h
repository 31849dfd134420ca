#pragma once

#include <filesystem>
#include <functional>

#include "session/session.h"
#include "shell/dialogs.h"

namespace kickvane::shell {

using SoundPlayer = std::function<void(const std::filesystem::path&)>;

// Shows what a session command returned: the signal sound, then the messages, then the popup.
class OutcomeView {
public:
    OutcomeView(Dialogs& dialogs, QWidget* owner, SoundPlayer sound)
        : dialogs_(dialogs), owner_(owner), sound_(std::move(sound)) {}

    void show(const session::Outcome& shown);
    void showMessage(const text::Message& message);
    void showPopup(const session::Popup& popup);

    Dialogs& dialogs() { return dialogs_; }

private:
    Dialogs& dialogs_;
    QWidget* owner_;
    SoundPlayer sound_;
};

}  // namespace kickvane::shell
