#pragma once

#include <cstdint>
#include <iosfwd>
#include <string>
#include <string_view>

namespace kickvane::text {

// Shows the tool's messages. Engine messages are stored VNI-typed; callers pass them through
// ConvertText and hand the result to ShowText. The window shows a message box; the command line
// writes to standard error.
class MessageHelper {
public:
    virtual ~MessageHelper() = default;

    // A VNI-typed text as Unicode (UTF-8).
    virtual std::string ConvertText(std::string_view vniText) const;

    // Shows an already converted text and returns once the user has had it.
    virtual void ShowText(std::string_view text) = 0;

    // The text of a window as Unicode (UTF-8); empty for a window the helper does not know.
    virtual std::string ReadWindowText(std::uintptr_t window) const = 0;
};

// Writes each text on its own line to a stream (standard error by default).
class ConsoleMessageHelper final : public MessageHelper {
public:
    ConsoleMessageHelper();
    explicit ConsoleMessageHelper(std::ostream& out);

    void ShowText(std::string_view text) override;
    std::string ReadWindowText(std::uintptr_t window) const override;

private:
    std::ostream& out_;
};

}  // namespace kickvane::text
