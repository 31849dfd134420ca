// System error codes on Windows: GetLastError values in the system category, and the portable
// std::errc values of the C runtime and the standard library elsewhere.
#include <windows.h>

#include "platform/status.h"

namespace kickvane {

FailureCause ClassifyError(const std::error_code& code) {
    if (code.category() != std::system_category()) {
        return ClassifyPortable(code);
    }
    switch (static_cast<DWORD>(code.value())) {
        case ERROR_ACCESS_DENIED:
            return FailureCause::NoPermission;
        case ERROR_WRITE_PROTECT:
            return FailureCause::ReadOnlyDisk;
        case ERROR_DISK_FULL:
        case ERROR_HANDLE_DISK_FULL:
            return FailureCause::DiskFull;
        case ERROR_SHARING_VIOLATION:
        case ERROR_LOCK_VIOLATION:
        case ERROR_USER_MAPPED_FILE:
            return FailureCause::InUse;
        case ERROR_FILE_NOT_FOUND:
        case ERROR_PATH_NOT_FOUND:
            return FailureCause::NotFound;
        case ERROR_FILENAME_EXCED_RANGE:
            return FailureCause::NameTooLong;
        case ERROR_DIRECTORY:
            return FailureCause::NotFolder;
        case ERROR_ALREADY_EXISTS:
        case ERROR_FILE_EXISTS:
            return FailureCause::Exists;
        case ERROR_FILE_TOO_LARGE:
            return FailureCause::TooLarge;
        case ERROR_CRC:
        case ERROR_READ_FAULT:
        case ERROR_WRITE_FAULT:
            return FailureCause::DiskError;
        default:
            return FailureCause::Other;
    }
}

std::error_code LastSystemError() {
    return {static_cast<int>(::GetLastError()), std::system_category()};
}

}  // namespace kickvane
