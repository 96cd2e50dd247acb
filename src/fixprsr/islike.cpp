#include "fix/kxfixvalidator.h"
#include "schema/valuepattern.h"

// The walk matches against each definition's pattern, split once when the schema was
// read; this answers the same for any pattern.
bool KXFIXValidator::isLike(const KXWString& value, const KXWString& pattern) {
    ValuePattern alternatives;
    alternatives.assign(pattern.view());
    return alternatives.matches(value.view());
}

BATCHERR KXFIXValidator::checkValidField(const KXWString& pattern, const KXWString& value) {
    return isLike(value, pattern) ? BATCH_OK : BATCH_CHECK_FAILED;
}
