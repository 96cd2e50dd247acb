#include "kxutil/kxwstring.h"

#include <algorithm>
#include <cstring>
#include <string>

#include "kxutil/kxstring.h"
#include "kxutil/utf.h"

namespace {

int32_t textLength(const char16_t* text) {
    int32_t n = 0;
    if (text != nullptr)
        while (text[n] != 0) ++n;
    return n;
}

}  // namespace

KXWString::KXWString(const KXWString& other) {
    assign(other.data_, other.length_);
}

KXWString::KXWString(KXWString&& other) noexcept
    : data_(other.data_), length_(other.length_), capacity_(other.capacity_) {
    other.data_ = nullptr;
    other.length_ = other.capacity_ = 0;
}

KXWString::KXWString(const char16_t* text, int32_t length) {
    assign(text, length < 0 ? textLength(text) : length);
}

KXWString::~KXWString() {
    delete[] data_;
}

KXWString& KXWString::operator=(KXWString&& other) noexcept {
    if (this != &other) {
        delete[] data_;
        data_ = other.data_;
        length_ = other.length_;
        capacity_ = other.capacity_;
        other.data_ = nullptr;
        other.length_ = other.capacity_ = 0;
    }
    return *this;
}

KXWString& KXWString::operator=(const char16_t* text) {
    assign(text, textLength(text));
    return *this;
}

KXWString& KXWString::operator+=(const KXWString& other) {
    append(other.data_, other.length_);
    return *this;
}

KXWString& KXWString::operator+=(const char16_t* text) {
    append(text, textLength(text));
    return *this;
}

int32_t KXWString::find(char16_t c, int32_t start) const {
    for (int32_t i = std::max(start, 0); i < length_; ++i)
        if (data_[i] == c) return i;
    return -1;
}

int32_t KXWString::find(const char16_t* text, int32_t start) const {
    const std::u16string_view haystack(c_str(), static_cast<size_t>(length_));
    const size_t at = haystack.find(text, static_cast<size_t>(std::max(start, 0)));
    return at == std::u16string_view::npos ? -1 : static_cast<int32_t>(at);
}

KXWString KXWString::substr(int32_t start, int32_t count) const {
    start = std::clamp(start, 0, length_);
    count = std::clamp(count, 0, length_ - start);
    return KXWString(c_str() + start, count);
}

void KXWString::Remove(int32_t count, int32_t start) {
    if (start < 0 || start >= length_ || count <= 0) return;
    count = std::min(count, length_ - start);
    std::memmove(data_ + start, data_ + start + count,
                 sizeof(char16_t) * static_cast<size_t>(length_ - start - count + 1));
    length_ -= count;
}

void KXWString::reserve(int32_t length) {
    if (length < capacity_) return;
    const int32_t capacity = std::max(length + 1, capacity_ * 2);
    auto* data = new char16_t[static_cast<size_t>(capacity)];
    if (length_ > 0) std::memcpy(data, data_, sizeof(char16_t) * static_cast<size_t>(length_));
    data[length_] = 0;
    delete[] data_;
    data_ = data;
    capacity_ = capacity;
}

bool KXWString::Assign(const char* text, KX_CSET cset, int32_t length) {
    std::u16string converted;
    const size_t n =
        length < 0 ? (text != nullptr ? std::strlen(text) : 0) : static_cast<size_t>(length);
    const bool lossless = kxutil::toUtf16(text, n, cset, converted);
    assign(converted.data(), static_cast<int32_t>(converted.size()));
    return lossless;
}

bool KXWString::Assign(const KXString& text, KX_CSET cset) {
    return Assign(text.c_str(), cset, text.length());
}

void KXWString::assign(const char16_t* text, int32_t length) {
    length_ = 0;
    append(text, length);
    if (data_ != nullptr) data_[length_] = 0;
}

void KXWString::append(const char16_t* text, int32_t length) {
    if (length <= 0) return;
    // The text may lie inside this string's own storage, which reserve may replace.
    const bool inside = data_ != nullptr && text >= data_ && text < data_ + capacity_;
    const auto offset = inside ? text - data_ : 0;
    reserve(length_ + length);
    if (inside) text = data_ + offset;
    std::memmove(data_ + length_, text, sizeof(char16_t) * static_cast<size_t>(length));
    length_ += length;
    data_[length_] = 0;
}
