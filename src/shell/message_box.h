#pragma once

#include <QString>
#include <string_view>

#include "shell/dialogs.h"
#include "text/message_helper.h"

class QWidget;

namespace kickvane::shell {

inline constexpr int kStyleInformation = 64;  // information icon, one OK button
inline constexpr std::string_view kNoticeTitleVni = "Tho6ng ba1o";

// Shows a message box whose text and title are stored VNI-typed; both are converted first.
// Style 64 shows the information icon; every style has the one OK button the tool uses.
// Returns the identifier of the pressed button (1, OK).
int ShowMessageW(std::string_view text, std::string_view title, int style, QWidget* owner);

// The window's message helper: texts are shown in message boxes titled "Thông báo".
class WindowMessageHelper final : public text::MessageHelper {
public:
    WindowMessageHelper(Dialogs& dialogs, QWidget* owner) : dialogs_(dialogs), owner_(owner) {}

    void ShowText(std::string_view text) override;
    // The text of a window of this process, by its native window id.
    std::string ReadWindowText(std::uintptr_t window) const override;

private:
    Dialogs& dialogs_;
    QWidget* owner_;
};

QString NoticeTitle();

}  // namespace kickvane::shell
