#include "engine/file_ops.h"

#include <algorithm>
#include <unordered_map>
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
    // whether there was one.
    std::pair<std::string, bool> Name(const std::string& name) const {
        auto found = names_.find(platform::FoldCase(name));
        return found == names_.end() ? std::pair{name, false} : std::pair{found->second, true};
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

Status CopyTree(const fs::path& source, const fs::path& target, CopyCount* count) {
    std::vector<fs::directory_entry> entries;
    std::error_code ec;
    for (fs::directory_iterator it(source, ec), end; !ec && it != end; it.increment(ec)) {
        entries.push_back(*it);
    }
    if (ec) {
        return Status::Fail("cannot read folder " + source.string() + ": " + ec.message());
    }
    std::sort(entries.begin(), entries.end());
    const FolderIndex index(target);
    platform::FolderCopy files(source, target);  // both folders opened once for all files
    for (const fs::directory_entry& entry : entries) {
        const std::string name = entry.path().filename().string();
        const auto [targetName, exists] = index.Name(name);
        std::error_code typeError;
        if (entry.is_directory(typeError)) {
            const fs::path into = target / platform::PathFromUtf8(targetName);
            if (!exists || !platform::IsDirectory(into)) {
                if (Status made = platform::MakeDirectory(into); !made) {
                    return made;
                }
            }
            if (Status copied = CopyTree(entry.path(), into, count); !copied) {
                return copied;
            }
            continue;
        }
        bool copied = false;
        if (Status status = files.Copy(name, targetName, exists, &copied); !status) {
            return status;
        }
        if (count) {
            ++(copied ? count->copied : count->upToDate);
        }
    }
    return Status::Ok();
}

// "not found", or "too long" when the system refuses the path for its length.
Status NotFound(std::string_view what, const fs::path& path) {
    return Status::Fail(std::string(what) +
                        (platform::IsTooLong(path) ? " path too long: " : " not found: ") +
                        path.string());
}

}  // namespace

Status MergeCopy(const fs::path& source, const fs::path& target, CopyCount* count) {
    const fs::path from = ResolveCaseInsensitive(source);
    if (!platform::IsDirectory(from)) {
        return NotFound("source folder", from);
    }
    const fs::path into = ResolveCaseInsensitive(target);
    if (!platform::IsDirectory(into)) {
        if (!platform::IsDirectory(into.parent_path())) {
            return NotFound("target's parent folder", into.parent_path());
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
        return NotFound("file", from);
    }
    const fs::path into = ResolveCaseInsensitive(folder);
    if (!platform::IsDirectory(into)) {
        return NotFound("folder", into);
    }
    const fs::path target = platform::FindEntryIgnoringCase(into, from.filename().string())
                                .value_or(into / from.filename());
    return CopyOne(from, target, count);
}

Status MakeFolder(const fs::path& folder) {
    const fs::path resolved = ResolveCaseInsensitive(folder);
    std::error_code ec;
    if (fs::exists(resolved, ec)) {
        return Status::Fail("folder exists already: " + resolved.string());
    }
    return platform::MakeDirectory(resolved);
}

bool FolderExists(const fs::path& folder) {
    return platform::IsDirectory(ResolveCaseInsensitive(folder));
}

bool FileExists(const fs::path& file) {
    return platform::IsRegularFile(ResolveCaseInsensitive(file));
}

}  // namespace kickvane::engine
