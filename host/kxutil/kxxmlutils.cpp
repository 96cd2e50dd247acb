#include "kxutil/kxxmlutils.h"

namespace KXXmlUtils {

void XMLChToWchar(const char16_t* text, KXWString& out, bool /*transcode*/) {
    out = text != nullptr ? text : u"";
}

}  // namespace KXXmlUtils
