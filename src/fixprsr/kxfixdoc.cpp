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
    peek_.valid = false;  // a new file, or the same one read anew
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
    if (!peek_.valid || peek_.at != savedPos) {
        peek_.valid = true;
        peek_.at = savedPos;
        peek_.sum = 0;
        KXWString& text = peek_.tag;
        text.clear();
        int64_t& sum = peek_.sum;
        const char16_t last = scan(
            [&text](char16_t c) { return c == kEquals || text.length() == kMaxTagLength; },
            [&text, &sum](char16_t c) {
                text += c;
                sum += c;
            });
        // Stopped by the length bound, the character read last is not the tag's.
        peek_.foundEquals = last == kEquals && text.length() < kMaxTagLength;
        if (peek_.foundEquals) sum += last;
        peek_.after = tell();
        seek(savedPos, 0);
    }
    tag = peek_.tag;
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
