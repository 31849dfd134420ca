#pragma once

// UTF-8 and UTF-16 conversions for the Windows backends (Windows only).
#include <string>
#include <string_view>

namespace kickvane::platform {

std::wstring Utf8ToWide(std::string_view utf8);
std::string WideToUtf8(std::wstring_view wide);

}  // namespace kickvane::platform
