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
    // is none.
    const Entry* read(const KXWString& tag);
    // Whether the entry whose key is exactly tag was read.
    bool wasRead(const KXWString& tag) const;

  private:
    struct Slot {
        const Entry* entry = nullptr;
        bool read = false;
    };
    // Tags beyond this, with a leading zero or with any other character go to the map.
    static constexpr int32_t kMaxIndexed = 99999;

    const FIXFieldMap& fieldMap_;
    std::vector<Slot> byNumber_;
    std::unordered_set<const Entry*> otherRead_;
};
