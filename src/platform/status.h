#pragma once

#include <string>
#include <utility>

namespace kickvane {

// The outcome of an operation that can fail: ok, or failed with a reason for the user or the log.
// Errors never cross module boundaries as exceptions; they travel as values of this type.
class [[nodiscard]] Status {
public:
    static Status Ok() { return Status(); }
    static Status Fail(std::string reason) { return Status(std::move(reason)); }

    bool ok() const { return !failed_; }
    explicit operator bool() const { return ok(); }
    const std::string& reason() const { return reason_; }

private:
    Status() = default;
    explicit Status(std::string reason) : failed_(true), reason_(std::move(reason)) {}

    bool failed_ = false;
    std::string reason_;
};

}  // namespace kickvane
