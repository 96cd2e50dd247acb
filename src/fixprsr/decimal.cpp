#include "fixprsr/decimal.h"

#include <algorithm>
#include <cwctype>
#include <limits>

int64_t leadingDecimal(const KXWString& text) {
    const int32_t length = text.length();
    int32_t i = 0;
    while (i < length && std::iswspace(text[i]) != 0) ++i;
    bool negative = false;
    if (i < length && (text[i] == u'+' || text[i] == u'-')) {
        negative = text[i] == u'-';
        ++i;
    }
    // The magnitude is gathered unsigned, so that the lowest value, whose magnitude has
    // no positive counterpart, is reached without overflow.
    constexpr uint64_t kMax = static_cast<uint64_t>(std::numeric_limits<int64_t>::max());
    const uint64_t limit = negative ? kMax + 1 : kMax;
    uint64_t magnitude = 0;
    for (; i < length && text[i] >= u'0' && text[i] <= u'9'; ++i) {
        const uint64_t digit = static_cast<uint64_t>(text[i] - u'0');
        if (magnitude > (limit - digit) / 10) {
            magnitude = limit;
            break;
        }
        magnitude = magnitude * 10 + digit;
    }
    if (!negative) return static_cast<int64_t>(magnitude);
    return magnitude == 0 ? 0 : -static_cast<int64_t>(magnitude - 1) - 1;
}

int repetitionCount(const KXWString& text) {
    const int64_t value = leadingDecimal(text);
    return static_cast<int>(std::clamp<int64_t>(value, std::numeric_limits<int>::min(),
                                                std::numeric_limits<int>::max()));
}
