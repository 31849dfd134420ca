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

void* Module::Find(const char* name) {
    if (!handle_) {
        return nullptr;  // error_ keeps why the library did not load
    }
    ::dlerror();
    void* address = ::dlsym(handle_, name);
    if (!address) {
        error_ = LastError();
    }
    return address;
}

std::filesystem::path FileHolding(const void* address) {
    Dl_info info{};
    if (::dladdr(address, &info) == 0 || info.dli_fname == nullptr) {
        return {};
    }
    return info.dli_fname;
}

}  // namespace kickvane::platform
