#pragma once

#include <string>

namespace kickvane::text {

// A message for the user, as an operation returns it; the window shows it in a message box, the
// command line writes it to standard error.
struct Message {
    enum class Kind {
        Component,  // the message component's box, titled "Thông báo"
        Plain,      // a box with its own title
        Warning,    // a box with its own title and the warning icon
        Notice,     // a box that does not wait: the window goes on while it is open
    };

    Kind kind = Kind::Component;
    std::string text;   // Unicode (UTF-8), shown as it is
    std::string title;  // unused for Component

    friend bool operator==(const Message&, const Message&) = default;
};

}  // namespace kickvane::text
