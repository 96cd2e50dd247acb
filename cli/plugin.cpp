#include "plugin.h"

#include <dlfcn.h>

Plugin::Plugin(const std::string& path) {
    handle_ = dlopen(path.c_str(), RTLD_NOW | RTLD_LOCAL);
    if (handle_ == nullptr) {
        const char* why = dlerror();
        error_ = why != nullptr ? why : "cannot load " + path;
        return;
    }
    new_ = reinterpret_cast<KXValidator* (*)()>(dlsym(handle_, "NewValidator"));
    delete_ = reinterpret_cast<void (*)(KXValidator*)>(dlsym(handle_, "DeleteValidator"));
    if (new_ == nullptr || delete_ == nullptr)
        error_ = path + " is not a validator plug-in (NewValidator/DeleteValidator missing)";
}

// The library stays loaded: the XML library it uses keeps process-wide state that is
// never torn down.
Plugin::~Plugin() = default;

Plugin::ValidatorPtr Plugin::newValidator() const {
    return ValidatorPtr(new_ != nullptr ? new_() : nullptr, Deleter{delete_});
}
