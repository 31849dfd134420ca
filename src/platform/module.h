#pragma once

#include <filesystem>
#include <string>

namespace kickvane::platform {

// A shared library loaded at run time: a part of the program that only some of its commands need,
// so that the others start without loading what it depends on. POSIX builds only.
class Module {
public:
    // Loads `file`; on failure `error()` says why.
    explicit Module(const std::filesystem::path& file);
    ~Module();
    Module(const Module&) = delete;
    Module& operator=(const Module&) = delete;

    bool loaded() const { return handle_ != nullptr; }
    const std::string& error() const { return error_; }

    // The address of the exported symbol `name`, or null (with `error()` set).
    void* Find(const char* name);

private:
    void* handle_ = nullptr;
    std::string error_;
};

}  // namespace kickvane::platform
