// UTF-16 string of the host. Everything that allocates is defined out of line, so the
// memory a string owns is always obtained and released inside this library.
#pragma once

#include <cstdint>
#include <string_view>

#include "kxexport.h"
#include "kxutil/kxcset.h"

class KXString;

class KXUTIL_API KXWString {
  public:
    KXWString() = default;
    KXWString(const KXWString& other);
    KXWString(KXWString&& other) noexcept;
    // length -1: up to the terminating zero.
    KXWString(const char16_t* text, int32_t length = -1);
    virtual ~KXWString();

    // Into storage that is large enough, copying allocates nothing and stays inline: the
    // walk copies every tag it reads.
    KXWString& operator=(const KXWString& other) {
        if (this != &other) {
            if (other.length_ < capacity_) {
                for (int32_t i = 0; i < other.length_; ++i) data_[i] = other.data_[i];
                length_ = other.length_;
                data_[length_] = 0;
            } else {
                assign(other.data_, other.length_);
            }
        }
        return *this;
    }
    KXWString& operator=(KXWString&& other) noexcept;
    KXWString& operator=(const char16_t* text);

    KXWString& operator+=(const KXWString& other);
    KXWString& operator+=(const char16_t* text);
    KXWString& operator+=(char16_t c) {
        if (length_ + 1 >= capacity_) reserve(length_ + 1);
        data_[length_++] = c;
        data_[length_] = 0;
        return *this;
    }

    // Appends the characters fill writes into room for `room` of them; fill answers how
    // many it wrote. For readers that copy a run in one pass.
    template <typename Fill>
    KXWString& appendRun(int32_t room, Fill fill) {
        if (length_ + room >= capacity_) reserve(length_ + room);
        length_ += fill(data_ + length_);
        data_[length_] = 0;
        return *this;
    }

    // Comparisons allocate nothing, so they are inline: the field map compares on every
    // field of every source.
    bool operator==(const KXWString& other) const { return view() == other.view(); }
    bool operator!=(const char16_t* text) const {
        return view() != (text != nullptr ? std::u16string_view(text) : std::u16string_view());
    }
    bool operator<(const KXWString& other) const { return view() < other.view(); }

    // Position of the first occurrence at or after start; -1 when there is none.
    int32_t find(char16_t c, int32_t start = 0) const;
    int32_t find(const char16_t* text, int32_t start = 0) const;
    KXWString substr(int32_t start, int32_t count) const;
    void Remove(int32_t count, int32_t start);

    // Keeps the storage, so a reused working string stops allocating.
    void clear() {
        length_ = 0;
        if (data_ != nullptr) data_[0] = 0;
    }
    // Makes room for at least `length` characters plus the terminating zero.
    void reserve(int32_t length);

    int32_t length() const { return length_; }
    const char16_t* c_str() const { return data_ != nullptr ? data_ : u""; }
    char16_t operator[](int32_t i) const { return data_[i]; }
    std::u16string_view view() const {
        return {c_str(), static_cast<std::u16string_view::size_type>(length_)};
    }

    // Both answer false when the text did not convert without loss; the result is then
    // the converted form, with U+FFFD for what could not be converted.
    bool Assign(const char* text, KX_CSET cset, int32_t length = -1);
    bool Assign(const KXString& text, KX_CSET cset);

  private:
    void assign(const char16_t* text, int32_t length);
    void append(const char16_t* text, int32_t length);

    char16_t* data_ = nullptr;
    int32_t length_ = 0;
    int32_t capacity_ = 0;  // slots in data_, the terminating zero included
};
