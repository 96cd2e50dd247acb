#include "fixprsr/kxfixdoc.h"

#include <cwctype>

namespace {

constexpr char16_t kEnd = KXFileProxy::kEndOfData;
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

int32_t KXFIXDoc::peekTagSlow(KXWString& tag) {
    tag.clear();
    int64_t sum = 0;
    const char16_t last =
        scan([&tag](char16_t c) { return c == kEquals || tag.length() == kMaxTagLength; },
             [&tag, &sum](char16_t c) {
                 tag += c;
                 sum += c;
             });
    // Stopped by the length bound, the character read last is not the tag's.
    const bool foundEquals = last == kEquals && tag.length() < kMaxTagLength;
    peek_ = {true, foundEquals, savedPos, tell(), foundEquals ? sum + last : sum};
    seek(savedPos, 0);
    return tag.length();
}

int32_t KXFIXDoc::readUnpeeked(KXWString& value) {
    int64_t sum = 0;
    const char16_t equals =
        scan([](char16_t c) { return c == kEquals; }, [&sum](char16_t c) { sum += c; });
    if (equals == kEnd) {
        lastFieldSum_ = sum;
        return 0;
    }
    return readRest(value, sum + equals);
}

// Buffered bytes are taken a run at a time; the rest, one character at a time. Every
// later "=" is dropped from the value, though it counts in the sum.
int32_t KXFIXDoc::readRest(KXWString& value, int64_t sum) {
    const auto separator = static_cast<unsigned char>(fieldSeparator);
    for (;;) {
        const unsigned char* bytes = nullptr;
        const int32_t available = buffered(bytes);
        if (available == 0) {
            const char16_t c = wgetch();
            if (c == kEnd) break;
            sum += c;
            if (c == separator) break;
            if (c != kEquals) value += c;
            continue;
        }
        // The room depends on the value alone, never on what happens to be buffered, so
        // a value's storage grows the same however the file falls into buffers.
        const int32_t room = std::max(kValueRun - value.length(), value.length());
        Run run;
        value.appendRun(room, [&](char16_t* out) {
            run = copyRun(bytes, std::min(available, room), separator, out);
            return run.written;
        });
        sum += run.sum;
        if (run.stopped) {
            skipBuffered(run.taken + 1);
            sum += separator;
            break;
        }
        skipBuffered(run.taken);
    }
    lastFieldSum_ = sum;
    return value.length();
}
