// Shared libraries loaded at run time through the dynamic linker.
#include <dlfcn.h>

#include "platform/module.h"

namespace kickvane::platform {

namespace {

std::string LastError() {
    const char* text = ::dlerror();
    return text ? text : "unknown error";
}

}  // namespace

Module::Module(const std::filesystem::path& file)
    : handle_(::dlopen(file.c_str(), RTLD_NOW | RTLD_LOCAL)) {
    if (!handle_) {
        error_ = LastError();
    }
}

// The module stays mapped: what it registered with the libraries it uses (Qt's types, say) may be
// looked at again while the process ends.
Module::~Module() = default;

void* Module::Find(const char* name) {
    ::dlerror();
    void* address = handle_ ? ::dlsym(handle_, name) : nullptr;
    if (!address) {
        error_ = LastError();
    }
    return address;
}

}  // namespace kickvane::platform
