#include <gtest/gtest.h>

#include "checkharness.h"

namespace {

using checks::wide;

struct LikeCase {
    const char* pattern;
    const char* value;
    bool matches;
};

TEST(IsLike, AlternativesSplitAtBarsUntilOneStartsTheRest) {
    const LikeCase cases[] = {
        {"A|B|C", "A", true},
        {"A|B|C", "B", true},
        {"A|B|C", "C", true},
        {"A|B|C", "D", false},
        {"A|B|C", "A|B", false},
        {"A|B|C", "", false},
        {"0", "0", true},
        {"0", "00", false},
        // A leading bar stops the splitting at once: the pattern matches only itself.
        {"|A", "A", false},
        {"|A", "|A", true},
        {"|A", "", false},
        // So does an empty alternative in the middle.
        {"A||B", "A", true},
        {"A||B", "|B", true},
        {"A||B", "B", false},
        {"A||B", "", false},
        {"A|", "A", true},
        {"A|", "", true},
        {"", "", true},
        {"", "A", false},
        {"FIX.4.2|FIX.4.4", "FIX.4.2", true},
        {"FIX.4.2|FIX.4.4", "FIX.4.4", true},
        {"FIX.4.2|FIX.4.4", "FIX.4.3", false},
        {"FIX.4.2|FIX.4.4", "fix.4.2", false},
        {"FIX.4.2|FIX.4.4", "FIX.4.", false},
        {"D|F|G", "D", true},
        {"D|F|G", "F", true},
        {"D|F|G", "G", true},
        {"D|F|G", "DF", false},
        {"D|F|G", "", false},
    };
    KXFIXValidator validator;
    for (const auto& c : cases) {
        const KXWString pattern = wide(c.pattern);
        const KXWString value = wide(c.value);
        EXPECT_EQ(KXFIXValidatorAccess::isLike(validator, value, pattern), c.matches)
            << "pattern \"" << c.pattern << "\", value \"" << c.value << "\"";
        // checkValidField takes the pattern first.
        EXPECT_EQ(KXFIXValidatorAccess::checkValidField(validator, pattern, value),
                  c.matches ? BATCH_OK : BATCH_CHECK_FAILED)
            << "pattern \"" << c.pattern << "\", value \"" << c.value << "\"";
        EXPECT_EQ(checks::narrow(pattern), c.pattern);  // the caller's pattern is untouched
    }
}

}  // namespace
