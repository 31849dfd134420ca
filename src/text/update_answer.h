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

// Longest version taken, in characters.
inline constexpr size_t kMaxVersionLength = 32;

// The version a fetched answer names: the text without the blanks and line ends around it, when
// that is at most kMaxVersionLength characters of an optional "v", a digit, further digits and
// dots, and an optional suffix of letters, digits, "-" and "." ("v2.1", "2.1.3", "v2.0-beta1").
// Anything else (an empty answer, a web page, words, several lines) names no version: nullopt.
std::optional<std::string> VersionFromAnswer(std::string_view text);

// The fetched link without surrounding blanks and line breaks, when it is an http or https
// address with a host; nullopt for anything else the browser must not be handed (local files,
// scripts, paths, several lines, empty text).
std::optional<std::string> DownloadLink(std::string_view text);

}  // namespace kickvane::text
