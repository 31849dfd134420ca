// Parts of the file system layer that the standard library covers on every platform.
#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <fstream>

#include "platform/filesystem.h"
#include "platform/sound.h"

namespace kickvane::platform {

std::unordered_map<std::string, std::string> EntriesByFoldedName(const fs::path& folder) {
    std::unordered_map<std::string, std::string> names;
    std::error_code ec;
    for (fs::directory_iterator it(folder.empty() ? fs::path(".") : folder, ec), end;
         !ec && it != end; it.increment(ec)) {
        std::string name = PathToUtf8(it->path().filename());
        auto [pos, inserted] = names.emplace(FoldCase(name), name);
        if (!inserted && name < pos->second) {
            pos->second = std::move(name);
        }
    }
    return names;
}

std::optional<fs::path> FindEntryIgnoringCase(const fs::path& folder, std::string_view name) {
    std::error_code ec;
    fs::path exact = folder / PathFromUtf8(name);
    if (fs::exists(fs::symlink_status(exact, ec))) {
        return exact;
    }
    const auto names = EntriesByFoldedName(folder);
    const auto found = names.find(FoldCase(name));
    if (found == names.end()) {
        return std::nullopt;
    }
    return folder / PathFromUtf8(found->second);
}

bool IsDirectory(const fs::path& path) {
    std::error_code ec;
    return fs::is_directory(path, ec);
}

bool IsRegularFile(const fs::path& path) {
    std::error_code ec;
    return fs::is_regular_file(path, ec);
}

FileRead ReadRegularFile(const fs::path& path, std::uintmax_t maxBytes) {
    FileRead read;
    std::error_code ec;
    const fs::file_status status = fs::status(path, ec);
    if (ec || !fs::exists(status)) {
        const bool missing =
            !ec || ec == std::errc::no_such_file_or_directory || ec == std::errc::not_a_directory;
        read.result = missing ? FileRead::Result::Missing : FileRead::Result::Unreadable;
        read.error = ec;
        return read;
    }
    if (fs::is_directory(status)) {
        read.result = FileRead::Result::Folder;
        return read;
    }
    if (!fs::is_regular_file(status)) {
        read.result = FileRead::Result::NotRegular;
        return read;
    }
    const std::uintmax_t size = fs::file_size(path, ec);
    if (!ec && size > maxBytes) {
        read.result = FileRead::Result::TooLarge;
        return read;
    }
    std::ifstream in(path, std::ios::binary);
    if (!in) {
        read.result = FileRead::Result::Unreadable;
        read.error = std::error_code(errno, std::generic_category());
        return read;
    }
    // Read in pieces: the file may have grown since its size was looked at.
    read.bytes.reserve(static_cast<size_t>(ec ? 0 : size));
    std::array<char, 1 << 14> piece;
    while (in.read(piece.data(), piece.size()) || in.gcount() > 0) {
        read.bytes.append(piece.data(), static_cast<size_t>(in.gcount()));
        if (read.bytes.size() > maxBytes) {
            read.result = FileRead::Result::TooLarge;
            read.bytes.clear();
            return read;
        }
    }
    if (in.bad()) {
        read.result = FileRead::Result::Unreadable;
        read.error = std::error_code(errno, std::generic_category());
        read.bytes.clear();
        return read;
    }
    read.result = FileRead::Result::Read;
    return read;
}

std::vector<fs::path> ListPlainFiles(const fs::path& folder) {
    std::vector<fs::path> files;
    std::error_code ec;
    for (fs::directory_iterator it(folder, ec), end; !ec && it != end; it.increment(ec)) {
        const std::string name = PathToUtf8(it->path().filename());
        std::error_code typeError;
        if (!name.empty() && name.front() != '.' && it->is_regular_file(typeError)) {
            files.push_back(it->path());
        }
    }
    std::sort(files.begin(), files.end());
    return files;
}

std::string TemporaryNamePrefix(std::string_view fileName) {
    constexpr std::string_view kMark = ".kv-";
    constexpr size_t kRoom = kMaxNameBytes - 1 - kMark.size() - 6;
    if (fileName.size() > kRoom) {
        size_t cut = kRoom;
        while (cut > 0 && (static_cast<unsigned char>(fileName[cut]) & 0xC0) == 0x80) {
            --cut;  // never split a UTF-8 character
        }
        fileName = fileName.substr(0, cut);
    }
    return "." + std::string(fileName) + std::string(kMark);
}

bool IsTemporaryName(std::string_view name) {
    constexpr std::string_view kMark = ".kv-";
    constexpr size_t kUnique = 6;
    if (name.size() < 1 + kMark.size() + kUnique || name.front() != '.' ||
        name.substr(name.size() - kUnique - kMark.size(), kMark.size()) != kMark) {
        return false;
    }
    return std::all_of(name.end() - kUnique, name.end(), [](char c) {
        return (c >= '0' && c <= '9') || (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z');
    });
}

void RemoveStaleTemporaries(const fs::path& folder, std::chrono::seconds minimumAge) {
    std::error_code ec;
    for (fs::directory_iterator it(folder, ec), end; !ec && it != end; it.increment(ec)) {
        if (IsTemporaryName(PathToUtf8(it->path().filename()))) {
            RemoveIfStale(it->path(), minimumAge);
        }
    }
}

bool IsTooLong(const fs::path& path) {
    // No file system here keeps a name of more than 255 characters, and Windows reports a path
    // holding one only as missing.
    constexpr size_t kNameLimit = 255;
    for (const fs::path& part : path) {
        if (part.native().size() > kNameLimit) {
            return true;
        }
    }
    std::error_code ec;
    (void)fs::symlink_status(path, ec);
    return ec == std::errc::filename_too_long;
}

std::string GetEnv(const char* name) {
    const char* value = std::getenv(name);
    return value ? std::string(value) : std::string();
}

std::optional<fs::path> SoundFileToPlay(const fs::path& wav) {
    std::error_code error;
    if (!fs::is_regular_file(wav, error)) {
        return std::nullopt;
    }
    fs::path absolute = fs::absolute(wav, error);
    if (error) {
        return std::nullopt;
    }
    return absolute;
}

}  // namespace kickvane::platform
