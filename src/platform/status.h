#pragma once

#include <filesystem>
#include <string>
#include <system_error>
#include <utility>

namespace kickvane {

// What the tool was doing when an operation failed.
enum class FailedAction {
    Read,          // reading a file
    Write,         // writing a file
    Replace,       // putting a written file in place of the old one
    CreateFolder,  // making a folder
    ReadFolder,    // listing a folder
    CopyFrom,      // finding what to copy
    CopyInto,      // finding the folder to copy into
    Run,           // running a program
    EnterFolder,   // entering a program's working folder
    Other,         // a failure no system call reports; `note` says what
};

// The system's reason for a failure, sorted into the kinds that a player is told about.
enum class FailureCause {
    NoPermission,
    ReadOnlyDisk,
    DiskFull,
    InUse,  // another program holds the file
    NotFound,
    NameTooLong,
    IsFolder,   // a folder where a file should be
    NotFolder,  // a file where a folder should be
    Exists,
    TooLarge,
    DiskError,
    NotText,  // a file that should be text is not
    Other,
};

// A failure as a value: what was being done, on which path, and the system's error code (errno,
// or the Windows error). The words for people come from it at the edge, never from the core.
struct Failure {
    FailedAction action = FailedAction::Other;
    std::filesystem::path path;
    std::error_code code;
    std::string note;  // for FailedAction::Other: what went wrong, in words for the log

    // The kind of the system's reason; Other when there is no code or the code is no known one.
    FailureCause cause() const;
    // English, for logs and tests: "replace /x/y.dds: Permission denied".
    std::string Describe() const;
};

// The cause of a system error code. Each platform knows its own codes; the portable conditions
// of std::errc are known everywhere.
FailureCause ClassifyError(const std::error_code& code);
// The same for the portable conditions only; the backends start from it.
FailureCause ClassifyPortable(const std::error_code& code);

// The error code of the last failed system call (errno, or GetLastError on Windows).
std::error_code LastSystemError();

// The outcome of an operation that can fail: ok, or failed with its Failure.
// Errors never cross module boundaries as exceptions; they travel as values of this type.
class [[nodiscard]] Status {
public:
    static Status Ok() { return Status(); }
    static Status Fail(Failure failure) { return Status(std::move(failure)); }
    static Status Fail(FailedAction action, std::filesystem::path path, std::error_code code) {
        return Status(Failure{action, std::move(path), code, {}});
    }
    // A failure that no system call reports (a value out of range, a broken rule of a format).
    static Status Fail(std::string note) {
        return Status(Failure{FailedAction::Other, {}, {}, std::move(note)});
    }

    bool ok() const { return !failed_; }
    explicit operator bool() const { return ok(); }
    const Failure& failure() const { return failure_; }
    // The failure in English, for logs and tests; empty when ok.
    std::string reason() const { return failed_ ? failure_.Describe() : std::string(); }

private:
    Status() = default;
    explicit Status(Failure failure) : failed_(true), failure_(std::move(failure)) {}

    bool failed_ = false;
    Failure failure_;
};

}  // namespace kickvane
