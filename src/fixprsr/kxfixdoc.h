// Reader that sees a source file as FIX fields: tag, "=", value, separator.
#pragma once

#include <algorithm>
#include <cstdint>

#include "kxutil/kxfileproxy.h"
#include "kxutil/kxwstring.h"
#include "kxvfixexport.h"

class KXVFIX_API KXFIXDoc : public KXFileProxy {
  public:
    // peekTag gathers at most this many characters, so that a file without "=" is
    // never held in memory whole; the tag then reads as this long prefix.
    static constexpr int32_t kMaxTagLength = 1024;

    KXFIXDoc() = default;
    KXFIXDoc(const KXFIXDoc& other) = default;
    KXFIXDoc& operator=(const KXFIXDoc& other) = default;
    ~KXFIXDoc() override;

    // As the file proxy's, and a new file forgets where the last peek was.
    int32_t openfile(const char16_t* path, const char* mode, KX_CSET cset);
    int32_t openfile(const char* path, const char* mode, KX_CSET cset);
    // After an optional byte-order mark and blank or ";" comment lines, the file starts
    // with "8". The reader is left on that first significant character.
    bool isFIXFile();
    // The next field's tag (everything before the next "="); nothing is consumed.
    // Inline, as are the usual cases of readValue, because the walk calls both for
    // every field: most fields lie whole in the buffer and are copied from there.
    int32_t peekTag(KXWString& tag) {
        savedPos = tell();
        tag.clear();
        const unsigned char* bytes = nullptr;
        const int32_t available = std::min(buffered(bytes), kMaxTagLength);
        Run run;
        tag.appendRun(kMaxTagLength, [&](char16_t* out) {
            run = copyRun(bytes, available, kEquals, out);
            return run.written;
        });
        if (!run.stopped) return peekTagSlow(tag);
        peek_ = {true, true, savedPos, savedPos + run.taken + 1, run.sum + kEquals};
        return tag.length();
    }
    // Consumes one field and yields its value (every "=" dropped, up to the separator).
    int32_t readValue(KXWString& value) {
        value.clear();
        if (!peek_.valid || !peek_.foundEquals || peek_.at != tell()) return readUnpeeked(value);
        seek(peek_.after, 0);
        const unsigned char* bytes = nullptr;
        const int32_t available = std::min(buffered(bytes), kValueRun);
        const auto separator = static_cast<unsigned char>(fieldSeparator);
        Run run;
        value.appendRun(kValueRun, [&](char16_t* out) {
            run = copyRun(bytes, available, separator, out);
            return run.written;
        });
        if (!run.stopped) {
            value.clear();
            return readRest(value, peek_.sum);
        }
        skipBuffered(run.taken + 1);
        lastFieldSum_ = peek_.sum + run.sum + separator;
        return value.length();
    }
    // Sum of the codes of every character the last readValue consumed.
    int64_t lastFieldSum() const { return lastFieldSum_; }

  private:
    static constexpr char16_t kEquals = u'=';
    // Characters of a value copied in one pass.
    static constexpr int32_t kValueRun = 1024;

    struct Run {
        int32_t taken = 0;    // bytes gone through, the stop not counted
        int32_t written = 0;  // characters written
        int64_t sum = 0;      // codes of the bytes gone through
        bool stopped = false;
    };
    // Widens bytes into out up to the first stop, at most limit of them, leaving out
    // every "=". out has room for limit characters.
    static Run copyRun(const unsigned char* bytes, int32_t limit, unsigned char stop,
                       char16_t* out) {
        Run run;
        const unsigned char* p = bytes;
        const unsigned char* const end = bytes + limit;
        char16_t* next = out;
        int64_t sum = 0;
        while (p != end) {
            const unsigned char c = *p;
            if (c == stop) {
                run.stopped = true;
                break;
            }
            ++p;
            sum += c;
            if (c != kEquals) *next++ = c;
        }
        run.taken = static_cast<int32_t>(p - bytes);
        run.written = static_cast<int32_t>(next - out);
        run.sum = sum;
        return run;
    }
    // The cases the inline readers leave: a field across buffers, UTF-16, a tag
    // without "=", a field that was not peeked at.
    int32_t peekTagSlow(KXWString& tag);
    int32_t readUnpeeked(KXWString& value);
    // The value from here, just past its "=", to the separator; sum holds the codes
    // consumed so far.
    int32_t readRest(KXWString& value, int64_t sum);

    // Where the last peekTag found its field, so that reading the field that was peeked
    // at does not read its tag again. Forgotten whenever a file is opened.
    struct Peek {
        bool valid = false;
        bool foundEquals = false;
        int64_t at = 0;     // where the tag starts
        int64_t after = 0;  // just past its "="
        int64_t sum = 0;    // codes of the tag and its "="
    };

    int64_t savedPos = 0;
    char fieldSeparator = 1;  // SOH
    int64_t lastFieldSum_ = 0;
    Peek peek_;
};
