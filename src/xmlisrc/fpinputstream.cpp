#include "xmlisrc/fpinputstream.h"

#include <algorithm>
#include <climits>

#include "kxutil/kxstring.h"

FPInputStream::FPInputStream(const KXWString& fileName, bool designMode) {
    KXString narrow;
    narrow.Assign(fileName.c_str(), KX_CSET_DEFAULT, -1);
    if (proxy.openfile(narrow.c_str(), "rb", KX_CSET_BYTE) != -1) proxy.setDesignMode(designMode);
}

FPInputStream::~FPInputStream() {
    proxy.close(false);
}

XMLSize_t FPInputStream::readBytes(XMLByte* toFill, XMLSize_t maxToRead) {
    const auto count = static_cast<int32_t>(std::min<XMLSize_t>(maxToRead, INT32_MAX));
    const int32_t n = proxy.read(reinterpret_cast<char*>(toFill), count);
    // A failed read ends the parser's input here.
    if (n <= 0) return 0;
    bytesDelivered += static_cast<uint32_t>(n);
    return static_cast<XMLSize_t>(n);
}
