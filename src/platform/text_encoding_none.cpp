// Systems without an ANSI code page: callers fall back to their own decoding.
#include "platform/text_encoding.h"

namespace kickvane::platform {

std::optional<std::string> AnsiTextToUtf8(std::string_view) {
    return std::nullopt;
}

std::optional<std::string> CodePageTextToUtf8(std::string_view, unsigned) {
    return std::nullopt;
}

}  // namespace kickvane::platform
