#include "game/read_config.h"

#include "platform/filesystem.h"

namespace kickvane::game {

std::optional<std::string> ReadConfigText(const std::filesystem::path& path,
                                          std::uintmax_t maxBytes, SkippedFile& skipped) {
    platform::FileRead read = platform::ReadRegularFile(path, maxBytes);
    using Result = platform::FileRead::Result;
    skipped = SkippedFile{path, SkipReason::Missing, 0, {}, {}};
    switch (read.result) {
        case Result::Read:
            return std::move(read.bytes);
        case Result::Missing:
            break;
        case Result::Folder:
        case Result::NotRegular:
            skipped.reason = SkipReason::NotAFile;
            break;
        case Result::TooLarge:
            skipped.reason = SkipReason::TooLarge;
            skipped.number = maxBytes;
            break;
        case Result::Unreadable:
            skipped.reason = SkipReason::Unreadable;
            skipped.error = read.error;
            break;
    }
    return std::nullopt;
}

}  // namespace kickvane::game
