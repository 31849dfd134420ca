#include "game/read_config.h"

#include "platform/filesystem.h"

namespace kickvane::game {

std::optional<std::string> ReadConfigText(const std::filesystem::path& path,
                                          std::uintmax_t maxBytes, std::string& problem) {
    platform::FileRead read = platform::ReadRegularFile(path, maxBytes);
    using Result = platform::FileRead::Result;
    switch (read.result) {
        case Result::Read:
            return std::move(read.bytes);
        case Result::Missing:
            problem = "missing";
            break;
        case Result::Folder:
        case Result::NotRegular:
            problem = "not a readable file";
            break;
        case Result::TooLarge:
            problem = "too large (over " + std::to_string(maxBytes) + " bytes)";
            break;
        case Result::Unreadable:
            problem = "cannot read: " + read.error.message();
            break;
    }
    return std::nullopt;
}

}  // namespace kickvane::game
