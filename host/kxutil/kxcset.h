// Character sets of conversions and files.
#pragma once

#include <cstdint>

enum KX_CSET : int32_t {
    KX_CSET_DEFAULT = 0,  // paths and names: UTF-8 (the ANSI code page on Windows) <-> UTF-16
    KX_CSET_BYTE = 1,     // files of 8-bit text: one byte is one character
    KX_CSET_UTF16 = -2,   // UTF-16 files, least significant byte first unless told otherwise
};
