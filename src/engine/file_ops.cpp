#include "engine/file_ops.h"

#include <algorithm>
#include <unordered_map>
#include <vector>

#include "platform/filesystem.h"

namespace kickvane::engine {

namespace {

using platform::ResolveCaseInsensitive;

// The entries of a target folder by their case-folded name, read once per folder so that a
// merge of many files does not scan the folder for each of them.
class FolderIndex {
public:
    explicit FolderIndex(const fs::path& folder) : folder_(folder) {
        std::error_code ec;
        for (fs::directory_iterator it(folder, ec), end; !ec && it != end; it.increment(ec)) {
            const std::string name = it->path().filename().string();
            auto [pos, inserted] = names_.emplace(platform::FoldCase(name), name);
            if (!inserted && name < pos->second) {
                pos->second = name;  // Same rule as the single lookup: first in name order.
            }
        }
    }

    // The existing entry for `name` in any letter case, else `name` as given.
    fs::path Entry(const std::string& name) const {
        auto found = names_.find(platform::FoldCase(name));
        return folder_ / platform::PathFromUtf8(found == names_.end() ? name : found->second);
    }

private:
    fs::path folder_;
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
    for (const fs::directory_entry& entry : entries) {
        const fs::path into = index.Entry(entry.path().filename().string());
        std::error_code typeError;
        if (entry.is_directory(typeError)) {
            if (!platform::IsDirectory(into)) {
                if (Status made = platform::MakeDirectory(into); !made) {
                    return made;
                }
            }
            if (Status copied = CopyTree(entry.path(), into, count); !copied) {
                return copied;
            }
        } else if (Status copied = CopyOne(entry.path(), into, count); !copied) {
            return copied;
        }
    }
    return Status::Ok();
}

}  // namespace

Status MergeCopy(const fs::path& source, const fs::path& target, CopyCount* count) {
    const fs::path from = ResolveCaseInsensitive(source);
    if (!platform::IsDirectory(from)) {
        return Status::Fail("source folder not found: " + source.string());
    }
    const fs::path into = ResolveCaseInsensitive(target);
    if (!platform::IsDirectory(into)) {
        if (!platform::IsDirectory(into.parent_path())) {
            return Status::Fail("target's parent folder not found: " + target.string());
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
        return Status::Fail("file not found: " + file.string());
    }
    const fs::path into = ResolveCaseInsensitive(folder);
    if (!platform::IsDirectory(into)) {
        return Status::Fail("folder not found: " + folder.string());
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
