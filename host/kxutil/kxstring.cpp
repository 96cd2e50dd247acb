#include "kxutil/kxstring.h"

#include <algorithm>
#include <cstring>
#include <string>

#include "kxutil/utf.h"

KXString::KXString(const KXString& other) {
    assign(other.data_, other.length_);
}

KXString::KXString(const char* text) {
    *this = text;
}

KXString::~KXString() {
    delete[] data_;
}

KXString& KXString::operator=(const KXString& other) {
    if (this != &other) assign(other.data_, other.length_);
    return *this;
}

KXString& KXString::operator=(const char* text) {
    assign(text, text != nullptr ? static_cast<int32_t>(std::strlen(text)) : 0);
    return *this;
}

KXString& KXString::operator+=(const KXString& other) {
    append(other.data_, other.length_);
    return *this;
}

KXString& KXString::operator+=(const char* text) {
    if (text != nullptr) append(text, static_cast<int32_t>(std::strlen(text)));
    return *this;
}

bool KXString::operator==(const char* text) const {
    return std::strcmp(c_str(), text != nullptr ? text : "") == 0;
}

bool KXString::Assign(const char16_t* text, KX_CSET cset, int32_t length) {
    size_t n = 0;
    if (length >= 0) {
        n = static_cast<size_t>(length);
    } else if (text != nullptr) {
        while (text[n] != 0) ++n;
    }
    std::string converted;
    const bool lossless = kxutil::fromUtf16(text, n, cset, converted);
    assign(converted.data(), static_cast<int32_t>(converted.size()));
    return lossless;
}

void KXString::assign(const char* text, int32_t length) {
    length_ = 0;
    if (data_ != nullptr) data_[0] = 0;
    append(text, length);
}

void KXString::append(const char* text, int32_t length) {
    if (length <= 0) return;
    if (length_ + length >= capacity_) {
        const int32_t capacity = std::max(length_ + length + 1, capacity_ * 2);
        char* data = new char[static_cast<size_t>(capacity)];
        if (length_ > 0) std::memcpy(data, data_, static_cast<size_t>(length_));
        // The text may lie inside the storage about to be released.
        if (data_ != nullptr && text >= data_ && text < data_ + capacity_)
            text = data + (text - data_);
        delete[] data_;
        data_ = data;
        capacity_ = capacity;
    }
    std::memmove(data_ + length_, text, static_cast<size_t>(length));
    length_ += length;
    data_[length_] = 0;
}
