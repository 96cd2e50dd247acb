// 8-bit string of the host, used where a path meets an 8-bit interface.
#pragma once

#include <cstdint>

#include "kxexport.h"
#include "kxutil/kxcset.h"

class KXUTIL_API KXString {
  public:
    KXString() = default;
    KXString(const KXString& other);
    KXString(const char* text);
    virtual ~KXString();

    KXString& operator=(const KXString& other);
    KXString& operator=(const char* text);
    KXString& operator+=(const KXString& other);
    KXString& operator+=(const char* text);
    bool operator==(const char* text) const;

    // Converts UTF-16 text; length -1 means up to the terminating zero. False when the
    // text did not convert without loss.
    bool Assign(const char16_t* text, KX_CSET cset, int32_t length = -1);

    int32_t length() const { return length_; }
    const char* c_str() const { return data_ != nullptr ? data_ : ""; }

  private:
    void assign(const char* text, int32_t length);
    void append(const char* text, int32_t length);

    char* data_ = nullptr;
    int32_t length_ = 0;
    int32_t capacity_ = 0;
};
