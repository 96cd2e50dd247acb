// Description of one option of a validator, with the callbacks that read and write it.
#pragma once

#include <cstdint>

#include "kxapi/batcherr.h"
#include "kxexport.h"
#include "kxutil/kxstring.h"
#include "kxutil/kxwstring.h"

class OptionValueDef;  // allowed values of an option; no validator here uses them

// The first argument is the validator, the last a text the callbacks may ignore.
using KXGetOption8 = BATCHERR (*)(void* object, KXString& result, const char16_t* text);
using KXSetOption8 = BATCHERR (*)(void* object, const char* value, bool& changed,
                                  const char16_t* text);
using KXGetOption16 = BATCHERR (*)(void* object, KXWString& result, const char16_t* text);
using KXSetOption16 = BATCHERR (*)(void* object, const char16_t* value, bool& changed,
                                   const char16_t* text);

// The arguments after the callbacks (allowed values, flags, category, help topic, maximum
// length, version) are accepted for the host interface; this host has no use for them.
class KXAPI_API KXOptionDef {
  public:
    KXOptionDef(const char16_t* name, const char16_t* alternateName, const char16_t* description,
                int32_t code, const char* defaultValue, const char16_t* text, KXGetOption8 get8,
                KXSetOption8 set8, KXGetOption16 get16, KXSetOption16 set16,
                const OptionValueDef* allowedValues, int32_t flags, const char* category,
                const char* helpTopic, int32_t maxLength, int32_t version);
    KXOptionDef(const KXOptionDef&) = delete;
    KXOptionDef& operator=(const KXOptionDef&) = delete;
    virtual ~KXOptionDef();

    // Either name, compared exactly.
    bool isNamed(const char16_t* name) const;

    const KXWString& name() const { return name_; }
    const KXWString& alternateName() const { return alternateName_; }
    const KXWString& description() const { return description_; }
    int32_t code() const { return code_; }
    const KXString& defaultValue() const { return defaultValue_; }
    KXGetOption8 get8() const { return get8_; }
    KXSetOption8 set8() const { return set8_; }
    KXGetOption16 get16() const { return get16_; }
    KXSetOption16 set16() const { return set16_; }

  private:
    KXWString name_;
    KXWString alternateName_;
    KXWString description_;
    int32_t code_;
    KXString defaultValue_;
    KXGetOption8 get8_;
    KXSetOption8 set8_;
    KXGetOption16 get16_;
    KXSetOption16 set16_;
};
