#pragma once

#include <string>
#include <string_view>

namespace kickvane::text {

// UTF-8 to UTF-16. Each maximal ill-formed sequence (a stray byte, a truncated sequence, an
// overlong form, an encoded surrogate, a value above U+10FFFF) becomes one U+FFFD.
std::u16string Utf8ToUtf16(std::string_view utf8);

// UTF-16 to UTF-8. An unpaired surrogate becomes U+FFFD.
std::string Utf16ToUtf8(std::u16string_view utf16);

// Appends one character as UTF-8; a surrogate or a value above U+10FFFF becomes U+FFFD.
void AppendUtf8(std::string& out, char32_t cp);

// Strict UTF-8: no overlong forms, no surrogates, nothing above U+10FFFF.
bool IsValidUtf8(std::string_view text);

// Text from files that older tools wrote: kept as it is when it is valid UTF-8, otherwise read
// as Windows-1252 (the five bytes that code page leaves unassigned become the C1 controls of the
// same value). Never drops a byte.
std::string LegacyTextToUtf8(std::string_view bytes);

}  // namespace kickvane::text
