#include "engine/file_ops.h"

#include <algorithm>
#include <atomic>
#include <condition_variable>
#include <cstdint>
#include <memory>
#include <mutex>
#include <system_error>
#include <thread>
#include <unordered_map>
#include <unordered_set>
#include <utility>
#include <vector>

#include "platform/filesystem.h"

namespace kickvane::engine {

namespace {

using platform::ResolveCaseInsensitive;

// The entries of a target folder by their case-folded name, read once per folder so that a
// merge of many files does not scan the folder for each of them. The same scan removes what
// killed copies left behind: temporary files of ours that nothing writes any more.
class FolderIndex {
public:
    FolderIndex(const fs::path& folder, platform::FolderCopy& opened)
        : entries_(opened.ListTarget()) {
        std::erase_if(entries_, [&folder](const auto& entry) {
            return platform::IsTemporaryName(entry.second.name) &&
                   platform::RemoveIfStale(folder / platform::PathFromUtf8(entry.second.name));
        });
    }

    // The existing entry for `name` in any letter case, or nullptr; `folded` is FoldCase(name).
    const platform::FolderCopy::TargetEntry* Find(const std::string& folded) const {
        auto found = entries_.find(folded);
        return found == entries_.end() ? nullptr : &found->second;
    }

private:
    std::unordered_map<std::string, platform::FolderCopy::TargetEntry> entries_;
};

// Creates one folder. Another program (a second apply on the same game) may have created it
// since the caller looked: a folder there now is what was wanted.
Status MakeFolderIfMissing(const fs::path& folder) {
    Status made = platform::MakeDirectory(folder);
    return made || platform::IsDirectory(folder) ? Status::Ok() : made;
}

// A copy that failed because another program replaced the target meanwhile (a second apply of
// the same sets) has nothing left to do when the target now equals its source.
bool ReplacedByAnEqualCopy(const fs::path& source, const fs::path& target) {
    return platform::IsUpToDateCopy(source, target);
}

Status CopyOne(const fs::path& source, const fs::path& target, CopyCount* count) {
    if (platform::IsUpToDateCopy(source, target)) {
        if (count) {
            ++count->upToDate;
        }
        return Status::Ok();
    }
    Status status = platform::ReplaceFile(source, target);
    if (!status && ReplacedByAnEqualCopy(source, target)) {
        status = Status::Ok();
    }
    if (status && count) {
        ++count->copied;
    }
    return status;
}

// One file to copy, and whether the target folder holds its name already.
struct FileJob {
    std::string sourceName;
    std::string targetName;
    bool targetExists = false;
};

// The files of one folder of the tree. Its two folders are opened by the first copy that needs
// them and closed once its last file is done, so that a tree of thousands of folders keeps only
// a few open at a time.
struct FolderJobs {
    fs::path source;
    fs::path target;
    std::vector<FileJob> files;
    bool oneByOne = false;  // two names differ only in letter case: copy them in name order

    std::mutex openMutex;
    std::unique_ptr<platform::FolderCopy> opened;
    std::atomic<int>* keptOpen = nullptr;  // the walk's count, when it left `opened` open
    std::atomic<size_t> left{0};

    platform::FolderCopy& Open() {
        const std::lock_guard lock(openMutex);
        if (!opened) {
            opened = std::make_unique<platform::FolderCopy>(source, target);
        }
        return *opened;
    }
    void Done(size_t files) {
        if (left.fetch_sub(files) == files) {
            const std::lock_guard lock(openMutex);
            opened.reset();
            if (keptOpen) {
                keptOpen->fetch_sub(1);
                keptOpen = nullptr;
            }
        }
    }
};

// A share of the work that one thread takes at a time: a few files of a folder in name order, or
// every file of a folder whose names collide. Shares are numbered in the order the copy has always
// taken: a folder's files in name order, then its subfolders in name order, depth first.
struct Share {
    FolderJobs* folder;
    size_t first;
    size_t count;
};

// Copies a tree. The calling thread walks it (reading each folder once and creating the target's
// folders) and hands out its files as shares; copying threads join as the shares pile up, so the
// first file is copied at once and a tree of a few files needs no thread. On a failure no further
// share is started or folder walked, and the failure of the first share in order among those tried
// is returned; the walk's own failure comes after every share handed out before it.
class TreeCopy {
public:
    Status Run(const fs::path& source, const fs::path& target, CopyCount* count) {
        {
            Walk(source, target);
            const std::lock_guard lock(mutex_);
            walkDone_ = true;
        }
        ready_.notify_all();
        Work();            // the walking thread copies what is left
        helpers_.clear();  // joins them
        if (count) {
            count->copied += copied_;
            count->upToDate += upToDate_;
        }
        return failure_ ? std::move(walkFailure_) : std::move(failure_);
    }

private:
    // A copying thread for every this many files waiting, up to the cores (at most four).
    static constexpr size_t kFilesPerWorker = 32;
    // Files of one folder taken together, so that threads meet at the queue less often.
    static constexpr size_t kFilesPerShare = 8;
    // Folders that the walk leaves open for their copy, at most (two descriptors each).
    static constexpr int kMaxKeptOpen = 64;

    void Walk(const fs::path& source, const fs::path& target) {
        if (stop_.load(std::memory_order_relaxed)) {
            return;
        }
        auto folder = std::make_unique<FolderJobs>();
        folder->source = source;
        folder->target = target;
        // The folders opened to list them serve the copy of their files as well, unless the walk
        // is far ahead of the copy: then they are opened again when their turn comes.
        auto opened = std::make_unique<platform::FolderCopy>(source, target);
        platform::FolderCopy::SourceEntries entries;
        if (Status listed = opened->ListSource(entries); !listed) {
            walkFailure_ = std::move(listed);
            return;
        }
        const FolderIndex index(target, *opened);
        // Two files that would land on one name on a file system that ignores letter case are
        // copied one after the other, so that the last in name order wins as it always has.
        std::unordered_set<std::string> foldedNames;
        folder->files.reserve(entries.files.size());
        for (std::string& name : entries.files) {
            std::string folded = platform::FoldCase(name);
            const auto* existing = index.Find(folded);
            std::string targetName = existing ? existing->name : name;
            folder->oneByOne = !foldedNames.insert(std::move(folded)).second || folder->oneByOne;
            folder->files.push_back({std::move(name), std::move(targetName), existing != nullptr});
        }
        std::sort(folder->files.begin(), folder->files.end(),
                  [](const FileJob& a, const FileJob& b) { return a.sourceName < b.sourceName; });
        std::sort(entries.folders.begin(), entries.folders.end());
        if (!folder->files.empty() && keptOpen_.load() < kMaxKeptOpen) {
            ++keptOpen_;
            folder->opened = std::move(opened);
            folder->keptOpen = &keptOpen_;
        }
        opened.reset();
        HandOut(std::move(folder));
        for (const std::string& name : entries.folders) {
            const auto* existing = index.Find(platform::FoldCase(name));
            const fs::path into = target / platform::PathFromUtf8(existing ? existing->name : name);
            if (!existing || !existing->isFolder) {
                if (Status made = MakeFolderIfMissing(into); !made) {
                    walkFailure_ = std::move(made);
                    return;
                }
            }
            Walk(source / platform::PathFromUtf8(name), into);
            if (!walkFailure_) {
                return;
            }
        }
    }

    void HandOut(std::unique_ptr<FolderJobs> folder) {
        const size_t files = folder->files.size();
        if (files == 0) {
            return;
        }
        folder->left = files;
        size_t waiting = 0;
        {
            const std::lock_guard lock(mutex_);
            if (folder->oneByOne) {
                shares_.push_back({folder.get(), 0, files});
            } else {
                for (size_t i = 0; i < files; i += kFilesPerShare) {
                    shares_.push_back({folder.get(), i, std::min(kFilesPerShare, files - i)});
                }
            }
            waitingFiles_ += files;
            waiting = waitingFiles_;
            folders_.push_back(std::move(folder));
        }
        ready_.notify_all();
        AddHelpers(waiting);
    }

    void AddHelpers(size_t waitingFiles) {
        static const unsigned cores = std::clamp(std::thread::hardware_concurrency(), 1u, 4u);
        // The walking thread copies too once the walk is done, so it counts as one.
        while (helpers_.size() + 1 < cores && waitingFiles / kFilesPerWorker > helpers_.size()) {
            try {
                helpers_.emplace_back([this] { Work(); });
            } catch (const std::system_error&) {
                return;  // no more threads to be had: the ones there are do the work
            }
        }
    }

    // Takes the next share; false when there is none left or the run stopped.
    bool Take(size_t& index, Share& share) {
        std::unique_lock lock(mutex_);
        ready_.wait(lock, [this] {
            return stop_.load(std::memory_order_relaxed) || next_ < shares_.size() || walkDone_;
        });
        if (stop_.load(std::memory_order_relaxed) || next_ >= shares_.size()) {
            return false;
        }
        index = next_++;
        share = shares_[index];
        waitingFiles_ -= share.count;
        return true;
    }

    void Work() {
        size_t index = 0;
        Share share{};
        while (Take(index, share)) {
            platform::FolderCopy& files = share.folder->Open();
            Status status = Status::Ok();
            size_t done = 0;
            for (; done < share.count && status; ++done) {
                const FileJob& job = share.folder->files[share.first + done];
                bool wasCopied = false;
                status = files.Copy(job.sourceName, job.targetName, job.targetExists, &wasCopied);
                if (!status && ReplacedByAnEqualCopy(
                                   share.folder->source / platform::PathFromUtf8(job.sourceName),
                                   share.folder->target / platform::PathFromUtf8(job.targetName))) {
                    status = Status::Ok();
                }
                if (status) {
                    ++(wasCopied ? copied_ : upToDate_);
                }
            }
            if (!status) {
                // The folder stays open; the run ends, and its folders close with it.
                const std::lock_guard lock(mutex_);
                if (index < failedAt_) {
                    failedAt_ = index;
                    failure_ = std::move(status);
                }
                stop_ = true;
                ready_.notify_all();
                return;
            }
            share.folder->Done(done);
        }
    }

    std::mutex mutex_;
    std::condition_variable ready_;
    std::vector<std::unique_ptr<FolderJobs>> folders_;
    std::vector<Share> shares_;
    size_t next_ = 0;
    size_t waitingFiles_ = 0;
    bool walkDone_ = false;
    std::atomic<bool> stop_{false};
    size_t failedAt_ = SIZE_MAX;
    Status failure_ = Status::Ok();
    Status walkFailure_ = Status::Ok();
    std::atomic<int> copied_{0};
    std::atomic<int> upToDate_{0};
    std::atomic<int> keptOpen_{0};
    std::vector<std::jthread> helpers_;  // last: joined before the rest goes
};

Status CopyTree(const fs::path& source, const fs::path& target, CopyCount* count) {
    return TreeCopy().Run(source, target, count);
}

// `path` is missing, or the system refuses it for its length.
Status NotFound(FailedAction action, const fs::path& path) {
    return Status::Fail(
        action, path,
        std::make_error_code(platform::IsTooLong(path) ? std::errc::filename_too_long
                                                       : std::errc::no_such_file_or_directory));
}

}  // namespace

Status MergeCopy(const fs::path& source, const fs::path& target, CopyCount* count) {
    const fs::path from = ResolveCaseInsensitive(source);
    if (!platform::IsDirectory(from)) {
        return NotFound(FailedAction::CopyFrom, from);
    }
    const fs::path into = ResolveCaseInsensitive(target);
    if (!platform::IsDirectory(into)) {
        // The target itself is named: it is the folder that the player knows the step by.
        if (!platform::IsDirectory(into.parent_path())) {
            return NotFound(FailedAction::CopyInto, into);
        }
        if (Status made = MakeFolderIfMissing(into); !made) {
            return made;
        }
    }
    return CopyTree(from, into, count);
}

Status CopyFileInto(const fs::path& file, const fs::path& folder, CopyCount* count) {
    const fs::path from = ResolveCaseInsensitive(file);
    if (!platform::IsRegularFile(from)) {
        return NotFound(FailedAction::CopyFrom, from);
    }
    const fs::path into = ResolveCaseInsensitive(folder);
    if (!platform::IsDirectory(into)) {
        return NotFound(FailedAction::CopyInto, into);
    }
    const fs::path target =
        platform::FindEntryIgnoringCase(into, platform::PathToUtf8(from.filename()))
            .value_or(into / from.filename());
    return CopyOne(from, target, count);
}

Status MakeFolder(const fs::path& folder) {
    const fs::path resolved = ResolveCaseInsensitive(folder);
    std::error_code ec;
    if (fs::exists(resolved, ec)) {
        return Status::Fail(FailedAction::CreateFolder, resolved,
                            std::make_error_code(std::errc::file_exists));
    }
    return platform::MakeDirectory(resolved);
}

bool FolderExists(const fs::path& folder) {
    return platform::IsDirectory(ResolveCaseInsensitive(folder));
}

}  // namespace kickvane::engine
