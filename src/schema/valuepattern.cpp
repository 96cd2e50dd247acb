#include "schema/valuepattern.h"

#include <algorithm>

namespace {

bool shorterOrLess(std::u16string_view a, std::u16string_view b) {
    return a.size() != b.size() ? a.size() < b.size() : a < b;
}

}  // namespace

void ValuePattern::assign(std::u16string_view pattern) {
    singles_[0] = singles_[1] = 0;
    others_.clear();
    const auto add = [this](std::u16string_view alternative) {
        if (alternative.size() == 1 && alternative[0] < 128)
            singles_[alternative[0] >> 6] |= uint64_t{1} << (alternative[0] & 63);
        else
            others_.push_back(alternative);
    };
    for (;;) {
        const size_t bar = pattern.find(u'|');
        if (bar == std::u16string_view::npos || bar == 0) {
            add(pattern);
            break;
        }
        add(pattern.substr(0, bar));
        pattern.remove_prefix(bar + 1);
    }
    std::sort(others_.begin(), others_.end(), shorterOrLess);
}

bool ValuePattern::matchesOther(std::u16string_view value) const {
    return std::binary_search(others_.begin(), others_.end(), value, shorterOrLess);
}
