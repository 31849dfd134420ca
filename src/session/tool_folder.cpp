#include "session/tool_folder.h"

#include <fstream>
#include <random>
#include <system_error>

#include "platform/filesystem.h"

namespace kickvane::session {

namespace {

// Copies the file or tree `from` to `to`, leaving every file that exists in `to` untouched.
Status CopyMissing(const fs::path& from, const fs::path& to) {
    std::error_code error;
    if (!fs::is_directory(from, error)) {
        if (fs::exists(to, error)) {
            return Status::Ok();
        }
        return platform::ReplaceFile(from, to);
    }
    fs::create_directories(to, error);
    if (error) {
        return Status::Fail(FailedAction::CreateFolder, to, error);
    }
    fs::directory_iterator entries(from, error);
    for (; !error && entries != fs::directory_iterator(); entries.increment(error)) {
        if (Status copied = CopyMissing(entries->path(), to / entries->path().filename());
            !copied) {
            return copied;
        }
    }
    if (error) {
        return Status::Fail(FailedAction::ReadFolder, from, error);
    }
    return Status::Ok();
}

}  // namespace

bool IsWritableFolder(const fs::path& folder) {
    std::random_device random;
    const fs::path probe = folder / (".kickvane-write-test-" + std::to_string(random()));
    {
        std::ofstream out(probe, std::ios::binary);
        if (!out) {
            return false;
        }
    }
    std::error_code error;
    fs::remove(probe, error);
    return true;
}

ToolFolderChoice ChooseToolFolder(const fs::path& programFolder, const fs::path& userDataHome,
                                  const WritableTest& isWritable) {
    const bool setsBeside = platform::IsDirectory(programFolder / "data");
    if (setsBeside && isWritable(programFolder)) {
        return {programFolder, {}};
    }
    const fs::path userFolder = userDataHome / "kickvane";
    if (setsBeside) {
        return {userFolder, programFolder};
    }
    const fs::path installed = (programFolder / ".." / "share" / "kickvane").lexically_normal();
    if (platform::IsDirectory(installed / "data")) {
        return {userFolder, installed};
    }
    return {programFolder, {}};
}

Status SeedToolFolder(const fs::path& from, const fs::path& to) {
    std::error_code error;
    if (fs::exists(to / kSeededMark, error)) {
        return Status::Ok();
    }
    fs::create_directories(to, error);
    if (error) {
        return Status::Fail(FailedAction::CreateFolder, to, error);
    }
    for (const char* item : kSeededItems) {
        if (!fs::exists(from / item, error)) {
            continue;
        }
        if (Status copied = CopyMissing(from / item, to / item); !copied) {
            return copied;
        }
    }
    return platform::WriteFileAtomically(to / kSeededMark, "");
}

}  // namespace kickvane::session
