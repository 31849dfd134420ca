#pragma once

#include <string>
#include <string_view>

namespace kickvane::text {

// UTF-8 to UTF-16. Each maximal ill-formed sequence (a stray byte, a truncated sequence, an
// overlong form, an encoded surrogate, a value above U+10FFFF) becomes one U+FFFD.
std::u16string Utf8ToUtf16(std::string_view utf8);

// UTF-16 to UTF-8. An unpaired surrogate becomes U+FFFD.
std::string Utf16ToUtf8(std::u16string_view utf16);

}  // namespace kickvane::text
