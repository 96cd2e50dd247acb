#include "fixprsr/tagindex.h"

TagIndex::TagIndex(const FIXFieldMap& fieldMap) : fieldMap_(fieldMap) {
    for (const Entry& entry : fieldMap_) {
        const int32_t n = canonicalNumber(entry.first);
        if (n < 0) continue;
        if (n >= static_cast<int32_t>(byNumber_.size())) byNumber_.resize(n + 1);
        byNumber_[n].entry = &entry;
    }
}

const TagIndex::Entry* TagIndex::readOther(const KXWString& tag) {
    const auto entry = fieldMap_.find(tag);
    if (entry == fieldMap_.end()) return nullptr;
    otherRead_.insert(&*entry);
    return &*entry;
}

bool TagIndex::wasRead(const KXWString& tag) const {
    const int32_t n = canonicalNumber(tag);
    if (n >= 0) return n < static_cast<int32_t>(byNumber_.size()) && byNumber_[n].read;
    const auto entry = fieldMap_.find(tag);
    return entry != fieldMap_.end() && otherRead_.count(&*entry) != 0;
}
