#include "fix/kxfixvalidator.h"

// Validation is not wired up yet: nothing is reported and the call is refused.
BATCHERR KXFIXValidator::Validate(const KXConnTarget& target) {
    sourceName.Assign(target.name, KX_CSET_DEFAULT);
    return BATCH_NOT_PERFORMED;
}
