#pragma once

#include <cstdint>
#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "platform/status.h"

// Reader and writer of Windows profile files (INI): "[section]" lines followed by "key=value"
// lines. Lookups follow the platform's profile functions: section and key names match without
// regard to ASCII letter case, blanks around names and values do not count, a value in a matching
// pair of quotes comes back without them, and the first matching key wins. The file is found in
// its folder whatever the letter case of its name.
//
// Only the first section of a name (in any letter case) counts: a later one of the same name is
// neither read nor written. Lines before the first section line belong to the section with the
// empty name.
//
// Text is UTF-8 in memory. A file that starts with a UTF-16 byte-order mark (either byte order)
// is read as UTF-16 and written back in it, as the platform's profile functions do. A line of
// any other file that is not valid UTF-8 was written in a Windows ANSI code page: on Windows it
// is read in the system's; elsewhere as Windows-1258 when it reads as Vietnamese, else as
// Windows-1252, so no byte is ever dropped. A write changes only the lines it sets: every other
// line of such a file keeps its bytes and its line end.
namespace kickvane::catalog {

// Largest settings file read; anything bigger is no settings file of ours.
inline constexpr std::uintmax_t kMaxIniBytes = 1 << 20;

enum class IniEncoding { Utf8, Utf8WithBom, Utf16Le, Utf16Be };

class IniDocument {
public:
    // Splits `bytes` into lines (CR LF, LF or a lone CR end a line). A byte-order mark sets the
    // encoding, which Serialize keeps. nullopt when the bytes are not text (they hold NUL
    // characters, as binary files and UTF-16 without a byte-order mark do).
    static std::optional<IniDocument> Parse(std::string_view bytes);

    // Reads the file found under `file` in any letter case. A missing file gives an empty
    // document. A file that exists but cannot be taken as a settings file (a folder, a device,
    // a pipe, too large, not text, unreadable) is a failure whose reason names the file, and
    // leaves `document` as it was.
    static Status Read(const std::filesystem::path& file, IniDocument* document);

    // The value of the first key `key` in the first section `section`; nullopt when there is
    // none. A key present with an empty value gives the empty text.
    std::optional<std::string> Get(std::string_view section, std::string_view key) const;

    // The keys of the first section `section` in file order, each with its value as Get gives
    // it; a key that occurs twice is listed once, with its first value.
    std::vector<std::pair<std::string, std::string>> Entries(std::string_view section) const;

    // Replaces the value of the first key `key` of the first section `section` in place, or adds
    // the key at the end of that section, or adds the section at the end. Line breaks and NUL
    // characters in the section, key and value are removed. Fails, changing nothing, for a name
    // that would be read back as something else: a key containing '=' or starting with '[' or
    // ';', a section containing ']'.
    Status Set(std::string_view section, std::string_view key, std::string_view value);

    // The file's bytes in the document's encoding: lines read from the file as they were (in a
    // UTF-16 file, as text), set and added lines in UTF-8 ended by CR LF.
    std::string Serialize() const;

    IniEncoding Encoding() const { return encoding_; }

    // Writes the document over the file found under `file` in any letter case (or creates it),
    // atomically: on failure the previous file stays as it was. A document larger than the
    // reader accepts (kMaxIniBytes) is not written.
    Status Save(const std::filesystem::path& file) const;

private:
    struct Line {
        std::string text;                  // UTF-8, without the line end
        std::optional<std::string> bytes;  // as read from a file of 8-bit text; unset once set
        std::string end = "\r\n";          // as read; empty for a last line without one
    };

    IniEncoding encoding_ = IniEncoding::Utf8;
    std::vector<Line> lines_;
};

// Reads one value as the platform's profile reader does; `defaultValue` (without its trailing
// blanks) when the file, section or key is missing or the file cannot be read. Values come back
// whole, however long.
std::string ReadIni(const std::filesystem::path& file, std::string_view section,
                    std::string_view key, std::string_view defaultValue);

// Writes one value as the platform's profile writer does: creates the file, section or key as
// needed and replaces an existing value, keeping the rest of the file and its encoding. The file
// is replaced atomically; a failure (such as a missing or read-only folder, or an existing file
// that cannot be read) is reported and leaves the previous file intact.
Status WriteIni(const std::filesystem::path& file, std::string_view section, std::string_view key,
                std::string_view value);

}  // namespace kickvane::catalog
