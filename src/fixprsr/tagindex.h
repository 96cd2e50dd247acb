// The field map as the walk uses it: every field read is looked up, and remembered as
// read for the required-field check at the end. A plain numeric tag is answered by
// its number, without string comparisons down the map's tree or hashing.
#pragma once

#include <unordered_set>
#include <vector>

#include "kxutil/kxwstring.h"
#include "schema/fixfield.h"

class TagIndex {
  public:
    using Entry = FIXFieldMap::value_type;

    explicit TagIndex(const FIXFieldMap& fieldMap);

    // The entry whose key is exactly tag, from now on counted as read; null when there
    // is none. Inline, as the walk calls it for every top-level field.
    const Entry* read(const KXWString& tag) {
        const int32_t n = canonicalNumber(tag);
        if (n < 0) return readOther(tag);
        if (n >= static_cast<int32_t>(byNumber_.size()) || byNumber_[n].entry == nullptr)
            return nullptr;
        byNumber_[n].read = true;
        return byNumber_[n].entry;
    }
    // Whether the entry whose key is exactly tag was read.
    bool wasRead(const KXWString& tag) const;

  private:
    struct Slot {
        const Entry* entry = nullptr;
        bool read = false;
    };
    // Tags beyond this, with a leading zero or with any other character go to the map.
    static constexpr int32_t kMaxIndexed = 99999;

    // The number a key spells in canonical decimal (no sign, no leading zero, at most
    // kMaxIndexed); -1 for every other key, so that each number stands for one key only.
    static int32_t canonicalNumber(const KXWString& tag) {
        const int32_t length = tag.length();
        if (length == 0 || length > 5 || tag[0] == u'0') return -1;
        int32_t n = 0;
        for (int32_t i = 0; i < length; ++i) {
            const char16_t c = tag[i];
            if (c < u'0' || c > u'9') return -1;
            n = n * 10 + (c - u'0');
        }
        return n <= kMaxIndexed ? n : -1;
    }
    const Entry* readOther(const KXWString& tag);

    const FIXFieldMap& fieldMap_;
    std::vector<Slot> byNumber_;
    std::unordered_set<const Entry*> otherRead_;
};
