#include <gtest/gtest.h>

#include <limits>

#include "checkharness.h"
#include "fixprsr/decimal.h"

namespace {

struct DecimalCase {
    const char* text;
    int64_t value;
    int count;
};

constexpr int64_t kMax64 = std::numeric_limits<int64_t>::max();
constexpr int64_t kMin64 = std::numeric_limits<int64_t>::min();
constexpr int kMaxInt = std::numeric_limits<int>::max();
constexpr int kMinInt = std::numeric_limits<int>::min();

TEST(LeadingDecimal, ReadsLikeWcstolAndSaturates) {
    const DecimalCase cases[] = {
        {"017", 17, 17},
        {" \t+42", 42, 42},
        {"-7", -7, -7},
        {"2x", 2, 2},
        {"x2", 0, 0},
        {"", 0, 0},
        {"-", 0, 0},
        {"+ 1", 0, 0},
        {"2147483647", kMaxInt, kMaxInt},
        {"2147483648", 2147483648LL, kMaxInt},
        {"-2147483649", -2147483649LL, kMinInt},
        {"9223372036854775807", kMax64, kMaxInt},
        {"9223372036854775808", kMax64, kMaxInt},
        {"-9223372036854775808", kMin64, kMinInt},
        {"-9223372036854775809", kMin64, kMinInt},
        {"99999999999999999999999", kMax64, kMaxInt},
    };
    for (const auto& c : cases) {
        const KXWString text = checks::wide(c.text);
        EXPECT_EQ(leadingDecimal(text), c.value) << c.text;
        EXPECT_EQ(repetitionCount(text), c.count) << c.text;
    }
}

}  // namespace
