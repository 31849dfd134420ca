#pragma once

#include <functional>

#include "engine/engine_ui.h"
#include "shell/dialogs.h"
#include "shell/message_box.h"

namespace kickvane::shell {

using SoundPlayer = std::function<void(const std::filesystem::path&)>;

// The engine's messages, popups and sound, shown by the window.
class WindowUi final : public engine::EngineUi {
public:
    WindowUi(Dialogs& dialogs, QWidget* owner, SoundPlayer sound)
        : dialogs_(dialogs), owner_(owner), messages_(dialogs, owner), sound_(std::move(sound)) {}

    text::MessageHelper& Messages() override { return messages_; }
    void ShowPlainMessage(std::string_view text, std::string_view title) override {
        dialogs_.ShowMessage(owner_,
                             QString::fromUtf8(title.data(), static_cast<qsizetype>(title.size())),
                             QString::fromUtf8(text.data(), static_cast<qsizetype>(text.size())));
    }
    void PlaySound(const std::filesystem::path& wav) override {
        if (sound_) {
            sound_(wav);
        }
    }
    void ShowPopup(const engine::PopupRequest& popup) override {
        dialogs_.ShowPopup(
            QString::fromUtf8(popup.text.data(), static_cast<qsizetype>(popup.text.size())),
            popup.displaySeconds);
    }

private:
    Dialogs& dialogs_;
    QWidget* owner_;
    WindowMessageHelper messages_;
    SoundPlayer sound_;
};

}  // namespace kickvane::shell
