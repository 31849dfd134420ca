// File system backend for Windows, where names are case-insensitive already and the game's
// folders are native paths.
#include <windows.h>
// windows.h names its own ReplaceFile function as a macro; ours is the one declared below.
#undef ReplaceFile

#include <fstream>
#include <random>

#include "platform/filesystem.h"

namespace kickvane::platform {

namespace {

std::string LastErrorText() {
    return std::error_code(static_cast<int>(::GetLastError()), std::system_category()).message();
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

Status MoveOver(const fs::path& from, const fs::path& to) {
    if (!::MoveFileExW(from.c_str(), to.c_str(),
                       MOVEFILE_REPLACE_EXISTING | MOVEFILE_WRITE_THROUGH)) {
        const std::string error = LastErrorText();
        std::error_code ignored;
        fs::remove(from, ignored);
        return Status::Fail("cannot replace " + to.string() + ": " + error);
    }
    return Status::Ok();
}

}  // namespace

fs::path ResolveCaseInsensitive(const fs::path& path) {
    return path;
}

Status MakeDirectory(const fs::path& path) {
    if (!::CreateDirectoryW(path.c_str(), nullptr)) {
        return Status::Fail("cannot create folder " + path.string() + ": " + LastErrorText());
    }
    return Status::Ok();
}

bool IsUpToDateCopy(const fs::path& source, const fs::path& target) {
    std::error_code ec;
    const auto sourceSize = fs::file_size(source, ec);
    if (ec || !fs::is_regular_file(target, ec)) {
        return false;
    }
    const auto targetSize = fs::file_size(target, ec);
    return !ec && sourceSize == targetSize &&
           fs::last_write_time(source, ec) == fs::last_write_time(target, ec) && !ec;
}

Status ReplaceFile(const fs::path& source, const fs::path& target) {
    std::error_code ec;
    if (!fs::is_regular_file(source, ec)) {
        return Status::Fail("not a file: " + source.string());
    }
    const fs::path temporary = TemporaryBeside(target);
    if (!::CopyFileW(source.c_str(), temporary.c_str(), TRUE)) {
        const std::string error = LastErrorText();
        fs::remove(temporary, ec);
        return Status::Fail("cannot copy to " + target.string() + ": " + error);
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
            return Status::Fail("cannot write " + path.string());
        }
    }
    return MoveOver(temporary, path);
}

FolderCopy::FolderCopy(const fs::path& sourceFolder, const fs::path& targetFolder)
    : source_(sourceFolder), target_(targetFolder) {}

FolderCopy::~FolderCopy() = default;

Status FolderCopy::Copy(const std::string& sourceName, const std::string& targetName, bool,
                        bool* copied) {
    // The names come from path::string(), so they convert back the same way.
    const fs::path source = source_ / fs::path(sourceName);
    const fs::path target = target_ / fs::path(targetName);
    *copied = !IsUpToDateCopy(source, target);
    return *copied ? ReplaceFile(source, target) : Status::Ok();
}

bool RemoveIfStale(const fs::path& file) {
    // A file that its writer still holds open cannot be deleted. Between the writer's close and
    // its rename the file is free, so only files made some time ago count as stale.
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
    constexpr unsigned long long kMinuteTicks = 60ULL * 10'000'000ULL;
    if (ticks(now) < ticks(data.ftCreationTime) + kMinuteTicks) {
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
    return fs::path(std::u8string(text.begin(), text.end()));
}

}  // namespace kickvane::platform
