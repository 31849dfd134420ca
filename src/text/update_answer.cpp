#include "text/update_answer.h"

#include "text/utf.h"

namespace kickvane::text {

namespace {

bool IsLinkBlank(char c) {
    return c == ' ' || c == '\t' || c == '\r' || c == '\n' || c == '\v' || c == '\f';
}

char AsciiLower(char c) {
    return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
}

}  // namespace

std::string ReadFetchedText(std::string_view bytes) {
    const std::string decoded = LegacyTextToUtf8(bytes);
    std::string text;
    text.reserve(decoded.size() + 2);
    size_t start = 0;
    for (size_t i = 0; i < decoded.size(); ++i) {
        if (decoded[i] != '\r') {
            continue;
        }
        text.append(decoded, start, i - start);
        text += "\r\n";
        if (i + 1 < decoded.size() && decoded[i + 1] == '\n') {
            ++i;
        }
        start = i + 1;
    }
    if (start < decoded.size()) {
        text.append(decoded, start);
        text += "\r\n";
    }
    return text;
}

std::optional<std::string> VersionFromAnswer(std::string_view text) {
    const auto isBlank = [](char c) { return c == ' ' || c == '\t' || c == '\r' || c == '\n'; };
    while (!text.empty() && isBlank(text.front())) {
        text.remove_prefix(1);
    }
    while (!text.empty() && isBlank(text.back())) {
        text.remove_suffix(1);
    }
    if (text.size() > kMaxVersionLength) {
        return std::nullopt;
    }
    const auto isDigit = [](char c) { return c >= '0' && c <= '9'; };
    const auto isLetter = [](char c) { return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z'); };
    std::string_view rest = text;
    if (rest.starts_with('v')) {
        rest.remove_prefix(1);
    }
    if (rest.empty() || !isDigit(rest.front())) {
        return std::nullopt;
    }
    // The digits and dots, then the suffix: both only use characters of the suffix's set.
    for (const char c : rest) {
        if (!isDigit(c) && !isLetter(c) && c != '.' && c != '-') {
            return std::nullopt;
        }
    }
    return std::string(text);
}

std::optional<std::string> DownloadLink(std::string_view text) {
    while (!text.empty() && IsLinkBlank(text.front())) {
        text.remove_prefix(1);
    }
    while (!text.empty() && IsLinkBlank(text.back())) {
        text.remove_suffix(1);
    }
    // Control characters inside mean several lines or a forged address; neither is one link.
    for (const char c : text) {
        const auto byte = static_cast<unsigned char>(c);
        if (byte < 0x20 || byte == 0x7F) {
            return std::nullopt;
        }
    }
    const size_t separator = text.find("://");
    if (separator == std::string_view::npos) {
        return std::nullopt;
    }
    std::string scheme;
    for (const char c : text.substr(0, separator)) {
        scheme += AsciiLower(c);
    }
    if (scheme != "http" && scheme != "https") {
        return std::nullopt;
    }
    std::string_view authority = text.substr(separator + 3);
    authority = authority.substr(0, authority.find_first_of("/?#"));
    if (authority.find_first_of("\\ ") != std::string_view::npos) {
        return std::nullopt;
    }
    if (const size_t at = authority.rfind('@'); at != std::string_view::npos) {
        authority.remove_prefix(at + 1);
    }
    size_t hostLength = authority.find(':');
    if (!authority.empty() && authority.front() == '[') {
        const size_t close = authority.find(']');
        hostLength = close == std::string_view::npos || close < 2 ? 0 : close + 1;
    }
    if (authority.substr(0, hostLength).empty()) {
        return std::nullopt;
    }
    return std::string(text);
}

}  // namespace kickvane::text
