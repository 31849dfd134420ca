#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "platform/status.h"

// Reader and writer of Windows profile files (INI): "[section]" lines followed by "key=value"
// lines. Lookups follow the platform's profile functions: section and key names match without
// regard to ASCII letter case, blanks around names and values do not count, a value in a matching
// pair of quotes comes back without them, and the first matching key wins. The file is found in
// its folder whatever the letter case of its name.
//
// Text is UTF-8 throughout. A line of an existing file that is not valid UTF-8 was written in the
// Windows ANSI code page and is read as Windows-1252, so no byte is ever dropped.
namespace kickvane::catalog {

class IniDocument {
public:
    // Splits `bytes` into lines (CR LF, LF or a lone CR end a line); a leading UTF-8 byte-order
    // mark is remembered and written back by Serialize.
    static IniDocument Parse(std::string_view bytes);

    // The file found under `file` in any letter case. A missing or unreadable file gives an empty
    // document, as the platform's reader does.
    static IniDocument Load(const std::filesystem::path& file);

    // Reads `file` for a change that will be saved back over it. A missing file gives an empty
    // document; a file that exists but cannot be read is a failure, since saving over it would
    // lose its content.
    static Status LoadForUpdate(const std::filesystem::path& file, IniDocument* document);

    // The value of the first key `key` in a section `section`; nullopt when there is none. A key
    // present with an empty value gives the empty text.
    std::optional<std::string> Get(std::string_view section, std::string_view key) const;

    // Replaces the value of the first key `key` of `section` in place, or adds the key at the end
    // of the first such section, or adds the section at the end. Line breaks in the section, key
    // and value are removed. Fails, changing nothing, for a name that would be read back as
    // something else: a key containing '=' or starting with '[' or ';', a section containing ']'.
    Status Set(std::string_view section, std::string_view key, std::string_view value);

    // The file's bytes: UTF-8, every line ended by CR LF.
    std::string Serialize() const;

    // Writes the document over the file found under `file` in any letter case (or creates it),
    // atomically: on failure the previous file stays as it was.
    Status Save(const std::filesystem::path& file) const;

private:
    bool has_byte_order_mark_ = false;
    std::vector<std::string> lines_;  // UTF-8, without line ends
};

// Reads one value as the platform's profile reader does; `defaultValue` (without its trailing
// blanks) when the file, section or key is missing. Values come back whole, however long.
std::string ReadIni(const std::filesystem::path& file, std::string_view section,
                    std::string_view key, std::string_view defaultValue);

// Writes one value as the platform's profile writer does: creates the file, section or key as
// needed and replaces an existing value, keeping the rest of the file. The file is replaced
// atomically; a failure (such as a missing or read-only folder) is reported and leaves the
// previous file intact.
Status WriteIni(const std::filesystem::path& file, std::string_view section, std::string_view key,
                std::string_view value);

}  // namespace kickvane::catalog
