#include "fixprsr/fieldreport.h"

bool matchesDefinitionTag(const KXWString& definitionTag, const KXWString& readTag) {
    const int32_t start = tagKeyStart(definitionTag);
    return definitionTag.view().substr(start) == readTag.view();
}

void reportFieldFinding(KXValidator& validator, const KXWString& file, const KXWString& tag,
                        const char16_t* finding) {
    KXWString message(u"Field ");
    message += tag;
    message += finding;
    validator.addError(KXVAL_FIELD_ERROR, message, file, -1, -1);
}
