#pragma once

#include <filesystem>
#include <string>

namespace kickvane::platform {

// A shared library loaded at run time: a part of the program that only some of its commands need,
// so that the others start without loading what it depends on. POSIX builds only. The library
// stays loaded for the rest of the process: what it registered with the libraries it uses (Qt's
// types, say) may be looked at again while the process ends.
class Module {
public:
    // Loads `file`; on failure Find finds nothing and `error()` says why.
    explicit Module(const std::filesystem::path& file);
    Module(const Module&) = delete;
    Module& operator=(const Module&) = delete;

    const std::string& error() const { return error_; }

    // The address of the exported symbol `name`, or null (with `error()` set).
    void* Find(const char* name);

private:
    void* handle_ = nullptr;
    std::string error_;
};

// The file of the program or shared library that holds `address` (code or data of its own);
// empty when the system cannot tell.
std::filesystem::path FileHolding(const void* address);

}  // namespace kickvane::platform
