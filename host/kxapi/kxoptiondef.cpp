#include "kxapi/kxoptiondef.h"

KXOptionDef::KXOptionDef(const char16_t* name, const char16_t* alternateName,
                         const char16_t* description, int32_t code, const char* defaultValue,
                         const char16_t* /*text*/, KXGetOption8 get8, KXSetOption8 set8,
                         KXGetOption16 get16, KXSetOption16 set16,
                         const OptionValueDef* /*allowedValues*/, int32_t /*flags*/,
                         const char* /*category*/, const char* /*helpTopic*/, int32_t /*maxLength*/,
                         int32_t /*version*/)
    : name_(name != nullptr ? name : u""),
      alternateName_(alternateName != nullptr ? alternateName : u""),
      description_(description != nullptr ? description : u""),
      code_(code),
      defaultValue_(defaultValue),
      get8_(get8),
      set8_(set8),
      get16_(get16),
      set16_(set16) {}

KXOptionDef::~KXOptionDef() = default;

bool KXOptionDef::isNamed(const char16_t* name) const {
    // An empty name names nothing, also when an option has no alternate name.
    if (name == nullptr || name[0] == 0) return false;
    return !(name_ != name) || !(alternateName_ != name);
}
