#include "platform/status.h"

namespace kickvane {

namespace {

std::string_view ActionName(FailedAction action) {
    switch (action) {
        case FailedAction::Read:
            return "read";
        case FailedAction::Write:
            return "write";
        case FailedAction::Replace:
            return "replace";
        case FailedAction::CreateFolder:
            return "create folder";
        case FailedAction::ReadFolder:
            return "read folder";
        case FailedAction::CopyFrom:
            return "copy from";
        case FailedAction::CopyInto:
            return "copy into";
        case FailedAction::Run:
            return "run";
        case FailedAction::EnterFolder:
            return "enter folder";
        case FailedAction::Other:
            break;
    }
    return "";
}

}  // namespace

FailureCause Failure::cause() const {
    return code ? ClassifyError(code) : FailureCause::Other;
}

std::string Failure::Describe() const {
    if (action == FailedAction::Other) {
        return note;
    }
    std::string text(ActionName(action));
    if (!path.empty()) {
        text += ' ';
        text += path.string();
    }
    if (code) {
        text += ": " + code.message();
    }
    if (!note.empty()) {
        text += " (" + note + ")";
    }
    return text;
}

// The portable conditions, which every platform's codes may also be compared with.
FailureCause ClassifyPortable(const std::error_code& code) {
    using std::errc;
    const auto is = [&code](auto... conditions) { return ((code == conditions) || ...); };
    if (is(errc::permission_denied, errc::operation_not_permitted)) {
        return FailureCause::NoPermission;
    }
    if (is(errc::read_only_file_system)) {
        return FailureCause::ReadOnlyDisk;
    }
    if (is(errc::no_space_on_device)) {
        return FailureCause::DiskFull;
    }
    if (is(errc::text_file_busy, errc::device_or_resource_busy)) {
        return FailureCause::InUse;
    }
    if (is(errc::no_such_file_or_directory)) {
        return FailureCause::NotFound;
    }
    if (is(errc::filename_too_long)) {
        return FailureCause::NameTooLong;
    }
    if (is(errc::is_a_directory)) {
        return FailureCause::IsFolder;
    }
    if (is(errc::not_a_directory)) {
        return FailureCause::NotFolder;
    }
    if (is(errc::file_exists)) {
        return FailureCause::Exists;
    }
    if (is(errc::file_too_large)) {
        return FailureCause::TooLarge;
    }
    if (is(errc::io_error)) {
        return FailureCause::DiskError;
    }
    if (is(errc::illegal_byte_sequence)) {
        return FailureCause::NotText;
    }
    return FailureCause::Other;
}

}  // namespace kickvane
