#include "catalog/ini.h"

#include <array>
#include <cstddef>
#include <exception>
#include <system_error>
#include <utility>

#include "platform/filesystem.h"
#include "platform/text_encoding.h"
#include "text/utf.h"
#include "text/windows1258.h"

namespace kickvane::catalog {

namespace fs = std::filesystem;

namespace {

constexpr std::string_view kUtf8Mark = "\xEF\xBB\xBF";
constexpr std::string_view kUtf16LeMark = "\xFF\xFE";
constexpr std::string_view kUtf16BeMark = "\xFE\xFF";

// UTF-16 bytes in the given order to UTF-8; an odd last byte becomes U+FFFD.
std::string Utf16BytesToUtf8(std::string_view bytes, bool bigEndian) {
    std::u16string units;
    units.reserve(bytes.size() / 2);
    for (size_t i = 0; i + 1 < bytes.size(); i += 2) {
        const auto first = static_cast<unsigned char>(bytes[i]);
        const auto second = static_cast<unsigned char>(bytes[i + 1]);
        units.push_back(
            static_cast<char16_t>(bigEndian ? (first << 8 | second) : (second << 8 | first)));
    }
    if (bytes.size() % 2 != 0) {
        units.push_back(u'\uFFFD');
    }
    return text::Utf16ToUtf8(units);
}

// A line that is not UTF-8 was written by an older tool in the ANSI code page of its system: on
// Windows that is this system's; elsewhere Windows-1258 (the tool's users are Vietnamese) when
// the line reads as Vietnamese, else Windows-1252.
std::string LineToUtf8(std::string_view bytes) {
    if (!text::IsValidUtf8(bytes)) {
        if (std::optional<std::string> decoded = platform::AnsiTextToUtf8(bytes)) {
            return *std::move(decoded);
        }
        if (std::optional<std::string> decoded = text::VietnameseWindowsTextToUtf8(bytes)) {
            return *std::move(decoded);
        }
    }
    return text::LegacyTextToUtf8(bytes);
}

std::string Utf8ToUtf16Bytes(std::string_view utf8, bool bigEndian) {
    const std::u16string units = text::Utf8ToUtf16(utf8);
    std::string bytes;
    bytes.reserve(units.size() * 2);
    for (const char16_t unit : units) {
        const auto high = static_cast<char>(unit >> 8);
        const auto low = static_cast<char>(unit & 0xFF);
        bytes += bigEndian ? high : low;
        bytes += bigEndian ? low : high;
    }
    return bytes;
}

// Drops what a line of the file cannot hold: line breaks, and NUL, which would make the file
// unreadable as text.
std::string WithoutLineBreaks(std::string_view text) {
    std::string out;
    out.reserve(text.size());
    for (const char c : text) {
        if (c != '\r' && c != '\n' && c != '\0') {
            out += c;
        }
    }
    return out;
}

// A section or key name as it is compared and stored. A byte-order mark in front counts as a
// blank: at the start of the file it would be read back as the file's own mark.
std::string NormalizeName(std::string_view name) {
    const std::string text = WithoutLineBreaks(text::LegacyTextToUtf8(name));
    std::string_view trimmed = platform::TrimBlanks(text);
    while (trimmed.starts_with(kUtf8Mark)) {
        trimmed = platform::TrimBlanks(trimmed.substr(kUtf8Mark.size()));
    }
    return std::string(trimmed);
}

enum class LineKind { kBlank, kComment, kSection, kEntry, kOther };

struct ParsedLine {
    LineKind kind = LineKind::kOther;
    std::string_view name;   // section or key name, without the blanks around it
    std::string_view value;  // value of an entry, without the blanks around it
};

ParsedLine ParseLine(std::string_view line) {
    const std::string_view text = platform::TrimBlanks(line);
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
            return {LineKind::kSection, platform::TrimBlanks(text.substr(1, close - 1)), {}};
        }
        // An unclosed section line falls through and is taken like any other line.
    }
    const size_t equals = text.find('=');
    if (equals == std::string_view::npos) {
        return {LineKind::kOther, {}, {}};
    }
    return {LineKind::kEntry, platform::TrimBlanks(text.substr(0, equals)),
            platform::TrimBlanks(text.substr(equals + 1))};
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

std::optional<IniDocument> IniDocument::Parse(std::string_view bytes) {
    IniDocument document;
    std::string decoded;  // the text as UTF-8 when it came in UTF-16
    if (bytes.starts_with(kUtf16LeMark) || bytes.starts_with(kUtf16BeMark)) {
        const bool bigEndian = bytes.starts_with(kUtf16BeMark);
        document.encoding_ = bigEndian ? IniEncoding::Utf16Be : IniEncoding::Utf16Le;
        decoded = Utf16BytesToUtf8(bytes.substr(2), bigEndian);
        bytes = decoded;
    } else if (bytes.starts_with(kUtf8Mark)) {
        document.encoding_ = IniEncoding::Utf8WithBom;
        bytes.remove_prefix(kUtf8Mark.size());
    }
    if (bytes.find('\0') != std::string_view::npos) {
        return std::nullopt;
    }
    const bool eightBit = decoded.empty() && document.encoding_ != IniEncoding::Utf16Le &&
                          document.encoding_ != IniEncoding::Utf16Be;
    size_t start = 0;
    while (start < bytes.size()) {
        size_t end = bytes.find_first_of("\r\n", start);
        if (end == std::string_view::npos) {
            end = bytes.size();
        }
        const std::string_view content = bytes.substr(start, end - start);
        start = end;
        if (start < bytes.size() && bytes[start] == '\r') {
            ++start;
        }
        if (start < bytes.size() && bytes[start] == '\n') {
            ++start;
        }
        Line line{LineToUtf8(content), std::nullopt, std::string(bytes.substr(end, start - end))};
        if (eightBit) {
            line.bytes = std::string(content);
        }
        document.lines_.push_back(std::move(line));
    }
    return document;
}

Status IniDocument::Read(const fs::path& file, IniDocument* document) {
    using Result = platform::FileRead::Result;
    const fs::path resolved = platform::ResolveCaseInsensitive(file);
    platform::FileRead read = platform::ReadRegularFile(resolved, kMaxIniBytes);
    const std::string name = DisplayName(resolved);
    switch (read.result) {
        case Result::Missing:
            *document = IniDocument();
            return Status::Ok();
        case Result::Read:
            if (std::optional<IniDocument> parsed = Parse(read.bytes)) {
                *document = std::move(*parsed);
                return Status::Ok();
            }
            return Status::Fail("File thiết lập " + name + " không phải là văn bản.");
        case Result::Folder:
            return Status::Fail("File thiết lập " + name + " là một thư mục, không phải file.");
        case Result::NotRegular:
            return Status::Fail("File thiết lập " + name +
                                " không phải file thường (có thể là thiết bị hoặc ống dẫn).");
        case Result::TooLarge:
            return Status::Fail("File thiết lập " + name + " quá lớn (hơn " +
                                std::to_string(kMaxIniBytes >> 10) + " KiB).");
        case Result::Unreadable:
            break;
    }
    return Status::Fail(FailedAction::Read, resolved, read.error);
}

std::optional<std::string> IniDocument::Get(std::string_view section, std::string_view key) const {
    const std::string wanted_section = NormalizeName(section);
    const std::string wanted_key = NormalizeName(key);
    // Lines before the first section line form the section with the empty name.
    bool in_section = wanted_section.empty();
    for (const Line& line : lines_) {
        const ParsedLine parsed = ParseLine(line.text);
        if (parsed.kind == LineKind::kSection) {
            if (in_section) {
                return std::nullopt;  // the first such section has ended; later ones do not count
            }
            in_section = !wanted_section.empty() &&
                         platform::NamesEqualIgnoringCase(parsed.name, wanted_section);
        } else if (in_section && parsed.kind == LineKind::kEntry &&
                   platform::NamesEqualIgnoringCase(parsed.name, wanted_key)) {
            return Unquote(parsed.value);
        }
    }
    return std::nullopt;
}

std::vector<std::pair<std::string, std::string>> IniDocument::Entries(
    std::string_view section) const {
    const std::string wanted_section = NormalizeName(section);
    std::vector<std::pair<std::string, std::string>> entries;
    bool in_section = wanted_section.empty();
    for (const Line& line : lines_) {
        const ParsedLine parsed = ParseLine(line.text);
        if (parsed.kind == LineKind::kSection) {
            if (in_section) {
                break;
            }
            in_section = !wanted_section.empty() &&
                         platform::NamesEqualIgnoringCase(parsed.name, wanted_section);
        } else if (in_section && parsed.kind == LineKind::kEntry) {
            bool seen = false;
            for (const auto& entry : entries) {
                seen = seen || platform::NamesEqualIgnoringCase(entry.first, parsed.name);
            }
            if (!seen) {
                entries.emplace_back(std::string(parsed.name), Unquote(parsed.value));
            }
        }
    }
    return entries;
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

    // Only the first section of the name is written; lines before the first section line form
    // the section with the empty name.
    bool in_section = section_name.empty();
    std::optional<size_t> insert_at;  // after the last entry of that section
    if (in_section) {
        insert_at = 0;
    }
    for (size_t i = 0; i < lines_.size(); ++i) {
        const ParsedLine parsed = ParseLine(lines_[i].text);
        if (parsed.kind == LineKind::kSection) {
            if (in_section) {
                break;
            }
            in_section = !section_name.empty() &&
                         platform::NamesEqualIgnoringCase(parsed.name, section_name);
            if (in_section) {
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
            lines_[i].text = std::string(parsed.name) + "=" + new_value;
            lines_[i].bytes.reset();
            return Status::Ok();
        }
        // Blank lines and comments at the end of a section usually belong to the next one.
        if (parsed.kind == LineKind::kEntry || parsed.kind == LineKind::kOther) {
            insert_at = i + 1;
        }
    }

    Line entry{key_name + "=" + new_value, std::nullopt, "\r\n"};
    if (insert_at) {
        lines_.insert(lines_.begin() + static_cast<std::ptrdiff_t>(*insert_at), std::move(entry));
    } else {
        lines_.push_back(Line{"[" + section_name + "]", std::nullopt, "\r\n"});
        lines_.push_back(std::move(entry));
    }
    return Status::Ok();
}

std::string IniDocument::Serialize() const {
    std::string text;
    for (size_t i = 0; i < lines_.size(); ++i) {
        const Line& line = lines_[i];
        text += line.bytes ? *line.bytes : line.text;
        // A last line without its end gets one when a line was added after it.
        text += line.end.empty() && i + 1 < lines_.size() ? "\r\n" : line.end;
    }
    switch (encoding_) {
        case IniEncoding::Utf8:
            return text;
        case IniEncoding::Utf8WithBom:
            return std::string(kUtf8Mark) + text;
        case IniEncoding::Utf16Le:
            return std::string(kUtf16LeMark) + Utf8ToUtf16Bytes(text, false);
        case IniEncoding::Utf16Be:
            return std::string(kUtf16BeMark) + Utf8ToUtf16Bytes(text, true);
    }
    return text;
}

Status IniDocument::Save(const fs::path& file) const {
    const fs::path resolved = platform::ResolveCaseInsensitive(file);
    const std::string bytes = Serialize();
    // A file the reader would refuse loses every setting at the next start: keep the old one.
    if (bytes.size() > kMaxIniBytes) {
        return Status::Fail("File thiết lập " + DisplayName(resolved) + " sẽ quá lớn (hơn " +
                            std::to_string(kMaxIniBytes >> 10) +
                            " KiB): thay đổi này không được ghi.");
    }
    Status saved = platform::WriteFileAtomically(resolved, bytes);
    // What saves killed half-way left behind goes now, once the new file is in place.
    platform::RemoveStaleTemporaries(resolved.parent_path().empty() ? fs::path(".")
                                                                    : resolved.parent_path());
    return saved;
}

std::string ReadIni(const fs::path& file, std::string_view section, std::string_view key,
                    std::string_view defaultValue) {
    try {
        IniDocument document;
        if (IniDocument::Read(file, &document)) {
            if (std::optional<std::string> value = document.Get(section, key)) {
                return std::move(*value);
            }
        }
    } catch (const std::exception&) {
        // Unreadable counts as missing, as for the platform's reader.
    }
    // Only trailing blanks go: leading ones stay, as the platform's reader keeps them.
    const size_t end = defaultValue.find_last_not_of(" \t");
    return std::string(defaultValue.substr(0, end == std::string_view::npos ? 0 : end + 1));
}

Status WriteIni(const fs::path& file, std::string_view section, std::string_view key,
                std::string_view value) {
    try {
        // Another process's write of the same file between this read and this write would be
        // lost: the two take turns.
        const platform::FileUpdateLock turn(platform::ResolveCaseInsensitive(file));
        IniDocument document;
        if (Status loaded = IniDocument::Read(file, &document); !loaded) {
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
