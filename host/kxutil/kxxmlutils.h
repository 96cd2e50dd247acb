// Bridge from the XML library's text to the host's strings.
#pragma once

#include "kxexport.h"
#include "kxutil/kxwstring.h"

namespace KXXmlUtils {

// out then holds exactly text (null gives the empty string). The XML library's
// character type is a 16-bit unit, so nothing is lost. `transcode` is kept for the
// host's interface; only false is used.
KXUTIL_API void XMLChToWchar(const char16_t* text, KXWString& out, bool transcode);

}  // namespace KXXmlUtils
