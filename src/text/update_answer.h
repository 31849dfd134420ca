#pragma once

#include <optional>
#include <string>
#include <string_view>

// What the update host's answers mean, before anything of the window acts on them.
namespace kickvane::text {

// The text of a fetched file as the tool compares and stores it: its lines, each followed by
// CR LF. A line ends at CR LF or a lone CR; a lone LF stays in the text; the last line may end
// without a terminator. Valid UTF-8 is taken as it is, anything else is read as Windows-1252
// (the ANSI code page the update host's files were written in). The result is UTF-8.
std::string ReadFetchedText(std::string_view bytes);

// Longest version text taken, in characters.
inline constexpr size_t kMaxVersionLength = 64;

// True when a fetched text (as ReadFetchedText gives it) can be a version: without its final
// CR LF (and a line feed before it, from a file with Unix line ends), one line of 1 to
// kMaxVersionLength printable characters, not all blanks. An empty answer, a lone line feed, a
// web page or binary data is no version.
bool IsVersionText(std::string_view text);

// The fetched link without surrounding blanks and line breaks, when it is an http or https
// address with a host; nullopt for anything else the browser must not be handed (local files,
// scripts, paths, several lines, empty text).
std::optional<std::string> DownloadLink(std::string_view text);

}  // namespace kickvane::text
