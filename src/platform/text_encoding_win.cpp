// Code pages on Windows, through the system's own conversion and normalisation.
#include <windows.h>

#include "platform/text_encoding.h"
#include "platform/win_text.h"

namespace kickvane::platform {

std::wstring Utf8ToWide(std::string_view utf8) {
    if (utf8.empty()) {
        return {};
    }
    const int size =
        MultiByteToWideChar(CP_UTF8, 0, utf8.data(), static_cast<int>(utf8.size()), nullptr, 0);
    std::wstring wide(static_cast<size_t>(size), L'\0');
    MultiByteToWideChar(CP_UTF8, 0, utf8.data(), static_cast<int>(utf8.size()), wide.data(), size);
    return wide;
}

std::string WideToUtf8(std::wstring_view wide) {
    if (wide.empty()) {
        return {};
    }
    const int size = WideCharToMultiByte(CP_UTF8, 0, wide.data(), static_cast<int>(wide.size()),
                                         nullptr, 0, nullptr, nullptr);
    std::string utf8(static_cast<size_t>(size), '\0');
    WideCharToMultiByte(CP_UTF8, 0, wide.data(), static_cast<int>(wide.size()), utf8.data(), size,
                        nullptr, nullptr);
    return utf8;
}

std::optional<std::string> CodePageTextToUtf8(std::string_view bytes, unsigned codePage) {
    if (bytes.empty()) {
        return std::string();
    }
    const int length = static_cast<int>(bytes.size());
    const int size = MultiByteToWideChar(codePage, 0, bytes.data(), length, nullptr, 0);
    if (size <= 0) {
        return std::nullopt;
    }
    std::wstring decoded(static_cast<size_t>(size), L'\0');
    MultiByteToWideChar(codePage, 0, bytes.data(), length, decoded.data(), size);

    // Compose base letters and combining marks (Windows-1258 writes "ệ" as "ê" + dot below).
    // The normaliser's first estimate may be short; it says how much it needs.
    int composedSize = NormalizeString(NormalizationC, decoded.data(), size, nullptr, 0);
    for (int attempt = 0; attempt < 3 && composedSize > 0; ++attempt) {
        std::wstring composed(static_cast<size_t>(composedSize), L'\0');
        const int written =
            NormalizeString(NormalizationC, decoded.data(), size, composed.data(), composedSize);
        if (written > 0) {
            composed.resize(static_cast<size_t>(written));
            return WideToUtf8(composed);
        }
        if (GetLastError() != ERROR_INSUFFICIENT_BUFFER) {
            break;
        }
        composedSize = -written;
    }
    return WideToUtf8(decoded);  // Not composable (invalid input): keep the decoded letters.
}

std::optional<std::string> AnsiTextToUtf8(std::string_view bytes) {
    return CodePageTextToUtf8(bytes, GetACP());
}

}  // namespace kickvane::platform
