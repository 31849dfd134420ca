// System error codes on POSIX systems: errno values, which std::errc names.
#include <cerrno>

#include "platform/status.h"

namespace kickvane {

FailureCause ClassifyError(const std::error_code& code) {
    return ClassifyPortable(code);
}

std::error_code LastSystemError() {
    return {errno, std::system_category()};
}

}  // namespace kickvane
