// Character set 0 on Windows: 8-bit paths and names are in the ANSI code page, converted
// by the system's own rules, so that they name the files every other program names.
#include <windows.h>

#include <climits>

#include "kxutil/utf.h"

namespace kxutil {

bool acpToUtf16(const char* text, size_t length, std::u16string& out) {
    out.clear();
    if (length == 0) return true;
    if (length > INT_MAX) return false;
    const int n = static_cast<int>(length);
    // Strict first, so that a byte the code page does not define is reported as a loss.
    DWORD flags = MB_ERR_INVALID_CHARS;
    int size = MultiByteToWideChar(CP_ACP, flags, text, n, nullptr, 0);
    const bool lossless = size > 0;
    if (!lossless) {
        flags = 0;
        size = MultiByteToWideChar(CP_ACP, flags, text, n, nullptr, 0);
        if (size <= 0) return false;
    }
    out.resize(static_cast<size_t>(size));
    MultiByteToWideChar(CP_ACP, flags, text, n, reinterpret_cast<wchar_t*>(out.data()), size);
    return lossless;
}

bool utf16ToAcp(const char16_t* text, size_t length, std::string& out) {
    out.clear();
    if (length == 0) return true;
    if (length > INT_MAX) return false;
    const auto* wide = reinterpret_cast<const wchar_t*>(text);
    const int n = static_cast<int>(length);
    // No best fit: a path must not silently turn into the name of another file. A UTF-8
    // code page takes no default character and reports invalid input instead.
    const bool utf8 = GetACP() == CP_UTF8;
    DWORD flags = utf8 ? WC_ERR_INVALID_CHARS : WC_NO_BEST_FIT_CHARS;
    const char* fallback = utf8 ? nullptr : "?";
    BOOL usedDefault = FALSE;
    BOOL* used = utf8 ? nullptr : &usedDefault;
    int size = WideCharToMultiByte(CP_ACP, flags, wide, n, nullptr, 0, fallback, used);
    const bool valid = size > 0;
    if (!valid) {  // a lone surrogate towards UTF-8: convert what can be converted
        flags = 0;
        size = WideCharToMultiByte(CP_ACP, flags, wide, n, nullptr, 0, nullptr, nullptr);
        if (size <= 0) return false;
    }
    out.resize(static_cast<size_t>(size));
    WideCharToMultiByte(CP_ACP, flags, wide, n, out.data(), size, valid ? fallback : nullptr,
                        valid ? used : nullptr);
    return valid && usedDefault == FALSE;
}

}  // namespace kxutil
