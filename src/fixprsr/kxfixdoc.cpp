#include "fixprsr/kxfixdoc.h"

#include <algorithm>
#include <cwctype>

namespace {

constexpr char16_t kEnd = KXFileProxy::kEndOfData;
constexpr char16_t kEquals = u'=';
constexpr int32_t kSniffLength = 5;
// Characters of a value copied in one pass.
constexpr int32_t kValueRun = 1024;

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
    peek_.valid = true;
    peek_.at = savedPos;
    // Most tags lie whole in the buffer: they are copied from there, nothing consumed.
    const unsigned char* bytes = nullptr;
    const int32_t available = std::min(buffered(bytes), kMaxTagLength);
    bool found = false;
    int64_t runSum = kEquals;
    tag.appendRun(kMaxTagLength, [bytes, available, &found, &runSum](char16_t* out) {
        int32_t length = 0;
        while (length != available) {
            const char16_t c = bytes[length];
            if ((found = c == kEquals)) break;
            runSum += c;
            out[length++] = c;
        }
        return length;
    });
    if (found) {
        peek_.foundEquals = true;
        peek_.after = savedPos + tag.length() + 1;
        peek_.sum = runSum;
        return tag.length();
    }
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
    // Every later "=" is dropped from the value, though it counts in the sum. Buffered
    // bytes are taken a run at a time; the rest, one character at a time.
    const char16_t separator = static_cast<unsigned char>(fieldSeparator);
    char16_t last = kEnd;
    for (;;) {
        const unsigned char* bytes = nullptr;
        const int32_t available = buffered(bytes);
        if (available == 0) {
            last = wgetch();
            if (last == kEnd || last == separator) break;
            sum += last;
            if (last != kEquals) value += last;
            continue;
        }
        // The room depends on the value alone, never on what happens to be buffered, so
        // a value's storage grows the same however the file falls into buffers.
        const int32_t room = std::max(kValueRun - value.length(), value.length());
        const int32_t limit = std::min(available, room);
        bool found = false;
        int32_t run = 0;
        value.appendRun(room, [bytes, limit, separator, &sum, &found, &run](char16_t* out) {
            const unsigned char* p = bytes;
            char16_t* next = out;
            int32_t runSum = 0;
            while (p != bytes + limit) {
                const char16_t c = *p;
                if (c == separator) {
                    found = true;
                    break;
                }
                ++p;
                runSum += c;
                if (c != kEquals) *next++ = c;
            }
            sum += runSum;
            run = static_cast<int32_t>(p - bytes);
            return static_cast<int32_t>(next - out);
        });
        if (found) {
            skipBuffered(run + 1);
            last = separator;
            break;
        }
        skipBuffered(run);
    }
    if (last != kEnd) add(last);
    lastFieldSum_ = sum;
    return value.length();
}
