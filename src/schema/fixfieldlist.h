// Growable array of nodes. It owns what it holds, except for lists that only refer to
// nodes owned elsewhere, which must shrink with dropLast and never destroy.
#pragma once

#include <cstdint>

#include "kxvfixexport.h"

class FIXField;

class KXVFIX_API FIXFieldList {
  public:
    static constexpr int32_t kGrowth = 16;

    FIXFieldList();
    FIXFieldList(const FIXFieldList&) = delete;
    FIXFieldList& operator=(const FIXFieldList&) = delete;
    ~FIXFieldList();

    int32_t getCount() const { return count; }
    FIXField* getAt(int32_t index) const {
        return index >= 0 && index < count ? items[index] : nullptr;
    }
    FIXField* getLast() const { return count > 0 ? items[count - 1] : nullptr; }

    // Adds node (a new empty node when null) at the end and returns it; null, and
    // nothing changed, when storage cannot be obtained.
    FIXField* append(FIXField* node);
    void removeAt(int32_t index);  // destroys the entry
    void dropLast();               // forgets the last entry without destroying it
    void clear();                  // destroys every entry, keeps the storage

  private:
    int32_t count = 0;
    int32_t capacity = 0;
    FIXField** items = nullptr;
};
