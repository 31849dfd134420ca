#include "text/failure_text.h"

#include <optional>
#include <vector>

#include "platform/filesystem.h"
#include "platform/text.h"

namespace kickvane::text {

namespace {

namespace fs = std::filesystem;

// The names of `path` below `folder`, compared without regard to letter case as the game's
// folders are; nullopt when `path` is not inside `folder`.
std::optional<std::vector<std::string>> NamesBelow(const fs::path& path, const fs::path& folder) {
    if (folder.empty() || !path.is_absolute()) {
        return std::nullopt;
    }
    const fs::path whole = path.lexically_normal();
    const fs::path base = folder.lexically_normal();
    auto at = whole.begin();
    for (const fs::path& name : base) {
        if (name.empty()) {
            continue;  // the empty name after a trailing separator
        }
        if (at == whole.end() || platform::FoldCase(platform::PathToUtf8(*at)) !=
                                     platform::FoldCase(platform::PathToUtf8(name))) {
            return std::nullopt;
        }
        ++at;
    }
    std::vector<std::string> names;
    for (; at != whole.end(); ++at) {
        if (!at->empty()) {
            names.push_back(platform::PathToUtf8(*at));
        }
    }
    return names;
}

bool IsInside(const fs::path& path, const fs::path& folder) {
    const auto names = NamesBelow(path, folder);
    return names && !names->empty();
}

bool Reads(FailedAction action) {
    return action == FailedAction::Read || action == FailedAction::ReadFolder ||
           action == FailedAction::CopyFrom || action == FailedAction::EnterFolder;
}

}  // namespace

std::string ShownPath(const fs::path& path, const ShownFolders& folders) {
    auto inGame = NamesBelow(path, folders.game);
    auto inTool = NamesBelow(path, folders.tool);
    if (inGame && inTool) {
        // Both hold it: the deeper folder leaves the shorter path.
        (inGame->size() <= inTool->size() ? inTool : inGame).reset();
    }
    const auto& names = inGame ? inGame : inTool;
    if (!names || names->empty()) {
        return platform::PathToUtf8(path);
    }
    std::string shown;
    for (const std::string& name : *names) {
        if (!shown.empty()) {
            shown += '\\';
        }
        shown += name;
    }
    return shown;
}

std::string CauseText(const Failure& failure, const ShownFolders& folders) {
    switch (failure.cause()) {
        case FailureCause::NoPermission:
            if (failure.action == FailedAction::Run) {
                return "không có quyền chạy";
            }
            return Reads(failure.action) ? "không có quyền đọc" : "không có quyền ghi";
        case FailureCause::ReadOnlyDisk:
            return "ổ đĩa chỉ cho đọc";
        case FailureCause::DiskFull:
            return "ổ đĩa đã đầy";
        case FailureCause::InUse:
            return "file đang được chương trình khác dùng (có thể là trò chơi)";
        case FailureCause::NotFound:
            if (failure.action == FailedAction::CopyInto && IsInside(failure.path, folders.game)) {
                return "trò chơi không có thư mục này";
            }
            return "không tìm thấy";
        case FailureCause::NameTooLong:
            return "tên quá dài";
        case FailureCause::IsFolder:
            return "ở đó là một thư mục, không phải file";
        case FailureCause::NotFolder:
            return "ở đó là một file, không phải thư mục";
        case FailureCause::Exists:
            return "đã có một file hay thư mục cùng tên";
        case FailureCause::TooLarge:
            return "file quá lớn";
        case FailureCause::DiskError:
            return "lỗi đọc ghi ổ đĩa";
        case FailureCause::NotText:
            return "không phải văn bản";
        case FailureCause::Other:
            break;
    }
    if (failure.code) {
        return "lỗi hệ thống (mã " + std::to_string(failure.code.value()) + ")";
    }
    return "lỗi hệ thống";
}

std::string FailureText(const Failure& failure, const ShownFolders& folders) {
    std::string what;
    switch (failure.action) {
        case FailedAction::Read:
            what = "không đọc được ";
            break;
        case FailedAction::Write:
            what = "không ghi được ";
            break;
        case FailedAction::Replace:
            what = "không thay được ";
            break;
        case FailedAction::CreateFolder:
            what = "không tạo được thư mục ";
            break;
        case FailedAction::ReadFolder:
            what = "không đọc được thư mục ";
            break;
        case FailedAction::CopyFrom:
            what = "không chép được từ ";
            break;
        case FailedAction::CopyInto:
            what = "không chép được vào ";
            break;
        case FailedAction::Run:
            what = "không chạy được ";
            break;
        case FailedAction::EnterFolder:
            what = "không vào được thư mục ";
            break;
        case FailedAction::Other:
            // Words the lower layer chose itself for a failure no system code describes.
            return failure.note.empty() ? CauseText(failure, folders) : failure.note;
    }
    return what + ShownPath(failure.path, folders) + ": " + CauseText(failure, folders);
}

std::string Capitalised(std::string text) {
    if (!text.empty() && text[0] >= 'a' && text[0] <= 'z') {
        text[0] = static_cast<char>(text[0] - 'a' + 'A');
    }
    return text;
}

}  // namespace kickvane::text
