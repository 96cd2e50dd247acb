// A validator plug-in loaded the way a host loads it, and the validators it makes.
#pragma once

#include <memory>
#include <string>

#include "kxapi/kxvalidator.h"

class Plugin {
  public:
    // Empty error() when loaded.
    explicit Plugin(const std::string& path);
    Plugin(const Plugin&) = delete;
    Plugin& operator=(const Plugin&) = delete;
    ~Plugin();

    const std::string& error() const { return error_; }

    struct Deleter {
        void(KX_STDCALL* destroy)(KXValidator*);
        void operator()(KXValidator* v) const { destroy(v); }
    };
    using ValidatorPtr = std::unique_ptr<KXValidator, Deleter>;
    // Null when the plug-in cannot make one.
    ValidatorPtr newValidator() const;

  private:
    void* handle_ = nullptr;
    KXValidator*(KX_STDCALL* new_)() = nullptr;
    void(KX_STDCALL* delete_)(KXValidator*) = nullptr;
    std::string error_;
};
