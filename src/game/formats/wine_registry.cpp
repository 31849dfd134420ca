#include "game/formats/wine_registry.h"

#include "game/formats/text_lines.h"
#include "platform/text.h"
#include "text/utf.h"

namespace kickvane::game {

namespace {

int HexDigit(char c) {
    if (c >= '0' && c <= '9') {
        return c - '0';
    }
    if (c >= 'a' && c <= 'f') {
        return c - 'a' + 10;
    }
    if (c >= 'A' && c <= 'F') {
        return c - 'A' + 10;
    }
    return -1;
}

// Reads up to `maxDigits` hex digits at `pos`; -1 when there is none.
long ReadHex(std::string_view text, size_t& pos, int maxDigits) {
    long code = -1;
    for (int i = 0; i < maxDigits && pos < text.size() && HexDigit(text[pos]) >= 0; ++i, ++pos) {
        code = (code < 0 ? 0 : code * 16) + HexDigit(text[pos]);
    }
    return code;
}

// Decodes Wine's escapes: \n \r \t \0, \xHHHH (up to four hex digits: Wine writes characters
// outside ASCII so), \uHHHH and \UHHHHHHHH; any other escaped character stands for itself
// (a backslash, a quote).
std::string DecodeRegistryText(std::string_view text) {
    std::string out;
    out.reserve(text.size());
    for (size_t i = 0; i < text.size(); ++i) {
        if (text[i] != '\\' || i + 1 == text.size()) {
            out += text[i];
            continue;
        }
        const char e = text[++i];
        size_t pos = i + 1;
        switch (e) {
            case 'n':
                out += '\n';
                break;
            case 'r':
                out += '\r';
                break;
            case 't':
                out += '\t';
                break;
            case '0':
                out += '\0';
                break;
            case 'x':
            case 'u':
            case 'U': {
                const long code = ReadHex(text, pos, e == 'U' ? 8 : 4);
                if (code >= 0) {
                    text::AppendUtf8(out, static_cast<char32_t>(code));
                    i = pos - 1;
                } else {
                    out += e;
                }
                break;
            }
            default:
                out += e;
        }
    }
    return out;
}

// The end of a quoted text that starts after `open`: the next quote not escaped.
size_t QuotedEnd(std::string_view text, size_t open) {
    for (size_t i = open + 1; i < text.size(); ++i) {
        if (text[i] == '\\') {
            ++i;
        } else if (text[i] == '"') {
            return i;
        }
    }
    return std::string_view::npos;
}

bool StartsWithIgnoringCase(std::string_view text, std::string_view prefix) {
    return text.size() >= prefix.size() &&
           platform::NamesEqualIgnoringCase(text.substr(0, prefix.size()), prefix);
}

}  // namespace

std::string RegistryArch(std::string_view text) {
    size_t start = 0;
    while (start < text.size()) {
        const std::string_view line = NextLine(text, start);
        if (line.starts_with("[")) {
            break;
        }
        if (line.starts_with("#arch=")) {
            return std::string(TrimLine(line.substr(6)));
        }
    }
    return {};
}

RegistryFile ParseWineRegistry(std::string_view text, const std::vector<std::string>& keyPrefixes) {
    RegistryFile file;
    if (!text.starts_with("WINE REGISTRY Version")) {
        file.problem = "not a Wine registry file";
        return file;
    }
    file.arch = RegistryArch(text);
    bool keyWanted = false;
    std::string key;
    size_t start = 0;
    while (start < text.size()) {
        const std::string_view line = NextLine(text, start);
        if (line.starts_with("[")) {
            // "[key] 1700000000": the key ends at the last ']' before the time stamp.
            const size_t keyEnd = line.rfind(']');
            key = keyEnd == std::string_view::npos ? std::string()
                                                   : DecodeRegistryText(line.substr(1, keyEnd - 1));
            keyWanted = false;
            for (const std::string& prefix : keyPrefixes) {
                keyWanted = keyWanted || StartsWithIgnoringCase(key, prefix);
            }
            continue;
        }
        if (!keyWanted || !line.starts_with("\"")) {
            continue;
        }
        // A value that ends with a backslash inside its quotes continues on the next line.
        std::string joined(line);
        size_t nameEnd = QuotedEnd(joined, 0);
        if (nameEnd == std::string::npos || joined.compare(nameEnd + 1, 1, "=") != 0) {
            continue;
        }
        size_t valueOpen = nameEnd + 2;
        if (joined.compare(valueOpen, 7, "str(2):") == 0) {
            valueOpen += 7;
        }
        if (joined.compare(valueOpen, 1, "\"") != 0) {
            continue;  // dword, hex: not needed here
        }
        size_t valueEnd = QuotedEnd(joined, valueOpen);
        while (valueEnd == std::string::npos && !joined.empty() && joined.back() == '\\' &&
               start < text.size()) {
            joined.pop_back();
            joined += TrimLine(NextLine(text, start));
            valueEnd = QuotedEnd(joined, valueOpen);
        }
        if (valueEnd == std::string::npos) {
            continue;
        }
        file.values.push_back({key,
                               DecodeRegistryText(std::string_view(joined).substr(1, nameEnd - 1)),
                               DecodeRegistryText(std::string_view(joined).substr(
                                   valueOpen + 1, valueEnd - valueOpen - 1))});
    }
    return file;
}

}  // namespace kickvane::game
