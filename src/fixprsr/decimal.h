// Decimal numbers read from field values the way the C library's wcstol reads them, but
// saturating instead of overflowing.
#pragma once

#include <cstdint>

#include "kxutil/kxwstring.h"

// Leading white space skipped, optional sign, digits up to the first non-digit; no digits
// gives 0. Values beyond the 64-bit range give its nearest bound.
int64_t leadingDecimal(const KXWString& text);

// A group's count, clamped to the range of int.
int repetitionCount(const KXWString& text);
