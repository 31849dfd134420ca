#pragma once

#include <filesystem>
#include <string_view>

#include "text/message_helper.h"

namespace kickvane::engine {

// A confirmation in the corner popup; the window shows it, the command line prints it.
struct PopupRequest {
    std::string_view text;  // Unicode, shown as it is
    int displaySeconds = 2;
};

// What the engine's operations show to the user. The window implements it with message boxes,
// popups and the desktop's event sound; the command line with its streams and no sound.
class EngineUi {
public:
    virtual ~EngineUi() = default;

    // Messages stored VNI-typed go through ConvertText and then ShowText.
    virtual text::MessageHelper& Messages() = 0;

    // A plain message box whose ASCII text is shown as stored.
    virtual void ShowPlainMessage(std::string_view text, std::string_view title) = 0;

    // Plays a WAV file without waiting for it; a missing file plays the desktop's default sound.
    virtual void PlaySound(const std::filesystem::path& wav) = 0;

    virtual void ShowPopup(const PopupRequest& popup) = 0;
};

}  // namespace kickvane::engine
