#pragma once

#include <optional>
#include <string>
#include <string_view>

// Text in the system's legacy ("ANSI") code page, which older Windows tools wrote their files in.
namespace kickvane::platform {

// `bytes` in the system's ANSI code page, as UTF-8 composed to NFC (Vietnamese systems use
// Windows-1258, which writes tone marks as combining characters after the letter). nullopt where
// the system has no such code page: everywhere but Windows.
std::optional<std::string> AnsiTextToUtf8(std::string_view bytes);

// The same for a given Windows code page; nullopt outside Windows or for a code page the system
// does not know.
std::optional<std::string> CodePageTextToUtf8(std::string_view bytes, unsigned codePage);

}  // namespace kickvane::platform
