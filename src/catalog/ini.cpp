#include "catalog/ini.h"

#include <array>
#include <cstddef>
#include <exception>
#include <system_error>
#include <utility>

#include "platform/filesystem.h"
#include "platform/text_encoding.h"
#include "text/utf.h"

namespace kickvane::catalog {

namespace fs = std::filesystem;

namespace {

constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";

// A line that is not UTF-8 was written by an older tool in the ANSI code page of its system: on
// Windows that is this system's; elsewhere Windows-1252 is the best guess.
std::string LineToUtf8(std::string_view bytes) {
    if (!text::IsValidUtf8(bytes)) {
        if (std::optional<std::string> decoded = platform::AnsiTextToUtf8(bytes)) {
            return *std::move(decoded);
        }
    }
    return text::LegacyTextToUtf8(bytes);
}

bool IsBlank(char c) {
    return c == ' ' || c == '\t';
}

std::string_view TrimBlanks(std::string_view text) {
    while (!text.empty() && IsBlank(text.front())) {
        text.remove_prefix(1);
    }
    while (!text.empty() && IsBlank(text.back())) {
        text.remove_suffix(1);
    }
    return text;
}

std::string WithoutLineBreaks(std::string_view text) {
    std::string out;
    out.reserve(text.size());
    for (const char c : text) {
        if (c != '\r' && c != '\n') {
            out += c;
        }
    }
    return out;
}

// A section or key name as it is compared and stored.
std::string NormalizeName(std::string_view name) {
    return std::string(TrimBlanks(WithoutLineBreaks(text::LegacyTextToUtf8(name))));
}

enum class LineKind { kBlank, kComment, kSection, kEntry, kOther };

struct ParsedLine {
    LineKind kind = LineKind::kOther;
    std::string_view name;   // section or key name, without the blanks around it
    std::string_view value;  // value of an entry, without the blanks around it
};

ParsedLine ParseLine(std::string_view line) {
    const std::string_view text = TrimBlanks(line);
    if (text.empty()) {
        return {LineKind::kBlank, {}, {}};
    }
    if (text.front() == ';') {
        return {LineKind::kComment, {}, {}};
    }
    if (text.front() == '[') {
        // The last ']' closes the name, as in the platform's reader; text after it is ignored.
        const size_t close = text.rfind(']');
        if (close != 0 && close != std::string_view::npos) {
            return {LineKind::kSection, TrimBlanks(text.substr(1, close - 1)), {}};
        }
        // An unclosed section line falls through and is taken like any other line.
    }
    const size_t equals = text.find('=');
    if (equals == std::string_view::npos) {
        return {LineKind::kOther, {}, {}};
    }
    return {LineKind::kEntry, TrimBlanks(text.substr(0, equals)),
            TrimBlanks(text.substr(equals + 1))};
}

std::string Unquote(std::string_view value) {
    if (value.size() >= 2 && (value.front() == '"' || value.front() == '\'') &&
        value.back() == value.front()) {
        value = value.substr(1, value.size() - 2);
    }
    return std::string(value);
}

std::string DisplayName(const fs::path& path) {
    const std::u8string text = path.u8string();
    return std::string(text.begin(), text.end());
}

}  // namespace

IniDocument IniDocument::Parse(std::string_view bytes) {
    IniDocument document;
    if (bytes.substr(0, kByteOrderMark.size()) == kByteOrderMark) {
        document.has_byte_order_mark_ = true;
        bytes.remove_prefix(kByteOrderMark.size());
    }
    size_t start = 0;
    while (start < bytes.size()) {
        size_t end = bytes.find_first_of("\r\n", start);
        if (end == std::string_view::npos) {
            end = bytes.size();
        }
        document.lines_.push_back(LineToUtf8(bytes.substr(start, end - start)));
        start = end;
        if (start < bytes.size() && bytes[start] == '\r') {
            ++start;
        }
        if (start < bytes.size() && bytes[start] == '\n') {
            ++start;
        }
    }
    return document;
}

IniDocument IniDocument::Load(const fs::path& file) {
    const std::optional<std::string> bytes =
        platform::ReadFile(platform::ResolveCaseInsensitive(file));
    return bytes ? Parse(*bytes) : IniDocument();
}

Status IniDocument::LoadForUpdate(const fs::path& file, IniDocument* document) {
    const fs::path resolved = platform::ResolveCaseInsensitive(file);
    if (const std::optional<std::string> bytes = platform::ReadFile(resolved)) {
        *document = Parse(*bytes);
        return Status::Ok();
    }
    std::error_code error;
    const bool exists = fs::exists(resolved, error);
    if (error || exists) {
        return Status::Fail("Cannot read " + DisplayName(resolved));
    }
    *document = IniDocument();
    return Status::Ok();
}

std::optional<std::string> IniDocument::Get(std::string_view section, std::string_view key) const {
    const std::string wanted_section = NormalizeName(section);
    const std::string wanted_key = NormalizeName(key);
    bool in_section = false;
    for (const std::string& line : lines_) {
        const ParsedLine parsed = ParseLine(line);
        if (parsed.kind == LineKind::kSection) {
            in_section = platform::NamesEqualIgnoringCase(parsed.name, wanted_section);
        } else if (in_section && parsed.kind == LineKind::kEntry &&
                   platform::NamesEqualIgnoringCase(parsed.name, wanted_key)) {
            return Unquote(parsed.value);
        }
    }
    return std::nullopt;
}

Status IniDocument::Set(std::string_view section, std::string_view key, std::string_view value) {
    const std::string section_name = NormalizeName(section);
    const std::string key_name = NormalizeName(key);
    const std::string new_value = WithoutLineBreaks(text::LegacyTextToUtf8(value));
    if (section_name.find(']') != std::string::npos) {
        return Status::Fail("A section name cannot contain ']': " + section_name);
    }
    if (key_name.find('=') != std::string::npos ||
        (!key_name.empty() && (key_name.front() == '[' || key_name.front() == ';'))) {
        return Status::Fail("A key name cannot contain '=' or start with '[' or ';': " + key_name);
    }

    bool in_section = false;
    bool in_first_match = false;      // new keys go to the first matching section
    std::optional<size_t> insert_at;  // after the last entry of that section
    for (size_t i = 0; i < lines_.size(); ++i) {
        const ParsedLine parsed = ParseLine(lines_[i]);
        if (parsed.kind == LineKind::kSection) {
            in_section = platform::NamesEqualIgnoringCase(parsed.name, section_name);
            in_first_match = in_section && !insert_at;
            if (in_first_match) {
                insert_at = i + 1;
            }
            continue;
        }
        if (!in_section) {
            continue;
        }
        if (parsed.kind == LineKind::kEntry &&
            platform::NamesEqualIgnoringCase(parsed.name, key_name)) {
            // Keep the key's spelling as the file has it.
            lines_[i] = std::string(parsed.name) + "=" + new_value;
            return Status::Ok();
        }
        // Blank lines and comments at the end of a section usually belong to the next one.
        if (in_first_match &&
            (parsed.kind == LineKind::kEntry || parsed.kind == LineKind::kOther)) {
            insert_at = i + 1;
        }
    }

    std::string entry = key_name + "=" + new_value;
    if (insert_at) {
        lines_.insert(lines_.begin() + static_cast<std::ptrdiff_t>(*insert_at), std::move(entry));
    } else {
        lines_.push_back("[" + section_name + "]");
        lines_.push_back(std::move(entry));
    }
    return Status::Ok();
}

std::string IniDocument::Serialize() const {
    std::string out;
    if (has_byte_order_mark_) {
        out += kByteOrderMark;
    }
    for (const std::string& line : lines_) {
        out += line;
        out += "\r\n";
    }
    return out;
}

Status IniDocument::Save(const fs::path& file) const {
    return platform::WriteFileAtomically(platform::ResolveCaseInsensitive(file), Serialize());
}

std::string ReadIni(const fs::path& file, std::string_view section, std::string_view key,
                    std::string_view defaultValue) {
    try {
        if (std::optional<std::string> value = IniDocument::Load(file).Get(section, key)) {
            return std::move(*value);
        }
    } catch (const std::exception&) {
        // Unreadable counts as missing, as for the platform's reader.
    }
    while (!defaultValue.empty() && IsBlank(defaultValue.back())) {
        defaultValue.remove_suffix(1);
    }
    return std::string(defaultValue);
}

Status WriteIni(const fs::path& file, std::string_view section, std::string_view key,
                std::string_view value) {
    try {
        IniDocument document;
        if (Status loaded = IniDocument::LoadForUpdate(file, &document); !loaded) {
            return loaded;
        }
        if (Status set = document.Set(section, key, value); !set) {
            return set;
        }
        return document.Save(file);
    } catch (const std::exception& error) {
        return Status::Fail(std::string("Cannot write ") + DisplayName(file) + ": " + error.what());
    }
}

}  // namespace kickvane::catalog
