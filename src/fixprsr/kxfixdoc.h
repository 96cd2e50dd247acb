// Reader that sees a source file as FIX fields: tag, "=", value, separator.
#pragma once

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
    int32_t peekTag(KXWString& tag);
    // Consumes one field and yields its value (every "=" dropped, up to the separator).
    int32_t readValue(KXWString& value);
    // Sum of the codes of every character the last readValue consumed.
    int64_t lastFieldSum() const { return lastFieldSum_; }

  private:
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
