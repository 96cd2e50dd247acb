#include "fixprsr/fieldreport.h"

void reportFieldFinding(KXValidator& validator, const KXWString& file, const KXWString& tag,
                        const char16_t* finding) {
    KXWString message(u"Field ");
    message += tag;
    message += finding;
    validator.addError(KXVAL_FIELD_ERROR, message, file, -1, -1);
}
