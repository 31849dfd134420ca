#pragma once

#include <filesystem>
#include <functional>

#include "platform/status.h"

namespace kickvane::session {

namespace fs = std::filesystem;

// Where the tool keeps its sets, skins, previews, sound and settings.
struct ToolFolderChoice {
    fs::path folder;
    fs::path seedFrom;  // where to copy the installed sets from first; empty when nothing to do
};

// The folders and files that a tool folder takes over from the installed data folder.
inline constexpr const char* kSeededItems[] = {"data", "extras", "skin",
                                               "img",  "icons",  "sound.wav"};

// The file that marks a tool folder as seeded; once it is there nothing is copied again.
inline constexpr const char* kSeededMark = ".kickvane-seeded";

// Tells whether the tool may write into a folder.
using WritableTest = std::function<bool(const fs::path&)>;

// True when a file can be created in `folder` (tried with a file that is removed at once).
bool IsWritableFolder(const fs::path& folder);

// The tool folder of a program that lies in `programFolder`:
// - the program's own folder when it holds the sets ("data") and is writable (the portable
//   layout);
// - otherwise `userDataHome`/kickvane, seeded from the program's folder when the sets lie there
//   (a read-only portable copy), else from the installed data folder "../share/kickvane";
// - a program with neither keeps its own folder.
ToolFolderChoice ChooseToolFolder(const fs::path& programFolder, const fs::path& userDataHome,
                                  const WritableTest& isWritable = IsWritableFolder);

// Copies the seeded items from `from` into `to`, creating it. Files that `to` has already are
// kept as they are; once the seeded mark is written, later calls copy nothing.
Status SeedToolFolder(const fs::path& from, const fs::path& to);

}  // namespace kickvane::session
