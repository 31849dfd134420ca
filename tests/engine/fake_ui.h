#pragma once

#include <filesystem>
#include <string>
#include <vector>

#include "engine/engine_ui.h"

namespace kickvane::testing {

// Records what the engine shows instead of showing it.
class FakeUi final : public engine::EngineUi {
public:
    class RecordedMessages final : public text::MessageHelper {
    public:
        void ShowText(std::string_view text) override { shown.emplace_back(text); }
        std::string ReadWindowText(std::uintptr_t) const override { return {}; }
        std::vector<std::string> shown;
    };

    text::MessageHelper& Messages() override { return messages; }
    void ShowPlainMessage(std::string_view text, std::string_view title) override {
        plain.emplace_back(std::string(title) + "|" + std::string(text));
    }
    void PlaySound(const std::filesystem::path& wav) override { sounds.push_back(wav); }
    void ShowPopup(const engine::PopupRequest& popup) override { popups.emplace_back(popup.text); }

    RecordedMessages messages;
    std::vector<std::string> plain;
    std::vector<std::filesystem::path> sounds;
    std::vector<std::string> popups;
};

}  // namespace kickvane::testing
