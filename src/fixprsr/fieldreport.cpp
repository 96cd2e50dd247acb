#include "fixprsr/fieldreport.h"

#include <algorithm>

bool matchesDefinitionTag(const KXWString& definitionTag, const KXWString& readTag) {
    const int32_t start = tagKeyStart(definitionTag);
    const char16_t* key = definitionTag.c_str() + start;
    return definitionTag.length() - start == readTag.length() &&
           std::equal(key, key + readTag.length(), readTag.c_str());
}

void reportFieldFinding(KXValidator& validator, const KXWString& file, const KXWString& tag,
                        const char16_t* finding) {
    KXWString message(u"Field ");
    message += tag;
    message += finding;
    validator.addError(KXVAL_FIELD_ERROR, message, file, -1, -1);
}
