// File system backend for Linux and other POSIX systems, where names are case-sensitive and a
// Windows game lives in a Wine prefix.
#include <dirent.h>
#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <atomic>
#include <cerrno>
#include <chrono>
#include <cstdint>
#include <cstring>
#include <ctime>
#include <random>
#include <string>
#include <thread>

#include "platform/filesystem.h"
#include "platform/posix_fd.h"
#include "platform/windows_path.h"

namespace kickvane::platform {

namespace {

Status Failed(FailedAction action, const fs::path& path, int error) {
    return Status::Fail(action, path, std::error_code(error, std::system_category()));
}

// A fresh unique part of a temporary name: six letters or digits.
std::string UniqueSuffix() {
    static constexpr char kLetters[] =
        "0123456789abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ";
    thread_local std::mt19937_64 random(std::random_device{}() ^
                                        (static_cast<uint64_t>(::getpid()) << 32));
    std::string suffix(6, '0');
    uint64_t bits = random();
    for (char& c : suffix) {
        c = kLetters[bits % (sizeof(kLetters) - 1)];
        bits /= sizeof(kLetters) - 1;
    }
    return suffix;
}

// The permission bits that new files lose. Read while the program starts, before any copy runs
// on another thread: reading means setting it for a moment.
const mode_t kCreationMask = [] {
    const mode_t current = ::umask(022);
    ::umask(current);
    return current;
}();

// A folder opened for use as the base of relative names.
int OpenFolder(const fs::path& folder) {
    return ::open(folder.empty() ? "." : folder.c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC);
}

// Gives the unnamed file `fd` the name `targetName` in the folder `dirFd`. Linking by descriptor
// needs a privilege on kernels before 6.10; the descriptor's entry under /proc does not. Once
// refused, the process goes to /proc straight away.
bool LinkUnnamed(int fd, int dirFd, const std::string& targetName) {
    static std::atomic<bool> byDescriptor{true};
    if (byDescriptor.load(std::memory_order_relaxed)) {
        if (::linkat(fd, "", dirFd, targetName.c_str(), AT_EMPTY_PATH) == 0) {
            return true;
        }
        if (errno != EPERM && errno != ENOENT) {
            return false;
        }
        byDescriptor.store(false, std::memory_order_relaxed);
    }
    const std::string self = "/proc/self/fd/" + std::to_string(fd);
    return ::linkat(AT_FDCWD, self.c_str(), dirFd, targetName.c_str(), AT_SYMLINK_FOLLOW) == 0;
}

// A temporary file beside its final place, in the folder `dirFd`; removed unless it was renamed
// into place. It holds an exclusive lock for its life, which tells RemoveIfStale that its writer
// still runs.
class TempFile {
public:
    TempFile(int dirFd, const std::string& targetName, mode_t mode) : dirFd_(dirFd) {
        const std::string prefix = TemporaryNamePrefix(targetName);
        // Where the file system has unnamed files, the file is locked before it gets its name,
        // so that no cleaner ever sees it unlocked.
        if (Fd unnamed(::openat(dirFd, ".", O_TMPFILE | O_WRONLY | O_CLOEXEC, mode));
            unnamed.valid() && ::flock(unnamed.get(), LOCK_EX) == 0) {
            for (int attempt = 0; attempt < 16; ++attempt) {
                std::string name = prefix + UniqueSuffix();
                if (LinkUnnamed(unnamed.get(), dirFd, name)) {
                    fd_ = unnamed.Release();
                    name_ = std::move(name);
                    return;
                }
                if (errno != EEXIST) {
                    break;
                }
            }
        }
        for (int attempt = 0; attempt < 16; ++attempt) {
            std::string name = prefix + UniqueSuffix();
            const int fd =
                ::openat(dirFd, name.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, mode);
            if (fd < 0) {
                if (errno == EEXIST) {
                    continue;
                }
                return;
            }
            // A cleaner may have taken the file for a stale one between its creation and the
            // lock; it is then unlinked, and a new one is made. A file system without locks
            // gets an unlocked file, which RemoveIfStale leaves alone.
            struct stat st {};
            const bool locked = ::flock(fd, LOCK_EX) == 0;
            if (!locked || (::fstat(fd, &st) == 0 && st.st_nlink > 0)) {
                fd_ = fd;
                name_ = std::move(name);
                return;
            }
            ::close(fd);
        }
        errno = EEXIST;
    }
    TempFile(const TempFile&) = delete;
    TempFile& operator=(const TempFile&) = delete;
    ~TempFile() {
        if (fd_ >= 0) {
            ::close(fd_);
        }
        if (!committed_ && !name_.empty()) {
            ::unlinkat(dirFd_, name_.c_str(), 0);
        }
    }

    bool valid() const { return fd_ >= 0; }
    int fd() const { return fd_; }

    // Renames the file over `targetName`, then closes it; `target` names it in messages. The lock
    // is held until the rename is done: a file closed first would look abandoned to a cleaner in
    // another process, which could delete it before it reaches its place.
    Status CommitAs(const std::string& targetName, const fs::path& target) {
        if (::renameat(dirFd_, name_.c_str(), dirFd_, targetName.c_str()) != 0) {
            return Failed(FailedAction::Replace, target, errno);
        }
        committed_ = true;
        const int fd = fd_;
        fd_ = -1;
        if (::close(fd) != 0) {
            return Failed(FailedAction::Write, target, errno);
        }
        return Status::Ok();
    }

private:
    int dirFd_;
    std::string name_;
    int fd_ = -1;
    bool committed_ = false;
};

bool WriteAll(int fd, const char* data, size_t size) {
    while (size > 0) {
        ssize_t written = ::write(fd, data, size);
        if (written < 0) {
            if (errno == EINTR) {
                continue;
            }
            return false;
        }
        data += written;
        size -= static_cast<size_t>(written);
    }
    return true;
}

// Copies the whole content of `in` to `out`; the kernel copies without a user-space buffer where
// it can, which keeps large texture sets as fast as cp.
bool CopyContent(int in, int out, off_t size) {
    off_t left = size;
    while (left > 0) {
        ssize_t copied = ::copy_file_range(in, nullptr, out, nullptr, static_cast<size_t>(left), 0);
        if (copied > 0) {
            left -= copied;
            continue;
        }
        if (copied == 0) {
            break;  // The source shrank while we copied; keep what there is.
        }
        if (errno == EINTR) {
            continue;
        }
        if (errno != EXDEV && errno != ENOSYS && errno != EINVAL && errno != EOPNOTSUPP) {
            return false;
        }
        // No in-kernel copy between these file systems: fall back to read and write.
        std::array<char, 1 << 16> buffer;
        for (;;) {
            ssize_t got = ::read(in, buffer.data(), buffer.size());
            if (got < 0 && errno == EINTR) {
                continue;
            }
            if (got < 0) {
                return false;
            }
            if (got == 0) {
                return true;
            }
            if (!WriteAll(out, buffer.data(), static_cast<size_t>(got))) {
                return false;
            }
        }
    }
    return true;
}

bool StatFile(const fs::path& path, struct stat& st) {
    return ::stat(path.c_str(), &st) == 0;
}

}  // namespace

fs::path ResolveCaseInsensitive(const fs::path& path) {
    // Mostly the path exists as spelled: one look at the whole spares one per component.
    const fs::path relative = path.relative_path();
    const bool plain = std::none_of(relative.begin(), relative.end(), [](const fs::path& part) {
        return part.empty() || part == "." || part == "..";
    });
    struct stat st {};
    if (plain && !path.empty() && ::lstat(path.c_str(), &st) == 0) {
        return path;
    }
    fs::path resolved = path.root_path();
    bool belowMissing = false;
    for (const fs::path& part : relative) {
        if (part.empty() || part == ".") {
            continue;  // Doubled or trailing separators name nothing.
        }
        if (!belowMissing && part != "..") {
            if (auto found = FindEntryIgnoringCase(resolved, part.string())) {
                resolved = *found;
                continue;
            }
            belowMissing = true;
        }
        resolved /= part;
    }
    return resolved;
}

Status MakeDirectory(const fs::path& path) {
    if (::mkdir(path.c_str(), 0777) != 0) {
        return Failed(FailedAction::CreateFolder, path, errno);
    }
    return Status::Ok();
}

bool IsUpToDateCopy(const fs::path& source, const fs::path& target) {
    struct stat src {};
    struct stat dst {};
    return StatFile(source, src) && StatFile(target, dst) && S_ISREG(dst.st_mode) &&
           src.st_size == dst.st_size && src.st_mtim.tv_sec == dst.st_mtim.tv_sec &&
           src.st_mtim.tv_nsec == dst.st_mtim.tv_nsec;
}

namespace {

// Gives the copy in `out` the source's permissions (where the creation mask took some away) and
// times.
void TakeModeAndTimes(int out, const struct stat& st) {
    const mode_t mode = st.st_mode & 0777;
    if (((mode | S_IRUSR | S_IWUSR) & ~kCreationMask) != mode) {
        ::fchmod(out, mode);
    }
    const struct timespec times[2] = {st.st_atim, st.st_mtim};
    ::futimens(out, times);
}

enum class NewFile { Written, Failed, Unsupported };

// Writes a file where none is: into a file without a name in the folder, named only once it is
// whole. A killed copy leaves nothing behind, and there is no temporary name, lock or rename to
// pay for. Unsupported where the file system has no unnamed files, or when the name was taken
// meanwhile; the caller then goes through a named temporary file.
NewFile CopyIntoNew(int in, const struct stat& st, int dirFd, const std::string& targetName) {
    Fd out(::openat(dirFd, ".", O_TMPFILE | O_WRONLY | O_CLOEXEC,
                    (st.st_mode & 0777) | S_IRUSR | S_IWUSR));
    if (!out.valid()) {
        return errno == EOPNOTSUPP || errno == EISDIR || errno == EINVAL ? NewFile::Unsupported
                                                                         : NewFile::Failed;
    }
    if (!CopyContent(in, out.get(), st.st_size)) {
        return NewFile::Failed;
    }
    TakeModeAndTimes(out.get(), st);
    if (!LinkUnnamed(out.get(), dirFd, targetName)) {
        return errno == EEXIST || errno == ENOENT || errno == EPERM ? NewFile::Unsupported
                                                                    : NewFile::Failed;
    }
    return out.Close() == 0 ? NewFile::Written : NewFile::Failed;
}

// Copies the open regular file `in` (described by `st`) to `targetName` in the folder `dirFd`,
// with the source's permissions and times: a new file straight into place where `targetIsNew`
// and the file system allows (cleared where it does not, so that later files skip the attempt),
// else through a temporary file renamed over the target.
Status CopyInto(int in, const struct stat& st, int dirFd, const std::string& targetName,
                const fs::path& targetFolder, bool* targetIsNew) {
    // The target's path is made for messages only.
    const auto fail = [&](FailedAction action) {
        const int error = errno;
        return Failed(action, targetFolder / targetName, error);
    };
    if (targetIsNew && *targetIsNew) {
        switch (CopyIntoNew(in, st, dirFd, targetName)) {
            case NewFile::Written:
                return Status::Ok();
            case NewFile::Failed:
                return fail(FailedAction::Write);
            case NewFile::Unsupported:
                *targetIsNew = false;
                if (::lseek(in, 0, SEEK_SET) != 0) {
                    return fail(FailedAction::Read);
                }
                break;
        }
    }
    TempFile temp(dirFd, targetName, (st.st_mode & 0777) | S_IRUSR | S_IWUSR);
    if (!temp.valid()) {
        return fail(FailedAction::Write);
    }
    if (!CopyContent(in, temp.fd(), st.st_size)) {
        return fail(FailedAction::Write);
    }
    TakeModeAndTimes(temp.fd(), st);
    return temp.CommitAs(targetName, targetFolder / targetName);
}

bool SameSizeAndTime(const struct stat& source, const struct stat& target) {
    return S_ISREG(target.st_mode) && source.st_size == target.st_size &&
           source.st_mtim.tv_sec == target.st_mtim.tv_sec &&
           source.st_mtim.tv_nsec == target.st_mtim.tv_nsec;
}

}  // namespace

Status ReplaceFile(const fs::path& source, const fs::path& target) {
    Fd in(::open(source.c_str(), O_RDONLY | O_CLOEXEC));
    if (in.get() < 0) {
        return Failed(FailedAction::Read, source, errno);
    }
    struct stat st {};
    if (::fstat(in.get(), &st) != 0) {
        return Failed(FailedAction::Read, source, errno);
    }
    if (!S_ISREG(st.st_mode)) {
        return Failed(FailedAction::Read, source, S_ISDIR(st.st_mode) ? EISDIR : EINVAL);
    }
    Fd folder(OpenFolder(target.parent_path()));
    if (folder.get() < 0) {
        return Failed(FailedAction::Write, target, errno);
    }
    return CopyInto(in.get(), st, folder.get(), target.filename().string(), target.parent_path(),
                    nullptr);
}

namespace {

// A folder opened for reading its entries and as the base of relative names.
int OpenReadableFolder(const fs::path& folder, int& error) {
    const int fd =
        ::open(folder.empty() ? "." : folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    error = fd < 0 ? errno : 0;
    return fd;
}

// Calls `entry(name, isFolder)` for each entry of the folder open as `fd` but "." and "..",
// reading the descriptor itself (no second open, no path lookup). Links count as what they
// point to, as std::filesystem's directory_entry::is_directory() does. False, with errno, when
// the folder cannot be read.
template <typename Entry>
bool ForEachEntry(int fd, Entry&& entry) {
    alignas(struct dirent64) char buffer[32 * 1024];
    for (;;) {
        const ssize_t got = ::getdents64(fd, buffer, sizeof buffer);
        if (got < 0) {
            return false;
        }
        if (got == 0) {
            return true;
        }
        for (ssize_t at = 0; at < got;) {
            const auto* item = reinterpret_cast<const struct dirent64*>(buffer + at);
            at += item->d_reclen;
            const std::string_view name = item->d_name;
            if (name == "." || name == "..") {
                continue;
            }
            bool isFolder = item->d_type == DT_DIR;
            if (item->d_type == DT_UNKNOWN || item->d_type == DT_LNK) {
                struct stat st {};
                isFolder = ::fstatat(fd, item->d_name, &st, 0) == 0 && S_ISDIR(st.st_mode);
            }
            entry(name, isFolder);
        }
    }
}

}  // namespace

FolderCopy::FolderCopy(const fs::path& sourceFolder, const fs::path& targetFolder)
    : source_(sourceFolder),
      target_(targetFolder),
      sourceFd_(OpenReadableFolder(sourceFolder, sourceError_)),
      targetFd_(OpenReadableFolder(targetFolder, targetError_)) {}

FolderCopy::~FolderCopy() {
    for (const int fd : {sourceFd_, targetFd_}) {
        if (fd >= 0) {
            ::close(fd);
        }
    }
}

Status FolderCopy::ListSource(SourceEntries& entries) {
    const bool read =
        sourceFd_ >= 0 && ForEachEntry(sourceFd_, [&](std::string_view name, bool isFolder) {
            (isFolder ? entries.folders : entries.files).emplace_back(name);
        });
    return read ? Status::Ok()
                : Failed(FailedAction::ReadFolder, source_, sourceFd_ < 0 ? sourceError_ : errno);
}

std::unordered_map<std::string, FolderCopy::TargetEntry> FolderCopy::ListTarget() {
    std::unordered_map<std::string, TargetEntry> entries;
    if (targetFd_ >= 0) {
        ForEachEntry(targetFd_, [&](std::string_view name, bool isFolder) {
            auto [at, inserted] =
                entries.try_emplace(FoldCase(name), TargetEntry{std::string(name), isFolder});
            if (!inserted && name < at->second.name) {
                at->second = {std::string(name), isFolder};
            }
        });
    }
    return entries;
}

Status FolderCopy::Copy(const std::string& sourceName, const std::string& targetName,
                        bool targetMayExist, bool* copied) {
    *copied = false;
    if (sourceFd_ < 0) {
        return Failed(FailedAction::ReadFolder, source_, sourceError_);
    }
    if (targetFd_ < 0) {
        return Failed(FailedAction::Write, target_, targetError_);
    }
    struct stat st {};
    Fd in;
    if (targetMayExist) {
        // Compare by name first, so that an up-to-date target costs no open.
        struct stat existing {};
        if (::fstatat(sourceFd_, sourceName.c_str(), &st, 0) != 0) {
            return Failed(FailedAction::Read, source_ / sourceName, errno);
        }
        if (S_ISREG(st.st_mode) && ::fstatat(targetFd_, targetName.c_str(), &existing, 0) == 0 &&
            SameSizeAndTime(st, existing)) {
            return Status::Ok();
        }
    }
    // Not blocking, so that a pipe among the sources does not hang the open.
    in.Reset(::openat(sourceFd_, sourceName.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK));
    if (!in.valid() || ::fstat(in.get(), &st) != 0) {
        return Failed(FailedAction::Read, source_ / sourceName, errno);
    }
    if (!S_ISREG(st.st_mode)) {
        return Failed(FailedAction::Read, source_ / sourceName,
                      S_ISDIR(st.st_mode) ? EISDIR : EINVAL);
    }
    *copied = true;
    bool targetIsNew = !targetMayExist && unnamedFiles_.load(std::memory_order_relaxed);
    Status status = CopyInto(in.get(), st, targetFd_, targetName, target_, &targetIsNew);
    if (!targetIsNew && !targetMayExist) {
        unnamedFiles_.store(false, std::memory_order_relaxed);
    }
    return status;
}

Status WriteFileAtomically(const fs::path& path, std::string_view content) {
    Fd folder(OpenFolder(path.parent_path()));
    if (folder.get() < 0) {
        return Failed(FailedAction::Write, path, errno);
    }
    // Keep the permissions of the file being replaced; a new file gets the usual ones.
    struct stat old {};
    const mode_t mode = StatFile(path, old) ? (old.st_mode & 0777) : 0644;
    TempFile temp(folder.get(), path.filename().string(), mode | S_IRUSR | S_IWUSR);
    if (!temp.valid()) {
        return Failed(FailedAction::Write, path, errno);
    }
    if (!WriteAll(temp.fd(), content.data(), content.size()) || ::fsync(temp.fd()) != 0) {
        return Failed(FailedAction::Write, path, errno);
    }
    ::fchmod(temp.fd(), mode);
    return temp.CommitAs(path.filename().string(), path);
}

FileUpdateLock::FileUpdateLock(const fs::path& path) {
    // A writer replaces the file by renaming a new one over it, so the file locked may have been
    // replaced by the time the lock is granted: then the new one is locked instead.
    const auto giveUp = std::chrono::steady_clock::now() + std::chrono::seconds(5);
    while (std::chrono::steady_clock::now() < giveUp) {
        Fd fd(::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NOFOLLOW | O_NONBLOCK));
        struct stat held {};
        if (!fd.valid() || ::fstat(fd.get(), &held) != 0 || !S_ISREG(held.st_mode)) {
            return;
        }
        while (::flock(fd.get(), LOCK_EX | LOCK_NB) != 0) {
            if (errno != EWOULDBLOCK || std::chrono::steady_clock::now() >= giveUp) {
                return;
            }
            std::this_thread::sleep_for(std::chrono::milliseconds(1));
        }
        struct stat named {};
        if (::stat(path.c_str(), &named) == 0 && named.st_dev == held.st_dev &&
            named.st_ino == held.st_ino) {
            fd_ = fd.Release();
            return;
        }
    }
}

FileUpdateLock::~FileUpdateLock() {
    if (fd_ >= 0) {
        ::close(fd_);
    }
}

bool RemoveIfStale(const fs::path& file, std::chrono::seconds minimumAge) {
    Fd fd(::open(file.c_str(), O_RDONLY | O_CLOEXEC | O_NOFOLLOW | O_NONBLOCK));
    struct stat st {};
    if (fd.get() < 0 || ::fstat(fd.get(), &st) != 0 || !S_ISREG(st.st_mode)) {
        return false;
    }
    // A writer creates its file and only then locks it: a file changed lately may be one whose
    // lock is still to come. The change time counts, as a copy sets the modification time to its
    // source's.
    struct timespec now {};
    ::clock_gettime(CLOCK_REALTIME, &now);
    if (now.tv_sec - st.st_ctim.tv_sec < minimumAge.count()) {
        return false;
    }
    // The writer's lock goes with its process: a lock that can be taken has no writer.
    if (::flock(fd.get(), LOCK_EX | LOCK_NB) != 0) {
        return false;
    }
    // The writer renames its file before it lets go of the lock, so the file locked here may
    // since have reached its final name: then the temporary name is gone or names another file.
    struct stat named {};
    if (::lstat(file.c_str(), &named) != 0 || named.st_dev != st.st_dev ||
        named.st_ino != st.st_ino) {
        return false;
    }
    return ::unlink(file.c_str()) == 0;
}

fs::path ProgramFolder() {
    std::error_code ec;
    fs::path exe = fs::read_symlink("/proc/self/exe", ec);
    return ec ? fs::current_path(ec) : exe.parent_path();
}

fs::path NativePathFromUserText(std::string_view text) {
    const std::optional<DrivePath> drivePath = ParseDrivePath(text);
    if (!drivePath) {
        std::string path(text);
        std::replace(path.begin(), path.end(), '\\', '/');
        return fs::path(path);
    }
    std::string prefix = GetEnv("WINEPREFIX");
    if (prefix.empty()) {
        prefix = GetEnv("HOME") + "/.wine";
    }
    // An unmapped drive still gets a path in the prefix: the folder checks then say it is missing.
    const fs::path drive =
        PrefixDriveFolder(prefix, drivePath->drive)
            .value_or(fs::path(prefix) / "dosdevices" / (std::string(1, drivePath->drive) + ":"));
    return JoinDrivePath(drive, *drivePath);
}

}  // namespace kickvane::platform
