#include "fixprsr/tagindex.h"

namespace {

// The number a key spells in canonical decimal (no sign, no leading zero, at most
// maxIndexed); -1 for every other key, so that each number stands for one key only.
int32_t canonicalNumber(const KXWString& tag, int32_t maxIndexed) {
    const int32_t length = tag.length();
    if (length == 0 || length > 5 || tag[0] == u'0') return -1;
    int32_t n = 0;
    for (int32_t i = 0; i < length; ++i) {
        const char16_t c = tag[i];
        if (c < u'0' || c > u'9') return -1;
        n = n * 10 + (c - u'0');
    }
    return n <= maxIndexed ? n : -1;
}

}  // namespace

TagIndex::TagIndex(const FIXFieldMap& fieldMap) : fieldMap_(fieldMap) {
    for (const Entry& entry : fieldMap_) {
        const int32_t n = canonicalNumber(entry.first, kMaxIndexed);
        if (n < 0) continue;
        if (n >= static_cast<int32_t>(byNumber_.size())) byNumber_.resize(n + 1);
        byNumber_[n].entry = &entry;
    }
}

const TagIndex::Entry* TagIndex::read(const KXWString& tag) {
    const int32_t n = canonicalNumber(tag, kMaxIndexed);
    if (n >= 0) {
        if (n >= static_cast<int32_t>(byNumber_.size()) || byNumber_[n].entry == nullptr)
            return nullptr;
        byNumber_[n].read = true;
        return byNumber_[n].entry;
    }
    const auto entry = fieldMap_.find(tag);
    if (entry == fieldMap_.end()) return nullptr;
    otherRead_.insert(&*entry);
    return &*entry;
}

bool TagIndex::wasRead(const KXWString& tag) const {
    const int32_t n = canonicalNumber(tag, kMaxIndexed);
    if (n >= 0) return n < static_cast<int32_t>(byNumber_.size()) && byNumber_[n].read;
    const auto entry = fieldMap_.find(tag);
    return entry != fieldMap_.end() && otherRead_.count(&*entry) != 0;
}
