#include <algorithm>

#include "fix/kxfixvalidator.h"

namespace {

bool equalsSpan(const KXWString& value, const char16_t* begin, int32_t length) {
    return value.length() == length && std::equal(begin, begin + length, value.c_str());
}

}  // namespace

// Walks the pattern by position instead of shortening a copy: it runs for every field
// that has a pattern.
bool KXFIXValidator::isLike(const KXWString& value, const KXWString& pattern) {
    const char16_t* text = pattern.c_str();
    int32_t start = 0;
    for (int32_t bar = pattern.find(u'|', start); bar > start; bar = pattern.find(u'|', start)) {
        if (equalsSpan(value, text + start, bar - start)) return true;
        start = bar + 1;
    }
    return equalsSpan(value, text + start, pattern.length() - start);
}

BATCHERR KXFIXValidator::checkValidField(const KXWString& pattern, const KXWString& value) {
    return isLike(value, pattern) ? BATCH_OK : BATCH_CHECK_FAILED;
}
