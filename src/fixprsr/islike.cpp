#include <algorithm>
#include <string_view>

#include "fix/kxfixvalidator.h"

// Walks the pattern by position instead of shortening a copy: it runs for every field
// that has a pattern. The alternatives end at the first empty one, whose "|" then
// belongs to the last alternative with the rest of the pattern.
bool KXFIXValidator::isLike(const KXWString& value, const KXWString& pattern) {
    const std::u16string_view wanted = value.view();
    const char16_t* start = pattern.c_str();
    const char16_t* const end = start + pattern.length();
    for (;;) {
        const char16_t* const bar = std::find(start, end, u'|');
        if (bar == end || bar == start) return wanted == std::u16string_view(start, end - start);
        if (wanted == std::u16string_view(start, bar - start)) return true;
        start = bar + 1;
    }
}

BATCHERR KXFIXValidator::checkValidField(const KXWString& pattern, const KXWString& value) {
    return isLike(value, pattern) ? BATCH_OK : BATCH_CHECK_FAILED;
}
