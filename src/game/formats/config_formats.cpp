#include "game/formats/config_formats.h"

#include <fstream>
#include <system_error>

#include "platform/filesystem.h"
#include "platform/text.h"

namespace kickvane::game {

namespace fs = std::filesystem;

namespace {

bool IsBlank(char c) {
    return c == ' ' || c == '\t' || c == '\r';
}

// Blanks and the CR of a file written with CR LF line ends.
std::string_view Trim(std::string_view text) {
    return platform::TrimBlanks(text, " \t\r");
}

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

void AppendUtf8(std::string& out, unsigned code) {
    if (code > 0x10FFFF || (code >= 0xD800 && code <= 0xDFFF)) {
        code = 0xFFFD;
    }
    if (code < 0x80) {
        out += static_cast<char>(code);
    } else if (code < 0x800) {
        out += static_cast<char>(0xC0 | (code >> 6));
        out += static_cast<char>(0x80 | (code & 0x3F));
    } else if (code < 0x10000) {
        out += static_cast<char>(0xE0 | (code >> 12));
        out += static_cast<char>(0x80 | ((code >> 6) & 0x3F));
        out += static_cast<char>(0x80 | (code & 0x3F));
    } else {
        out += static_cast<char>(0xF0 | (code >> 18));
        out += static_cast<char>(0x80 | ((code >> 12) & 0x3F));
        out += static_cast<char>(0x80 | ((code >> 6) & 0x3F));
        out += static_cast<char>(0x80 | (code & 0x3F));
    }
}

// Reads up to `maxDigits` hex digits at `pos`; -1 when there is none.
long ReadHex(std::string_view text, size_t& pos, int maxDigits) {
    long code = -1;
    for (int i = 0; i < maxDigits && pos < text.size() && HexDigit(text[pos]) >= 0; ++i, ++pos) {
        code = (code < 0 ? 0 : code * 16) + HexDigit(text[pos]);
    }
    return code;
}

// The line that starts at `start` (without its line break, also a "\r\n" one); `start` moves to
// the next line.
std::string_view NextLine(std::string_view text, size_t& start) {
    size_t end = text.find('\n', start);
    if (end == std::string_view::npos) {
        end = text.size();
    }
    std::string_view line = text.substr(start, end - start);
    start = end + 1;
    if (!line.empty() && line.back() == '\r') {
        line.remove_suffix(1);
    }
    return line;
}

// Decodes backslash escapes: \n \r \t \0, \xH.. (up to `xDigits` hex digits), \uHHHH and
// \UHHHHHHHH as UTF-8; any other escaped character stands for itself (\\ and \").
std::string DecodeEscapes(std::string_view text, int xDigits) {
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
                const long code = ReadHex(text, pos, e == 'x' ? xDigits : (e == 'u' ? 4 : 8));
                if (code >= 0) {
                    AppendUtf8(out, static_cast<unsigned>(code));
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

// ---- YAML subset ----

// Removes a comment: '#' at the start or after a blank, outside quotes.
std::string_view StripYamlComment(std::string_view line) {
    char quote = 0;
    for (size_t i = 0; i < line.size(); ++i) {
        const char c = line[i];
        if (quote != 0) {
            if (c == quote) {
                quote = 0;
            } else if (c == '\\' && quote == '"') {
                ++i;
            }
        } else if (c == '"' || c == '\'') {
            if (i == 0 || IsBlank(line[i - 1]) || line[i - 1] == ':' || line[i - 1] == '-') {
                quote = c;
            }
        } else if (c == '#' && (i == 0 || IsBlank(line[i - 1]))) {
            return line.substr(0, i);
        }
    }
    return line;
}

std::string YamlScalar(std::string_view text) {
    text = Trim(text);
    if (text.size() >= 2 && text.front() == '\'' && text.back() == '\'') {
        std::string out;
        for (size_t i = 1; i + 1 < text.size(); ++i) {
            out += text[i];
            if (text[i] == '\'' && text[i + 1] == '\'') {
                ++i;
            }
        }
        return out;
    }
    if (text.size() >= 2 && text.front() == '"' && text.back() == '"') {
        return DecodeEscapes(text.substr(1, text.size() - 2), 2);
    }
    return std::string(text);
}

// Where the key of "key: value" ends: the first ':' followed by a blank or the line's end,
// outside quotes. npos when the line is no mapping entry.
size_t YamlKeyEnd(std::string_view line) {
    char quote = 0;
    for (size_t i = 0; i < line.size(); ++i) {
        const char c = line[i];
        if (quote != 0) {
            quote = c == quote ? 0 : quote;
        } else if ((c == '"' || c == '\'') && i == 0) {
            quote = c;
        } else if (c == ':' && (i + 1 == line.size() || IsBlank(line[i + 1]))) {
            return i;
        }
    }
    return std::string_view::npos;
}

struct YamlLevel {
    int indent;
    std::string path;
    int nextItem = 0;     // index of the next "- " item below this key
    bool isItem = false;  // opened by a "- " item
};

std::string JoinKey(const std::string& parent, std::string_view key) {
    return parent.empty() ? std::string(key) : parent + "." + std::string(key);
}

}  // namespace

std::optional<std::string> FlatValues::Find(std::string_view key) const {
    for (const auto& [name, value] : entries_) {
        if (name == key) {
            return value;
        }
    }
    return std::nullopt;
}

std::optional<std::string> ReadBoundedFile(const fs::path& path, size_t maxBytes,
                                           std::string* problem) {
    auto fail = [&](std::string reason) -> std::optional<std::string> {
        if (problem != nullptr) {
            *problem = std::move(reason);
        }
        return std::nullopt;
    };
    std::error_code error;
    if (!fs::is_regular_file(path, error)) {
        return fail("not a readable file");
    }
    const std::uintmax_t size = fs::file_size(path, error);
    if (error) {
        return fail("cannot read: " + error.message());
    }
    if (size > maxBytes) {
        return fail("too large (" + std::to_string(size) + " bytes)");
    }
    std::ifstream in(path, std::ios::binary);
    if (!in) {
        return fail("cannot open");
    }
    std::string content(static_cast<size_t>(size), '\0');
    in.read(content.data(), static_cast<std::streamsize>(size));
    content.resize(static_cast<size_t>(in.gcount()));
    if (in.bad()) {
        return fail("cannot read");
    }
    return content;
}

Parsed ParseYamlSubset(std::string_view text) {
    Parsed parsed;
    if (text.find('\0') != std::string_view::npos) {
        parsed.problem = "not a text file";
        return parsed;
    }
    std::vector<YamlLevel> levels{{-1, ""}};
    int blockIndent = -1;  // inside a block scalar ("|" or ">"): lines deeper than this are text
    size_t lineNumber = 0;
    size_t entries = 0;
    size_t start = 0;
    while (start < text.size()) {
        const std::string_view line = NextLine(text, start);
        ++lineNumber;

        int indent = 0;
        while (static_cast<size_t>(indent) < line.size() &&
               line[static_cast<size_t>(indent)] == ' ') {
            ++indent;
        }
        std::string_view content = Trim(StripYamlComment(line.substr(static_cast<size_t>(indent))));
        if (blockIndent >= 0) {
            if (content.empty() || indent > blockIndent) {
                continue;
            }
            blockIndent = -1;
        }
        if (content.empty() || content == "---" || content == "...") {
            continue;
        }
        // A list may stand at its key's own column ("key:\n- item"), so an item closes only the
        // previous item of that column, not the key.
        const bool item = content == "-" || content.starts_with("- ");
        while (levels.size() > 1 &&
               (levels.back().indent > indent ||
                (levels.back().indent == indent && (!item || levels.back().isItem)))) {
            levels.pop_back();
        }
        // "- " items: a scalar item gets the next index; an item that opens a mapping becomes a
        // level of its own, at the column of its first key.
        std::string parentPath = levels.back().path;
        if (item) {
            const std::string itemPath =
                JoinKey(parentPath, std::to_string(levels.back().nextItem++));
            std::string_view rest = Trim(content.substr(1));
            const int itemIndent = indent + 1 + static_cast<int>(content.size() - 1 - rest.size());
            if (rest.empty()) {
                levels.push_back({indent, itemPath, 0, true});
                continue;
            }
            if (YamlKeyEnd(rest) == std::string_view::npos) {
                parsed.values.Add(itemPath, YamlScalar(rest));
                ++entries;
                continue;
            }
            levels.push_back({indent, itemPath, 0, true});
            parentPath = itemPath;
            content = rest;
            indent = itemIndent;
        }
        const size_t keyEnd = YamlKeyEnd(content);
        if (keyEnd == std::string_view::npos) {
            // A plain scalar continued on a later line is tolerated below the top level; at the
            // top level the text is no mapping at all.
            if (levels.size() == 1) {
                parsed.problem =
                    "line " + std::to_string(lineNumber) + ": not a \"key: value\" line";
                return parsed;
            }
            continue;
        }
        const std::string key = YamlScalar(content.substr(0, keyEnd));
        const std::string_view value = Trim(content.substr(keyEnd + 1));
        const std::string path = JoinKey(parentPath, key);
        ++entries;
        if (value.empty()) {
            levels.push_back({indent, path});
        } else if (value == "|" || value == ">" || value.starts_with("|-") ||
                   value.starts_with(">-") || value.starts_with("|+") || value.starts_with(">+")) {
            blockIndent = indent;
        } else {
            parsed.values.Add(path, YamlScalar(value));
        }
    }
    if (entries == 0 && !Trim(text).empty() && Trim(text) != "---") {
        parsed.problem = "no entries";
    }
    return parsed;
}

// ---- JSON ----

namespace {

class JsonReader {
public:
    JsonReader(std::string_view text, FlatValues& out) : text_(text), out_(out) {}

    std::string Read() {
        SkipBlanks();
        if (!Value("", 0)) {
            return problem_.empty() ? "malformed" : problem_;
        }
        SkipBlanks();
        if (pos_ != text_.size()) {
            return Fail("text after the end");
        }
        return {};
    }

private:
    static constexpr int kMaxDepth = 64;

    std::string Fail(std::string what) {
        if (problem_.empty()) {
            problem_ = "offset " + std::to_string(pos_) + ": " + std::move(what);
        }
        return problem_;
    }

    void SkipBlanks() {
        while (pos_ < text_.size() && (text_[pos_] == ' ' || text_[pos_] == '\t' ||
                                       text_[pos_] == '\n' || text_[pos_] == '\r')) {
            ++pos_;
        }
    }

    bool Literal(std::string_view word) {
        if (text_.substr(pos_, word.size()) != word) {
            Fail("unexpected text");
            return false;
        }
        pos_ += word.size();
        return true;
    }

    bool String(std::string& out) {
        ++pos_;  // the opening quote
        while (pos_ < text_.size()) {
            const char c = text_[pos_++];
            if (c == '"') {
                return true;
            }
            if (static_cast<unsigned char>(c) < 0x20) {
                Fail("control character in a string");
                return false;
            }
            if (c != '\\') {
                out += c;
                continue;
            }
            if (pos_ >= text_.size()) {
                break;
            }
            const char e = text_[pos_++];
            switch (e) {
                case 'n':
                    out += '\n';
                    break;
                case 't':
                    out += '\t';
                    break;
                case 'r':
                    out += '\r';
                    break;
                case 'b':
                    out += '\b';
                    break;
                case 'f':
                    out += '\f';
                    break;
                case 'u': {
                    const size_t before = pos_;
                    long code = ReadHex(text_, pos_, 4);
                    if (pos_ - before != 4) {
                        Fail("bad \\u escape");
                        return false;
                    }
                    // A surrogate pair makes one character.
                    if (code >= 0xD800 && code <= 0xDBFF && text_.substr(pos_, 2) == "\\u") {
                        size_t low = pos_ + 2;
                        const long second = ReadHex(text_, low, 4);
                        if (low - pos_ == 6 && second >= 0xDC00 && second <= 0xDFFF) {
                            code = 0x10000 + ((code - 0xD800) << 10) + (second - 0xDC00);
                            pos_ = low;
                        }
                    }
                    AppendUtf8(out, static_cast<unsigned>(code));
                    break;
                }
                default:
                    out += e;
            }
        }
        Fail("unterminated string");
        return false;
    }

    bool Value(const std::string& path, int depth) {
        if (depth > kMaxDepth) {
            Fail("nested too deep");
            return false;
        }
        if (pos_ >= text_.size()) {
            Fail("unexpected end");
            return false;
        }
        const char c = text_[pos_];
        if (c == '{' || c == '[') {
            const bool object = c == '{';
            ++pos_;
            SkipBlanks();
            const char close = object ? '}' : ']';
            if (pos_ < text_.size() && text_[pos_] == close) {
                ++pos_;
                return true;
            }
            for (int index = 0;; ++index) {
                SkipBlanks();
                std::string key = std::to_string(index);
                if (object) {
                    key.clear();
                    if (pos_ >= text_.size() || text_[pos_] != '"' || !String(key)) {
                        Fail("expected a key");
                        return false;
                    }
                    SkipBlanks();
                    if (pos_ >= text_.size() || text_[pos_] != ':') {
                        Fail("expected ':'");
                        return false;
                    }
                    ++pos_;
                    SkipBlanks();
                }
                if (!Value(JoinKey(path, key), depth + 1)) {
                    return false;
                }
                SkipBlanks();
                if (pos_ < text_.size() && text_[pos_] == ',') {
                    ++pos_;
                    continue;
                }
                if (pos_ < text_.size() && text_[pos_] == close) {
                    ++pos_;
                    return true;
                }
                Fail("expected ',' or the end of a collection");
                return false;
            }
        }
        if (c == '"') {
            std::string value;
            if (!String(value)) {
                return false;
            }
            out_.Add(path, std::move(value));
            return true;
        }
        if (c == 't' || c == 'f' || c == 'n') {
            const std::string_view word = c == 't' ? "true" : (c == 'f' ? "false" : "null");
            if (!Literal(word)) {
                return false;
            }
            if (c != 'n') {
                out_.Add(path, std::string(word));
            }
            return true;
        }
        const size_t begin = pos_;
        while (pos_ < text_.size() &&
               std::string_view("+-0123456789.eE").find(text_[pos_]) != std::string_view::npos) {
            ++pos_;
        }
        if (pos_ == begin) {
            Fail("unexpected character");
            return false;
        }
        out_.Add(path, std::string(text_.substr(begin, pos_ - begin)));
        return true;
    }

    std::string_view text_;
    FlatValues& out_;
    size_t pos_ = 0;
    std::string problem_;
};

}  // namespace

Parsed ParseJson(std::string_view text) {
    Parsed parsed;
    parsed.problem = JsonReader(text, parsed.values).Read();
    return parsed;
}

// ---- Valve KeyValues ----

Parsed ParseVdf(std::string_view text) {
    Parsed parsed;
    std::vector<std::string> path;
    std::optional<std::string> pendingKey;
    size_t pos = 0;
    auto fail = [&](const std::string& what) {
        parsed.problem = "offset " + std::to_string(pos) + ": " + what;
        return parsed;
    };
    while (pos < text.size()) {
        const char c = text[pos];
        if (c == ' ' || c == '\t' || c == '\r' || c == '\n') {
            ++pos;
        } else if (c == '/' && text.substr(pos, 2) == "//") {
            pos = text.find('\n', pos);
            pos = pos == std::string_view::npos ? text.size() : pos;
        } else if (c == '{') {
            if (!pendingKey || path.size() >= 64) {
                return fail("'{' without a key");
            }
            path.push_back(*pendingKey);
            pendingKey.reset();
            ++pos;
        } else if (c == '}') {
            if (path.empty() || pendingKey) {
                return fail("unexpected '}'");
            }
            path.pop_back();
            ++pos;
        } else if (c == '"') {
            std::string token;
            ++pos;
            while (pos < text.size() && text[pos] != '"') {
                if (text[pos] == '\\' && pos + 1 < text.size()) {
                    const char e = text[++pos];
                    token += e == 'n' ? '\n' : (e == 't' ? '\t' : e);
                } else {
                    token += text[pos];
                }
                ++pos;
            }
            if (pos >= text.size()) {
                return fail("unterminated string");
            }
            ++pos;
            if (!pendingKey) {
                pendingKey = std::move(token);
            } else {
                std::string key;
                for (const std::string& part : path) {
                    key = JoinKey(key, part);
                }
                parsed.values.Add(JoinKey(key, *pendingKey), std::move(token));
                pendingKey.reset();
            }
        } else {
            return fail("unexpected character");
        }
    }
    if (!path.empty() || pendingKey) {
        return fail("unexpected end");
    }
    return parsed;
}

// ---- Wine registry files ----

namespace {

// Wine writes characters outside ASCII as \x with up to four hex digits.
std::string DecodeRegistryText(std::string_view text) {
    return DecodeEscapes(text, 4);
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

RegistryFile ParseWineRegistry(std::string_view text, const std::vector<std::string>& keyPrefixes) {
    RegistryFile file;
    if (!text.starts_with("WINE REGISTRY Version")) {
        file.problem = "not a Wine registry file";
        return file;
    }
    bool keyWanted = false;
    std::string key;
    size_t start = 0;
    while (start < text.size()) {
        const std::string_view line = NextLine(text, start);
        if (line.starts_with("#arch=")) {
            file.arch = std::string(Trim(line.substr(6)));
            continue;
        }
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
            joined += Trim(NextLine(text, start));
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

std::string DesktopEntryValue(std::string_view text, std::string_view key) {
    bool inMainGroup = false;
    size_t start = 0;
    while (start < text.size()) {
        const std::string_view line = Trim(NextLine(text, start));
        if (line.starts_with("[")) {
            inMainGroup = line == "[Desktop Entry]";
            continue;
        }
        const size_t equals = line.find('=');
        if (inMainGroup && equals != std::string_view::npos &&
            Trim(line.substr(0, equals)) == key) {
            return std::string(Trim(line.substr(equals + 1)));
        }
    }
    return {};
}

}  // namespace kickvane::game
