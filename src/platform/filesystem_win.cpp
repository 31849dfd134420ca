// File system backend for Windows, where names are case-insensitive already and the game's
// folders are native paths.
#include <windows.h>
// windows.h names its own ReplaceFile function as a macro; ours is the one declared below.
#undef ReplaceFile

#include <algorithm>
#include <cstdint>
#include <fstream>
#include <random>
#include <string_view>
#include <vector>

#include "platform/filesystem.h"

namespace kickvane::platform {

namespace {

std::error_code LastError() {
    return {static_cast<int>(::GetLastError()), std::system_category()};
}

// A fresh name beside `target` for the data of a replacement.
fs::path TemporaryBeside(const fs::path& target) {
    static constexpr char kLetters[] = "0123456789abcdefghijklmnopqrstuvwxyz";
    std::random_device random;
    std::string unique;
    for (int i = 0; i < 6; ++i) {
        unique += kLetters[random() % (sizeof(kLetters) - 1)];
    }
    const std::u8string name = target.filename().u8string();
    const std::string prefix = TemporaryNamePrefix(std::string(name.begin(), name.end()));
    const std::string full = prefix + unique;
    return target.parent_path() / fs::path(std::u8string(full.begin(), full.end()));
}

// Windows refuses to replace a file that another program holds open with "access denied", as it
// does a file that may not be written and a folder in the file's place. A folder is told by its
// attributes; opening the file for deletion tells the other two apart: a held file answers with a
// sharing violation.
std::error_code ReplaceError(const fs::path& target) {
    const std::error_code denied = LastError();
    if (denied.value() != ERROR_ACCESS_DENIED) {
        return denied;
    }
    const DWORD attributes = ::GetFileAttributesW(target.c_str());
    if (attributes != INVALID_FILE_ATTRIBUTES && (attributes & FILE_ATTRIBUTE_DIRECTORY) != 0) {
        return std::make_error_code(std::errc::is_a_directory);
    }
    HANDLE probe = ::CreateFileW(target.c_str(), DELETE, FILE_SHARE_READ | FILE_SHARE_WRITE,
                                 nullptr, OPEN_EXISTING, FILE_ATTRIBUTE_NORMAL, nullptr);
    if (probe != INVALID_HANDLE_VALUE) {
        ::CloseHandle(probe);
        return denied;
    }
    const std::error_code why = LastError();
    return why.value() == ERROR_SHARING_VIOLATION ? why : denied;
}

Status MoveOver(const fs::path& from, const fs::path& to) {
    if (!::MoveFileExW(from.c_str(), to.c_str(),
                       MOVEFILE_REPLACE_EXISTING | MOVEFILE_WRITE_THROUGH)) {
        const std::error_code error = ReplaceError(to);
        std::error_code ignored;
        fs::remove(from, ignored);
        return Status::Fail(FailedAction::Replace, to, error);
    }
    return Status::Ok();
}

std::uint64_t FileTimeTicks(const FILETIME& time) {
    return (static_cast<std::uint64_t>(time.dwHighDateTime) << 32) | time.dwLowDateTime;
}

bool SameContent(const fs::path& a, const fs::path& b) {
    std::ifstream first(a, std::ios::binary);
    std::ifstream second(b, std::ios::binary);
    std::vector<char> left(64 * 1024);
    std::vector<char> right(left.size());
    while (first && second) {
        first.read(left.data(), static_cast<std::streamsize>(left.size()));
        second.read(right.data(), static_cast<std::streamsize>(right.size()));
        if (first.gcount() != second.gcount() ||
            !std::equal(left.begin(), left.begin() + first.gcount(), right.begin())) {
            return false;
        }
    }
    return !first.bad() && !second.bad() && first.eof() && second.eof();
}

}  // namespace

fs::path ResolveCaseInsensitive(const fs::path& path) {
    return path;
}

Status MakeDirectory(const fs::path& path) {
    if (!::CreateDirectoryW(path.c_str(), nullptr)) {
        return Status::Fail(FailedAction::CreateFolder, path, LastError());
    }
    return Status::Ok();
}

bool IsUpToDateCopy(const fs::path& source, const fs::path& target) {
    // The system's own file times, to 100 ns: the standard library of MinGW rounds them to the
    // second, which takes a same-size file written in the same second for the same file.
    WIN32_FILE_ATTRIBUTE_DATA from{};
    WIN32_FILE_ATTRIBUTE_DATA to{};
    if (!::GetFileAttributesExW(source.c_str(), GetFileExInfoStandard, &from) ||
        !::GetFileAttributesExW(target.c_str(), GetFileExInfoStandard, &to) ||
        (to.dwFileAttributes & FILE_ATTRIBUTE_DIRECTORY) != 0) {
        return false;
    }
    const std::uint64_t fromTime = FileTimeTicks(from.ftLastWriteTime);
    if (from.nFileSizeHigh != to.nFileSizeHigh || from.nFileSizeLow != to.nFileSizeLow ||
        fromTime != FileTimeTicks(to.ftLastWriteTime)) {
        return false;
    }
    // A time on a whole second may come from a file system that keeps no finer times (FAT keeps
    // two seconds), where two different files easily share it: then the contents decide.
    constexpr std::uint64_t kTicksPerSecond = 10'000'000;
    return fromTime % kTicksPerSecond != 0 || SameContent(source, target);
}

Status ReplaceFile(const fs::path& source, const fs::path& target) {
    std::error_code ec;
    if (!fs::is_regular_file(source, ec)) {
        return Status::Fail(FailedAction::Read, source,
                            ec ? ec
                            : fs::is_directory(source, ec)
                                ? std::make_error_code(std::errc::is_a_directory)
                                : std::make_error_code(std::errc::no_such_file_or_directory));
    }
    const fs::path temporary = TemporaryBeside(target);
    if (!::CopyFileW(source.c_str(), temporary.c_str(), TRUE)) {
        const std::error_code error = LastError();
        fs::remove(temporary, ec);
        return Status::Fail(FailedAction::Write, target, error);
    }
    // CopyFileW keeps the source's modification time, which the quick check relies on.
    return MoveOver(temporary, target);
}

Status WriteFileAtomically(const fs::path& path, std::string_view content) {
    const fs::path temporary = TemporaryBeside(path);
    {
        std::ofstream out(temporary, std::ios::binary | std::ios::trunc);
        out.write(content.data(), static_cast<std::streamsize>(content.size()));
        out.flush();
        if (!out) {
            std::error_code ignored;
            fs::remove(temporary, ignored);
            return Status::Fail(FailedAction::Write, path,
                                std::make_error_code(std::errc::io_error));
        }
    }
    return MoveOver(temporary, path);
}

FolderCopy::FolderCopy(const fs::path& sourceFolder, const fs::path& targetFolder)
    : source_(sourceFolder), target_(targetFolder) {}

FolderCopy::~FolderCopy() = default;

Status FolderCopy::Copy(const std::string& sourceName, const std::string& targetName, bool,
                        bool* copied) {
    // The names come from path::string(), which gives UTF-8 here.
    const fs::path source = source_ / PathFromUtf8(sourceName);
    const fs::path target = target_ / PathFromUtf8(targetName);
    *copied = !IsUpToDateCopy(source, target);
    return *copied ? ReplaceFile(source, target) : Status::Ok();
}

namespace {

// Calls `entry(name, isFolder)` for each entry of `folder` but "." and "..", with the attributes
// the listing gives (no look at each entry). A link to a folder counts as a folder. False, with
// the system's error, when the folder cannot be read.
template <typename Entry>
bool ForEachEntry(const fs::path& folder, std::error_code& error, Entry&& entry) {
    WIN32_FIND_DATAW found{};
    const fs::path pattern = folder / L"*";
    HANDLE find = ::FindFirstFileExW(pattern.c_str(), FindExInfoBasic, &found,
                                     FindExSearchNameMatch, nullptr, FIND_FIRST_EX_LARGE_FETCH);
    if (find == INVALID_HANDLE_VALUE) {
        error = LastError();
        return false;
    }
    do {
        const std::wstring_view name = found.cFileName;
        if (name != L"." && name != L"..") {
            entry(PathToUtf8(fs::path(name)),
                  (found.dwFileAttributes & FILE_ATTRIBUTE_DIRECTORY) != 0);
        }
    } while (::FindNextFileW(find, &found));
    const DWORD last = ::GetLastError();
    ::FindClose(find);
    if (last != ERROR_NO_MORE_FILES) {
        error = {static_cast<int>(last), std::system_category()};
        return false;
    }
    return true;
}

}  // namespace

Status FolderCopy::ListSource(SourceEntries& entries) {
    std::error_code error;
    const bool read = ForEachEntry(source_, error, [&](std::string name, bool isFolder) {
        (isFolder ? entries.folders : entries.files).push_back(std::move(name));
    });
    return read ? Status::Ok() : Status::Fail(FailedAction::ReadFolder, source_, error);
}

std::unordered_map<std::string, FolderCopy::TargetEntry> FolderCopy::ListTarget() {
    std::unordered_map<std::string, TargetEntry> entries;
    std::error_code error;
    ForEachEntry(target_, error, [&](std::string name, bool isFolder) {
        std::string folded = FoldCase(name);
        entries.try_emplace(std::move(folded), TargetEntry{std::move(name), isFolder});
    });
    return entries;
}

// Windows' sharing rules keep the file replaceable only when it is not held open: nothing is
// held here.
FileUpdateLock::FileUpdateLock(const fs::path&) {}
FileUpdateLock::~FileUpdateLock() = default;

bool RemoveIfStale(const fs::path& file, std::chrono::seconds minimumAge) {
    // A file that its writer still holds open cannot be deleted. Between the writer's close and
    // its rename the file is free, so only files made and last written some time ago count as
    // stale (a copy takes its source's modification time, so the creation time counts too).
    WIN32_FILE_ATTRIBUTE_DATA data{};
    if (!::GetFileAttributesExW(file.c_str(), GetFileExInfoStandard, &data) ||
        (data.dwFileAttributes & FILE_ATTRIBUTE_DIRECTORY)) {
        return false;
    }
    FILETIME now{};
    ::GetSystemTimeAsFileTime(&now);
    const auto ticks = [](const FILETIME& time) {
        return (static_cast<unsigned long long>(time.dwHighDateTime) << 32) | time.dwLowDateTime;
    };
    // Never less than a minute here: the writer holds no lock over its rename.
    const unsigned long long age =
        std::max<unsigned long long>(60, static_cast<unsigned long long>(minimumAge.count())) *
        10'000'000ULL;
    const unsigned long long changed =
        std::max(ticks(data.ftLastWriteTime), ticks(data.ftCreationTime));
    if (ticks(now) < changed + age) {
        return false;
    }
    return ::DeleteFileW(file.c_str()) != 0;
}

fs::path ProgramFolder() {
    std::wstring buffer(MAX_PATH, L'\0');
    for (;;) {
        const DWORD length =
            ::GetModuleFileNameW(nullptr, buffer.data(), static_cast<DWORD>(buffer.size()));
        if (length < buffer.size()) {
            buffer.resize(length);
            return fs::path(buffer).parent_path();
        }
        buffer.resize(buffer.size() * 2);
    }
}

fs::path NativePathFromUserText(std::string_view text) {
    return PathFromUtf8(text);
}

}  // namespace kickvane::platform
