// Text conversions behind the character sets (internal to kxutil).
#pragma once

#include <cstddef>
#include <string>

#include "kxutil/kxcset.h"

namespace kxutil {

// Both return false when something could not be converted; it is then replaced
// (U+FFFD towards UTF-16, '?' towards 8-bit text).
bool toUtf16(const char* text, size_t length, KX_CSET cset, std::u16string& out);
bool fromUtf16(const char16_t* text, size_t length, KX_CSET cset, std::string& out);

#if defined(_WIN32)
// KX_CSET_DEFAULT there: the ANSI code page (acp.cpp).
bool acpToUtf16(const char* text, size_t length, std::u16string& out);
bool utf16ToAcp(const char16_t* text, size_t length, std::string& out);
#endif

}  // namespace kxutil
