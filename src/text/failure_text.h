#pragma once

#include <filesystem>
#include <string>

#include "platform/status.h"

// The one table that turns a failure into words for the player, in Vietnamese. The window and
// the command line both show failures through it.
namespace kickvane::text {

// The folders that paths are shown relative to: a path inside one of them is shown from there.
struct ShownFolders {
    std::filesystem::path game;
    std::filesystem::path tool;
};

// `path` as the player reads it: relative to the game folder or the tool folder when it lies
// inside one (the deeper of the two when both hold it), its names joined by backslashes as the
// game's Windows folders are written; any other path as the system writes it.
std::string ShownPath(const std::filesystem::path& path, const ShownFolders& folders);

// Why it failed: "không có quyền ghi", "ổ đĩa đã đầy", "lỗi hệ thống (mã 71)".
std::string CauseText(const Failure& failure, const ShownFolders& folders);

// What failed, where and why:
// "không chép được vào zdata\data2\crowd\textures: trò chơi không có thư mục này".
std::string FailureText(const Failure& failure, const ShownFolders& folders);

// `text` with its first letter in capitals, to start a sentence (the texts above start in
// small letters, to follow a label).
std::string Capitalised(std::string text);

}  // namespace kickvane::text
