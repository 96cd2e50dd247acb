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

int32_t KXFIXDoc::openfile(const char16_t* path, const char* mode, KX_CSET cset) {
    peek_.valid = false;
    return KXFileProxy::openfile(path, mode, cset);
}

int32_t KXFIXDoc::openfile(const char* path, const char* mode, KX_CSET cset) {
    peek_.valid = false;
    return KXFileProxy::openfile(path, mode, cset);
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
    int64_t sum = 0;
    const char16_t last =
        scan([&tag](char16_t c) { return c == kEquals || tag.length() == kMaxTagLength; },
             [&tag, &sum](char16_t c) {
                 tag += c;
                 sum += c;
             });
    // Stopped by the length bound, the character read last is not the tag's.
    peek_.foundEquals = last == kEquals && tag.length() < kMaxTagLength;
    peek_.valid = true;
    peek_.at = savedPos;
    peek_.after = tell();
    peek_.sum = peek_.foundEquals ? sum + last : sum;
    seek(savedPos, 0);
    return tag.length();
}

int32_t KXFIXDoc::readValue(KXWString& value) {
    value.clear();
    int64_t sum = 0;
    const auto add = [&sum](char16_t c) { sum += c; };
    if (peek_.valid && peek_.foundEquals && peek_.at == tell()) {
        seek(peek_.after, 0);
        sum = peek_.sum;
    } else {
        const char16_t equals = scan([](char16_t c) { return c == kEquals; }, add);
        if (equals == kEnd) {
            lastFieldSum_ = sum;
            return 0;
        }
        add(equals);
    }
    // Every later "=" is dropped from the value, though it counts in the sum.
    const char16_t separator = static_cast<unsigned char>(fieldSeparator);
    const char16_t last = scan([separator](char16_t c) { return c == separator; },
                               [&sum, &value](char16_t c) {
                                   sum += c;
                                   if (c != kEquals) value += c;
                               });
    if (last != kEnd) add(last);
    lastFieldSum_ = sum;
    return value.length();
}
