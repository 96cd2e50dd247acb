// A Value pattern split once into its alternatives, so that matching a field's value
// costs a bit test or a binary search instead of a walk along the pattern text.
#pragma once

#include <cstdint>
#include <string_view>
#include <vector>

#include "kxvfixexport.h"

class KXVFIX_API ValuePattern {
  public:
    // "A|B|C" holds A, B and C. The alternatives end at the first empty one: its "|"
    // belongs to the last alternative, with the rest of the pattern. The views point
    // into pattern, which must outlive this object or the next assign. Until assigned,
    // it holds no alternative.
    void assign(std::u16string_view pattern);
    // Whether value equals one of the alternatives.
    bool matches(std::u16string_view value) const {
        if (value.size() == 1 && value[0] < 128) {
            const char16_t c = value[0];
            if ((singles_[c >> 6] >> (c & 63) & 1) != 0) return true;
        }
        return matchesOther(value);
    }

  private:
    bool matchesOther(std::u16string_view value) const;

    // One bit per one-character ASCII alternative: most FIX enumerations are those.
    uint64_t singles_[2] = {0, 0};
    // The other alternatives, ordered by length, then by content.
    std::vector<std::u16string_view> others_;
};
