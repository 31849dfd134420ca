#pragma once

#include <string>
#include <string_view>

namespace kickvane::text {

// Converts VNI-typed text (digits 1-9 after a letter mark its diacritics) to Unicode.
// Works on UTF-16 code units, as the texts of message boxes are held.
std::u16string VniToUnicode(std::u16string_view text);

// The same for UTF-8 text. Bytes that are not valid UTF-8 pass through as U+FFFD.
std::string VniToUnicodeUtf8(std::string_view text);

}  // namespace kickvane::text
