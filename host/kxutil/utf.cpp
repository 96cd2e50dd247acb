#include "kxutil/utf.h"

#include <cstdint>

namespace kxutil {
namespace {

constexpr char16_t kReplacement = 0xFFFD;

// Decodes one UTF-8 sequence at text[i]; returns its code point or -1 (and advances i
// past the bytes that belong to the bad sequence).
int32_t decodeOne(const unsigned char* text, size_t length, size_t& i) {
    const unsigned char lead = text[i++];
    if (lead < 0x80) return lead;
    int32_t extra;
    int32_t cp;
    int32_t min;
    if ((lead & 0xE0) == 0xC0) {
        extra = 1, cp = lead & 0x1F, min = 0x80;
    } else if ((lead & 0xF0) == 0xE0) {
        extra = 2, cp = lead & 0x0F, min = 0x800;
    } else if ((lead & 0xF8) == 0xF0) {
        extra = 3, cp = lead & 0x07, min = 0x10000;
    } else {
        return -1;
    }
    for (int32_t k = 0; k < extra; ++k) {
        if (i >= length || (text[i] & 0xC0) != 0x80) return -1;
        cp = (cp << 6) | (text[i++] & 0x3F);
    }
    if (cp < min || cp > 0x10FFFF || (cp >= 0xD800 && cp <= 0xDFFF)) return -1;
    return cp;
}

void appendUtf8(int32_t cp, std::string& out) {
    if (cp < 0x80) {
        out += static_cast<char>(cp);
    } else if (cp < 0x800) {
        out += static_cast<char>(0xC0 | (cp >> 6));
        out += static_cast<char>(0x80 | (cp & 0x3F));
    } else if (cp < 0x10000) {
        out += static_cast<char>(0xE0 | (cp >> 12));
        out += static_cast<char>(0x80 | ((cp >> 6) & 0x3F));
        out += static_cast<char>(0x80 | (cp & 0x3F));
    } else {
        out += static_cast<char>(0xF0 | (cp >> 18));
        out += static_cast<char>(0x80 | ((cp >> 12) & 0x3F));
        out += static_cast<char>(0x80 | ((cp >> 6) & 0x3F));
        out += static_cast<char>(0x80 | (cp & 0x3F));
    }
}

}  // namespace

bool toUtf16(const char* text, size_t length, KX_CSET cset, std::u16string& out) {
#if defined(_WIN32)
    if (cset == KX_CSET_DEFAULT) return acpToUtf16(text, length, out);
#endif
    out.clear();
    out.reserve(length);
    const auto* bytes = reinterpret_cast<const unsigned char*>(text);
    if (cset != KX_CSET_DEFAULT) {
        out.assign(bytes, bytes + length);
        return true;
    }
    bool lossless = true;
    for (size_t i = 0; i < length;) {
        const int32_t cp = decodeOne(bytes, length, i);
        if (cp < 0) {
            out += kReplacement;
            lossless = false;
        } else if (cp < 0x10000) {
            out += static_cast<char16_t>(cp);
        } else {
            out += static_cast<char16_t>(0xD800 + ((cp - 0x10000) >> 10));
            out += static_cast<char16_t>(0xDC00 + ((cp - 0x10000) & 0x3FF));
        }
    }
    return lossless;
}

bool fromUtf16(const char16_t* text, size_t length, KX_CSET cset, std::string& out) {
#if defined(_WIN32)
    if (cset == KX_CSET_DEFAULT) return utf16ToAcp(text, length, out);
#endif
    out.clear();
    out.reserve(length);
    bool lossless = true;
    for (size_t i = 0; i < length; ++i) {
        int32_t cp = text[i];
        if (cset != KX_CSET_DEFAULT) {
            lossless &= cp <= 0xFF;
            out += static_cast<char>(cp <= 0xFF ? cp : '?');
            continue;
        }
        if (cp >= 0xD800 && cp <= 0xDBFF && i + 1 < length && text[i + 1] >= 0xDC00 &&
            text[i + 1] <= 0xDFFF) {
            cp = 0x10000 + ((cp - 0xD800) << 10) + (text[++i] - 0xDC00);
        } else if (cp >= 0xD800 && cp <= 0xDFFF) {
            cp = kReplacement;
            lossless = false;
        }
        appendUtf8(cp, out);
    }
    return lossless;
}

}  // namespace kxutil
