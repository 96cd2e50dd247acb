#include "plugin.h"

#if defined(_WIN32)
#include <windows.h>

#include "kxutil/kxwstring.h"
#else
#include <dlfcn.h>
#endif

namespace {

#if defined(_WIN32)
// Hosts look the entry points up by their decorated standard-call names.
constexpr const char* kNewName = "_NewValidator@0";
constexpr const char* kDeleteName = "_DeleteValidator@4";

void* openLibrary(const std::string& path, std::string& error) {
    KXWString wide;
    wide.Assign(path.c_str(), KX_CSET_DEFAULT);
    HMODULE module = LoadLibraryW(reinterpret_cast<const wchar_t*>(wide.c_str()));
    if (module == nullptr)
        error = "cannot load " + path + " (Windows error " + std::to_string(GetLastError()) + ")";
    return reinterpret_cast<void*>(module);
}

void* findSymbol(void* library, const char* name) {
    return reinterpret_cast<void*>(GetProcAddress(static_cast<HMODULE>(library), name));
}
#else
constexpr const char* kNewName = "NewValidator";
constexpr const char* kDeleteName = "DeleteValidator";

void* openLibrary(const std::string& path, std::string& error) {
    void* library = dlopen(path.c_str(), RTLD_NOW | RTLD_LOCAL);
    if (library == nullptr) {
        const char* why = dlerror();
        error = why != nullptr ? why : "cannot load " + path;
    }
    return library;
}

void* findSymbol(void* library, const char* name) {
    return dlsym(library, name);
}
#endif

}  // namespace

Plugin::Plugin(const std::string& path) {
    handle_ = openLibrary(path, error_);
    if (handle_ == nullptr) return;
    new_ = reinterpret_cast<decltype(new_)>(findSymbol(handle_, kNewName));
    delete_ = reinterpret_cast<decltype(delete_)>(findSymbol(handle_, kDeleteName));
    if (new_ == nullptr || delete_ == nullptr)
        error_ = path + " is not a validator plug-in (NewValidator/DeleteValidator missing)";
}

// The library stays loaded: the XML library it uses keeps process-wide state that is
// never torn down.
Plugin::~Plugin() = default;

Plugin::ValidatorPtr Plugin::newValidator() const {
    return ValidatorPtr(new_ != nullptr ? new_() : nullptr, Deleter{delete_});
}
