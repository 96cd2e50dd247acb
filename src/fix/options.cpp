#include "fix/options.h"

#include "fix/kxfixvalidator.h"
#include "kxutil/kxglob.h"

namespace {

KXFIXValidator& validatorOf(void* object) {
    return *static_cast<KXFIXValidator*>(object);
}

const KXOptionDef schemaFileOptionDef(u"schemafile", u"SchemaFile", u"A Schema Specification File",
                                      5, "", u"", nullptr, nullptr, getSchemaFileOption,
                                      setSchemaFileOption, nullptr, 0, nullptr, nullptr, 65535, 1);
const KXOptionDef unicodeOptionDef(u"Unicode", u"Unicode", u"Is IDoc file Unicode encoded?", 0,
                                   "False", u"", getUnicodeOption, setUnicodeOption, nullptr,
                                   nullptr, nullptr, 0, nullptr, nullptr, 65535, 1);

}  // namespace

const KXOptionDef* const optionDefs[kfixOptionCount + 1] = {&schemaFileOptionDef, &unicodeOptionDef,
                                                            nullptr};

BATCHERR getUnicodeOption(void* object, KXString& result, const char16_t* /*text*/) {
    result = KXGlob::BoolToStr(validatorOf(object).Unicode());
    return BATCH_OK;
}

BATCHERR setUnicodeOption(void* object, const char* value, bool& changed,
                          const char16_t* /*text*/) {
    validatorOf(object).Unicode(KXGlob::StrToBool(value, "True.False.true.false"));
    changed = true;
    return BATCH_OK;
}

BATCHERR getSchemaFileOption(void* object, KXWString& result, const char16_t* /*text*/) {
    result = validatorOf(object).SchemaFile();
    return BATCH_OK;
}

BATCHERR setSchemaFileOption(void* object, const char16_t* value, bool& changed,
                             const char16_t* /*text*/) {
    validatorOf(object).SchemaFile(value != nullptr ? value : u"");
    changed = true;
    return BATCH_OK;
}
