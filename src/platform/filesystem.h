#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "platform/status.h"

// File system operations of the core. The game's folders follow Windows rules (letter case does
// not matter), so on a case-sensitive file system every lookup goes through ResolveCaseInsensitive.
namespace kickvane::platform {

namespace fs = std::filesystem;

// ASCII letters compared without regard to case, as Windows compares file names.
bool NamesEqualIgnoringCase(std::string_view a, std::string_view b);
std::string FoldCase(std::string_view name);

// Returns `path` with every component that does not exist in its exact spelling replaced by an
// existing entry of its parent that differs only in letter case. Components below the first one
// that exists in no spelling keep the spelling given. Identity on case-insensitive systems.
fs::path ResolveCaseInsensitive(const fs::path& path);

// Finds the entry of `folder` named `name` in any letter case; nullopt when there is none.
std::optional<fs::path> FindEntryIgnoringCase(const fs::path& folder, std::string_view name);

bool IsDirectory(const fs::path& path);
bool IsRegularFile(const fs::path& path);

// Creates one folder. Fails when it exists already or its parent does not exist.
Status MakeDirectory(const fs::path& path);

// True when `target` exists as a regular file with the same size and modification time as
// `source` (rsync's quick check): copying again would change nothing.
bool IsUpToDateCopy(const fs::path& source, const fs::path& target);

// Copies the file `source` to `target`, replacing it. The data is written to a temporary file
// beside `target` and renamed over it, so a failed copy leaves the old file whole and a reader
// that holds the old file open keeps reading a whole file. The copy takes the source's
// modification time. Fails when the source is no readable file or the target's folder is missing.
Status ReplaceFile(const fs::path& source, const fs::path& target);

// Writes `content` to a temporary file beside `path`, flushes it and renames it over `path`.
// On failure the previous file is left as it was.
Status WriteFileAtomically(const fs::path& path, std::string_view content);

// Reads a whole file. nullopt when it cannot be opened or read.
std::optional<std::string> ReadFile(const fs::path& path);

// The plain files (not folders, not hidden: no leading dot) directly inside `folder`, sorted by
// name.
std::vector<fs::path> ListPlainFiles(const fs::path& folder);

// A path from UTF-8 text (the command line, the settings file). Unlike a path made from a plain
// string, which MinGW's standard library reads byte by byte, it keeps every letter on Windows.
inline fs::path PathFromUtf8(std::string_view text) {
    return fs::path(std::u8string(text.begin(), text.end()));
}

// Folder that holds the running program.
fs::path ProgramFolder();

// Value of an environment variable; empty when unset.
std::string GetEnv(const char* name);

// Turns a folder typed by the user into a native path. On Linux a Windows path ("C:\Games\FO2")
// is looked up in the Wine prefix (WINEPREFIX, else ~/.wine) through its drive mapping, and
// backslashes become separators. Other text is taken as a native path.
fs::path NativePathFromUserText(std::string_view text);

}  // namespace kickvane::platform
