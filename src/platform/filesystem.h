#pragma once

#include <atomic>
#include <chrono>
#include <cstdint>
#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <system_error>
#include <unordered_map>
#include <vector>

#include "platform/status.h"
#include "platform/text.h"

// File system operations of the core. The game's folders follow Windows rules (letter case does
// not matter), so on a case-sensitive file system every lookup goes through ResolveCaseInsensitive.
namespace kickvane::platform {

namespace fs = std::filesystem;

// Returns `path` with every component that does not exist in its exact spelling replaced by an
// existing entry of its parent that differs only in letter case. Components below the first one
// that exists in no spelling keep the spelling given. Identity on case-insensitive systems.
fs::path ResolveCaseInsensitive(const fs::path& path);

// The entries of `folder` by their case-folded name. Where several differ only in letter case,
// the first in name order stands for them all, whatever order the folder lists them in.
std::unordered_map<std::string, std::string> EntriesByFoldedName(const fs::path& folder);

// Finds the entry of `folder` named `name` in any letter case; nullopt when there is none.
// The exact spelling wins, else the first in name order.
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

// Copies files from one folder into another, each as ReplaceFile does, unless the target already
// equals its source (IsUpToDateCopy). Both folders are opened once, so that the copy of one file
// does not look their paths up again. Where the target folder holds no such name yet, the file is
// written without a name and linked into place once whole, where the file system allows.
class FolderCopy {
public:
    FolderCopy(const fs::path& sourceFolder, const fs::path& targetFolder);
    ~FolderCopy();
    FolderCopy(const FolderCopy&) = delete;
    FolderCopy& operator=(const FolderCopy&) = delete;

    // Copies `sourceName` of the source folder to `targetName` of the target folder; sets
    // `copied` to false when the target was up to date. `targetMayExist` false (the caller knows
    // the target folder holds no such name) spares the look at the target.
    Status Copy(const std::string& sourceName, const std::string& targetName, bool targetMayExist,
                bool* copied);

    // What the source folder holds: its files and its subfolders (links followed), in no
    // particular order. Lists through the folder opened already, once per FolderCopy.
    struct SourceEntries {
        std::vector<std::string> files;
        std::vector<std::string> folders;
    };
    Status ListSource(SourceEntries& entries);

    // The entries of the target folder by case-folded name, as EntriesByFoldedName gives them,
    // each with whether it is a folder; empty when the folder cannot be read. Once per FolderCopy.
    struct TargetEntry {
        std::string name;
        bool isFolder = false;
    };
    std::unordered_map<std::string, TargetEntry> ListTarget();

private:
    fs::path source_;
    fs::path target_;
    int sourceFd_ = -1;
    int targetFd_ = -1;
    int sourceError_ = 0;  // why a folder could not be opened
    int targetError_ = 0;
    std::atomic<bool> unnamedFiles_{true};  // new files may be written unnamed, then linked
};

// Writes `content` to a temporary file beside `path`, flushes it and renames it over `path`.
// On failure the previous file is left as it was.
Status WriteFileAtomically(const fs::path& path, std::string_view content);

// Keeps other processes from updating the file at `path` while it lives: two read-change-write
// cycles of one file (two `kickvane ini set` at once) then follow each other instead of the later
// write undoing the earlier one. Holds nothing where the file does not exist yet, where the
// system has no such locks, or when another holder keeps it for more than a few seconds.
class FileUpdateLock {
public:
    explicit FileUpdateLock(const fs::path& path);
    ~FileUpdateLock();
    FileUpdateLock(const FileUpdateLock&) = delete;
    FileUpdateLock& operator=(const FileUpdateLock&) = delete;

private:
    int fd_ = -1;
};

// The temporary files of ReplaceFile and WriteFileAtomically are named ".NAME.kv-XXXXXX" (six
// letters or digits), NAME being the final name cut short where the whole would pass the limit
// of 255 bytes for one name.
inline constexpr size_t kMaxNameBytes = 255;
std::string TemporaryNamePrefix(std::string_view fileName);  // ".NAME.kv-"
bool IsTemporaryName(std::string_view name);

// Removes `file`, a temporary file of ours, when no save or copy writes it any more (its writer
// was killed or crashed): nothing holds its lock and it has not changed for `minimumAge`. A
// writer keeps its file locked from just after its creation until it has been renamed into
// place; the age spares the moment before the lock, and writers that hold no lock (the Windows
// program under Wine writing the same folder). True when it was removed.
inline constexpr std::chrono::seconds kStaleTemporaryAge{5};
bool RemoveIfStale(const fs::path& file, std::chrono::seconds minimumAge = kStaleTemporaryAge);

// RemoveIfStale for every temporary file of ours directly inside `folder`.
void RemoveStaleTemporaries(const fs::path& folder,
                            std::chrono::seconds minimumAge = kStaleTemporaryAge);

// True when the system refuses `path` for its length: the whole path, or one of its names.
bool IsTooLong(const fs::path& path);

// Reads a whole regular file of at most `maxBytes`, without ever opening anything else (a device
// or a pipe could block or never end).
struct FileRead {
    enum class Result { Read, Missing, Folder, NotRegular, TooLarge, Unreadable };
    Result result = Result::Missing;
    std::string bytes;      // when Read
    std::error_code error;  // the system's reason when Unreadable
};
FileRead ReadRegularFile(const fs::path& path, std::uintmax_t maxBytes);

// The plain files (not folders, not hidden: no leading dot) directly inside `folder`, sorted by
// name.
std::vector<fs::path> ListPlainFiles(const fs::path& folder);

// A path from UTF-8 text (the command line, the settings file). Unlike a path made from a plain
// string, which MinGW's standard library reads byte by byte, it keeps every letter on Windows.
inline fs::path PathFromUtf8(std::string_view text) {
    return fs::path(std::u8string(text.begin(), text.end()));
}

// The UTF-8 text of a path: PathFromUtf8 gives the path back.
inline std::string PathToUtf8(const fs::path& path) {
    const std::u8string text = path.u8string();
    return std::string(text.begin(), text.end());
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
