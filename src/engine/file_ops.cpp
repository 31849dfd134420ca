#include "engine/file_ops.h"

#include <algorithm>
#include <atomic>
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
    explicit FolderIndex(const fs::path& folder) : names_(platform::EntriesByFoldedName(folder)) {
        std::erase_if(names_, [&folder](const auto& entry) {
            return platform::IsTemporaryName(entry.second) &&
                   platform::RemoveIfStale(folder / entry.second);
        });
    }

    // The name of the existing entry for `name` in any letter case, else `name` as given, and
    // whether there was one; `folded` is FoldCase(name) where the caller has it already.
    std::pair<std::string, bool> Name(const std::string& name, const std::string& folded) const {
        auto found = names_.find(folded);
        return found == names_.end() ? std::pair{name, false} : std::pair{found->second, true};
    }
    std::pair<std::string, bool> Name(const std::string& name) const {
        return Name(name, platform::FoldCase(name));
    }

private:
    std::unordered_map<std::string, std::string> names_;
};

Status CopyOne(const fs::path& source, const fs::path& target, CopyCount* count) {
    if (platform::IsUpToDateCopy(source, target)) {
        if (count) {
            ++count->upToDate;
        }
        return Status::Ok();
    }
    Status status = platform::ReplaceFile(source, target);
    if (status && count) {
        ++count->copied;
    }
    return status;
}

// One file of a folder to copy, and whether the target folder holds its name already.
struct FileJob {
    std::string sourceName;
    std::string targetName;
    bool targetExists = false;
};

// How many files of one folder are copied at once. A copy is mostly the kernel's work, which runs
// on as many cores as there are copies under way; a folder of a few files is not worth a thread.
unsigned CopyWorkers(size_t files) {
    constexpr size_t kFilesPerWorker = 32;
    const unsigned cores = std::clamp(std::thread::hardware_concurrency(), 1u, 4u);
    return static_cast<unsigned>(std::clamp<size_t>(files / kFilesPerWorker, 1, cores));
}

// Copies the files of one folder, several at once where there are many. On a failure no further
// file is started, and the failure of the first file in name order among those tried is returned.
Status CopyFiles(platform::FolderCopy& files, const std::vector<FileJob>& jobs, bool oneByOne,
                 CopyCount* count) {
    std::atomic<size_t> next{0};
    std::atomic<bool> stop{false};
    std::atomic<int> copied{0};
    std::atomic<int> upToDate{0};
    std::mutex failureMutex;
    size_t failedAt = jobs.size();
    Status failure = Status::Ok();
    const auto work = [&] {
        while (!stop.load(std::memory_order_relaxed)) {
            const size_t i = next.fetch_add(1, std::memory_order_relaxed);
            if (i >= jobs.size()) {
                return;
            }
            bool wasCopied = false;
            Status status = files.Copy(jobs[i].sourceName, jobs[i].targetName, jobs[i].targetExists,
                                       &wasCopied);
            if (!status) {
                const std::lock_guard lock(failureMutex);
                if (i < failedAt) {
                    failedAt = i;
                    failure = std::move(status);
                }
                stop = true;
                return;
            }
            ++(wasCopied ? copied : upToDate);
        }
    };
    {
        const unsigned workers = oneByOne ? 1 : CopyWorkers(jobs.size());
        std::vector<std::jthread> helpers;
        try {
            while (helpers.size() + 1 < workers) {
                helpers.emplace_back(work);
            }
        } catch (const std::system_error&) {
            // No more threads to be had: the ones there are do the work.
        }
        work();
    }  // the helpers are joined here
    if (count) {
        count->copied += copied;
        count->upToDate += upToDate;
    }
    return failure;
}

Status CopyTree(const fs::path& source, const fs::path& target, CopyCount* count) {
    std::vector<FileJob> jobs;
    std::vector<std::string> folders;
    // Two files that would land on one name on a file system that ignores letter case are
    // copied one after the other, so that the last in name order wins as it always has.
    std::unordered_set<std::string> foldedNames;
    bool namesCollide = false;
    std::error_code ec;
    const FolderIndex index(target);
    for (fs::directory_iterator it(source, ec), end; !ec && it != end; it.increment(ec)) {
        std::string name = it->path().filename().string();
        std::error_code typeError;
        if (it->is_directory(typeError)) {
            folders.push_back(std::move(name));
            continue;
        }
        std::string folded = platform::FoldCase(name);
        auto [targetName, exists] = index.Name(name, folded);
        namesCollide = !foldedNames.insert(std::move(folded)).second || namesCollide;
        jobs.push_back({std::move(name), std::move(targetName), exists});
    }
    if (ec) {
        return Status::Fail(FailedAction::ReadFolder, source, ec);
    }
    std::sort(jobs.begin(), jobs.end(),
              [](const FileJob& a, const FileJob& b) { return a.sourceName < b.sourceName; });
    std::sort(folders.begin(), folders.end());
    {
        platform::FolderCopy files(source, target);  // both folders opened once for all files
        if (Status copied = CopyFiles(files, jobs, namesCollide, count); !copied) {
            return copied;
        }
    }
    for (const std::string& name : folders) {
        const auto [targetName, exists] = index.Name(name);
        const fs::path into = target / platform::PathFromUtf8(targetName);
        if (!exists || !platform::IsDirectory(into)) {
            if (Status made = platform::MakeDirectory(into); !made) {
                return made;
            }
        }
        if (Status copied = CopyTree(source / platform::PathFromUtf8(name), into, count); !copied) {
            return copied;
        }
    }
    return Status::Ok();
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
        if (Status made = platform::MakeDirectory(into); !made) {
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
    const fs::path target = platform::FindEntryIgnoringCase(into, from.filename().string())
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
