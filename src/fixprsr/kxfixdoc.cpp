#include "fixprsr/kxfixdoc.h"

#include <cwctype>

namespace {

constexpr char16_t kEnd = KXFileProxy::kEndOfData;
constexpr char16_t kEquals = u'=';
constexpr int32_t kSniffLength = 5;

}  // namespace

KXFIXDoc::~KXFIXDoc() {
    close(false);
}

bool KXFIXDoc::isFIXFile() {
    setBufferSize(16384);
    const int32_t first = getch() & 0xFFFF;
    if (first == 0xFFFE) {
        setMSBFirst(true);
    } else if (first == 0xFEFF) {
        setMSBFirst(false);
    } else {
        wputBack(static_cast<char16_t>(first));
    }
    for (;;) {
        const char16_t c = wgetch();
        if (c == kEnd) break;
        if (c == u';') {
            char16_t d;
            do d = wgetch();
            while (d != u'\n' && d != kEnd);
            continue;
        }
        if (std::iswspace(c) != 0 || c == u'\r' || c == u'\n') continue;
        wputBack(c);
        break;
    }
    savedPos = tell();
    char16_t start[kSniffLength];
    const int32_t n = read(start, kSniffLength);
    seek(savedPos, 0);
    return n > 0 && start[0] == u'8';
}

int32_t KXFIXDoc::peekTag(KXWString& tag) {
    savedPos = tell();
    tag.clear();
    for (int32_t n = 0; n < kMaxTagLength; ++n) {
        const char16_t c = wgetch();
        if (c == kEquals || c == kEnd) break;
        tag += c;
    }
    seek(savedPos, 0);
    return tag.length();
}

int32_t KXFIXDoc::readValue(KXWString& value) {
    value.clear();
    const char16_t separator = static_cast<unsigned char>(fieldSeparator);
    int64_t sum = 0;
    bool seenEquals = false;
    for (;;) {
        const char16_t c = wgetch();
        if (c == kEnd) break;
        sum += c;
        if (c == kEquals) {
            seenEquals = true;
        } else if (seenEquals) {
            if (c == separator) break;
            value += c;
        }
    }
    lastFieldSum_ = sum;
    return value.length();
}
