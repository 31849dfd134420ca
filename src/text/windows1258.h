#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace kickvane::text {

// Text that a Vietnamese Windows wrote in its ANSI code page, Windows-1258, as UTF-8 composed to
// NFC: that code page writes most toned letters as a letter followed by a combining tone mark
// ("Trò" is "Tro" and U+0300). nullopt unless the bytes read as Vietnamese: every byte is
// assigned in Windows-1258, each tone mark follows a letter it belongs on, everything beyond
// ASCII is a Vietnamese letter (or ₫), and at least one letter or mark of that code page that
// Windows-1252 lacks appears (Ă, Đ, Ơ, Ư, ₫, a tone mark).
std::optional<std::string> VietnameseWindowsTextToUtf8(std::string_view bytes);

}  // namespace kickvane::text
