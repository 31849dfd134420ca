#pragma once

#include <filesystem>

#include "platform/status.h"

// The copy operations of the patch plan. Paths may be spelled in any letter case: each one is
// matched to what exists, as on the game's own file system.
namespace kickvane::engine {

namespace fs = std::filesystem;

struct CopyCount {
    int copied = 0;    // files written
    int upToDate = 0;  // files left alone because the target already equals the source
};

// Copies every file and subfolder of `source` into `target`, recursively. `target` is created when
// missing, but not its parent. Files in `target` are replaced; files that exist only there stay.
// Fails when `source` is missing, when the parent of `target` is missing, or at the first file
// that cannot be written (no further file is started; what was copied stays). A file whose size
// and modification time already equal its source's is not copied again. The files of a large
// folder are copied several at once.
Status MergeCopy(const fs::path& source, const fs::path& target, CopyCount* count = nullptr);

// Copies one file into an existing folder under its own name, replacing a file of that name.
Status CopyFileInto(const fs::path& file, const fs::path& folder, CopyCount* count = nullptr);

// Creates one folder; fails when it exists already or its parent is missing.
Status MakeFolder(const fs::path& folder);

bool FolderExists(const fs::path& folder);

}  // namespace kickvane::engine
